// One side of a concrete member end on the sheet of a code: geometry, strengths and shear strengths
// at its axial force and shear span. SI.
#pragma once

#include "qm_rps/codes/asce41strength.h"
#include "qm_rps/codes/concreteshear.h"
#include "qm_rps/codes/en1998rotation.h"
#include "qm_rps/generate/rcmember.h"

/// One side with what all formulas share.
struct T_RC_BASIS {
    const T_MEMBER_END& end;
    T_RC_BENDING section;
    T_RC_MATERIAL material;
    double axial = 0.0; // that counts
};
/// (+) compresses the side +z (about y) or +y. Empty: the fault of the sheet says why.
std::optional<T_RC_BASIS> RcBasis(const T_MEMBER_END& end, bool positive, CCodeSheet& sheet);

/// "spacing: must be above 0", or that the code gives no answer.
std::string ReasonOf(const CCodeSheet& sheet);

/// EN 1998-3, Circolare: the member as their formulas take it.
std::optional<T_EN_MEMBER> EnMember(const T_RC_BASIS& in, CCodeSheet& sheet);
/// The side as the rules of shear take it; of a circle bw d is its area.
T_SHEAR_SECTION ShearSectionOf(const T_RC_BENDING& section, double fc, double fyw, double axial);
/// EN 1992-1-1 6.2 with the strengths of `material`, 45 degrees.
std::optional<T_EN_SHEAR> EnMonotonicShear(const T_RC_BASIS& in, const T_RC_MATERIAL& material,
                                           CCodeSheet& sheet);

/// ASCE 41, FEMA 356, with the strengths of `material`: beams by ACI 318 with the share of ties
/// of ASCE 41-17 10.3.4, columns by Eq. (10-3) at a displacement ductility.
std::optional<T_ACI_SHEAR> AsceBeamShear(const T_RC_BASIS& in, const T_RC_MATERIAL& material,
                                         CCodeSheet& sheet);
std::optional<T_ASCE_COLUMN_STRENGTH> AsceColumnShearOf(const T_RC_BASIS& in,
                                                        const T_RC_MATERIAL& material,
                                                        double ductility, CCodeSheet& sheet);
