// Units that the header of a pasted curve names, against those that the curve is read in.
#pragma once

#include "qm_base/finding.h"
#include "qm_db/records.h"
#include "qm_rps/create/curvetext.h"

/// Units count in brackets ("V (kips)") or, where no word of a language is written like them, alone
/// ("kN"). 1: the header names none, or these; 0: fault filled with its line and the unit, or with
/// the "%" of a column that is no displacement (a drift).
[[nodiscard]] int CheckHeaderUnits(const T_CURVE_READ& read, const T_UNITS& units,
                                   T_FINDING& fault);
