// Spreadsheet of a solved unknown load factor item: the influence matrix with the factors, whose
// formulas recompute every constrained quantity.
#pragma once

#include "qm_db/sheetfile.h"
#include "qm_rps/factors/ulfresult.h"

struct T_ULF_SHEET_SETTINGS {
    /// Version of the spreadsheet application that shall read the file: below 12 at most 230
    /// constraints, from 12 on 16,384, and never more than the sheet has columns from C on.
    int applicationVersion = 16;
    int year = 0, month = 0, day = 0; // of the current local date; month from 1
    std::string fileName;             // of the model, may be empty
};

/// True when so many constraints fit.
bool UlfSheetFits(std::size_t constraints, int applicationVersion);

/// Fills the sheet, with quantity and unit above each constraint, whether a factor is known beside
/// the frame, numbers rounded where they are shown; a constraint that is read at a stage and step
/// has them in its heading. 1 done; 0 too many constraints, `sheet` as it was. Factor cells are
/// inputs: changing one changes row 11.
[[nodiscard]] int MakeUlfSheet(const T_ULF_RESULT& result, const T_ULF_SHEET_SETTINGS& settings,
                               T_SHEET& sheet);
