#include "qm_db/shape/channelshape.h"

#include <cmath>
#include <numbers>
#include <span>

namespace {

using std::numbers::pi;

/// Angle of the arcs between the inner face and the web or the tip.
double ArcOf(const T_SECT_D& s)
{
    return 0.5 * pi - std::atan(s.taper);
}

/// Thickness of a flange.
double ThicknessAt(const T_SECT_D& s, double y)
{
    return s.size[3] + s.taper * (0.5 * (s.size[1] + s.size[2]) - y);
}

struct T_PLACE {
    double y = 0.0, z = 0.0, dy = 0.0; // dy: over the run of the piece
};

/// The lower border of the upper half: straight, or an arc about (y0, z0).
struct T_PIECE {
    double y0 = 0.0, z0 = 0.0, y1 = 0.0, z1 = 0.0; // ends of a straight one
    double radius = 0.0, from = 0.0, to = 0.0;     // angles of an arc

    T_PLACE At(double run) const
    {
        if (radius == 0.0) return {y0 + run * (y1 - y0), z0 + run * (z1 - z0), y1 - y0};
        const double angle = from + run * (to - from);
        return {y0 + radius * std::cos(angle), z0 + radius * std::sin(angle),
                -radius * std::sin(angle) * (to - from)};
    }

    /// Of f(place) dy up to a run, by Simpson's rule.
    template <class F>
    double Sum(double run, F f) const
    {
        constexpr int kParts = 64;
        double sum = 0.0;
        for (int i = 0; i <= kParts; ++i) {
            const T_PLACE p = At(run * i / kParts);
            sum += (i == 0 || i == kParts ? 1.0 : i % 2 == 1 ? 4.0 : 2.0) * f(p) * p.dy;
        }
        return sum * run / (3.0 * kParts);
    }
};

/// Web, fillet, face, rounded tip.
std::array<T_PIECE, 4> PiecesOf(const T_SECT_D& s)
{
    const auto face = ChannelFace(s);
    const double arc = ArcOf(s), web = s.size[2], tip = s.size[1], toe = ToeRadius(s);
    return {{{0.0, 0.0, web, 0.0},
             {web + s.fillet, face[0].z, web, face[0].z, s.fillet, pi, pi - arc},
             {face[1].y, face[1].z, face[2].y, face[2].z},
             {tip - toe, face[3].z, tip, face[3].z, toe, -arc, 0.0}}};
}

/// Of both halves, f(place) dy over all pieces.
template <class F>
double Whole(std::span<const T_PIECE> pieces, F f)
{
    double sum = 0.0;
    for (const T_PIECE& p : pieces)
        sum += 2.0 * p.Sum(1.0, f);
    return sum;
}

/// Plastic axis, and the plastic modulus about it.
void TakePlastic(std::span<const T_PIECE> pieces, double top, double first, T_CHANNEL& c)
{
    const auto height = [top](const T_PLACE& p) { return top - p.z; };
    const auto moment = [top](const T_PLACE& p) { return p.y * (top - p.z); };
    double area = 0.0, left = 0.0; // before the piece
    for (const T_PIECE& p : pieces) {
        const double more = 2.0 * p.Sum(1.0, height);
        if (area + more < 0.5 * c.area) {
            area += more;
            left += 2.0 * p.Sum(1.0, moment);
            continue;
        }
        constexpr int kHalvings = 60;
        double low = 0.0, high = 1.0;
        for (int i = 0; i < kHalvings; ++i) {
            const double run = 0.5 * (low + high);
            (area + 2.0 * p.Sum(run, height) < 0.5 * c.area ? low : high) = run;
        }
        c.plasticAxis = p.At(high).y;
        c.Zz = first - 2.0 * (left + 2.0 * p.Sum(high, moment));
        return;
    }
}

/// From the middle of the web: the shear flow of both flanges under a unit force along z,
/// with its lever between their middle lines (Timoshenko and Gere, Theory of Elastic Stability).
double ShearLever(const T_SECT_D& s, double Iyy)
{
    const double start = 0.5 * s.size[2], h = s.size[0];
    const T_PIECE flange{start, 0.0, s.size[1], 0.0};
    return flange.Sum(1.0, [&](const T_PLACE& p) {
        const double t = ThicknessAt(s, p.y);
        const double between = h - ThicknessAt(s, 0.5 * (start + p.y));
        return 0.5 * t * (h - t) * between * (p.y - start);
    }) / Iyy;
}

} // namespace

std::array<T_FACE_CORNER, 4> ChannelFace(const T_SECT_D& s)
{
    const auto& [height, width, web, flange] = s.size;
    const double root = ArcTangent(s, s.fillet), toe = ArcTangent(s, ToeRadius(s));
    const auto [thick, thin] = FlangeEnds(s);
    const double run = 1.0 / std::hypot(1.0, s.taper), rise = s.taper * run;
    const double low = 0.5 * height - thick, high = 0.5 * height - thin;
    const double bulge = std::tan(0.25 * ArcOf(s));
    return {{{web, low - root, root > 0.0 ? -bulge : 0.0},
             {web + root * run, low + root * rise, 0.0},
             {width - toe * run, high - toe * rise, toe > 0.0 ? bulge : 0.0},
             {width, high + toe, 0.0}}};
}

T_CHANNEL ChannelProperties(const T_SECT_D& s)
{
    const auto pieces = PiecesOf(s);
    const double top = 0.5 * s.size[0];
    const auto powers = [](double a, double b, int n) {
        return (std::pow(a, n) - std::pow(b, n)) / n;
    };
    T_CHANNEL c;
    c.area = Whole(pieces, [&](const T_PLACE& p) { return top - p.z; });
    const double first = Whole(pieces, [&](const T_PLACE& p) { return p.y * (top - p.z); });
    c.centroid = first / c.area;
    c.Izz = Whole(pieces, [&](const T_PLACE& p) {
        const double y = p.y - c.centroid;
        return y * y * (top - p.z);
    });
    c.Iyy = Whole(pieces, [&](const T_PLACE& p) { return powers(top, p.z, 3); });
    c.Zy = Whole(pieces, [&](const T_PLACE& p) { return powers(top, p.z, 2); });
    TakePlastic(pieces, top, first, c);
    c.shearCentre = 0.5 * s.size[2] - ShearLever(s, c.Iyy);
    return c;
}
