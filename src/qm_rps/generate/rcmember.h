// A member end of reinforced concrete as the codes' formulas take it: geometry by the side that is
// compressed, strengths by code. Rectangles and circles with bars and detailing. SI.
#pragma once

#include "qm_rps/generate/codeside.h"

/// A section bent about y or z so that the side +z or +y (positive) is compressed, or the other.
struct T_RC_BENDING {
    bool round = false;
    double b = 0.0, h = 0.0; // across and along the shear force; a circle: diameter
    double area = 0.0;
    double d = 0.0, dPrime = 0.0; // from the compressed edge
    double As = 0.0, AsPrime = 0.0, AsWeb = 0.0;
    double barDiameter = 0.0;          // largest tension bar, from its area
    double coreB = 0.0, coreH = 0.0;   // between centre lines of the stirrup
    int legs = 0, across = 0;          // legs along the shear force and across it
    double legArea = 0.0, shear = 0.0; // of one leg; of all along the shear force
    double spacing = 0.0;

    double Bars() const { return As + AsPrime + AsWeb; }
};
/// The rows of tension and compression are the bars within a tenth of the depth from the outermost
/// ones; the rest is web. Of a circle they are the bars of either half, those on the axis half to
/// each, with d = 0.8 D (ACI 318 22.5.2.2), and a hoop has two legs. Refuses a side without bars.
std::optional<T_RC_BENDING> RcBending(const T_SECT_D& section, bool aboutY, bool positive,
                                      CCodeSheet& sheet);

/// EN 1992-1-1 9.6.1(1): an upright rectangle with one side more than four times the other.
bool IsWallSection(const T_SECT_D& section);

/// Strengths that an existing member is assessed with.
struct T_RC_MATERIAL {
    double fc = 0.0, fy = 0.0, fyw = 0.0, Es = 0.0;
    double Ec = 0.0; // chord codes: 22 (fcm / 10)^0.3 GPa of the mean strength
};
/// ASCE 41, FEMA 356: expected strengths, the material's means or the characteristic ones times the
/// factors of Table 10-1. EN 1998-3, Circolare: means over the confidence factor, which both must
/// be there.
std::optional<T_RC_MATERIAL> RcMaterial(const T_MATL_D& material, HINGE_CODE code,
                                        CCodeSheet& sheet);
/// The confidence factor of a material, or that of its knowledge level; refused where there is
/// none.
std::optional<double> ConfidenceOf(const T_MATL_D& material, CCodeSheet& sheet);
