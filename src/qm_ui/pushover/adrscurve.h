// A curve of spectral acceleration over spectral displacement in a picture.
#pragma once

#include "qm_rps/pushover/pushevaluation.h"
#include "qm_ui/plot/plotdata.h"

/// Adds the curve to the picture; one without points is left out.
void AddAdrsCurve(T_PLOT& plot, const char* name, const T_ADRS_CURVE& c, PLOT_LINE line,
                  double width, T_PLOT_COLOR color, PLOT_MARKER marker = PLOT_MARKER::None);
