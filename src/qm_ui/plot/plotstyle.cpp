#include "qm_ui/plot/plotstyle.h"

#include <array>

namespace {

constexpr std::array<PLOT_LINE, 4> kLines{PLOT_LINE::Solid, PLOT_LINE::Dash, PLOT_LINE::DashDot,
                                          PLOT_LINE::Dot};
constexpr std::array<PLOT_MARKER, 5> kMarkers{PLOT_MARKER::Circle, PLOT_MARKER::Square,
                                              PLOT_MARKER::Triangle, PLOT_MARKER::Cross,
                                              PLOT_MARKER::Plus};
constexpr std::array<T_PLOT_COLOR, 6> kColors{
    {{20, 66, 140}, {190, 40, 30}, {30, 120, 70}, {110, 50, 140}, {190, 110, 0}, {70, 70, 70}}};

} // namespace

T_PLOT_STYLE ResolveStyle(const T_PLOT_SERIES& series, std::size_t index)
{
    T_PLOT_STYLE style{series.line, series.marker,
                       series.color.value_or(kColors[index % kColors.size()]), series.width,
                       series.markerSize};
    if (style.line == PLOT_LINE::Auto) style.line = kLines[index % kLines.size()];
    if (style.marker == PLOT_MARKER::Auto) {
        const bool plain = style.line != PLOT_LINE::None && index < kLines.size();
        style.marker = plain ? PLOT_MARKER::None : kMarkers[(index + 1) % kMarkers.size()];
    }
    return style;
}
