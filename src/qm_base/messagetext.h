// Texts with numbered places {1}, {2} ... that a translator may reorder; "{{" is a brace.
#pragma once

#include <set>
#include <span>
#include <string>
#include <string_view>

namespace zql::lib {

/// The text with {1}, {2} ... replaced by the arguments, taken as they are: a brace inside an
/// argument means nothing. A place without an argument stays as it is.
std::string FillPlaces(std::string_view text, std::span<const std::string_view> args);

/// The numbers of the places in a text.
std::set<std::size_t> PlacesOf(std::string_view text);

} // namespace zql::lib
