// What a page of a hinge type yields at: strengths, entered or calculated, and the deformation at
// first yield. Magnitudes, in one consistent unit system.
#pragma once

#include "qm_rps/hinge/hingefindings.h"
#include "qm_rps/hinge/hingelabels.h"
#include "qm_rps/hinge/hingetheta.h"

using T_SIDE_VALUES = T_SIDES<std::optional<double>>;

struct T_PAGE_STRENGTH {
    T_SIDE_VALUES yield;   // empty: automatic, and there is no method
    T_SIDES<double> crack; // entered P1 of a trilinear curve, else 0
};

/// Strengths of a component's curve. Of a curve by axial force the entered ones are those without
/// an axial force (SidesWithoutForce), as the calculated ones are.
T_PAGE_STRENGTH PageStrength(const T_SKEL_CURVE& curve, SKEL_TYPE type, HINGE_COMPONENT c,
                             const CHingeSources::T_RESULT& result);

/// The sides that count without an axial force. Of curves by axial force, yield strength and user
/// stiffness lie on the straight line between the two forces around 0; where all forces lie on one
/// side of 0, the nearest one's count.
T_SIDES<T_SKEL_SIDE> SidesWithoutForce(const T_SKEL_FEMA& curve);
/// The axial force nearest to 0, where a curve has a list of which all lie on one side of 0.
std::optional<double> ForceAwayFrom0(const T_SKEL_FEMA& curve);

/// The look-up for pages of a type on an element: the span that the type gives, else the member's
/// length; stiffness by length where the type is one of curvatures.
T_THETA_LOOKUP LookupOf(const T_PHGT_D& type, const T_SECT_D* section, const T_MATL_D* material,
                        double memberLength);

/// Rotation, curvature or displacement at first yield of each side at an end (IEnd or JEnd); empty
/// where there is no strength, no method, or data are missing. The user stiffness of the negative
/// side is its own where the curve has two (FEMA: asymmetric stiffness, others: asymmetric curve).
T_SIDE_VALUES PageDeform(const T_SKEL_CURVE& curve, HINGE_COMPONENT c, HINGE_LOCATION end,
                         const T_THETA_LOOKUP& lookup, const T_SIDE_VALUES& yield);
/// The negative side of a curve has a user stiffness of its own.
bool HasTwoStiffnesses(const T_SKEL_CURVE& curve);

/// Strengths and deformations that an automatic page of a type shows before any element has it:
/// those of the type's own section, material and span. Empty: they differ from element to element,
/// or from axial force to axial force, or are entered.
struct T_PAGE_VALUES {
    T_SIDE_VALUES yield, deform;
};
T_PAGE_VALUES CalculatedPage(const T_HINGE_OWNER& owner, HINGE_COMPONENT c, HINGE_END end,
                             const T_SKEL_CURVE& curve);
/// Writes what is known into the curve of a component of this type.
void PutCalculated(const T_PAGE_VALUES& values, SKEL_TYPE type, T_SKEL_CURVE& curve);
/// A page shows its yield strength: it is entered, or known.
bool IsYieldShown(const T_SKEL_CURVE& curve, const T_PAGE_VALUES& values);

/// Yield level of the type's own section and material; empty: they give none.
std::optional<T_YIELD_LEVEL> CalculatedLevel(const T_HINGE_OWNER& owner);
