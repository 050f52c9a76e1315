#include "qm_rps/hinge/sectionbending.h"

#include "qm_rps/outline/sectionoutline.h"

#include <algorithm>
#include <cmath>
#include <numbers>

namespace {

using namespace solver;

T_SECTION_MODEL ConcreteModel(const T_SECT_D& section, const T_MATL_D& material,
                              const T_CONCRETE_LAW& law)
{
    T_STRESS_LAW concrete;
    concrete.strength = material.fck;
    concrete.peakStrain = law.peakStrain;
    concrete.limitStrain = law.crushStrain;
    concrete.exponent = law.n;
    T_SECTION_MODEL model;
    model.laws = {concrete, SteelLaw(material.fyk, material.Es)};
    model.regions = {{SectionRings(section), 0}};
    model.lumped = true;
    for (const T_REBAR& bar : section.bars)
        model.bars.push_back({bar.y, bar.z, bar.area, 1});
    return model;
}

T_SECTION_MODEL SteelModel(const T_SECT_D& section, double fy)
{
    T_SECTION_MODEL model;
    model.laws = {SteelLaw(fy, 0.0)};
    model.regions = {{SectionRings(section), 0}};
    model.plastic = true;
    return model;
}

} // namespace

std::optional<CSectionBending>
CSectionBending::Of(const T_SECT_D& section, const T_MATL_D& material, const T_CONCRETE_LAW& law)
{
    CSectionBending out;
    out.m_plastic = material.type == MATL_CLASS::Steel;
    out.m_straight = section.shape == SECT_SHAPE::Value;
    out.m_leans = out.m_plastic && section.shape == SECT_SHAPE::Channel;
    out.m_axial = section.area * material.Fy;
    out.m_moments = {section.Zy * material.Fy, section.Zz * material.Fy};
    out.Turn(true, true);
    T_SECTION_ERROR error;
    if (out.m_straight) return out;
    if (!out.m_solver.Prepare(out.m_plastic ? SteelModel(section, material.Fy)
                                            : ConcreteModel(section, material, law),
                              error))
        return std::nullopt;
    return out;
}

void CSectionBending::Turn(bool aboutY, bool positive)
{
    m_aboutY = aboutY;
    m_direction = (aboutY ? 0.0 : 0.5 * std::numbers::pi) + (positive ? 0.0 : std::numbers::pi);
    m_moment = m_moments[aboutY ? 0 : 1];
}

T_AXIAL_MOMENT CSectionBending::Along(const T_CAPACITY& c) const
{
    return {c.axial, c.My * std::cos(m_direction) + c.Mz * std::sin(m_direction)};
}

int CSectionBending::Leaning(double axial, T_AXIAL_MOMENT& out) const
{
    constexpr double kTip = 1.0 - 1e-9; // nothing is left for moments
    double moment = 0.0;
    const double share = std::fabs(axial) / m_axial;
    if (share < kTip && !Towards(m_direction, axial, moment)) return 0;
    out = {axial, moment};
    return 1;
}

int CSectionBending::At(double u, T_AXIAL_MOMENT& out) const
{
    if (m_leans && m_aboutY) return Leaning((u - 1.0) * m_axial, out);
    if (m_straight) {
        out = {(u - 1.0) * m_axial, (1.0 - std::fabs(u - 1.0)) * m_moment};
        return 1;
    }
    T_CAPACITY found;
    T_SECTION_ERROR error;
    // Places of a plastic section end where the neutral axis leaves it.
    if (!m_solver.Capacity(m_direction, m_plastic ? 0.5 * u : u, found, error)) return 0;
    out = Along(found);
    return 1;
}

int CSectionBending::AtAxial(double axial, T_AXIAL_MOMENT& out) const
{
    if (m_straight) return At(1.0 + axial / m_axial, out);
    if (m_leans && m_aboutY) return Leaning(axial, out);
    T_CAPACITY found;
    T_SECTION_ERROR error;
    if (!m_solver.AtAxial(m_direction, axial, found, error)) return 0;
    out = Along(found);
    return 1;
}

int CSectionBending::Largest(T_AXIAL_MOMENT& out, double& u) const
{
    if (m_straight || (m_leans && m_aboutY)) {
        u = 1.0;
        return At(u, out);
    }
    T_CAPACITY found;
    T_SECTION_ERROR error;
    double place = 0.0;
    if (!m_solver.Largest(m_direction, found, place, error)) return 0;
    out = Along(found);
    u = m_plastic ? 2.0 * place : place;
    return 1;
}

int CSectionBending::Towards(double direction, double axial, double& moment) const
{
    T_CAPACITY found;
    T_SECTION_ERROR error;
    if (m_straight || !m_solver.TowardsMoment(direction, axial, found, error)) return 0;
    moment = std::hypot(found.My, found.Mz);
    return 1;
}
