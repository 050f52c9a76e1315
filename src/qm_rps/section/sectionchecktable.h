// The checks of sections as tables: what text and sheet show.
#pragma once

#include "qm_rps/dialog/texttable.h"
#include "qm_rps/section/sectioncheck.h"

/// What was checked by which way, ratio, verdict (a reason where it was not checked); a row for
/// each way.
T_TEXT_TABLE SectionWaysTable(const std::vector<T_SECTION_WAY>& ways);

/// The name of the set, then the table of the ways; a row for each way of each set.
T_TEXT_TABLE SectionSetsTable(const T_SECTION_CHECK& check);

/// The name of the set, its forces, then the table of the ways; rows as above.
T_TEXT_TABLE SectionCheckTable(const T_SECTION_CHECK& check, const T_UNITS& units);

/// The section with its strengths and warnings, a line each; then what the ways warn of.
std::vector<std::string> SectionCheckHead(const T_SECTION_CHECK& check, const T_UNITS& units);

/// The ways with their lines of trace.
std::vector<std::string> SectionCheckTrace(const T_SECTION_CHECK& check, const T_UNITS& units);

/// The tables of several sections as one, with the section and the material of each row.
T_TEXT_TABLE SectionCheckExport(const std::vector<T_SECTION_CHECK>& checks, const T_UNITS& units);
