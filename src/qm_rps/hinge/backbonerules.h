// Rules that the FEMA and the Eurocode 8 skeleton curve check on the two sides of a backbone
// (points B to E, acceptance criteria, yield strengths; ASCE 41 7.5.1 and EN 1998-3 2.1).
#pragma once

#include "qm_rps/hinge/hingefindings.h"

/// One backbone with the options that its rules ask for. Holds references: use it at once.
struct T_BACKBONE {
    const T_SKEL_SIDE& pos;
    const T_SKEL_SIDE& neg; // negative numbers; not looked at where symmetric
    bool symmetric = true;
    bool strengthLoss = true;
    bool autoYield = true;
    bool ratios = true;   // deformations are D/Dy, else plastic
    bool criteria = true; // the acceptance criteria are in use
};

/// The sides of a FEMA or Eurocode curve with the curve's options.
template <class CURVE>
T_BACKBONE CheckedSides(const CURVE& curve, const T_SIDES<T_SKEL_SIDE>& sides)
{
    T_BACKBONE b{sides.pos, sides.neg};
    b.symmetric = curve.symmetric;
    b.strengthLoss = curve.strengthLoss;
    b.autoYield = curve.autoYield;
    b.ratios = curve.measure == SKEL_MEASURE::DDy;
    if constexpr (requires { curve.compliance; }) b.criteria = curve.compliance;
    return b;
}

/// A group of rules: appends what is not kept, in the order of the curves' check.
using BACKBONE_CHECK = void(const T_BACKBONE&, const T_HINGE_PLACE&, std::vector<T_FINDING>&);
BACKBONE_CHECK CheckPositiveSigns;
BACKBONE_CHECK CheckNegativeSigns;
BACKBONE_CHECK CheckFemaOrder;
BACKBONE_CHECK CheckEc8Order;
BACKBONE_CHECK CheckFromOrigin; // of the diagram that shows A
BACKBONE_CHECK CheckAcceptance;
BACKBONE_CHECK CheckYieldStrengths;
BACKBONE_CHECK CheckEnergyFactors;
BACKBONE_CHECK CheckUsualPoints; // no refusal: B at the yield point, CP not beyond E

/// The side that mirrors `pos`. Energy factors and user stiffness have entries of their own on
/// each side, so they stay as they are in `neg`.
void MirrorSide(const T_SKEL_SIDE& pos, T_SKEL_SIDE& neg);
