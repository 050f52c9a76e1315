#include "qm_rps/outline/sectionoutline.h"

#include "qm_db/sectionproperties.h"

#include <algorithm>
#include <cmath>
#include <limits>
#include <numbers>

namespace {

using namespace solver;

/// tan(pi / 8): bulge of a quarter circle.
constexpr double kQuarter = std::numbers::sqrt2 - 1.0;

T_RING Rectangle(double width, double depth)
{
    const double y = width / 2.0, z = depth / 2.0;
    return {{-y, -z}, {y, -z}, {y, z}, {-y, z}};
}

/// Corners rounded with a radius.
T_RING Rounded(double width, double depth, double radius)
{
    if (!(radius > 0.0)) return Rectangle(width, depth);
    const double y = width / 2.0, z = depth / 2.0, r = radius, left = kQuarter;
    return {{-y + r, -z}, {y - r, -z, left}, {y, -z + r}, {y, z - r, left},
            {y - r, z},   {-y + r, z, left}, {-y, z - r}, {-y, -z + r, left}};
}

T_RING Circle(double diameter)
{
    return {{diameter / 2.0, 0.0, 1.0}, {-diameter / 2.0, 0.0, 1.0}};
}

/// Height a, width b, web c, flanges d, fillets r.
T_RING IShape(double a, double b, double c, double d, double r)
{
    const double y = b / 2.0, w = c / 2.0, z = a / 2.0, f = z - d;
    if (r > 0.0)
        return {{-y, -z},     {y, -z},
                {y, -f},      {w + r, -f, -kQuarter},
                {w, -f + r},  {w, f - r, -kQuarter},
                {w + r, f},   {y, f},
                {y, z},       {-y, z},
                {-y, f},      {-w - r, f, -kQuarter},
                {-w, f - r},  {-w, -f + r, -kQuarter},
                {-w - r, -f}, {-y, -f}};
    return {{-y, -z}, {y, -z}, {y, -f}, {w, -f}, {w, f},   {y, f},
            {y, z},   {-y, z}, {-y, f}, {-w, f}, {-w, -f}, {-y, -f}};
}

/// About the centroid.
T_RING Channel(const T_SECT_D& section)
{
    const double back = -ChannelProperties(section).centroid, tip = back + section.size[1];
    const double top = 0.5 * section.size[0];
    const auto face = ChannelFace(section);
    T_RING ring{{back, -top}, {tip, -top}};
    // The lower face from its tip; the bulge of a way stands at its first corner.
    for (std::size_t i = face.size(); i-- > 0;)
        ring.push_back({back + face[i].y, -face[i].z, i > 0 ? face[i - 1].bulge : 0.0});
    for (const T_FACE_CORNER& c : face)
        ring.push_back({back + c.y, c.z, c.bulge});
    ring.push_back({tip, top});
    ring.push_back({back, top});
    // Sharp corners stand there twice.
    const auto same = [](const T_CORNER& a, const T_CORNER& b) { return a.y == b.y && a.z == b.z; };
    const auto rest = std::ranges::unique(ring, same);
    ring.erase(rest.begin(), rest.end());
    return ring;
}

} // namespace

std::vector<T_RING> SectionRings(const T_SECT_D& section)
{
    const auto& [a, b, c, d] = section.size;
    switch (section.shape) {
    case SECT_SHAPE::Rectangle:
        return {Rectangle(b, a)};
    case SECT_SHAPE::Circle:
        return {Circle(a)};
    case SECT_SHAPE::Pipe:
        return {Circle(a), Circle(a - 2.0 * b)};
    case SECT_SHAPE::Box:
        return {Rounded(b, a, section.fillet),
                Rounded(b - 2.0 * c, a - 2.0 * d, InnerRadius(section))};
    case SECT_SHAPE::IShape:
        return {IShape(a, b, c, d, section.fillet)};
    case SECT_SHAPE::Channel:
        return {Channel(section)};
    case SECT_SHAPE::Value:
        break;
    }
    return {};
}

std::vector<T_RING> CoreRings(const T_SECT_D& section)
{
    if (!section.detailing) return {};
    const double edge = 2.0 * section.detailing->cover + section.detailing->stirrupDiameter;
    const double height = section.size[0] - edge, width = section.size[1] - edge;
    if (section.shape == SECT_SHAPE::Circle && height > 0.0) return {Circle(height)};
    if (section.shape == SECT_SHAPE::Rectangle && height > 0.0 && width > 0.0)
        return {Rectangle(width, height)};
    return {};
}

T_STRESS_LAW SteelLaw(double strength, double modulus)
{
    T_STRESS_LAW law;
    law.kind = STRESS_LAW::Steel;
    law.strength = strength;
    law.modulus = modulus;
    return law;
}

T_RING_EXTENT ExtentAlong(const T_RING& ring, double direction)
{
    const double c = std::cos(direction), s = std::sin(direction);
    T_RING_EXTENT out{std::numeric_limits<double>::infinity(),
                      -std::numeric_limits<double>::infinity()};
    const auto take = [&](double place) {
        out = {std::min(out.low, place), std::max(out.high, place)};
    };
    for (std::size_t i = 0; i < ring.size(); ++i) {
        const T_CORNER &p = ring[i], &q = ring[(i + 1) % ring.size()];
        take(p.z * c + p.y * s);
        if (p.bulge == 0.0) continue;
        // The centre lies beside the middle of the chord; the arc reaches its circle's end in the
        // direction where that lies on the arc's side of the chord.
        const double y = q.y - p.y, z = q.z - p.z, chord = std::hypot(y, z);
        const double beside = (1.0 - p.bulge * p.bulge) / (4.0 * p.bulge);
        const double my = 0.5 * (p.y + q.y) - beside * z, mz = 0.5 * (p.z + q.z) + beside * y;
        const double radius = 0.25 * chord * (1.0 + p.bulge * p.bulge) / std::fabs(p.bulge);
        for (const double sign : {-1.0, 1.0}) {
            const double ty = my + sign * radius * s, tz = mz + sign * radius * c;
            const double side = y * (tz - p.z) - z * (ty - p.y);
            if (side * p.bulge <= 0.0) take(tz * c + ty * s);
        }
    }
    return out;
}
