// Which known name someone meant who typed another one.
#pragma once

#include <span>
#include <string>
#include <string_view>

/// The known name with the fewest changed, missing, additional or swapped letters, where these are
/// at most a third of the typed ones (one of two or three letters). Else the first that begins with
/// a typed name of three letters or more, else the first that has it as a part. Empty: none. Case,
/// '-' and '_' count as alike.
std::string NearestName(std::string_view typed, std::span<const std::string_view> known);
