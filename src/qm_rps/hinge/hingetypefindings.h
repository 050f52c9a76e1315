// Everything that a hinge type does not keep, and what is worth a warning.
#pragma once

#include "qm_rps/hinge/hingecontext.h"
#include "qm_rps/hinge/hingefindings.h"

/// Name, references, curve types that are not offered, rules of the curves of all active components
/// and ends, symmetric curves whose stored negative side is another one, automatic strengths of the
/// type's own section, masonry, yield surface, user interaction curves.
std::vector<T_FINDING> HingeTypeFindings(const T_PHGT_D& type, const T_HINGE_CONTEXT& context);

/// Of several multilinear curves with stiffness reduction ratios, those that the ratios do not
/// suit: a ratio above 1 (harder than the initial stiffness), or alpha2 above alpha1. Then, page by
/// page, points that are not where the curve's measure has them (PointWarnings), entered curves by
/// axial force that do not reach a force of 0, and VoidInputWarnings. No refusal.
std::vector<T_FINDING> HingeTypeWarnings(const T_PHGT_D& type);
/// Values of the active components that another entered value makes void (StiffnessWarnings).
std::vector<T_FINDING> VoidInputWarnings(const T_PHGT_D& type);

/// Automatic strengths of active components that can't be calculated from this section and
/// material: a fault of the section, or no method for the component; and crack strengths above the
/// calculated yield strength.
void AutoStrengthFindings(const T_PHGT_D& type, const CHingeSources::T_RESULT& result,
                          std::vector<T_FINDING>& out);

/// The strengths of the curve come from section and material.
bool IsAutoYield(const T_SKEL_CURVE& curve);
/// An active component of the type has such a curve in use.
bool AnyAutoYield(const T_PHGT_D& type);
