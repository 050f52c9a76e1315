// Both sides of the plastic hinge of a concrete member end: strength, shear and backbone by a code.
#pragma once

#include "qm_rps/generate/rcend.h"

/// (+) compresses the side +z (about y) or +y, (-) the other. The strength is the bending capacity
/// with the parabola-rectangle of EN 1992-1-1 for the strengths of RcMaterial; V = (M(+) + M(-)) /
/// clear length, its strength ASCE 41 Eq. (10-3) of columns, ACI 318 of beams and walls, EN 1998-3
/// (A.12). Strength does not rise beyond yield. Where V of a beam or wall of ASCE 41 is above its
/// strength, the sides have a backbone of shear too.
/// 1 done; 0 with the reason in words, `out` unchanged.
[[nodiscard]] int RcHinge(const T_MEMBER_END& end, T_SIDES<T_CODE_SIDE>& out, std::string& reason);

/// The section's material with the assessed strengths in place of the characteristic ones, as the
/// section calculator takes it.
T_MATL_D AssessedMaterial(const T_MATL_D& material, const T_RC_MATERIAL& strengths);

// ---- for the files of concrete alone ------------------------------------------------------------

/// Tables of ASCE 41 and FEMA 356; fills shear strength and backbone of shear.
std::optional<T_CODE_BACKBONE> AsceBackbone(const T_RC_BASIS& in, T_CODE_SIDE& side,
                                            CCodeSheet& sheet);
/// EN 1998-3 Annex A and the Circolare 2019; fills shear strength and hinge length. Circles: (A.4)
/// with the curvatures of the section, whose core is confined by (A.9).
std::optional<T_CODE_BACKBONE> EnBackbone(const T_RC_BASIS& in, T_CODE_SIDE& side,
                                          CCodeSheet& sheet);
