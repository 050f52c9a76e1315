// Columns of concrete under two moments, from the strengths of each axis.
#pragma once

#include "qm_rps/codes/codesheet.h"

/// Bresler's reciprocal: strength under both eccentricities from those under each alone.
std::optional<double> BreslerAxial(double Pnx, double Pny, double P0, CCodeSheet& sheet);

/// EN 1992-1-1 5.8.9(4): (MEdz/MRdz)^a + (MEdy/MRdy)^a; a by NEd/NRd, circles 2.
std::optional<double> EnBiaxialRatio(double axialRatio, double ratioY, double ratioZ, bool circle,
                                     CCodeSheet& sheet);
