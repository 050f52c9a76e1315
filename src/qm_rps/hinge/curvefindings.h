// What the skeleton curve of one page of a component does not keep.
#pragma once

#include "qm_rps/hinge/hingefindings.h"

/// The rules of a curve in the order of its editor's check; of a FEMA curve with several axial
/// forces those of each. Appends.
void CurveFindings(const T_SKEL_MULTI& curve, SKEL_TYPE type, const T_HINGE_PLACE& place,
                   std::vector<T_FINDING>& out);
void CurveFindings(const T_SKEL_FEMA& curve, const T_HINGE_PLACE& place,
                   std::vector<T_FINDING>& out);
void CurveFindings(const T_SKEL_EC8& curve, const T_HINGE_PLACE& place,
                   std::vector<T_FINDING>& out);
void CurveFindings(const T_SKEL_CURVE& curve, SKEL_TYPE type, const T_HINGE_PLACE& place,
                   std::vector<T_FINDING>& out);
/// Those of each page of a component; none where it is not active.
std::vector<T_FINDING> ComponentFindings(HINGE_COMPONENT c, const T_HINGE_COMPONENT& component);

/// Those without which a push of the curve means nothing: signs of stiffness reduction ratios,
/// order of acceptance criteria. Appends.
void RatioFindings(const T_SKEL_MULTI& curve, SKEL_TYPE type, const T_HINGE_PLACE& place,
                   std::vector<T_FINDING>& out);
void PushFindings(const T_SKEL_CURVE& curve, SKEL_TYPE type, const T_HINGE_PLACE& place,
                  std::vector<T_FINDING>& out);

/// The older table of a FEMA curve's diagram (signs, deformations A <= B <= C <= D <= E,
/// strengths), then its acceptance criteria; one message key for each of the two tables.
std::vector<T_FINDING> DiagramFindings(const T_SKEL_FEMA& curve, HINGE_COMPONENT c);

/// Stiffness reduction ratios that do not suit: one above 1 (harder than the initial stiffness),
/// or alpha2 above alpha1. No refusal.
void RatioWarnings(const T_SKEL_MULTI& curve, SKEL_TYPE type, const T_HINGE_PLACE& place,
                   std::vector<T_FINDING>& out);

/// A yield deformation, or a first deformation D1, beside a user stiffness that gives another one
/// with the entered strength: the push takes the stiffness. No refusal.
void StiffnessWarnings(const T_SKEL_CURVE& curve, SKEL_TYPE type, const T_HINGE_PLACE& place,
                       std::vector<T_FINDING>& out);

/// Points of a FEMA or Eurocode curve that are not where its measure has them: B at the yield
/// point, CP not beyond E. No refusal. A panel strut in its general form has axes of its own.
void PointWarnings(const T_SKEL_CURVE& curve, const T_HINGE_PLACE& place,
                   std::vector<T_FINDING>& out);
