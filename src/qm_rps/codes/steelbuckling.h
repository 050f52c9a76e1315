// Compressed steel members: flexural buckling by EN 1993-1-1 6.3.1 and AISC 360 E3.
#pragma once

#include "qm_rps/codes/steelinteraction.h"

struct T_BUCKLING {
    double area = 0.0;
    double length = 0.0; // K L, m
    double radius = 0.0; // of gyration about the axis of buckling, m
    double fy = 0.0, E = 0.0;
};

/// EN 1993-1-1 Table 6.2: imperfection factor for buckling about y (minor: false) or z. Tubes are
/// taken as cold formed (c; hot finished: a).
double EnImperfection(const T_STEEL_SHAPE& shape, bool minor, CCodeSheet& sheet);
/// 6.3.1.2 with gamma_M1 = 1: chi A fy.
std::optional<double> EnBuckling(const T_BUCKLING& b, double imperfection, CCodeSheet& sheet);
/// AISC 360 E3: Fcr A, members without slender plates.
std::optional<double> AiscBuckling(const T_BUCKLING& b, CCodeSheet& sheet);
