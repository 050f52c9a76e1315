// A plot as a drawing, for files and printers.
#pragma once

#include "qm_ui/plot/plotdata.h"
#include "qm_ui/report/picturefile.h"

/// 960 px wide and as high as the plot says. It keeps a reference to the plot.
[[nodiscard]] T_DRAWING DrawingOf(const T_PLOT& plot);
