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
    bool ratios = true; // deformations are D/Dy, else plastic
    INIT_STIFFNESS initStiffness = INIT_STIFFNESS::EI6L;
    bool asymStiffness = false;
    const T_SKEL_FEMA* fema = nullptr; // options that the FEMA curve alone has
    bool criteria = true;              // the acceptance criteria are in use
};

using T_BACKBONE_RULES = std::span<const T_HINGE_RULE<T_BACKBONE>>;

/// In the order in which the curves check them.
T_BACKBONE_RULES PositiveSignRules();
T_BACKBONE_RULES NegativeSignRules();
T_BACKBONE_RULES FemaOrderRules();
T_BACKBONE_RULES Ec8OrderRules();
T_BACKBONE_RULES AcceptanceRules();
T_BACKBONE_RULES YieldStrengthRules();

/// Comparisons of entered values; false where one is not finite.
bool Below(double a, double b);
bool NotAbove(double a, double b);
/// Normalised strengths count as equal within 1e-9.
bool SameStrength(double a, double b);

/// The side that mirrors `pos`. Energy factors and user stiffness have entries of their own on
/// each side, so they stay as they are in `neg`.
void MirrorSide(const T_SKEL_SIDE& pos, T_SKEL_SIDE& neg);
