#include "qm_solver/section/ringgeometry.h"

#include <algorithm>
#include <cmath>
#include <numbers>

namespace solver {

namespace {

constexpr double kChordAngle = std::numbers::pi / 12.0;

const T_CORNER& After(const T_RING& ring, std::size_t i)
{
    return ring[i + 1 < ring.size() ? i + 1 : 0];
}

/// Twice the area of a triangle, positive when it turns left.
double Turn(const T_CORNER& a, const T_CORNER& b, double y, double z)
{
    return (b.y - a.y) * (z - a.z) - (b.z - a.z) * (y - a.y);
}

/// The ring with arcs as chords.
T_RING Chords(const T_RING& ring)
{
    T_RING out;
    for (std::size_t i = 0; i < ring.size(); ++i) {
        out.push_back({ring[i].y, ring[i].z});
        if (ring[i].bulge == 0.0) continue;
        const T_BULGE arc = BulgeOf(ring[i], After(ring, i));
        const int parts = static_cast<int>(std::ceil(std::fabs(arc.sweep) / kChordAngle));
        for (int k = 1; k < parts; ++k) {
            const double at = arc.from + arc.sweep * k / parts;
            out.push_back({arc.y + arc.radius * std::cos(at), arc.z + arc.radius * std::sin(at)});
        }
    }
    return out;
}

bool Between(double a, double b, double v)
{
    return std::min(a, b) <= v && v <= std::max(a, b);
}

/// Whether p, on the line through a and b, lies between them.
bool OnWay(const T_CORNER& a, const T_CORNER& b, const T_CORNER& p)
{
    return Between(a.y, b.y, p.y) && Between(a.z, b.z, p.z);
}

bool Meet(const T_CORNER& a, const T_CORNER& b, const T_CORNER& c, const T_CORNER& d)
{
    const double c1 = Turn(a, b, c.y, c.z), d1 = Turn(a, b, d.y, d.z);
    const double a1 = Turn(c, d, a.y, a.z), b1 = Turn(c, d, b.y, b.z);
    if (((c1 > 0.0) != (d1 > 0.0)) && ((a1 > 0.0) != (b1 > 0.0)) && c1 != 0.0 && d1 != 0.0 &&
        a1 != 0.0 && b1 != 0.0)
        return true;
    return (c1 == 0.0 && OnWay(a, b, c)) || (d1 == 0.0 && OnWay(a, b, d)) ||
           (a1 == 0.0 && OnWay(c, d, a)) || (b1 == 0.0 && OnWay(c, d, b));
}

/// Neighbours share a corner; they overlap only where the second goes back along the first.
bool FoldsBack(const T_CORNER& a, const T_CORNER& b, const T_CORNER& c)
{
    return Turn(a, b, c.y, c.z) == 0.0 &&
           (b.y - a.y) * (c.y - b.y) + (b.z - a.z) * (c.z - b.z) <= 0.0;
}

} // namespace

T_BULGE BulgeOf(const T_CORNER& a, const T_CORNER& b)
{
    T_BULGE out;
    const double k = a.bulge, dy = b.y - a.y, dz = b.z - a.z;
    // The centre lies (1 - k2) / (4 k) of the chord to the left of its middle.
    const double left = (1.0 - k * k) / (4.0 * k);
    out.y = 0.5 * (a.y + b.y) - left * dz;
    out.z = 0.5 * (a.z + b.z) + left * dy;
    out.radius = std::hypot(dy, dz) * (1.0 + k * k) / (4.0 * std::fabs(k));
    out.from = std::atan2(a.z - out.z, a.y - out.y);
    out.sweep = 4.0 * std::atan(k);
    return out;
}

double AreaOf(const T_RING& ring)
{
    double area = 0.0;
    for (std::size_t i = 0; i < ring.size(); ++i) {
        const T_CORNER &a = ring[i], &b = After(ring, i);
        area += 0.5 * Turn(ring[0], a, b.y, b.z);
        if (a.bulge == 0.0) continue;
        const T_BULGE arc = BulgeOf(a, b);
        area += 0.5 * arc.radius * arc.radius * (arc.sweep - std::sin(arc.sweep));
    }
    return area;
}

double ExtentOf(const T_RING& ring)
{
    double extent = 0.0;
    for (const T_CORNER& c : Chords(ring))
        extent = std::max({extent, std::fabs(c.y - ring[0].y), std::fabs(c.z - ring[0].z)});
    return extent;
}

namespace {

/// Whether a point lies to the right of the chord from a to b. One on it counts as shifted towards
/// +y, and by less towards +z, so that of two chords there and back it is right of one.
bool RightOf(const T_CORNER& a, const T_CORNER& b, double y, double z)
{
    const double turn = Turn(a, b, y, z);
    if (turn != 0.0) return turn < 0.0;
    return a.z == b.z ? b.y < a.y : b.z > a.z;
}

} // namespace

bool Within(const T_RING& ring, double y, double z)
{
    bool in = false;
    for (std::size_t i = 0; i < ring.size(); ++i) {
        const T_CORNER &a = ring[i], &b = After(ring, i);
        // A ray towards +y; half-open in z, so that a corner counts once.
        if ((a.z > z) != (b.z > z) && y < a.y + (b.y - a.y) * (z - a.z) / (b.z - a.z)) in = !in;
        if (a.bulge == 0.0) continue;
        // Between chord and arc inside and outside change places; the arc bulges to the right of
        // its chord when it turns left.
        const T_BULGE arc = BulgeOf(a, b);
        const bool beyond = RightOf(a, b, y, z) == (a.bulge > 0.0);
        if (beyond && std::hypot(y - arc.y, z - arc.z) < arc.radius) in = !in;
    }
    return in;
}

bool Crossing(const T_RING& first, const T_RING& second, bool same)
{
    const T_RING a = Chords(first), b = Chords(second);
    for (std::size_t i = 0; i < a.size(); ++i)
        for (std::size_t k = same ? i + 1 : 0; k < b.size(); ++k) {
            const bool next = same && k == i + 1, last = same && i == 0 && k + 1 == b.size();
            if (next || last) {
                const std::size_t from = next ? i : k;
                const T_CORNER& mid = After(a, from);
                const T_CORNER& far = a[(from + 2) % a.size()];
                if (FoldsBack(a[from], mid, far)) return true;
            } else if (Meet(a[i], After(a, i), b[k], After(b, k)))
                return true;
        }
    return false;
}

} // namespace solver
