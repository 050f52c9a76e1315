#include "qm_solver/section/sectionshape.h"

#include "qm_solver/section/ringgeometry.h"

#include <algorithm>
#include <cmath>
#include <numbers>

namespace solver {

namespace {

constexpr double kLeastArea = 1e-12;   // of a ring, over the square of its extent
constexpr int kBorderPlaces = 8;       // of a way, where regions must not overlap
constexpr double kJustWithin = 1e-6;   // of the length of the way
constexpr double kTouching = 1e-9;     // bars may touch; part of the distance
constexpr double kLargestStrain = 1.0; // of a law

bool FiniteLaw(const T_STRESS_LAW& l)
{
    for (const double v : {l.strength, l.peakStrain, l.limitStrain, l.exponent, l.blockDepth,
                           l.modulus, l.hardening})
        if (!std::isfinite(v)) return false;
    return true;
}

bool SoundStrains(const T_STRESS_LAW& l)
{
    const bool limited = l.limitStrain > 0.0 && l.limitStrain < kLargestStrain;
    const bool peaked = limited && l.peakStrain > 0.0 && l.peakStrain <= l.limitStrain;
    switch (l.kind) {
    case STRESS_LAW::ParabolaRectangle:
        return peaked && l.exponent >= 1.0;
    case STRESS_LAW::Block:
        return limited && l.blockDepth > 0.0 && l.blockDepth <= 1.0;
    case STRESS_LAW::Mander:
        return peaked && l.modulus * l.peakStrain > l.strength;
    case STRESS_LAW::Steel:
        break;
    }
    const double yield = l.strength / l.modulus;
    return yield < kLargestStrain && l.hardening >= 0.0 && l.hardening <= l.modulus &&
           (l.limitStrain == 0.0 || (l.limitStrain > yield && limited));
}

SECTION_FAULT CheckLaw(const T_STRESS_LAW& l, bool plastic)
{
    if (!FiniteLaw(l)) return SECTION_FAULT::NotFinite;
    const bool elastic = l.kind == STRESS_LAW::Mander || (l.kind == STRESS_LAW::Steel && !plastic);
    if (!(l.strength > 0.0) || (elastic && !(l.modulus > 0.0))) return SECTION_FAULT::LawStrength;
    if (plastic && l.kind == STRESS_LAW::Steel) return SECTION_FAULT::None;
    return SoundStrains(l) ? SECTION_FAULT::None : SECTION_FAULT::LawStrains;
}

/// Where a fault is found, the error says so.
bool Set(T_SECTION_ERROR& error, SECTION_FAULT fault)
{
    error.fault = fault;
    return fault == SECTION_FAULT::None;
}

bool CheckRing(const T_RING& ring, T_SECTION_ERROR& error)
{
    for (const T_CORNER& c : ring)
        if (!std::isfinite(c.y) || !std::isfinite(c.z) || !std::isfinite(c.bulge))
            return Set(error, SECTION_FAULT::NotFinite);
    const double extent = ExtentOf(ring), least = kLeastArea * extent * extent;
    // All corners on one line, straight all round.
    bool flat = ring.size() < 2 || std::fabs(AreaOf(ring)) <= least;
    for (std::size_t i = 2; i < ring.size() && flat; ++i)
        flat = std::fabs(AreaOf({ring[0], ring[1], ring[i]})) <= least;
    if (flat) return Set(error, SECTION_FAULT::RingArea);
    return Set(error,
               Crossing(ring, ring, true) ? SECTION_FAULT::RingCrossed : SECTION_FAULT::None);
}

bool CheckRegion(const T_SECTION_REGION& region, T_SECTION_ERROR& error)
{
    if (region.rings.empty()) {
        error.ring = 0;
        return Set(error, SECTION_FAULT::RingArea);
    }
    for (std::size_t i = 0; i < region.rings.size(); ++i) {
        error.ring = static_cast<long>(i);
        const T_RING& ring = region.rings[i];
        if (!CheckRing(ring, error)) return false;
        for (std::size_t k = 0; k < i; ++k)
            if (Crossing(region.rings[k], ring, false))
                return Set(error, SECTION_FAULT::RingCrossed);
        if (i > 0 && !Within(region.rings[0], ring[0].y, ring[0].z))
            return Set(error, SECTION_FAULT::HoleOutside);
    }
    error.ring = -1;
    return true;
}

bool InRegion(const T_SECTION_REGION& region, double y, double z)
{
    bool in = Within(region.rings[0], y, z);
    for (std::size_t i = 1; i < region.rings.size() && in; ++i)
        in = !Within(region.rings[i], y, z);
    return in;
}

/// Diameter of a round bar.
double Diameter(const T_SECTION_BAR& bar)
{
    return std::sqrt(4.0 * bar.area / std::numbers::pi);
}

/// Fills the law of the concrete around a bar.
bool CheckBar(const T_SECTION_MODEL& m, std::size_t i, std::size_t& host, T_SECTION_ERROR& error)
{
    const T_SECTION_BAR& bar = m.bars[i];
    error.bar = static_cast<long>(i);
    if (!std::isfinite(bar.y) || !std::isfinite(bar.z) || !std::isfinite(bar.area))
        return Set(error, SECTION_FAULT::NotFinite);
    if (!(bar.area > 0.0)) return Set(error, SECTION_FAULT::BarArea);
    if (bar.law >= m.laws.size()) return Set(error, SECTION_FAULT::NoSuchLaw);
    if (m.laws[bar.law].kind != STRESS_LAW::Steel) return Set(error, SECTION_FAULT::WrongLaw);
    const auto in = std::ranges::find_if(m.regions, [&](const T_SECTION_REGION& r) {
        return m.laws[r.law].kind != STRESS_LAW::Steel && InRegion(r, bar.y, bar.z);
    });
    if (in == m.regions.end()) return Set(error, SECTION_FAULT::BarOutside);
    host = in->law;
    for (std::size_t k = 0; k < i; ++k) {
        const double apart = std::hypot(bar.y - m.bars[k].y, bar.z - m.bars[k].z);
        const double own = Diameter(bar), other = Diameter(m.bars[k]);
        const double least = 0.5 * (m.lumped ? std::max(own, other) : own + other);
        if (apart >= least * (1.0 - kTouching)) continue;
        error.otherBar = static_cast<long>(k);
        return Set(error, SECTION_FAULT::BarsOverlap);
    }
    error.bar = -1;
    return true;
}

/// Edges and arcs of a ring about the point of moments.
void AddRing(const T_RING& ring, bool hole, std::size_t region, T_SECTION_SHAPE& out)
{
    const double y0 = out.model.momentY, z0 = out.model.momentZ;
    const double sign = (AreaOf(ring) > 0.0) == hole ? -1.0 : 1.0;
    for (std::size_t i = 0; i < ring.size(); ++i) {
        const T_CORNER &a = ring[i], &b = ring[i + 1 < ring.size() ? i + 1 : 0];
        if (a.bulge == 0.0) {
            out.edges.push_back({a.y - y0, a.z - z0, b.y - y0, b.z - z0, sign, region});
            continue;
        }
        const T_BULGE arc = BulgeOf(a, b);
        const bool left = arc.sweep > 0.0;
        out.arcs.push_back({arc.y - y0, arc.z - z0, arc.radius,
                            left ? arc.from : arc.from + arc.sweep, std::fabs(arc.sweep),
                            left ? sign : -sign, region});
    }
    // Two half circles are one circle, which integrates faster.
    if (ring.size() == 2 && ring[0].bulge == ring[1].bulge && std::fabs(ring[0].bulge) == 1.0) {
        out.arcs.pop_back();
        out.arcs.back().sweep = 2.0 * std::numbers::pi;
    }
}

/// Whether a place just within the border of a region lies in another region too.
bool CheckApart(const T_SECTION_SHAPE& shape, T_SECTION_ERROR& error)
{
    const T_SECTION_MODEL& m = shape.model;
    const auto apart = [&](std::size_t region, double y, double z) {
        for (std::size_t i = 0; i < m.regions.size(); ++i)
            if (i != region && InRegion(m.regions[i], m.momentY + y, m.momentZ + z)) {
                error.region = static_cast<long>(std::max(i, region));
                error.otherRegion = static_cast<long>(std::min(i, region));
                return Set(error, SECTION_FAULT::RegionsOverlap);
            }
        return true;
    };
    for (int k = 0; k < kBorderPlaces; ++k) {
        const double at = (k + 0.5) / kBorderPlaces;
        for (const T_EDGE& e : shape.edges) {
            const double dy = e.y1 - e.y0, dz = e.z1 - e.z0, in = e.sign * kJustWithin;
            if (!apart(e.region, e.y0 + at * dy - in * dz, e.z0 + at * dz + in * dy)) return false;
        }
        for (const T_ARC& a : shape.arcs) {
            const double angle = a.from + at * a.sweep, r = a.radius * (1.0 - a.sign * kJustWithin);
            if (!apart(a.region, a.y + r * std::cos(angle), a.z + r * std::sin(angle)))
                return false;
        }
    }
    return true;
}

bool CheckParts(const T_SECTION_MODEL& m, T_SECTION_ERROR& error)
{
    if (!std::isfinite(m.momentY) || !std::isfinite(m.momentZ))
        return Set(error, SECTION_FAULT::NotFinite);
    for (std::size_t i = 0; i < m.laws.size(); ++i) {
        error.law = static_cast<long>(i);
        if (!Set(error, CheckLaw(m.laws[i], m.plastic))) return false;
    }
    error.law = -1;
    if (m.regions.empty()) return Set(error, SECTION_FAULT::NoRegion);
    for (std::size_t i = 0; i < m.regions.size(); ++i) {
        error.region = static_cast<long>(i);
        const T_SECTION_REGION& region = m.regions[i];
        if (region.law >= m.laws.size()) return Set(error, SECTION_FAULT::NoSuchLaw);
        if (m.plastic && m.laws[region.law].kind != STRESS_LAW::Steel)
            return Set(error, SECTION_FAULT::ConcretePlastic);
        if (!CheckRegion(region, error)) return false;
    }
    error.region = -1;
    return true;
}

} // namespace

int MakeShape(const T_SECTION_MODEL& model, T_SECTION_SHAPE& out, T_SECTION_ERROR& error)
{
    error = {};
    if (!CheckParts(model, error)) return 0;
    T_SECTION_SHAPE shape;
    shape.model = model;
    for (const T_STRESS_LAW& law : model.laws)
        shape.laws.emplace_back(law, model.plastic);
    for (std::size_t r = 0; r < model.regions.size(); ++r)
        for (const T_RING& ring : model.regions[r].rings)
            AddRing(ring, &ring != &model.regions[r].rings.front(), r, shape);
    if (!CheckApart(shape, error)) return 0;
    for (std::size_t i = 0; i < model.bars.size(); ++i) {
        const T_SECTION_BAR& bar = model.bars[i];
        std::size_t host = 0;
        if (!CheckBar(model, i, host, error)) return 0;
        shape.bars.push_back(
            {bar.y - model.momentY, bar.z - model.momentZ, bar.area, bar.law, host});
    }
    out = std::move(shape);
    return 1;
}

} // namespace solver
