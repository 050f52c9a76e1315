// Curvatures of a round column: its core confined, its cover not.
#pragma once

#include "qm_rps/codes/confinement.h"

struct T_ROUND_COLUMN {
    const T_SECT_D& section;
    T_CONFINED core;
    double fc = 0.0, fy = 0.0, Es = 0.0; // cover; bars
    double axial = 0.0;                  // compression positive
    double coreDiameter = 0.0;           // between the centre lines of the hoop
};
struct T_ROUND_CURVATURES {
    double yield = 0.0;      // first bar at its yield strain or concrete at its peak strain
    double ultimate = 0.0;   // core or bars at their limit, or 80 % of the largest moment
    double compressed = 0.0; // depth of the compressed zone at yield, m
};
/// Moment-curvature with parabola-rectangles; the cover spalls at its limit. Bars are limited to a
/// strain of 0.04.
std::optional<T_ROUND_CURVATURES> RoundCurvatures(const T_ROUND_COLUMN& column, CCodeSheet& sheet);
