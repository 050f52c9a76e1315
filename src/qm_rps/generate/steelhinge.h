// Hinges of steel members: bending of beams and columns, axial force of braces.
#pragma once

#include "qm_rps/generate/steelmember.h"

/// Both sides of bending. ASCE 41, FEMA 356: I-shapes (Table 9-6 and 9-7.1), strength rising by
/// 3 % of the elastic stiffness; EN 1998-3 Annex B and Circolare 2019: class 1 and 2, N up to 0.3
/// Npl. V = (M(+) + M(-)) / clear length. Force-controlled columns are refused.
/// 1 done; 0 with the reason in words, `out` unchanged.
[[nodiscard]] int SteelHinge(const T_MEMBER_END& end, T_SIDES<T_CODE_SIDE>& out,
                             std::string& reason);

/// A brace: (+) tension up to A fy, (-) compression up to buckling over its clear length (K = 1)
/// about the axis of the least radius; deformations are those of the whole length.
[[nodiscard]] int SteelBrace(const T_MEMBER_END& end, T_SIDES<T_CODE_SIDE>& out,
                             std::string& reason);

/// Axial force and moment of the ends (about y, z or both; one member) as the eleven points of a
/// hinge type, by the formulas of the code; the given forces (compression positive) are among them.
std::optional<T_PMM_TABLE> SteelAxialCurve(const std::vector<T_MEMBER_END>& ends,
                                           const T_ENDS<double>& forces);
