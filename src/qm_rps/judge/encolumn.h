// Steel columns under more axial force than EN 1998-3 Annex B counts on rotations with. SI.
#pragma once

#include "qm_rps/codes/steelbuckling.h"
#include "qm_rps/generate/steelmember.h"

struct T_EN_COLUMN_CHECK {
    double ratio = 0.0;
    const char* clause = ""; // of the check that governs
};

/// Flexural buckling of a column over its clear length (K = 1) about one axis, with what slender
/// plates leave of its area.
std::optional<T_EN_BUCKLED> EnColumnBuckled(const T_STEEL_BASIS& in, bool aboutY,
                                            CCodeSheet& sheet);

/// EN 1993-1-1 6.2.9 by the class of the section under these forces and, in compression, 6.3.3. No
/// answer for sections of class 4. onSurface: a hinge flows under them, so that 6.2.9.1 gives 1 but
/// for rounding.
std::optional<T_EN_COLUMN_CHECK> EnColumn(const T_STEEL_BASIS& in, const T_STEEL_FORCES& f,
                                          bool onSurface, CCodeSheet& sheet);
