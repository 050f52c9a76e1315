// Yield rotation and yield deformation of a hinge component from section, material and length.
#pragma once

#include "qm_db/records.h"

#include <optional>

/// What the look-up of an element found. Not owned; a null pointer means that the section or the
/// material is missing.
struct T_THETA_LOOKUP {
    const T_SECT_D* section = nullptr;
    const T_MATL_D* material = nullptr;
    double memberLength = 0.0; // of the member that contains the element
    bool perLength = false;    // the hinge is one of curvatures and strains: EI, EA, GJ in place
                               // of n EI/L, EA/L, GJ/L
    bool needsSection = true;  // false for links and springs, which have a user stiffness alone
};

/// Rotation (or curvature) My / K and displacement Fy / K at first yield. Values in one consistent
/// unit system; the sign of the strength passes to the result. Shapes with dimensions are evaluated
/// from these (CSectionProperties), a section given by values with the values. Every case outside
/// the stated ones gives 0: a failed look-up, another component, end or option, a stiffness below
/// 1e-10 (or negative), anything that is not finite.
class CHingeTheta {
public:
    /// Initial stiffness at an end: the user stiffness; else EA/L of Fx and GJ/L of Mx (any other
    /// option), n EI/L of My and Mz, G times the shear area of Fy and Fz (Elastic). Each property
    /// times its factor of that end. Empty where data or a method is missing.
    static std::optional<double> CalcStiffness(const T_THETA_LOOKUP& lookup,
                                               HINGE_COMPONENT component, HINGE_LOCATION end,
                                               INIT_STIFFNESS option, double userStiffness);

    /// My or Mz. K = 6EI/L (double curvature), 3EI/L, 2EI/L or the user stiffness; I about the
    /// component's axis times the factor of that end. `end` is IEnd or JEnd.
    static double CalcThetaMoment(const T_THETA_LOOKUP& lookup, HINGE_COMPONENT component,
                                  HINGE_LOCATION end, INIT_STIFFNESS option, double userStiffness,
                                  double yieldMoment);

    /// Fy or Fz. K = the user stiffness, or (option Elastic) G times the shear area of that
    /// direction and its factor of that end, G as the material has it.
    static double CalcThetaShear(const T_THETA_LOOKUP& lookup, HINGE_COMPONENT component,
                                 HINGE_LOCATION end, INIT_STIFFNESS option, double userStiffness,
                                 double yieldForce);
};
