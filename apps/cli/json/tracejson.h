// Calculations by a code as JSON.
#pragma once

#include "qm_rps/codes/codesheet.h"
#include "json/jsontext.h"

#include <array>
#include <vector>

/// How sure a figure is, by CODE_MARK; in every language.
inline constexpr std::array<const char*, 4> kMarkWords{
    "computed", "sighted twice", "sighted once",
    "recalled: not checked against the printed standard"};

/// The member "warnings".
void WriteWarnings(CJsonText& writer, const std::vector<T_CODE_WARNING>& warnings);
/// A member whose lines have symbol, value, unit, clause, formula and mark.
void WriteTrace(CJsonText& writer, const char* name, const std::vector<T_CODE_TRACE>& trace,
                const T_UNITS& units);
