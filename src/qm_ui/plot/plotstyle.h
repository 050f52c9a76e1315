// Line, marker and colour of a series after the automatic choices.
#pragma once

#include "qm_ui/plot/plotdata.h"

#include <cstddef>

struct T_PLOT_STYLE {
    PLOT_LINE line = PLOT_LINE::Solid;      // never Auto
    PLOT_MARKER marker = PLOT_MARKER::None; // never Auto
    T_PLOT_COLOR color;
    double width = 1.8;      // px
    double markerSize = 7.0; // px
};

/// Dashes, markers and colours go round with the index; colours also differ as greys.
[[nodiscard]] T_PLOT_STYLE ResolveStyle(const T_PLOT_SERIES& series, std::size_t index);
