// Units of force and length as a command names them: "kN,mm".
#pragma once

#include "qm_db/records.h"

#include <string>

/// False: no such pair; the units are as they were.
[[nodiscard]] bool ParseUnits(const std::string& text, T_UNITS& units);
/// The names that there are: "N kN MN kgf tonf lbf kips, mm cm m in ft".
std::string UnitWords();
