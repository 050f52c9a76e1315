#include "qm_rps/hinge/sectionstrength.h"

#include "qm_rps/hinge/sectionbending.h"

#include <algorithm>
#include <cmath>
#include <functional>
#include <numbers>

namespace {

constexpr int kCurveSteps = 64;
/// Way of the points A to E from the largest moment to pure compression and to pure tension.
constexpr std::array<double, 5> kWayC{0.0, 0.25, 0.5, 0.75, 1.0};
constexpr std::array<double, 5> kWayT{0.05, 0.25, 0.5, 0.75, 1.0};

bool Positive(double v)
{
    return v > 0.0 && std::isfinite(v);
}

double FckMpa(const T_MATL_D& m, const T_UNITS& units)
{
    return ToSi(m.fck, units, kDimStress) / 1e6;
}

struct T_DIRECTION {
    double atZero = 0.0, largest = 0.0; // moments
    T_PM_CURVE curve{};
};

/// Moments and the ten points of one direction.
bool Solve(const CSectionBending& bending, T_DIRECTION& out)
{
    T_AXIAL_MOMENT zero, top, pure, tension;
    double peak = 0.0;
    if (!bending.AtAxial(0.0, zero) || !bending.Largest(top, peak)) return false;
    if (!bending.At(2.0, pure) || !bending.At(0.0, tension)) return false;
    out.atZero = zero.moment;
    out.largest = top.moment;
    if (!Positive(out.atZero) || !Positive(out.largest)) return false;
    if (!(tension.axial < top.axial && top.axial < pure.axial)) return false;
    for (std::size_t i = 0; i < kWayC.size(); ++i) {
        const double c = top.axial + kWayC[i] * (pure.axial - top.axial);
        const double t = top.axial + kWayT[i] * (tension.axial - top.axial);
        T_AXIAL_MOMENT atC = pure, atT = tension;
        if (i + 1 < kWayC.size() && (!bending.AtAxial(c, atC) || !bending.AtAxial(t, atT)))
            return false;
        const double ratio = i == 0 ? CSectionStrength::kLargestRatio : atC.moment / out.largest;
        out.curve[4 - i] = {c / pure.axial, ratio};
        out.curve[5 + i] = {t / pure.axial, atT.moment / out.largest};
    }
    return true;
}

/// The centre of one lies within the other: a bar was entered twice.
bool StandsIn(const T_REBAR& a, const T_REBAR& b)
{
    const double radius = std::sqrt(std::max(a.area, b.area) / std::numbers::pi);
    return std::hypot(a.y - b.y, a.z - b.z) < 0.999 * radius;
}

SECT_FAULT CheckBars(const T_SECT_D& s)
{
    if (s.bars.empty()) return SECT_FAULT::NoBars;
    double steel = 0.0;
    for (const T_REBAR& b : s.bars) {
        if (std::any_of(s.bars.data(), &b, [&](const T_REBAR& a) { return StandsIn(a, b); }))
            return SECT_FAULT::Bars;
        const bool inside = s.shape == SECT_SHAPE::Circle ? std::hypot(b.y, b.z) < 0.5 * s.size[0]
                                                          : std::fabs(b.z) < 0.5 * s.size[0] &&
                                                                std::fabs(b.y) < 0.5 * s.size[1];
        if (!inside || !Positive(b.area)) return SECT_FAULT::Bars;
        steel += b.area;
    }
    return steel < s.area ? SECT_FAULT::None : SECT_FAULT::Bars;
}

SECT_FAULT CheckConcrete(const T_SECT_D& s, const T_MATL_D& m, const T_UNITS& units)
{
    if (s.shape != SECT_SHAPE::Rectangle && s.shape != SECT_SHAPE::Circle) return SECT_FAULT::Shape;
    if (!Positive(m.fck) || !Positive(m.fyk) || !Positive(m.Es)) return SECT_FAULT::Material;
    // fck in another unit system may miss 90 by a rounding.
    if (FckMpa(m, units) > kMaxFckMpa * (1.0 + 1e-9)) return SECT_FAULT::ConcreteClass;
    return CheckBars(s);
}

SECT_FAULT CheckSteel(const T_SECT_D& s, const T_MATL_D& m)
{
    if (!Positive(m.Fy)) return SECT_FAULT::Material;
    // A section given by values must bring what the strengths are made of.
    return Positive(s.area) && Positive(s.Zy) && Positive(s.Zz) ? SECT_FAULT::None
                                                                : SECT_FAULT::Values;
}

/// The section with its properties, when its strengths can be calculated.
bool Prepare(const T_SECT_D& in, const T_MATL_D& m, const T_UNITS& units, T_SECT_D& section,
             SECT_FAULT& fault)
{
    if (!CSectionProperties::Calc(in, section, fault)) return false;
    if (m.type == MATL_CLASS::Steel)
        fault = CheckSteel(section, m);
    else if (m.type == MATL_CLASS::Concrete)
        fault = CheckConcrete(section, m, units);
    else
        fault = SECT_FAULT::Class;
    return fault == SECT_FAULT::None;
}

/// How a section bends that its strengths can be calculated of.
bool PrepareBending(const T_SECT_D& in, const T_MATL_D& m, const T_UNITS& units, T_SECT_D& section,
                    std::optional<CSectionBending>& bending, SECT_FAULT& fault)
{
    if (!Prepare(in, m, units, section, fault)) return false;
    T_CONCRETE_LAW law;
    if (m.type == MATL_CLASS::Concrete) law = ConcreteLaw(std::min(FckMpa(m, units), kMaxFckMpa));
    bending = CSectionBending::Of(section, m, law);
    if (!bending) fault = SECT_FAULT::Material;
    return bending.has_value();
}

bool SolveAxis(CSectionBending& bending, bool aboutY, T_YIELD_AXIS& axis)
{
    T_DIRECTION pos, neg;
    bending.Turn(aboutY, true);
    if (!Solve(bending, pos)) return false;
    bending.Turn(aboutY, false);
    if (!Solve(bending, neg)) return false;
    axis = {true, {pos.atZero, neg.atZero}, {pos.largest, neg.largest}, {pos.curve, neg.curve}};
    return true;
}

/// One row of the surface; false where a moment can't be found or is none.
bool SolveRow(CSectionBending& bending, std::span<const double> directions, T_SURFACE_ROW& row)
{
    std::array<T_SIDES<double>, 2> strength; // y, z
    for (std::size_t k = 0; k < 2; ++k)
        for (const bool positive : {true, false}) {
            T_AXIAL_MOMENT found;
            bending.Turn(k == 0, positive);
            if (!bending.AtAxial(row.axial, found) || !Positive(found.moment)) return false;
            (positive ? strength[k].pos : strength[k].neg) = found.moment;
        }
    const auto part = [](const T_SIDES<double>& s, double share) {
        return share * (share > 0.0 ? s.pos : s.neg);
    };
    for (const double angle : directions) {
        const double y = part(strength[0], std::cos(angle)), z = part(strength[1], std::sin(angle));
        double moment = 0.0;
        if (!bending.Towards(std::atan2(z, y), row.axial, moment) || !Positive(moment))
            return false;
        row.share.push_back(moment / std::hypot(y, z));
    }
    return true;
}

std::optional<T_SIDES<double>> Both(double v)
{
    return Positive(v) ? std::optional(T_SIDES<double>{v, v}) : std::nullopt;
}

} // namespace

int CSectionStrength::Calc(const T_SECT_D& section, const T_MATL_D& material, const T_UNITS& units,
                           T_SECTION_STRENGTH& out, SECT_FAULT& fault)
{
    T_SECT_D s;
    std::optional<CSectionBending> bending;
    if (!PrepareBending(section, material, units, s, bending, fault)) return 0;
    T_SECTION_STRENGTH r;
    T_AXIAL_MOMENT pure, tension;
    if (!bending->At(2.0, pure) || !bending->At(0.0, tension) ||
        !SolveAxis(*bending, true, r.level.y) || !SolveAxis(*bending, false, r.level.z)) {
        fault = SECT_FAULT::NotConverged;
        return 0;
    }
    r.level.compression = pure.axial;
    r.level.tension = -tension.axial;
    const auto at = [&r](HINGE_COMPONENT c) -> auto&
    {
        return r.yield[static_cast<std::size_t>(c)];
    };
    at(HINGE_COMPONENT::Fx) = {r.level.tension, r.level.compression};
    at(HINGE_COMPONENT::My) = r.level.y.moment;
    at(HINGE_COMPONENT::Mz) = r.level.z.moment;
    if (material.type == MATL_CLASS::Steel) {
        const double shear = material.Fy / std::numbers::sqrt3; // von Mises
        const T_SHEAR_AREAS areas = CSectionProperties::StrengthShearAreas(s);
        at(HINGE_COMPONENT::Fy) = Both(areas.y * shear);
        at(HINGE_COMPONENT::Fz) = Both(areas.z * shear);
    }
    out = r;
    return 1;
}

int CSectionStrength::CalcMoment(const T_SECT_D& section, const T_MATL_D& material,
                                 const T_UNITS& units, bool aboutY, bool positive, double axial,
                                 double& moment, SECT_FAULT& fault)
{
    T_SECT_D s;
    std::optional<CSectionBending> bending;
    if (!PrepareBending(section, material, units, s, bending, fault)) return 0;
    bending->Turn(aboutY, positive);
    T_AXIAL_MOMENT pure, tension, found;
    fault = SECT_FAULT::NotConverged;
    if (!bending->At(2.0, pure) || !bending->At(0.0, tension)) return 0;
    if (!(tension.axial <= axial && axial <= pure.axial)) {
        fault = SECT_FAULT::Values;
        return 0;
    }
    if (!bending->AtAxial(axial, found)) return 0;
    fault = SECT_FAULT::None;
    moment = found.moment;
    return 1;
}

int CSectionStrength::CalcCurve(const T_SECT_D& section, const T_MATL_D& material,
                                const T_UNITS& units, bool aboutY, bool positive,
                                std::vector<T_PM_POINT>& out, SECT_FAULT& fault)
{
    T_SECT_D s;
    std::optional<CSectionBending> bending;
    if (!PrepareBending(section, material, units, s, bending, fault)) return 0;
    bending->Turn(aboutY, positive);
    T_AXIAL_MOMENT pure, top;
    double peak = 0.0;
    fault = SECT_FAULT::NotConverged;
    if (!bending->At(2.0, pure) || !bending->Largest(top, peak)) return 0;
    if (!Positive(pure.axial) || !Positive(top.moment)) return 0;
    std::vector<double> places{peak};
    for (int i = 0; i <= kCurveSteps; ++i)
        places.push_back(2.0 * i / kCurveSteps);
    std::ranges::sort(places, std::greater());
    std::vector<T_PM_POINT> curve;
    for (const double u : places) {
        T_AXIAL_MOMENT at;
        if (!bending->At(u, at)) return 0;
        curve.push_back({at.axial / pure.axial, at.moment / top.moment});
    }
    fault = SECT_FAULT::None;
    out = std::move(curve);
    return 1;
}

int CSectionStrength::CalcSurface(const T_SECT_D& section, const T_MATL_D& material,
                                  const T_UNITS& units, std::size_t rows,
                                  std::span<const double> directions,
                                  std::vector<T_SURFACE_ROW>& out, SECT_FAULT& fault)
{
    T_SECT_D s;
    std::optional<CSectionBending> bending;
    if (!PrepareBending(section, material, units, s, bending, fault)) return 0;
    if (section.shape == SECT_SHAPE::Value) {
        fault = SECT_FAULT::Values;
        return 0;
    }
    T_AXIAL_MOMENT pure, tension;
    fault = SECT_FAULT::NotConverged;
    if (!bending->At(2.0, pure) || !bending->At(0.0, tension)) return 0;
    std::vector<T_SURFACE_ROW> found;
    for (std::size_t i = 0; i < rows; ++i) {
        const double part = (static_cast<double>(i) + 0.5) / static_cast<double>(rows);
        T_SURFACE_ROW row{tension.axial + part * (pure.axial - tension.axial), {}};
        if (SolveRow(*bending, directions, row)) found.push_back(std::move(row));
    }
    if (found.empty()) return 0;
    fault = SECT_FAULT::None;
    out = std::move(found);
    return 1;
}
