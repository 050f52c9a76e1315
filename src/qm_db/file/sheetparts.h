// The parts of an .xlsx file as text.
#pragma once

#include "qm_db/sheetfile.h"

#include <map>
#include <string>

/// Cell formats in the order of their numbers, as the cells name them; 0 is the plain one.
using SHEET_FORMATS = std::map<T_SHEET_STYLE, std::size_t>;
SHEET_FORMATS SheetFormats(const T_SHEET& sheet);

/// Source: ECMA-376-1, 18.3 (worksheet) and 18.8 (styles). Texts stand in their cells.
std::string WorksheetPart(const T_SHEET& sheet, const SHEET_FORMATS& formats);
std::string StylesPart(const SHEET_FORMATS& formats);
std::string WorkbookPart(const T_SHEET& sheet);

/// Where the parts stand, which is the same for every file.
struct T_SHEET_PART {
    const char* name;
    const char* text;
};
extern const T_SHEET_PART kFixedSheetParts[3];
