#include "qm_rps/curvecrossing.h"

#include <algorithm>
#include <cmath>
#include <numbers>

namespace {

constexpr double kFar = 1e48;        // radial and vertical lines run out to here
constexpr double kTolerance = 1e-18; // mathIntersectLine2 raises it to its own smallest
constexpr double kTouch = 1e-9;      // relative length of a touch

bool AtOrigin(const T_POINT2& p, const T_POINT2& a, const T_POINT2& b)
{
    return std::fabs(p.x) <= kTouch * std::max(std::fabs(a.x), std::fabs(b.x)) &&
           std::fabs(p.y) <= kTouch * std::max(std::fabs(a.y), std::fabs(b.y));
}

/// First crossing in walk order; `skipOrigin` passes over a crossing at (0, 0).
std::optional<T_POINT2> FirstCrossing(T_POINT2 P1, T_POINT2 P2, const T_ADRS_VIEW& curve,
                                      bool skipOrigin)
{
    for (std::size_t i = 0; i + 1 < curve.Size(); ++i) {
        const T_POINT2 a = curve.At(i), b = curve.At(i + 1);
        double param = 0.0;
        T_POINT2 point;
        if (!CMathFunc::mathIntersectLine2(P1, P2, a, b, kTolerance, param, point)) continue;
        if (skipOrigin && AtOrigin(point, a, b)) continue;
        return point;
    }
    return std::nullopt;
}

/// Cross product of p and q: above 0 when q is steeper than p, seen from the origin.
double Steeper(const T_POINT2& p, const T_POINT2& q)
{
    return p.x * q.y - p.y * q.x;
}

/// Walks a demand curve by radial angle, from a remembered index, in amortised constant time.
class CAngleCursor {
public:
    explicit CAngleCursor(const T_ADRS_VIEW& demand) : m_demand(demand) {}

    /// Smallest index whose point is not steeper than p.
    std::size_t Seek(const T_POINT2& p)
    {
        const auto steeper = [&](std::size_t k) {
            return p.x * m_demand.Sa[k] - p.y * m_demand.Sd[k] > 0.0;
        };
        while (m_at < m_demand.Size() && steeper(m_at))
            ++m_at;
        while (m_at > 0 && !steeper(m_at - 1))
            --m_at;
        return m_at;
    }

private:
    const T_ADRS_VIEW& m_demand;
    std::size_t m_at = 0;
};

struct T_RANGE {
    std::size_t first = 0, last = 0; // demand points
};

/// Demand points whose segments a capacity segment a-b can meet, one to spare on either side.
T_RANGE Reachable(const T_POINT2& a, const T_POINT2& b, CAngleCursor& cursor, std::size_t count)
{
    // A touch may lie just beyond the ends.
    const T_POINT2 from{a.x - kTouch * (b.x - a.x), a.y - kTouch * (b.y - a.y)};
    const T_POINT2 to{b.x + kTouch * (b.x - a.x), b.y + kTouch * (b.y - a.y)};
    const bool inQuadrant = std::min({from.x, from.y, to.x, to.y}) >= 0.0;
    if (!inQuadrant || (a.x == 0.0 && a.y == 0.0) || (b.x == 0.0 && b.y == 0.0))
        return {0, count - 1};
    const bool falling = Steeper(to, from) >= 0.0;
    const std::size_t lo = cursor.Seek(falling ? from : to);
    const std::size_t hi = cursor.Seek(falling ? to : from);
    return {lo < 2 ? 0 : lo - 2, std::min(hi + 2, count - 1)};
}

/// True when no demand point of the range comes to the other side of the line a-b, nor near it.
bool OneSided(const T_POINT2& a, const T_POINT2& b, const T_ADRS_VIEW& demand, T_RANGE range)
{
    const double rx = b.x - a.x, ry = b.y - a.y;
    double least = INFINITY, most = -INFINITY, scale = 0.0;
    for (std::size_t k = range.first; k <= range.last; ++k) {
        const double s = rx * (demand.Sa[k] - a.y), t = ry * (demand.Sd[k] - a.x);
        least = std::min(least, s - t);
        most = std::max(most, s - t);
        scale = std::max(scale, std::fabs(s) + std::fabs(t));
    }
    const double margin = 1e-6 * scale; // far wider than any touch
    return least > margin || most < -margin;
}

/// Crossing nearest the start of the capacity segment a-b.
std::optional<T_POINT2> Nearest(const T_POINT2& a, const T_POINT2& b, const T_ADRS_VIEW& demand,
                                T_RANGE range)
{
    std::optional<T_POINT2> best;
    double bestParam = 2.0;
    for (std::size_t k = range.first; k < range.last; ++k) {
        double param = 0.0;
        T_POINT2 point;
        if (CMathFunc::mathIntersectLine2(demand.At(k), demand.At(k + 1), a, b, kTolerance, param,
                                          point) &&
            param < bestParam) {
            bestParam = param;
            best = point;
        }
    }
    return best;
}

} // namespace

std::optional<T_POINT2> CCurveCrossing::HalfLine(T_POINT2 toward, const T_ADRS_VIEW& curve)
{
    return FirstCrossing({0.0, 0.0}, {toward.x * kFar, toward.y * kFar}, curve, true);
}

std::optional<T_POINT2> CCurveCrossing::PeriodLine(double T, double gravity,
                                                   const T_ADRS_VIEW& curve)
{
    const double slope = 4.0 * std::numbers::pi * std::numbers::pi / (T * T * gravity);
    if (!std::isfinite(slope)) return std::nullopt;
    return HalfLine({1.0, slope}, curve);
}

std::optional<T_POINT2> CCurveCrossing::Vertical(double d, const T_ADRS_VIEW& curve)
{
    return FirstCrossing({d, 0.0}, {d, kFar}, curve, false);
}

std::optional<T_POINT2> CCurveCrossing::Segment(T_POINT2 P1, T_POINT2 P2, const T_ADRS_VIEW& curve)
{
    return FirstCrossing(P1, P2, curve, false);
}

std::optional<T_POINT2> CCurveCrossing::CapacityWithDemand(const T_ADRS_VIEW& capacity,
                                                           const T_ADRS_VIEW& demand)
{
    if (capacity.Size() < 2 || demand.Size() < 2) return std::nullopt;
    // Points ascending in period fall in radial angle; a zero ordinate has no angle.
    const bool ordered =
        std::all_of(demand.Sa.begin(), demand.Sa.end(), [](double a) { return a > 0.0; });
    CAngleCursor cursor(demand);
    for (std::size_t i = 0; i + 1 < capacity.Size(); ++i) {
        const T_POINT2 a = capacity.At(i), b = capacity.At(i + 1);
        T_RANGE range{0, demand.Size() - 1};
        if (ordered) {
            range = Reachable(a, b, cursor, demand.Size());
            if (OneSided(a, b, demand, range)) continue;
        }
        if (const auto point = Nearest(a, b, demand, range)) return point;
    }
    return std::nullopt;
}
