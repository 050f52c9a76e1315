// Compressed steel members: flexural buckling by EN 1993-1-1 6.3.1 and AISC 360 E3.
#pragma once

#include "qm_rps/codes/steelinteraction.h"

struct T_BUCKLING {
    double area = 0.0;
    double length = 0.0; // K L, m
    double radius = 0.0; // of gyration about the axis of buckling, m
    double fy = 0.0, E = 0.0;
    double counted = 0.0; // area that slender plates leave; 0: all
};

/// EN 1993-1-1 Table 6.2: imperfection factor for buckling about y (minor: false) or z. Tubes are
/// taken as cold formed (c; hot finished: a).
double EnImperfection(const T_STEEL_SHAPE& shape, bool minor, CCodeSheet& sheet);
struct T_EN_BUCKLED {
    double slenderness = 0.0, chi = 1.0;
    double strength = 0.0; // chi A fy, gamma_M1 = 1
};
/// 6.3.1.2.
std::optional<T_EN_BUCKLED> EnBuckled(const T_BUCKLING& b, double imperfection, CCodeSheet& sheet);
/// Its strength.
std::optional<double> EnBuckling(const T_BUCKLING& b, double imperfection, CCodeSheet& sheet);
/// AISC 360 E3, E7: Fcr Ae of a member of this shape.
std::optional<double> AiscBuckling(const T_BUCKLING& b, const T_STEEL_SHAPE& shape,
                                   CCodeSheet& sheet);

/// A compressed and bent member of class 1 to 3.
struct T_EN_BEAM_COLUMN {
    STEEL_SHAPE shape = STEEL_SHAPE::RolledI;
    bool plastic = true; // class 1, 2: My and Mz are plastic strengths; else elastic ones
    double My = 0.0, Mz = 0.0;
    T_EN_BUCKLED y, z;
};
/// EN 1993-1-1 6.3.3 with Annex B, Table B.1: the larger one of (6.61) and (6.62). chi_LT = 1; Cm =
/// 0.9, that of members which buckle sideways (Table B.3).
std::optional<double> EnBeamColumn(const T_EN_BEAM_COLUMN& c, const T_STEEL_FORCES& f,
                                   CCodeSheet& sheet);
