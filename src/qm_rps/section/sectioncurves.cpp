#include "qm_rps/section/sectioncurves.h"

#include "qm_base/say.h"
#include "qm_db/sectionproperties.h"
#include "qm_rps/outline/sectionoutline.h"
#include "qm_rps/section/sectiontexts.h"
#include "qm_solver/sectionsolver.h"

#include <algorithm>
#include <cmath>
#include <numbers>

namespace {

using namespace solver;

/// A section that the calculator holds, and what its results are measured by.
class CCalculation {
public:
    CCalculation(const T_SECTION_REQUEST& request, T_SECTION_ANSWER& out)
        : m_request(request), m_out(out)
    {
    }
    bool Prepare(const T_SECTION_MODEL& model);
    bool Run() { return Calc() && (Tidy(), true); }
    const T_SECTION_ERROR& Error() const { return m_error; }

private:
    bool Calc();
    void Tidy();
    bool Capacities();
    bool Curvatures();
    bool Interactions();
    bool Surface();
    bool LevelsOfSurface();
    bool StateOf(const T_CAPACITY& c, T_SECTION_STATE& out);
    void Edges(T_SECTION_STATE& state) const;

    const T_SECTION_REQUEST& m_request;
    T_SECTION_ANSWER& m_out;
    T_SECTION_MODEL m_model;
    CSectionSolver m_solver;
    T_SECTION_ERROR m_error;
    double m_force = 1.0, m_moment = 1.0; // scales of residuals
};

bool CCalculation::Prepare(const T_SECTION_MODEL& model)
{
    m_model = model;
    if (!m_solver.Prepare(model, m_error)) return false;
    T_CAPACITY pure, none, top;
    T_SECTION_ERROR noCapacity; // steel that hardens without end has a path all the same
    double place = 0.0;
    if (m_solver.Capacity(0.0, 2.0, pure, noCapacity) &&
        m_solver.Capacity(0.0, -2.0, none, noCapacity) &&
        m_solver.Largest(0.0, top, place, noCapacity)) {
        m_out.compression = pure.axial;
        m_out.tension = -none.axial;
        m_force = std::max(std::fabs(pure.axial), std::fabs(none.axial));
        m_moment = std::hypot(top.My, top.Mz);
    }
    return true;
}

bool CCalculation::Calc()
{
    switch (m_request.task) {
    case SECTION_TASK::Capacity:
        return Capacities();
    case SECTION_TASK::Curvature:
        return Curvatures();
    case SECTION_TASK::Interaction:
        return Interactions();
    case SECTION_TASK::Surface:
        return m_request.axial.empty() ? Surface() : LevelsOfSurface();
    }
    return false;
}

/// Rounding noise of forces that are 0 is 0.
void CCalculation::Tidy()
{
    constexpr double kNoise = 1e-11;
    const auto force = [&](double& n) { n = std::fabs(n) < kNoise * m_force ? 0.0 : n; };
    const auto moments = [&](auto& p) {
        for (double* m : {&p.My, &p.Mz})
            *m = std::fabs(*m) < kNoise * m_moment ? 0.0 : *m;
    };
    const auto both = [&](auto& p) {
        force(p.axial);
        moments(p);
    };
    for (T_SECTION_CAPACITY_AT& c : m_out.capacities)
        both(c.at);
    for (T_SECTION_CURVATURE& c : m_out.curvatures)
        std::ranges::for_each(c.curve.points, moments);
    for (T_SECTION_INTERACTION& c : m_out.interactions)
        std::ranges::for_each(c.curve.points, both);
    for (T_SECTION_CONTOUR& c : m_out.contours) {
        force(c.axial);
        std::ranges::for_each(c.points, both);
    }
}

// ---- states -------------------------------------------------------------------------------------

/// Strains of the edges along the curvature of the plane, and where between them there is none.
void CCalculation::Edges(T_SECTION_STATE& s) const
{
    const double kappa = std::hypot(s.plane.overZ, s.plane.overY);
    const double direction = std::atan2(s.plane.overY, s.plane.overZ);
    const double origin =
        m_model.momentZ * std::cos(direction) + m_model.momentY * std::sin(direction);
    const T_RING_EXTENT edge = ExtentAlong(m_model.regions.front().rings.front(), direction);
    s.top = s.plane.axial + kappa * (edge.high - origin);
    s.bottom = s.plane.axial + kappa * (edge.low - origin);
    if (s.top > 0.0 && s.bottom < 0.0) s.depth = s.top / kappa;
}

bool CCalculation::StateOf(const T_CAPACITY& c, T_SECTION_STATE& out)
{
    out.axial = c.axial, out.My = c.My, out.Mz = c.Mz;
    out.plane = c.plane, out.governs = c.governs;
    Edges(out);
    if (m_model.plastic) { // the plane has the neutral axis alone
        out.top = out.bottom = 0.0;
        return true;
    }
    T_SECTION_RESPONSE r;
    if (!m_solver.Respond(c.plane, r, m_error)) return false;
    out.residual = std::max(std::fabs(r.axial - c.axial) / m_force,
                            std::hypot(r.My - c.My, r.Mz - c.Mz) / m_moment);
    return true;
}

// ---- tasks --------------------------------------------------------------------------------------

std::vector<double> AxialOf(const T_SECTION_REQUEST& request)
{
    return request.axial.empty() ? std::vector<double>{0.0} : request.axial;
}

bool CCalculation::Capacities()
{
    for (const double axial : AxialOf(m_request))
        for (const double direction : m_request.directions) {
            T_CAPACITY found;
            if (!(m_request.ofMoment ? m_solver.TowardsMoment(direction, axial, found, m_error)
                                     : m_solver.AtAxial(direction, axial, found, m_error)))
                return false;
            T_SECTION_CAPACITY_AT& row = m_out.capacities.emplace_back();
            row.direction = direction;
            if (!StateOf(found, row.at)) return false;
        }
    return true;
}

bool CCalculation::Curvatures()
{
    for (const double axial : AxialOf(m_request))
        for (const double direction : m_request.directions) {
            T_SECTION_CURVATURE& row = m_out.curvatures.emplace_back();
            row.direction = direction, row.axial = axial;
            const T_CURVATURE_REQUEST asked{axial, direction, m_request.ofMoment, m_request.points,
                                            m_request.maxCurvature};
            T_MOMENT_CURVATURE& curve = row.curve;
            if (!m_solver.MomentCurvature(asked, curve, m_error)) return false;
            if (m_force == 1.0) m_force = std::max(1.0, std::fabs(axial));
            if (m_moment == 1.0)
                m_moment = std::ranges::max(curve.points, {}, &T_CURVATURE_POINT::moment).moment;
            const T_CURVATURE_POINT &yield = curve.points[curve.yield], &last = curve.points.back();
            if (!StateOf({axial, yield.My, yield.Mz, yield.plane, curve.yields}, row.yield) ||
                !StateOf({axial, last.My, last.Mz, last.plane, curve.governs}, row.ultimate))
                return false;
        }
    return true;
}

bool CCalculation::Interactions()
{
    for (const double direction : m_request.directions) {
        T_SECTION_INTERACTION& row = m_out.interactions.emplace_back();
        row.direction = direction;
        if (!m_solver.Curve(direction, m_request.points, row.curve, m_error)) return false;
    }
    return true;
}

/// Even axial forces from uniform compression to uniform tension.
bool CCalculation::Surface()
{
    std::vector<T_CAPACITY> all; // directions x levels
    if (!m_solver.Surface(m_request.points, kSurfaceLevels, all, m_error)) return false;
    for (std::size_t level = 0; level < kSurfaceLevels; ++level) {
        T_SECTION_CONTOUR& contour = m_out.contours.emplace_back();
        contour.axial = all[level].axial;
        for (std::size_t d = 0; d < m_request.points; ++d)
            contour.points.push_back(all[d * kSurfaceLevels + level]);
    }
    return true;
}

bool CCalculation::LevelsOfSurface()
{
    for (const double axial : m_request.axial) {
        T_SECTION_CONTOUR& contour = m_out.contours.emplace_back();
        contour.axial = axial;
        for (std::size_t d = 0; d < m_request.points; ++d) {
            const double direction = 2.0 * std::numbers::pi * double(d) / double(m_request.points);
            if (!m_solver.AtAxial(direction, axial, contour.points.emplace_back(), m_error))
                return false;
        }
    }
    return true;
}

std::string RequestFault(const T_SECTION_REQUEST& r, MATL_CLASS type)
{
    const std::string most = std::to_string(kMostSectionPoints);
    if (r.points < kFewestPoints || r.points > kMostSectionPoints)
        return Say("IDS_QM_SECC_POINTS", std::to_string(kFewestPoints), most);
    if (r.task == SECTION_TASK::Interaction && r.ofMoment)
        return Say("IDS_QM_SECC_MOMENT_INTERACTION");
    if (r.task == SECTION_TASK::Curvature && r.options.law == SECTION_LAW::Aci &&
        type == MATL_CLASS::Concrete)
        return Say("IDS_QM_SECC_BLOCK_CURVATURE");
    if (!(r.maxCurvature >= 0.0 && std::isfinite(r.maxCurvature)))
        return Say("IDS_QM_SECC_MAX_CURVATURE");
    return {};
}

} // namespace

int CalcSection(const T_SECT_D& section, const T_MATL_D& material, const T_SECTION_REQUEST& request,
                const T_UNITS& units, T_SECTION_ANSWER& out, std::string& reason)
{
    T_SECT_D s;
    SECT_FAULT fault = SECT_FAULT::None;
    reason = RequestFault(request, material.type);
    if (!reason.empty()) return 0;
    if (!CSectionProperties::Calc(section, s, fault)) {
        reason = Say(MessageKeyOf(fault));
        return 0;
    }
    CCodeSheet sheet;
    const bool strains = request.task == SECTION_TASK::Curvature;
    const auto model = SectionModelOf(s, material, request.options, strains, sheet);
    if (!model) {
        reason = FaultText(*sheet.Fault());
        return 0;
    }
    T_SECTION_ANSWER answer;
    answer.task = request.task;
    answer.section = section.name, answer.material = material.name;
    answer.options = request.options, answer.ofMoment = request.ofMoment;
    answer.ofConcrete = material.type == MATL_CLASS::Concrete;
    answer.trace = sheet.Trace(), answer.warnings = sheet.Warnings();
    CCalculation calculation(request, answer);
    if (!calculation.Prepare(*model) || !calculation.Run()) {
        reason = SectionErrorText(calculation.Error(), units);
        return 0;
    }
    out = std::move(answer);
    return 1;
}
