// How a raw table parts its numbers and writes their decimals, and the cells of its rows.
#pragma once

#include <optional>
#include <span>
#include <string>
#include <string_view>
#include <vector>

enum class RECORDER_DECIMAL { Auto, Point, Comma };
enum class RECORDER_SEPARATOR { Blanks, Commas, Semicolons };

struct T_RECORDER_FORM {
    RECORDER_SEPARATOR separator = RECORDER_SEPARATOR::Blanks;
    bool isDecimalComma = false;
    bool isBlankJudged = true; // "0. 36" may be one number with a blank in it
};

/// A row of the table and its line in the file, from 1.
struct T_RECORDER_LINE {
    std::string_view text; // without blanks at its ends
    int line = 0;
};

/// What is wrong with a table, and the column (from 1) where it shows.
struct T_RECORDER_FAULT {
    int line = 0;
    std::size_t column = 0;
    std::string reason;
    bool isEither = false; // a comma may be a decimal one or part two numbers
};

/// True for a row in which no cell looks like a number, whatever the form of the table.
bool IsRecorderHeader(std::string_view row);

/// The form of a table. A semicolon parts cells wherever there is one. Else blanks or commas do,
/// not both between numbers. A comma between digits is a decimal comma beside semicolons or blanks,
/// where no number has a decimal point; in a table of commas alone whose numbers have no point it
/// could be either, unless `header` (may be empty) has as many names as the rows have cells then.
/// `decimal` other than Auto decides. Nothing, with `fault` filled, for a table that can be read in
/// two ways.
std::optional<T_RECORDER_FORM> FindRecorderForm(std::span<const T_RECORDER_LINE> rows,
                                                std::string_view header, RECORDER_DECIMAL decimal,
                                                T_RECORDER_FAULT& fault);

/// Cells of a row. A separator at the end adds no cell; two in a row make an empty cell.
void SplitRecorderRow(std::string_view row, RECORDER_SEPARATOR separator,
                      std::vector<std::string_view>& cells);
/// Names of a header, without quotes around them. They may hold blanks where commas, semicolons or
/// tabs part them.
std::vector<std::string> SplitRecorderHeader(std::string_view row, const T_RECORDER_FORM& form);

/// The number of a cell, finite; nothing for any other text.
std::optional<double> RecorderNumber(std::string_view cell, const T_RECORDER_FORM& form);
/// Position from 0 of the first cell that may go on behind the blank after it ("0. 36").
std::optional<std::size_t> FindBlankInNumber(std::span<const std::string_view> cells);
