// What a spectrum's parameters give: corner periods, soil factor, damping correction, ordinates.
#pragma once

#include "qm_db/records.h"
#include "qm_rps/dialog/texttable.h"

#include <string>
#include <vector>

/// Ordinates of one curve of a spectrum: its own damping; of ntc one for each limit state.
struct T_SPECTRUM_CURVE {
    std::string name;              // of the limit state; else of the spectrum
    std::vector<double> T, Sa, Sd; // s, g, length; Sd = Sa g (T / 2 pi)2
};

/// Largest period of the curves of a spectrum that a code gives, s.
inline constexpr double kShownPeriod = 4.0;

/// The spectrum must keep its rules. gravity: in the length unit that Sd is wanted in.
std::vector<T_SPECTRUM_CURVE> SpectrumCurves(const T_SPFC_D& spectrum, double gravity);

/// Symbol, value, unit, meaning with its clause: a row each; a column of values for each curve.
T_TEXT_TABLE SpectrumValues(const T_SPFC_D& spectrum);

/// "! ag above 1.5 g, or an ordinate above 5 g": m/s2 were taken for g, most likely. Empty:
/// neither.
std::string SpectrumDoubt(const T_SPFC_D& spectrum);
