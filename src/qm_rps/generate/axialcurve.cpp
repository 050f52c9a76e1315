#include "qm_rps/generate/axialcurve.h"

#include "qm_rps/codes/concretelaw.h"
#include "qm_rps/hinge/sectionbending.h"
#include "qm_rps/push/law/lawaxial.h"

#include <algorithm>
#include <cmath>
#include <functional>

namespace {

constexpr double kWider = 1.0 + 1e-6; // rounding of a force must not choose among equal gaps
constexpr double kRounding = 1e-9;    // of the largest moment: at its tips the curve has none

std::optional<CSectionBending> BendingOf(const T_MEMBER_END& end)
{
    CCodeSheet sheet;
    const std::optional<T_RC_MATERIAL> strengths = RcMaterial(end.material, end.code, sheet);
    if (!strengths) return {};
    const double fc = std::min(strengths->fc / kPascalsPerMpa, kMaxFckMpa);
    return CSectionBending::Of(end.section, AssessedMaterial(end.material, *strengths),
                               ConcreteLaw(fc));
}

/// Moments over their largest; false: one is below 0 or was not found.
template <class CURVE>
bool Fill(const CSectionBending& bending, const std::vector<double>& forces, CURVE& curve)
{
    double largest = 0.0;
    for (std::size_t i = 0; i < curve.size(); ++i) {
        T_AXIAL_MOMENT found;
        const bool tip = i == 0 || i + 1 == curve.size();
        if (!(tip ? bending.At(i == 0 ? 2.0 : 0.0, found) : bending.AtAxial(forces[i], found)))
            return false;
        curve[i] = {forces[i] / forces.front(), found.moment};
        largest = std::max(largest, found.moment);
    }
    for (T_PM_POINT& p : curve) {
        p.m /= largest;
        if (p.m < -kRounding || !std::isfinite(p.m)) return false;
        p.m = std::fabs(p.m) <= kRounding ? 0.0 : p.m;
    }
    return true;
}

} // namespace

std::vector<double> AxialForces(double compression, double tension,
                                std::initializer_list<double> fixed, std::size_t count)
{
    const double same = 1e-6 * (compression - tension);
    std::vector<double> forces{compression, tension};
    for (const double force : fixed)
        if (std::ranges::all_of(forces, [&](double f) { return std::fabs(f - force) > same; }) &&
            tension < force && force < compression)
            forces.push_back(force);
    std::ranges::sort(forces, std::greater());
    while (forces.size() < count) {
        std::size_t widest = 1;
        for (std::size_t i = 2; i < forces.size(); ++i)
            if (forces[i - 1] - forces[i] > kWider * (forces[widest - 1] - forces[widest]))
                widest = i;
        const double middle = 0.5 * (forces[widest - 1] + forces[widest]);
        forces.insert(forces.begin() + static_cast<std::ptrdiff_t>(widest), middle);
    }
    return forces;
}

void UseForBoth(T_PMM_TABLE& table, bool aboutY)
{
    const std::size_t used = aboutY ? 0 : 1;
    table.curves[1 - used] = table.curves[used];
    (*table.negative)[1 - used] = (*table.negative)[used];
}

std::optional<T_PMM_TABLE> AxialCurve(const std::vector<T_MEMBER_END>& ends,
                                      const T_ENDS<double>& given)
{
    T_PMM_TABLE table;
    table.negative.emplace();
    table.balanced = true;
    std::optional<CSectionBending> bending = BendingOf(ends.front());
    T_AXIAL_MOMENT compression, balanced, tension;
    double place = 0.0;
    if (!bending) return {};
    bending->Turn(ends.front().aboutY, true);
    if (!bending->At(2.0, compression) || !bending->At(0.0, tension) ||
        !bending->Largest(balanced, place) || !(tension.axial < 0.0))
        return {};
    const std::vector<double> forces =
        AxialForces(compression.axial, tension.axial, {0.0, balanced.axial, given.I, given.J},
                    table.curves.front().size());
    table.Pmax = compression.axial;
    for (const T_MEMBER_END& end : ends)
        for (const bool positive : {true, false}) {
            const auto component = end.aboutY ? HINGE_COMPONENT::My : HINGE_COMPONENT::Mz;
            T_PMM_CURVES& curves = positive ? table.curves : *table.negative;
            bending->Turn(end.aboutY, positive != IsSectionSignOpposite(component));
            if (!Fill(*bending, forces, curves[end.aboutY ? 0 : 1])) return {};
        }
    if (ends.size() == 1) UseForBoth(table, ends.front().aboutY);
    return table;
}
