// Pictures of what a model is made from: the capacity curve as it was read, a spectrum.
#pragma once

#include "qm_rps/create/curvetext.h"
#include "qm_rps/create/spectrumvalues.h"
#include "qm_ui/plot/plotdata.h"

/// Base shear over displacement; null: a note that there is nothing to draw.
T_PLOT CurvePlot(const T_CURVE_READ* read, const T_UNITS& units);

enum class SPECTRUM_AXES {
    Periods,     // Sa over T
    Displacement // Sa over Sd
};
/// One that breaks its rules is not drawn: the note says which.
T_PLOT SpectrumPlot(const T_SPFC_D& spectrum, SPECTRUM_AXES axes, const T_UNITS& units);
