// A block of cells as a spreadsheet copies it, and where it may be pasted.
#pragma once

#include <cstddef>
#include <string>
#include <vector>

/// Selected cells; a single cell is where a pasted block starts.
struct T_GRID_RANGE {
    std::size_t row = 0, column = 0, rows = 1, columns = 1;
};
using T_GRID_BLOCK = std::vector<std::vector<std::string>>;

/// Lines of tab-separated cells; line ends of either kind, and a last one is no row.
T_GRID_BLOCK BlockOfText(std::string text);

/// Key of the message of what keeps a block from a range of a table; null when it fits. Into one
/// cell the block must fit between it and the table's end; into several it must have their size.
const char* WrongShape(const T_GRID_BLOCK& block, const T_GRID_RANGE& range, std::size_t rows,
                       std::size_t columns);
