#include "qm_rps/hinge/hingetheta.h"

#include "qm_db/sectionproperties.h"

#include <cmath>

namespace {

constexpr double kZeroStiffness = 1e-10; // in the units of the stiffness

struct T_BASIS {
    T_SECT_D section; // with computed properties
    const T_SECT_FACTORS* factors = nullptr;
};

/// The section with its properties and the factors of the end; false where one is missing.
bool ReadBasis(const T_THETA_LOOKUP& lookup, HINGE_LOCATION end, T_BASIS& out)
{
    if (!lookup.section || !lookup.material) return false;
    if (end != HINGE_LOCATION::IEnd && end != HINGE_LOCATION::JEnd) return false;
    SECT_FAULT fault;
    if (!CSectionProperties::Calc(*lookup.section, out.section, fault)) return false;
    out.factors = end == HINGE_LOCATION::IEnd ? &out.section.factorsI : &out.section.factorsJ;
    return true;
}

/// A calculated stiffness; none where its data are missing.
std::optional<double> Positive(double v)
{
    return std::isfinite(v) && v > 0.0 ? std::optional(v) : std::nullopt;
}

double Deformation(double strength, double stiffness)
{
    if (!(stiffness >= kZeroStiffness) || !std::isfinite(stiffness)) return 0.0;
    const double theta = strength / stiffness;
    return std::isfinite(theta) ? theta : 0.0;
}

/// n of n EI/L; 0 for another option.
double RotationFactor(INIT_STIFFNESS option)
{
    switch (option) {
    case INIT_STIFFNESS::EI6L:
        return 6.0;
    case INIT_STIFFNESS::EI3L:
        return 3.0;
    case INIT_STIFFNESS::EI2L:
        return 2.0;
    default:
        return 0.0;
    }
}

/// Strength over stiffness; the look-up must succeed even where the user gives the stiffness.
double Theta(const T_THETA_LOOKUP& lookup, HINGE_COMPONENT component, HINGE_LOCATION end,
             INIT_STIFFNESS option, double userStiffness, double strength)
{
    T_BASIS b;
    if (lookup.needsSection && !ReadBasis(lookup, end, b)) return 0.0;
    const auto k = CHingeTheta::CalcStiffness(lookup, component, end, option, userStiffness);
    return k ? Deformation(strength, *k) : 0.0;
}

} // namespace

std::optional<double> CHingeTheta::CalcStiffness(const T_THETA_LOOKUP& lookup,
                                                 HINGE_COMPONENT component, HINGE_LOCATION end,
                                                 INIT_STIFFNESS option, double userStiffness)
{
    if (option == INIT_STIFFNESS::User)
        return std::isfinite(userStiffness) ? std::optional(userStiffness) : std::nullopt;
    T_BASIS b;
    if (!ReadBasis(lookup, end, b)) return std::nullopt;
    const double E = lookup.material->E, L = lookup.perLength ? 1.0 : lookup.memberLength;
    const double G = ShearModulus(*lookup.material);
    const bool shear = option == INIT_STIFFNESS::Elastic, elastic = shear && !lookup.perLength;
    const double n = lookup.perLength ? 1.0 : RotationFactor(option);
    switch (component) {
    case HINGE_COMPONENT::Fx:
        return Positive(E * b.section.area * b.factors->area / L);
    case HINGE_COMPONENT::Mx:
        return Positive(G * b.section.J * b.factors->J / L);
    case HINGE_COMPONENT::Fy:
        return shear ? Positive(G * b.section.Asy * b.factors->Asy) : std::nullopt;
    case HINGE_COMPONENT::Fz:
        return shear ? Positive(G * b.section.Asz * b.factors->Asz) : std::nullopt;
    case HINGE_COMPONENT::My:
        if (elastic) return std::nullopt;
        return Positive(n * E * b.section.Iyy * b.factors->Iyy / L);
    case HINGE_COMPONENT::Mz:
        if (elastic) return std::nullopt;
        return Positive(n * E * b.section.Izz * b.factors->Izz / L);
    }
    return std::nullopt;
}

double CHingeTheta::CalcThetaMoment(const T_THETA_LOOKUP& lookup, HINGE_COMPONENT component,
                                    HINGE_LOCATION end, INIT_STIFFNESS option, double userStiffness,
                                    double yieldMoment)
{
    if (component != HINGE_COMPONENT::My && component != HINGE_COMPONENT::Mz) return 0.0;
    return Theta(lookup, component, end, option, userStiffness, yieldMoment);
}

double CHingeTheta::CalcThetaShear(const T_THETA_LOOKUP& lookup, HINGE_COMPONENT component,
                                   HINGE_LOCATION end, INIT_STIFFNESS option, double userStiffness,
                                   double yieldForce)
{
    if (component != HINGE_COMPONENT::Fy && component != HINGE_COMPONENT::Fz) return 0.0;
    return Theta(lookup, component, end, option, userStiffness, yieldForce);
}
