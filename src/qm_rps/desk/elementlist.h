// Lists of element numbers as a person writes them.
#pragma once

#include <optional>
#include <string>
#include <vector>

/// The numbers of "1, 2, 5-9", ascending, each once; an empty text is an empty list. None: the text
/// is no such list, or names more than a million numbers.
std::optional<std::vector<int>> ParseElementList(const std::string& text);

/// The shortest such text of numbers that ascend: "1, 2, 5-9".
std::string ElementListText(const std::vector<int>& ids);
