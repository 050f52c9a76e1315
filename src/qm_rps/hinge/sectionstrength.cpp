#include "qm_rps/hinge/sectionstrength.h"

#include "qm_rps/hinge/sectionbending.h"

#include <algorithm>
#include <cmath>
#include <functional>
#include <numbers>

namespace {

constexpr int kMaxIterations = 200;
constexpr double kAxialTol = 1e-9; // residual of the axial force / range of axial forces
constexpr int kScan = 64;          // steps of the search for the largest moment
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

/// u of an axial force between the forces at lo and hi, by bisection.
bool FindAxial(const ISectionBending& bending, double axial, double lo, double hi, double& u)
{
    const double nLo = bending.At(lo).axial, nHi = bending.At(hi).axial;
    const double tol = kAxialTol * (bending.At(2.0).axial - bending.At(0.0).axial);
    if (!(nLo - tol <= axial && axial <= nHi + tol)) return false;
    for (int i = 0; i < kMaxIterations && hi - lo > 0.0; ++i) {
        const double mid = 0.5 * (lo + hi);
        if (mid <= lo || mid >= hi) break;
        (bending.At(mid).axial < axial ? lo : hi) = mid;
    }
    u = std::fabs(bending.At(lo).axial - axial) < std::fabs(bending.At(hi).axial - axial) ? lo : hi;
    return std::fabs(bending.At(u).axial - axial) <= tol;
}

/// u of the largest moment: scan, then golden section around the best step.
double FindPeak(const ISectionBending& bending)
{
    double best = 0.0;
    for (int i = 0; i <= kScan; ++i) {
        const double u = 2.0 * i / kScan;
        if (bending.At(u).moment > bending.At(best).moment) best = u;
    }
    constexpr double kGolden = 1.0 / std::numbers::phi;
    double lo = std::max(0.0, best - 2.0 / kScan), hi = std::min(2.0, best + 2.0 / kScan);
    for (int i = 0; i < kMaxIterations && hi - lo > 1e-12; ++i) {
        const double a = hi - kGolden * (hi - lo), b = lo + kGolden * (hi - lo);
        (bending.At(a).moment < bending.At(b).moment ? lo : hi) =
            bending.At(a).moment < bending.At(b).moment ? a : b;
    }
    const double refined = 0.5 * (lo + hi);
    return bending.At(refined).moment > bending.At(best).moment ? refined : best;
}

struct T_DIRECTION {
    double atZero = 0.0, largest = 0.0; // moments
    T_PM_CURVE curve{};
};

/// Moments and the ten points of one direction.
bool Solve(const ISectionBending& bending, T_DIRECTION& out)
{
    double u = 0.0;
    if (!FindAxial(bending, 0.0, 0.0, 2.0, u)) return false;
    out.atZero = bending.At(u).moment;
    const double peak = FindPeak(bending);
    const T_AXIAL_MOMENT top = bending.At(peak);
    out.largest = top.moment;
    const double pure = bending.At(2.0).axial, tension = bending.At(0.0).axial;
    if (!Positive(out.atZero) || !Positive(out.largest)) return false;
    if (!(tension < top.axial && top.axial < pure)) return false;
    for (std::size_t i = 0; i < kWayC.size(); ++i) {
        const double c = top.axial + kWayC[i] * (pure - top.axial);
        const double t = top.axial + kWayT[i] * (tension - top.axial);
        double uc = 2.0, ut = 0.0;
        if (i + 1 < kWayC.size() &&
            (!FindAxial(bending, c, peak, 2.0, uc) || !FindAxial(bending, t, 0.0, peak, ut)))
            return false;
        const double ratio = bending.At(uc).moment / out.largest;
        out.curve[4 - i] = {c / pure, i == 0 ? CSectionStrength::kLargestRatio : ratio};
        out.curve[5 + i] = {t / pure, bending.At(ut).moment / out.largest};
    }
    return true;
}

SECT_FAULT CheckBars(const T_SECT_D& s)
{
    if (s.bars.empty()) return SECT_FAULT::NoBars;
    double steel = 0.0;
    for (const T_REBAR& b : s.bars) {
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

/// A section that its strengths can be calculated of, and how it bends.
struct T_READY {
    const T_SECT_D& section;
    const T_MATL_D& material;
    T_CONCRETE_LAW law{}; // of concrete
    T_READY(const T_SECT_D& s, const T_MATL_D& m, const T_UNITS& units) : section(s), material(m)
    {
        if (m.type == MATL_CLASS::Concrete)
            law = ConcreteLaw(std::min(FckMpa(m, units), kMaxFckMpa));
    }
    std::unique_ptr<ISectionBending> Bending(bool aboutY, bool positive) const
    {
        // A steel section is symmetric: (+) and (-) are the same.
        return material.type == MATL_CLASS::Steel
                   ? MakeSteelBending(section, material.Fy, aboutY)
                   : MakeConcreteBending(section, material, law, aboutY, positive);
    }
};

bool SolveAxis(const T_READY& ready, bool aboutY, T_YIELD_AXIS& axis)
{
    T_DIRECTION pos, neg;
    if (!Solve(*ready.Bending(aboutY, true), pos)) return false;
    if (!Solve(*ready.Bending(aboutY, false), neg)) return false;
    axis = {true, {pos.atZero, neg.atZero}, {pos.largest, neg.largest}, {pos.curve, neg.curve}};
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
    if (!Prepare(section, material, units, s, fault)) return 0;
    T_SECTION_STRENGTH r;
    const T_READY ready(s, material, units);
    const auto axial = ready.Bending(true, true);
    r.level.compression = axial->At(2.0).axial;
    r.level.tension = -axial->At(0.0).axial;
    if (!SolveAxis(ready, true, r.level.y) || !SolveAxis(ready, false, r.level.z)) {
        fault = SECT_FAULT::NotConverged;
        return 0;
    }
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
    if (!Prepare(section, material, units, s, fault)) return 0;
    const auto bending = T_READY(s, material, units).Bending(aboutY, positive);
    if (!(bending->At(0.0).axial <= axial && axial <= bending->At(2.0).axial)) {
        fault = SECT_FAULT::Values;
        return 0;
    }
    double u = 0.0;
    if (!FindAxial(*bending, axial, 0.0, 2.0, u)) {
        fault = SECT_FAULT::NotConverged;
        return 0;
    }
    moment = bending->At(u).moment;
    return 1;
}

int CSectionStrength::CalcCurve(const T_SECT_D& section, const T_MATL_D& material,
                                const T_UNITS& units, bool aboutY, bool positive,
                                std::vector<T_PM_POINT>& out, SECT_FAULT& fault)
{
    T_SECT_D s;
    if (!Prepare(section, material, units, s, fault)) return 0;
    const auto bending = T_READY(s, material, units).Bending(aboutY, positive);
    const double pure = bending->At(2.0).axial, peak = FindPeak(*bending);
    const double largest = bending->At(peak).moment;
    if (!Positive(pure) || !Positive(largest)) {
        fault = SECT_FAULT::NotConverged;
        return 0;
    }
    std::vector<double> places{peak};
    for (int i = 0; i <= kScan; ++i)
        places.push_back(2.0 * i / kScan);
    std::ranges::sort(places, std::greater());
    std::vector<T_PM_POINT> curve;
    for (const double u : places) {
        const T_AXIAL_MOMENT at = bending->At(u);
        curve.push_back({at.axial / pure, at.moment / largest});
    }
    out = std::move(curve);
    return 1;
}
