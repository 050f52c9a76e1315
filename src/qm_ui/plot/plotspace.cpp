#include "qm_ui/plot/plotspace.h"

#include <algorithm>
#include <cmath>
#include <limits>
#include <numbers>

namespace {

constexpr double kCell = 4.0;              // px
constexpr double kEdge = 3.0;              // px between a text and the frame
constexpr double kGap = 2.0;               // px between two texts
constexpr double kHideCost = 5.0;          // cost of hidden weight, in px of distance
constexpr double kCrossTextCost = 1000.0;  // a leader through a text
constexpr double kCrossLeaderCost = 200.0; // a leader over a leader
constexpr double kLeaderHideCost = 3.0;    // of weight below a leader
constexpr double kLeaderClear = 3.0;       // px that leaders keep from each other's ends
constexpr double kLeaderFrom = 14.0;       // px: a nearer text needs no leader
constexpr double kFirstRing = 6.0;         // px from the anchor to the box
constexpr double kRingGrowth = 1.25;
constexpr int kDirections = 64;
constexpr int kSlides = 48;

struct T_BEST {
    double cost = std::numeric_limits<double>::infinity();
    T_PLOT_BOX box;
    void Offer(double newCost, const T_PLOT_BOX& newBox)
    {
        if (!(newCost < cost)) return;
        cost = newCost;
        box = newBox;
    }
    [[nodiscard]] bool Found() const { return std::isfinite(cost); }
};

std::size_t CellCount(double length)
{
    return static_cast<std::size_t>(std::max(1.0, std::ceil(length / kCell)));
}

std::size_t CellIndex(double px, double origin, std::size_t count)
{
    const double cell = std::floor((px - origin) / kCell);
    return static_cast<std::size_t>(std::clamp(cell, 0.0, static_cast<double>(count - 1)));
}

// The place at the fraction t (0..1) of the point count.
T_PLOT_PX PointOnRun(const PLOT_RUN& run, double t)
{
    const double at = t * static_cast<double>(run.size() - 1);
    const auto i = static_cast<std::size_t>(at);
    if (i + 1 >= run.size()) return run.back();
    const double part = at - static_cast<double>(i);
    return {run[i].x + part * (run[i + 1].x - run[i].x),
            run[i].y + part * (run[i + 1].y - run[i].y)};
}

bool Crosses(const T_PLOT_BOX& box, T_PLOT_PX a, T_PLOT_PX b)
{
    return ClipSegment(box, a, b);
}

T_PLOT_BOX EndBox(T_PLOT_PX p)
{
    return {p.x - kLeaderClear, p.y - kLeaderClear, 2 * kLeaderClear, 2 * kLeaderClear};
}

bool IsLeftOf(T_PLOT_PX r, T_PLOT_PX p, T_PLOT_PX q)
{
    return (q.x - p.x) * (r.y - p.y) - (q.y - p.y) * (r.x - p.x) > 0.0;
}

bool CrossEachOther(T_PLOT_PX a, T_PLOT_PX b, T_PLOT_PX c, T_PLOT_PX d)
{
    return IsLeftOf(c, a, b) != IsLeftOf(d, a, b) && IsLeftOf(a, c, d) != IsLeftOf(b, c, d);
}

} // namespace

CPlotSpace::CPlotSpace(const T_PLOT_BOX& area)
    : m_area(area), m_cols(CellCount(area.w)), m_rows(CellCount(area.h)),
      m_weights(m_cols * m_rows, 0.0)
{
}

void CPlotSpace::MarkPoint(T_PLOT_PX p, double weight)
{
    if (!m_area.Holds(p)) return;
    const std::size_t row = CellIndex(p.y, m_area.y, m_rows);
    double& cell = m_weights[row * m_cols + CellIndex(p.x, m_area.x, m_cols)];
    cell = std::max(cell, weight);
}

void CPlotSpace::MarkLine(T_PLOT_PX a, T_PLOT_PX b, double weight)
{
    if (!ClipSegment(m_area, a, b)) return;
    const int steps = static_cast<int>(std::ceil(PlotDistance(a, b) / kCell));
    for (int i = 0; i <= steps; ++i) {
        const double t = steps == 0 ? 0.0 : static_cast<double>(i) / steps;
        MarkPoint({a.x + t * (b.x - a.x), a.y + t * (b.y - a.y)}, weight);
    }
}

void CPlotSpace::MarkRun(const PLOT_RUN& run, double weight)
{
    for (std::size_t i = 1; i < run.size(); ++i)
        MarkLine(run[i - 1], run[i], weight);
}

bool CPlotSpace::IsFree(const T_PLOT_BOX& box) const
{
    const T_PLOT_BOX inner{m_area.x + kEdge, m_area.y + kEdge, m_area.w - 2 * kEdge,
                           m_area.h - 2 * kEdge};
    const T_PLOT_BOX wide{box.x - kGap, box.y - kGap, box.w + 2 * kGap, box.h + 2 * kGap};
    return inner.Holds(box) && std::none_of(m_taken.begin(), m_taken.end(),
                                            [&](const T_PLOT_BOX& t) { return t.Meets(wide); });
}

double CPlotSpace::Hidden(const T_PLOT_BOX& box) const
{
    const std::size_t c1 = CellIndex(box.Right(), m_area.x, m_cols);
    const std::size_t r1 = CellIndex(box.Bottom(), m_area.y, m_rows);
    double sum = 0.0;
    for (std::size_t r = CellIndex(box.y, m_area.y, m_rows); r <= r1; ++r)
        for (std::size_t c = CellIndex(box.x, m_area.x, m_cols); c <= c1; ++c)
            sum += m_weights[r * m_cols + c];
    return sum;
}

std::optional<T_PLOT_BOX> CPlotSpace::PlaceAnywhere(double w, double h)
{
    constexpr int kGrid = 24;
    constexpr double kInset = 10.0;      // px from the frame
    constexpr double kCornerCost = 0.05; // per px from the nearest corner
    T_BEST best;
    const double freeW = m_area.w - w - 2 * kInset;
    const double freeH = m_area.h - h - 2 * kInset;
    if (freeW < 0.0 || freeH < 0.0) return std::nullopt;
    for (int i = 0; i <= kGrid; ++i) {
        for (int j = 0; j <= kGrid; ++j) {
            const double right = freeW * i / kGrid;
            const double down = freeH * j / kGrid;
            const T_PLOT_BOX box{m_area.Right() - kInset - w - right, m_area.y + kInset + down, w,
                                 h};
            const double corner = std::min(right, freeW - right) + std::min(down, freeH - down) +
                                  0.1 * (right + down);
            if (IsFree(box)) best.Offer(kHideCost * Hidden(box) + kCornerCost * corner, box);
        }
    }
    if (!best.Found()) return std::nullopt;
    Take(best.box);
    return best.box;
}

// Weight of the cells below the line, without the one that holds its start.
double CPlotSpace::HiddenBelow(T_PLOT_PX a, T_PLOT_PX b) const
{
    const int steps = static_cast<int>(PlotDistance(a, b) / kCell);
    double sum = 0.0;
    for (int i = 2; i <= steps; ++i) {
        const double t = static_cast<double>(i) / steps;
        const std::size_t row = CellIndex(a.y + t * (b.y - a.y), m_area.y, m_rows);
        sum += m_weights[row * m_cols + CellIndex(a.x + t * (b.x - a.x), m_area.x, m_cols)];
    }
    return sum;
}

double CPlotSpace::LeaderCost(T_PLOT_PX anchor, const T_PLOT_BOX& box) const
{
    const T_PLOT_PX end = box.Nearest(anchor);
    double cost = PlotDistance(anchor, end) + kLeaderHideCost * HiddenBelow(anchor, end);
    for (const T_PLOT_BOX& t : m_taken)
        if (Crosses(t, anchor, end)) cost += kCrossTextCost;
    for (const T_LEADER& l : m_leaders) {
        if (Crosses(box, l.a, l.b)) cost += kCrossTextCost;
        if (CrossEachOther(anchor, end, l.a, l.b)) cost += kCrossLeaderCost;
        if (Crosses(EndBox(l.b), anchor, end) || Crosses(EndBox(end), l.a, l.b))
            cost += kCrossLeaderCost;
    }
    return cost;
}

T_PLOT_PLACE CPlotSpace::TakeWithLeader(T_PLOT_PX anchor, const T_PLOT_BOX& box)
{
    T_PLOT_PLACE place{box, anchor, std::nullopt};
    const T_PLOT_PX end = box.Nearest(anchor);
    if (PlotDistance(anchor, end) > kLeaderFrom) {
        place.leaderEnd = end;
        m_leaders.push_back({anchor, end});
    }
    Take(box);
    return place;
}

std::optional<T_PLOT_PLACE> CPlotSpace::PlaceNear(T_PLOT_PX anchor, double w, double h)
{
    T_BEST best;
    const double farthest = m_area.w + m_area.h;
    for (double ring = kFirstRing; ring < farthest; ring *= kRingGrowth) {
        if (ring > best.cost) break; // distance alone costs more than the best so far
        for (int i = 0; i < kDirections; ++i) {
            // Starts up and to the right, where a reader expects a label.
            const double angle = std::numbers::pi * (2.0 * i / kDirections - 0.25);
            const T_PLOT_PX mid{anchor.x + std::cos(angle) * (0.5 * w + ring),
                                anchor.y + std::sin(angle) * (0.5 * h + ring)};
            const T_PLOT_BOX box{mid.x - 0.5 * w, mid.y - 0.5 * h, w, h};
            if (!IsFree(box)) continue;
            best.Offer(kHideCost * Hidden(box) + LeaderCost(anchor, box) + 0.004 * i, box);
        }
    }
    if (!best.Found()) return std::nullopt;
    return TakeWithLeader(anchor, best.box);
}

std::optional<T_PLOT_PLACE> CPlotSpace::PlaceAlong(const PLOT_RUN& run, double w, double h)
{
    constexpr double kBeside = 5.0; // px between line and text
    T_BEST best;
    T_PLOT_PX anchor = run.back();
    for (int i = 0; i < kSlides; ++i) {
        const T_PLOT_PX on = PointOnRun(run, 1.0 - static_cast<double>(i) / kSlides);
        for (int side = 0; side < 4; ++side) {
            const double x = side % 2 == 0 ? on.x + kBeside : on.x - kBeside - w;
            const double y = side / 2 == 0 ? on.y - kBeside - h : on.y + kBeside;
            const T_PLOT_BOX box{x, y, w, h};
            if (!IsFree(box)) continue;
            const double before = best.cost;
            best.Offer(kHideCost * Hidden(box) + 1.5 * i + 0.01 * side, box);
            if (best.cost < before) anchor = on;
        }
    }
    if (!best.Found()) return PlaceNear(PointOnRun(run, 0.5), w, h);
    return TakeWithLeader(anchor, best.box);
}
