// Plates of steel sections that buckle before they yield: EN 1993-1-5.
#pragma once

#include "qm_rps/codes/steelinteraction.h"

/// EN 1993-1-5 4.4: the area that counts in uniform compression. Plates beyond class 3 of EN
/// 1993-1-1 Table 5.2 count with rho of their width; refuses circular tubes of class 4.
std::optional<double> EnCompressedArea(const T_STEEL_SHAPE& s, double fy, CCodeSheet& sheet);
