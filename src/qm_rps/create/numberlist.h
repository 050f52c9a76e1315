// Lists of numbers as a person writes them: "5, 5, 4.5" or "3x5".
#pragma once

#include <optional>
#include <string>
#include <string_view>
#include <vector>

/// Numbers parted by commas, semicolons or blanks; "3x5" is 5, 5, 5. A comma between digits is a
/// decimal one beside semicolons ("3,5; 3"). An empty text is an empty list. None: a part is no
/// finite number, the list has more than 1000 of them, or it can be read in two ways ("3,5 3",
/// "2x4,5"); `why` says which, for the user.
std::optional<std::vector<double>> ParseNumberList(std::string_view text, std::string& why);

/// "5, 5, 4.5": reads back as the same numbers.
std::string NumberListText(const std::vector<double>& numbers);
