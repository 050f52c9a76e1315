#include "qm_ui/pushover/adrscurve.h"

void AddAdrsCurve(T_PLOT& plot, const char* name, const T_ADRS_CURVE& c, PLOT_LINE line,
                  double width, T_PLOT_COLOR color, PLOT_MARKER marker)
{
    if (c.Sd.empty()) return;
    T_PLOT_SERIES s;
    s.name = name;
    s.x = c.Sd;
    s.y = c.Sa;
    s.line = line;
    s.width = width;
    s.color = color;
    s.marker = marker;
    plot.series.push_back(std::move(s));
}
