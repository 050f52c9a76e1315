#include "qm_rps/generate/roundcurvature.h"

#include "qm_rps/codes/concretelaw.h"
#include "qm_solver/sectionsolver.h"

#include <algorithm>

namespace {

using namespace solver;

constexpr double kBarStrain = 0.04; // Circolare 2019, bridges

T_RING Circle(double diameter)
{
    return {{diameter / 2.0, 0.0, 1.0}, {-diameter / 2.0, 0.0, 1.0}};
}

T_SECTION_MODEL ModelOf(const T_ROUND_COLUMN& c)
{
    const T_CONCRETE_LAW plain = ConcreteLaw(std::min(c.fc / kPascalsPerMpa, kMaxFckMpa));
    T_STRESS_LAW cover, core, steel;
    cover.strength = c.fc;
    cover.peakStrain = plain.peakStrain;
    cover.limitStrain = plain.crushStrain;
    cover.exponent = plain.n;
    cover.spalls = true;
    core = cover;
    core.strength = c.core.strength;
    core.peakStrain = c.core.peakStrain;
    core.limitStrain = std::max(c.core.ultimateStrain, c.core.peakStrain);
    core.spalls = false;
    steel.kind = STRESS_LAW::Steel;
    steel.strength = c.fy;
    steel.modulus = c.Es;
    steel.limitStrain = kBarStrain;
    T_SECTION_MODEL model;
    model.laws = {cover, core, steel};
    model.regions = {{{Circle(c.section.size[0]), Circle(c.coreDiameter)}, 0},
                     {{Circle(c.coreDiameter)}, 1}};
    for (const T_REBAR& bar : c.section.bars)
        model.bars.push_back({bar.y, bar.z, bar.area, 2});
    model.lumped = true;
    return model;
}

} // namespace

std::optional<T_ROUND_CURVATURES> RoundCurvatures(const T_ROUND_COLUMN& c, CCodeSheet& sheet)
{
    CSectionSolver solver;
    T_SECTION_ERROR error;
    T_CURVATURE_REQUEST request;
    request.axial = c.axial;
    T_MOMENT_CURVATURE path;
    if (!solver.Prepare(ModelOf(c), error) || !solver.MomentCurvature(request, path, error) ||
        path.points.size() < 2) {
        sheet.Refuse(CODE_REASON::Missing, "phi_y, phi_u", "moment-curvature");
        return {};
    }
    const T_CURVATURE_POINT& yield = path.points[path.yield];
    constexpr T_DIM kPerLength{0, -1};
    constexpr auto K = CODE_MARK::Computed;
    T_ROUND_CURVATURES r;
    sheet.Put("eps_su", kBarStrain, "Circolare 2019", "0.04", CODE_MARK::SightedOnce);
    r.yield =
        sheet.Put("phi_y", yield.curvature, kPerLength, "", "plane sections, confined core", K);
    r.ultimate = sheet.Put("phi_u", path.points.back().curvature, kPerLength, "",
                           "plane sections: core at eps_cu, bars at eps_su or 80 % of Mmax", K);
    if (!sheet.Positive({{"phi_y", r.yield}})) return {};
    const double edge = yield.plane.axial + yield.curvature * c.section.size[0] / 2.0;
    r.compressed = sheet.Put("x", std::clamp(edge / yield.curvature, 0.0, c.section.size[0]),
                             kDimLength, "", "compressed depth at yield", K);
    return r;
}
