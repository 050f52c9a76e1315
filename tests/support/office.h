// An office program without a screen that recalculates the spreadsheets of the tests.
#pragma once

#include "tempfolder.h"

#include <string>
#include <vector>

using OFFICE_CELLS = std::vector<std::vector<std::string>>; // rows of cells

/// LibreOffice with a profile of its own, in which every formula is calculated anew on loading
/// (its usual profile shows the stored values of .xlsx files).
class COffice {
public:
    /// Whether the program is installed; a test without it is skipped.
    static bool IsThere();

    COffice();

    /// All cells of the sheet in full precision (15 digits), or the formulas in place of their
    /// values; no rows when the program fails.
    OFFICE_CELLS Recalculated(const std::string& sheet) const;
    OFFICE_CELLS Formulas(const std::string& sheet) const;

    /// Puts a number into a cell ("B12") of an .xlsx file that holds a number, as a person would;
    /// the stored values of all formulas stay. False when there is no such cell.
    static bool PutNumber(const std::string& sheet, const std::string& cell, double value);

private:
    OFFICE_CELLS Convert(const std::string& sheet, bool formulas) const;
    CTempFolder m_folder;
};
