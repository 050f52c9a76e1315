// Places in a JSON document as messages show them: pushover[0].steps.displacement."5".
#pragma once

#include <cstddef>
#include <string>
#include <string_view>

/// Text for a one-line message: control characters are escaped.
std::string EscapedText(std::string_view text);
/// Text in quotes for a message, cut when it is very long.
std::string QuotedText(std::string_view text);

/// Place of a member or an item of the value at `place` (empty: the whole document).
/// Keys that are identifiers stand plain, others in quotes.
std::string MemberPlace(const std::string& place, std::string_view key);
std::string ItemPlace(const std::string& place, std::size_t index);
