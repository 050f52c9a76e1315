// Layouts of plots without a font.
#pragma once

#include "qm_ui/plot/plotlayout.h"

#include <string>

/// The layout on a page, with widths of text much as a font would give them.
inline T_PLOT_LAYOUT LayoutOf(const T_PLOT& plot, const T_PLOT_VIEW& view = {},
                              T_PLOT_BOX page = {0, 0, 960, 640})
{
    const auto measure = [](const std::string& line, double sizePx, bool bold) {
        return static_cast<double>(line.size()) * sizePx * (bold ? 0.66 : 0.58);
    };
    return CPlotLayout(plot, measure).Calc(page, view);
}
