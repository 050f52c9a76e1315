// A spreadsheet as plain data, and its file (.xlsx).
#pragma once

#include "qm_db/fileerror.h"

#include <cstddef>
#include <map>
#include <string>
#include <utility>
#include <variant>
#include <vector>

inline constexpr std::size_t kSheetRows = 1048576; // of one sheet in the file format
inline constexpr std::size_t kSheetColumns = 16384;

/// A formula with '=' in front, English function names and commas, and the value it has now:
/// programs that don't recalculate on loading show that one.
struct T_SHEET_FORMULA {
    std::string text;
    double value = 0.0;
    bool operator==(const T_SHEET_FORMULA&) const = default;
};

/// Empty, text, number or formula. A text stays text whatever it begins with.
using SHEET_VALUE = std::variant<std::monostate, std::string, double, T_SHEET_FORMULA>;

enum class SHEET_EDGE { None, Thin, Double };

struct T_SHEET_STYLE {
    bool centred = false;
    bool bold = false;
    bool input = false;       // a cell made to be changed: coloured
    std::string numberFormat; // as in an office program ("0.000"); empty: general
    SHEET_EDGE left = SHEET_EDGE::None, right = SHEET_EDGE::None;
    SHEET_EDGE top = SHEET_EDGE::None, bottom = SHEET_EDGE::None;
    auto operator<=>(const T_SHEET_STYLE&) const = default;
};

struct T_SHEET_CELL {
    SHEET_VALUE value{};
    T_SHEET_STYLE style{};
    bool operator==(const T_SHEET_CELL&) const = default;
};

struct T_SHEET_WIDTH {
    std::size_t firstColumn = 0, lastColumn = 0;
    double characters = 8.43; // of the standard font
    bool operator==(const T_SHEET_WIDTH&) const = default;
};

using SHEET_AT = std::pair<std::size_t, std::size_t>; // row, column; both from 0

struct T_SHEET {
    std::string name = "Sheet1"; // up to 31 letters, none of []:*?/\ .
    std::map<SHEET_AT, T_SHEET_CELL> cells{};
    std::vector<T_SHEET_WIDTH> widths{};
    /// Rows from the top and columns from the left that stay in sight; the rows head every page.
    std::size_t frozenRows = 0, frozenColumns = 0;
    bool fitsWidth = false; // printed one page wide, across
    bool operator==(const T_SHEET&) const = default;
};

/// Cells from (top, left) to (bottom, right), both included.
struct T_SHEET_BLOCK {
    std::size_t top = 0, left = 0, bottom = 0, right = 0;
};

/// Letters of a column from 0: 0 is "A", 25 "Z", 26 "AA", 16383 "XFD".
std::string SheetColumn(std::size_t column);
/// A1 name of a cell, row and column from 0: (10, 2) is "C11".
std::string SheetAddress(std::size_t row, std::size_t column);

/// Edges round the block, along its lower side, along its right side. Cells that are not there are
/// made (empty); other edges of the cells stay.
void FrameBlock(T_SHEET& sheet, const T_SHEET_BLOCK& block, SHEET_EDGE edge);
void EdgeBelow(T_SHEET& sheet, const T_SHEET_BLOCK& block, SHEET_EDGE edge);
void EdgeRight(T_SHEET& sheet, const T_SHEET_BLOCK& block, SHEET_EDGE edge);

/// Writes the sheet as an .xlsx file. The same sheet gives the same bytes (the dates in the file
/// are fixed); numbers are stored with 16 significant digits. The file is replaced as a whole or
/// left as it was. Returns 1; or 0 with the reason: BadInput for a number that is not finite, a
/// cell beyond the sheet, a text of more than 32,767 or a formula of more than 8,192 letters, a
/// wrong name; NoAccess for a file that can't be written or that an office program has open.
[[nodiscard]] int WriteSheet(const std::string& path, const T_SHEET& sheet, T_FILE_ERROR& error);

/// Opens a file in the program that the desktop has for its kind (xdg-open), which stays open on
/// its own. 1 started; 0 there is no such program.
[[nodiscard]] int OpenSheetFile(const std::string& path);
