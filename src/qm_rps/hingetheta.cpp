#include "qm_rps/hingetheta.h"

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

} // namespace

double CHingeTheta::CalcThetaMoment(const T_THETA_LOOKUP& lookup, HINGE_COMPONENT component,
                                    HINGE_LOCATION end, INIT_STIFFNESS option, double userStiffness,
                                    double yieldMoment)
{
    T_BASIS b;
    const bool aboutY = component == HINGE_COMPONENT::My;
    if (!aboutY && component != HINGE_COMPONENT::Mz) return 0.0;
    if (!ReadBasis(lookup, end, b)) return 0.0;
    if (option == INIT_STIFFNESS::User) return Deformation(yieldMoment, userStiffness);
    const double inertia = aboutY ? b.section.Iyy * b.factors->Iyy : b.section.Izz * b.factors->Izz;
    return Deformation(yieldMoment,
                       RotationFactor(option) * lookup.material->E * inertia / lookup.memberLength);
}

double CHingeTheta::CalcThetaShear(const T_THETA_LOOKUP& lookup, HINGE_COMPONENT component,
                                   HINGE_LOCATION end, INIT_STIFFNESS option, double userStiffness,
                                   double yieldForce)
{
    T_BASIS b;
    const bool alongY = component == HINGE_COMPONENT::Fy;
    if (!alongY && component != HINGE_COMPONENT::Fz) return 0.0;
    if (!ReadBasis(lookup, end, b)) return 0.0;
    if (option == INIT_STIFFNESS::User) return Deformation(yieldForce, userStiffness);
    if (option != INIT_STIFFNESS::Elastic) return 0.0;
    const double shearModulus = lookup.material->E / (2.0 * (1.0 + lookup.material->nu));
    const double area = alongY ? b.section.Asy * b.factors->Asy : b.section.Asz * b.factors->Asz;
    return Deformation(yieldForce, shearModulus * area);
}
