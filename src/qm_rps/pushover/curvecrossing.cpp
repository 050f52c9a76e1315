#include "qm_rps/pushover/curvecrossing.h"

#include "qm_rps/pushover/adrsformulas.h"

#include <algorithm>
#include <cmath>
#include <limits>
#include <utility>

namespace {

constexpr double kInfinite = std::numeric_limits<double>::infinity();
constexpr double kFar = 1e48;        // radial and vertical lines run out to here
constexpr double kTolerance = 1e-18; // mathIntersectLine2 raises it to its own smallest
constexpr double kTouch = 1e-9;      // relative length of a touch

bool AtOrigin(const T_POINT2& p, const T_POINT2& a, const T_POINT2& b)
{
    return std::fabs(p.x) <= kTouch * std::max(std::fabs(a.x), std::fabs(b.x)) &&
           std::fabs(p.y) <= kTouch * std::max(std::fabs(a.y), std::fabs(b.y));
}

/// True when both ends of a segment lie clearly on one side of a line: `a` and `b` are the signed
/// sides of its ends, `scale` the larger size of the terms they came from.
bool Aside(double a, double b, double scale)
{
    constexpr double kClear = 1e-6; // far wider than any touch
    return std::min(a, b) > kClear * scale || std::max(a, b) < -kClear * scale;
}

enum class LINE {
    Segment,
    HalfLine,       // starts at P1: on a line of 1e48 no relative touch reaches behind it
    HalfLineOrigin, // starts at the origin, which itself does not count
};

/// First crossing in walk order of the line P1-P2.
std::optional<T_POINT2> FirstCrossing(T_POINT2 P1, T_POINT2 P2, const T_ADRS_VIEW& curve, LINE kind)
{
    const double rx = P2.x - P1.x, ry = P2.y - P1.y;
    double sideA = 0.0, scaleA = 0.0; // of point i
    for (std::size_t i = 0; i < curve.Size(); ++i) {
        const double up = rx * (curve.Sa[i] - P1.y), right = ry * (curve.Sd[i] - P1.x);
        const double side = up - right, scale = std::fabs(up) + std::fabs(right);
        const double before = std::exchange(sideA, side);
        const double scaleBefore = std::exchange(scaleA, scale);
        if (i == 0 || Aside(before, side, std::max(scaleBefore, scale))) continue;
        const T_POINT2 a = curve.At(i - 1), b = curve.At(i);
        double param = 0.0;
        T_POINT2 point;
        if (!CMathFunc::mathIntersectLine2(P1, P2, a, b, kTolerance, param, point)) continue;
        const double ahead = (point.x - P1.x) * rx + (point.y - P1.y) * ry;
        if (kind != LINE::Segment && ahead < 0.0) continue;
        if (kind == LINE::HalfLineOrigin && AtOrigin(point, a, b)) continue;
        return point;
    }
    return std::nullopt;
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

/// Demand points whose segments a capacity segment can meet, when its ends lie at the cursor
/// positions i and j: two to spare on either side, for a touch just beyond the ends.
T_RANGE Reachable(std::size_t i, std::size_t j, std::size_t count)
{
    const std::size_t lo = std::min(i, j), hi = std::max(i, j);
    return {lo < 2 ? 0 : lo - 2, std::min(hi + 2, count - 1)};
}

/// True when one end is so near the origin, seen from the other, that its angle means nothing.
bool NearOrigin(const T_POINT2& a, const T_POINT2& b)
{
    constexpr double kNear = 1e-6;
    return (a.x <= kNear * b.x && a.y <= kNear * b.y) || (b.x <= kNear * a.x && b.y <= kNear * a.y);
}

/// True when the whole range of the demand lies clearly above the segment a-b.
bool Above(const T_POINT2& a, const T_POINT2& b, const T_ADRS_VIEW& demand, T_RANGE range)
{
    double least = demand.Sa[range.first], most = least;
    for (std::size_t k = range.first + 1; k <= range.last; ++k) {
        least = std::min(least, demand.Sa[k]);
        most = std::max(most, demand.Sa[k]);
    }
    return least - std::max(a.y, b.y) > 1e-6 * most;
}

/// True when a point of the range has no ordinate above 0, hence no radial angle.
bool HasZero(const T_ADRS_VIEW& demand, T_RANGE range)
{
    std::size_t positive = 0;
    for (std::size_t k = range.first; k <= range.last; ++k)
        positive += demand.Sa[k] > 0.0;
    return positive != range.last - range.first + 1;
}

/// True when no demand point of the range comes to the other side of the line a-b, nor near it.
bool OneSided(const T_POINT2& a, const T_POINT2& b, const T_ADRS_VIEW& demand, T_RANGE range)
{
    const double rx = b.x - a.x, ry = b.y - a.y;
    double least = kInfinite, most = -kInfinite, scale = 0.0;
    for (std::size_t k = range.first; k <= range.last; ++k) {
        const double up = rx * (demand.Sa[k] - a.y), right = ry * (demand.Sd[k] - a.x);
        least = std::min(least, up - right);
        most = std::max(most, up - right);
        scale = std::max(scale, std::fabs(up) + std::fabs(right));
    }
    return Aside(least, most, scale);
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
    return FirstCrossing({0.0, 0.0}, {toward.x * kFar, toward.y * kFar}, curve,
                         LINE::HalfLineOrigin);
}

std::optional<T_POINT2> CCurveCrossing::PeriodLine(double T, double gravity,
                                                   const T_ADRS_VIEW& curve)
{
    const double slope = RadialSlope(T, gravity);
    if (!std::isfinite(slope)) return std::nullopt;
    return HalfLine({1.0, slope}, curve);
}

std::optional<T_POINT2> CCurveCrossing::Vertical(double d, const T_ADRS_VIEW& curve)
{
    return FirstCrossing({d, 0.0}, {d, kFar}, curve, LINE::HalfLine);
}

std::optional<T_POINT2> CCurveCrossing::Segment(T_POINT2 P1, T_POINT2 P2, const T_ADRS_VIEW& curve)
{
    return FirstCrossing(P1, P2, curve, LINE::Segment);
}

std::optional<T_POINT2> CCurveCrossing::CapacityWithDemand(const T_ADRS_VIEW& capacity,
                                                           const T_ADRS_VIEW& demand)
{
    if (capacity.Size() < 2 || demand.Size() < 2) return std::nullopt;
    // Points ascending in period fall in radial angle. A zero ordinate has no angle: the cursor
    // stops there, and the whole demand is searched. Ordinates of both signs don't occur beyond
    // the first period, since factors act on whole branches.
    const std::size_t last = demand.Size() - 1;
    const bool ordered = demand.Sa[0] > 0.0 && demand.Sa[1] > 0.0 && demand.Sa[last] > 0.0;
    CAngleCursor cursor(demand);
    std::size_t at = ordered ? cursor.Seek(capacity.At(0)) : 0;
    for (std::size_t i = 0; i + 1 < capacity.Size(); ++i) {
        const T_POINT2 a = capacity.At(i), b = capacity.At(i + 1);
        T_RANGE range{0, last};
        if (ordered) {
            const std::size_t before = std::exchange(at, cursor.Seek(b));
            if (!NearOrigin(a, b)) range = Reachable(before, at, demand.Size());
            if (Above(a, b, demand, range)) continue;
            if (HasZero(demand, range)) range = {0, last};
            if (OneSided(a, b, demand, range)) continue;
        }
        if (const auto point = Nearest(a, b, demand, range)) return point;
    }
    return std::nullopt;
}
