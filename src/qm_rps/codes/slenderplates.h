// Plates of steel sections that buckle before they yield: EN 1993-1-5, AISC 360 E7.
#pragma once

#include "qm_rps/codes/steelinteraction.h"

/// EN 1993-1-5 4.4: the area that counts in uniform compression. Plates beyond class 3 of EN
/// 1993-1-1 Table 5.2 count with rho of their width; refuses circular tubes of class 4.
std::optional<double> EnCompressedArea(const T_STEEL_SHAPE& s, double fy, CCodeSheet& sheet);

/// EN 1993-1-1 6.2.6: Vpl; of webs beyond 72 eps no more than their strength in shear buckling by
/// EN 1993-1-5 5.2 and 5.3: the web alone, eta = 1, end posts that are not rigid, no stiffeners but
/// at the supports.
std::optional<double> EnShearStrength(const T_STEEL_SHAPE& s, bool alongDepth, double fy,
                                      CCodeSheet& sheet);

/// AISC 360 E7: the area that counts at the buckling stress Fcr, with the effective widths of
/// plates beyond Table B4.1a. Refuses circular tubes beyond 0.45 E/Fy.
std::optional<double> AiscCompressedArea(const T_STEEL_SHAPE& s, double Fcr, double Fy, double E,
                                         CCodeSheet& sheet);
