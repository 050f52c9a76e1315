#include "qm_ui/plot/plotgeometry.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <cstddef>

namespace {

// Appends the first, lowest, highest and last point of run[begin, end) in their order.
void AppendColumn(const PLOT_RUN& run, std::size_t begin, std::size_t end, PLOT_RUN& out)
{
    std::array<std::size_t, 4> keep{begin, begin, begin, end - 1};
    for (std::size_t i = begin; i < end; ++i) {
        if (run[i].y < run[keep[1]].y) keep[1] = i;
        if (run[i].y > run[keep[2]].y) keep[2] = i;
    }
    std::sort(keep.begin(), keep.end());
    for (std::size_t k = 0; k < keep.size(); ++k)
        if (k == 0 || keep[k] != keep[k - 1]) out.push_back(run[keep[k]]);
}

} // namespace

bool T_PLOT_BOX::Holds(T_PLOT_PX p) const
{
    return p.x >= x && p.x <= Right() && p.y >= y && p.y <= Bottom();
}

bool T_PLOT_BOX::Holds(const T_PLOT_BOX& b) const
{
    return b.x >= x && b.Right() <= Right() && b.y >= y && b.Bottom() <= Bottom();
}

bool T_PLOT_BOX::Meets(const T_PLOT_BOX& b) const
{
    return b.x < Right() && x < b.Right() && b.y < Bottom() && y < b.Bottom();
}

T_PLOT_PX T_PLOT_BOX::Nearest(T_PLOT_PX p) const
{
    return {std::clamp(p.x, x, Right()), std::clamp(p.y, y, Bottom())};
}

PLOT_RUN DecimateRun(const PLOT_RUN& run, double columnPx)
{
    PLOT_RUN out;
    for (std::size_t begin = 0; begin < run.size();) {
        const double column = std::floor(run[begin].x / columnPx);
        std::size_t end = begin + 1;
        while (end < run.size() && std::floor(run[end].x / columnPx) == column)
            ++end;
        AppendColumn(run, begin, end, out);
        begin = end;
    }
    return out;
}

bool ClipSegment(const T_PLOT_BOX& box, T_PLOT_PX& a, T_PLOT_PX& b)
{
    const double dx = b.x - a.x;
    const double dy = b.y - a.y;
    const std::array<double, 4> p{-dx, dx, -dy, dy};
    const std::array<double, 4> q{a.x - box.x, box.Right() - a.x, a.y - box.y, box.Bottom() - a.y};
    double t0 = 0.0;
    double t1 = 1.0;
    for (std::size_t i = 0; i < p.size(); ++i) {
        if (p[i] == 0.0) {
            if (q[i] < 0.0) return false;
            continue;
        }
        const double t = q[i] / p[i];
        if (p[i] < 0.0)
            t0 = std::max(t0, t);
        else
            t1 = std::min(t1, t);
    }
    if (t0 > t1) return false;
    const T_PLOT_PX from = a;
    // From far outside, rounding may leave a cut end beside the edge.
    if (t1 < 1.0) b = box.Nearest({from.x + t1 * dx, from.y + t1 * dy});
    if (t0 > 0.0) a = box.Nearest({from.x + t0 * dx, from.y + t0 * dy});
    return true;
}

std::vector<PLOT_RUN> ClipRun(const T_PLOT_BOX& box, const PLOT_RUN& run)
{
    std::vector<PLOT_RUN> parts;
    if (run.size() == 1 && box.Holds(run[0])) parts.push_back(run);
    for (std::size_t i = 1; i < run.size(); ++i) {
        T_PLOT_PX a = run[i - 1];
        T_PLOT_PX b = run[i];
        if (!ClipSegment(box, a, b)) continue;
        if (parts.empty() || parts.back().back() != a) parts.push_back({a});
        parts.back().push_back(b);
    }
    return parts;
}

double PlotDistance(T_PLOT_PX a, T_PLOT_PX b)
{
    return std::hypot(a.x - b.x, a.y - b.y);
}
