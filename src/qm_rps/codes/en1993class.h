// Cross-section classes of steel by EN 1993-1-1 Table 5.2.
#pragma once

#include "qm_rps/codes/steelinteraction.h"

/// 1 to 4 of the worst part, in plastic bending about y or z with an axial force (compression
/// positive): the first class whose limit every part holds. Flanges of an I or channel and all
/// parts across the axis of bending count as compressed throughout; clear widths between the
/// plates, less a fillet on either side. Class 3 of a web by the elastic stresses under N, psi = 2
/// N/(A fy) - 1.
std::optional<int> En1993Class(const T_STEEL_SHAPE& shape, bool aboutY, double axial, double fy,
                               CCodeSheet& sheet);
/// The same in compression alone.
std::optional<int> En1993ClassCompressed(const T_STEEL_SHAPE& shape, double fy, CCodeSheet& sheet);
