// Tables as text for the terminal.
#pragma once

#include <string>
#include <vector>

using T_TABLE_ROWS = std::vector<std::vector<std::string>>;

/// Columns under their heads (the first row), numbers to the right, the last one to the left.
std::string TableText(const T_TABLE_ROWS& rows);
