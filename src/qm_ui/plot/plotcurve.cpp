#include "qm_ui/plot/plotcurve.h"

#include <algorithm>
#include <cmath>
#include <cstddef>
#include <iterator>
#include <utility>

namespace {

constexpr double kColumnPx = 0.5;        // one device pixel of a picture at twice the size
constexpr std::size_t kManyMarkers = 80; // on a line; beyond it they are spaced out
constexpr double kMarkerSpacing = 26.0;  // px
constexpr double kMarkerCell = 2.0;      // px
constexpr int kRadialPoints = 400;       // on a log axis a radial line is curved

std::vector<T_PLOT_PX> SpacedOut(const std::vector<T_PLOT_PX>& all)
{
    std::vector<T_PLOT_PX> kept;
    for (const T_PLOT_PX& p : all)
        if (kept.empty() || PlotDistance(kept.back(), p) >= kMarkerSpacing) kept.push_back(p);
    return kept;
}

std::vector<T_PLOT_PX> OnePerCell(const std::vector<T_PLOT_PX>& all, const T_PLOT_BOX& area)
{
    const auto cols = static_cast<std::size_t>(area.w / kMarkerCell) + 1;
    const auto rows = static_cast<std::size_t>(area.h / kMarkerCell) + 1;
    std::vector<bool> seen(cols * rows, false);
    std::vector<T_PLOT_PX> kept;
    for (const T_PLOT_PX& p : all) {
        const auto c = static_cast<std::size_t>((p.x - area.x) / kMarkerCell);
        const auto r = static_cast<std::size_t>((p.y - area.y) / kMarkerCell);
        if (seen[r * cols + c]) continue;
        seen[r * cols + c] = true;
        kept.push_back(p);
    }
    return kept;
}

PLOT_RUN MapRadial(double slope, const CPlotScale& x, const CPlotScale& y)
{
    const T_PLOT_RANGE r = x.Range();
    if (!x.IsLog() && !y.IsLog())
        return {{x.ToPixel(r.lo), y.ToPixel(slope * r.lo)},
                {x.ToPixel(r.hi), y.ToPixel(slope * r.hi)}};
    PLOT_RUN run;
    const double from = x.ToPixel(r.lo);
    const double step = (x.ToPixel(r.hi) - from) / kRadialPoints;
    for (int i = 0; i <= kRadialPoints; ++i) {
        const double px = from + i * step;
        const double value = slope * x.ToValue(px);
        if (y.CanShow(value)) run.push_back({px, y.ToPixel(value)});
    }
    return run;
}

} // namespace

std::vector<PLOT_RUN> MapSeries(const T_PLOT_SERIES& series, const CPlotScale& x,
                                const CPlotScale& y)
{
    std::vector<PLOT_RUN> runs;
    bool open = false;
    for (std::size_t i = 0; i < std::min(series.x.size(), series.y.size()); ++i) {
        const bool shown = x.CanShow(series.x[i]) && y.CanShow(series.y[i]);
        if (shown && !open) runs.emplace_back();
        if (shown) runs.back().push_back({x.ToPixel(series.x[i]), y.ToPixel(series.y[i])});
        open = shown;
    }
    return runs;
}

std::vector<PLOT_RUN> VisibleLines(const std::vector<PLOT_RUN>& runs, const T_PLOT_BOX& area)
{
    std::vector<PLOT_RUN> lines;
    for (const PLOT_RUN& run : runs)
        for (PLOT_RUN& part : ClipRun(area, DecimateRun(run, kColumnPx)))
            lines.push_back(std::move(part));
    return lines;
}

std::vector<T_PLOT_PX> VisibleMarkers(const std::vector<PLOT_RUN>& runs, const T_PLOT_BOX& area,
                                      bool onLine)
{
    std::vector<T_PLOT_PX> all;
    for (const PLOT_RUN& run : runs)
        std::copy_if(run.begin(), run.end(), std::back_inserter(all),
                     [&](const T_PLOT_PX& p) { return area.Holds(p); });
    if (!onLine) return OnePerCell(all, area);
    return all.size() > kManyMarkers ? SpacedOut(all) : all;
}

PLOT_RUN MapGuide(const T_PLOT_GUIDE& guide, const CPlotScale& x, const CPlotScale& y,
                  const T_PLOT_BOX& area)
{
    const double v = guide.value;
    switch (guide.kind) {
    case PLOT_GUIDE::Vertical:
        if (!x.CanShow(v)) return {};
        return {{x.ToPixel(v), area.Bottom()}, {x.ToPixel(v), area.y}};
    case PLOT_GUIDE::Horizontal:
        if (!y.CanShow(v)) return {};
        return {{area.x, y.ToPixel(v)}, {area.Right(), y.ToPixel(v)}};
    case PLOT_GUIDE::Radial:
        break;
    }
    return std::isfinite(v) && std::fabs(v) < 1e100 ? MapRadial(v, x, y) : PLOT_RUN{};
}
