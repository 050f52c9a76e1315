// The results of sections as files: comma-separated values, spreadsheet.
#pragma once

#include "qm_db/sheetfile.h"
#include "qm_rps/section/sectiontables.h"

/// The points of all curves, or the capacities, with the section and the material of each row.
T_TEXT_TABLE SectionExport(const std::vector<T_SECTION_ANSWER>& answers, const T_UNITS& units);

/// Rows of a section below those of others, with the section and the material of each.
void AppendOfSection(const std::string& section, const std::string& material,
                     const T_TEXT_TABLE& one, T_TEXT_TABLE& all);

/// Texts with commas or quotes are quoted.
std::string TableCsv(const T_TEXT_TABLE& table);

/// Heads bold; cells of number columns that are numbers are numbers.
T_SHEET TableSheet(const T_TEXT_TABLE& table);
