// A table of numbers as a person pastes it from a spreadsheet or another program: rows with their
// lines, what was skipped, and what was taken for the decimal point and the separator.
#pragma once

#include <string>
#include <string_view>
#include <vector>

enum class PASTED_DECIMAL { Auto, Point, Comma };
enum class PASTED_SEPARATOR { Blanks, Commas, Semicolons };

struct T_PASTED_ROW {
    int line = 0; // of the text, from 1
    std::vector<double> cells{};
};

struct T_PASTED_TABLE {
    std::vector<T_PASTED_ROW> rows; // as many cells in each
    std::vector<std::string> names; // of the columns, from the last header line; may be empty
    std::vector<int> headers;       // lines of words before the numbers, which were skipped
    PASTED_SEPARATOR separator = PASTED_SEPARATOR::Blanks; // tabs are blanks
    bool isDecimalComma = false;
    bool hasPoint = false; // some number has a decimal point or comma
};

struct T_PASTED_FAULT {
    int line = 0; // 0: of the whole text
    std::string text;
};

/// Columns are parted by tabs, blanks, semicolons or commas; empty lines and those that start with
/// '#' don't count; lines with more words than numbers before the first row are headers. Auto reads
/// the decimal comma from the numbers and refuses a text that can be read in two ways. Separators
/// of thousands, cells that are no finite number and rows of different lengths are refused. 1 done;
/// 0 fault filled with the line, `out` as it was.
[[nodiscard]] int ReadPastedTable(std::string_view text, PASTED_DECIMAL decimal,
                                  T_PASTED_TABLE& out, T_PASTED_FAULT& fault);
