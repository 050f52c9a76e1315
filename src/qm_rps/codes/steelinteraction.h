// Shear and combined forces of steel sections: EN 1993-1-1 6.2 and AISC 360.
#pragma once

#include "qm_rps/codes/codesheet.h"

enum class STEEL_SHAPE { RolledI, WeldedI, RectangularTube, CircularTube, Channel };
struct T_STEEL_SHAPE {
    STEEL_SHAPE shape = STEEL_SHAPE::RolledI;
    double A = 0.0;            // m2
    double h = 0.0, b = 0.0;   // depth along the force that bends about y, width; m
    double tf = 0.0, tw = 0.0; // I-shapes; the wall of a tube in both
    double r = 0.0;            // fillet of a rolled shape, m; 0 of a channel: welded
};

/// EN 1993-1-1 6.2.6(3): shear area for a force along the depth (of an I: parallel to the web), or
/// across it; eta = 1.
std::optional<double> EnShearArea(const T_STEEL_SHAPE& s, bool alongDepth, CCodeSheet& sheet);
/// 6.2.6(2): Av fy / sqrt 3.
std::optional<double> EnPlasticShear(double area, double fy, CCodeSheet& sheet);
/// 6.2.8(3): share of fy that the shear area loses; 0 up to half of Vpl.
std::optional<double> EnShearReduction(double shear, double plasticShear, CCodeSheet& sheet);

struct T_STEEL_FORCES {
    double N = 0.0, My = 0.0, Mz = 0.0; // signs do not matter
};
/// Plastic resistances without other forces.
struct T_STEEL_PLASTIC_STRENGTH {
    double Npl = 0.0, Mply = 0.0, Mplz = 0.0;
};
struct T_EN_INTERACTION {
    double MNy = 0.0, MNz = 0.0; // reduced by the axial force
    double alpha = 1.0, beta = 1.0;
    double ratio = 0.0; // M/MN about one axis; (My/MNy)^alpha + (Mz/MNz)^beta about both
};
/// EN 1993-1-1 6.2.9.1, sections of class 1 and 2. A channel, of which it says nothing: (6.2), the
/// sum of the ratios, which the convex surface of full plasticity contains.
std::optional<T_EN_INTERACTION> EnAxialBending(const T_STEEL_SHAPE& s,
                                               const T_STEEL_PLASTIC_STRENGTH& r,
                                               const T_STEEL_FORCES& f, CCodeSheet& sheet);

/// 6.2.9.2, sections of class 3, with A fy and the elastic moments: the ratio.
std::optional<double> EnElasticBending(const T_STEEL_PLASTIC_STRENGTH& elastic,
                                       const T_STEEL_FORCES& f, CCodeSheet& sheet);

/// AISC 360 H1-1 with the available strengths: the ratio.
std::optional<double> AiscInteraction(const T_STEEL_PLASTIC_STRENGTH& available,
                                      const T_STEEL_FORCES& f, CCodeSheet& sheet);

/// AISC 360 G2.1, webs of I-shapes and channels without stiffeners: Vn = 0.6 Fy Aw Cv1. d: whole
/// depth, h: clear web depth.
std::optional<double> AiscShear(double d, double h, double tw, double Fy, double E,
                                CCodeSheet& sheet);
/// Of an I or a channel along its web (G2.1), or of its flanges across it (G6). Refuses other
/// shapes.
std::optional<double> AiscShapeShear(const T_STEEL_SHAPE& s, bool alongDepth, double Fy, double E,
                                     CCodeSheet& sheet);

/// AISC 360 Table B4.1: limits of plates in uniform compression, over sqrt(E/Fy); of circular tubes
/// over E/Fy.
struct T_AISC_SLENDER {
    double flange = 0.0, web = 0.0;
};
T_AISC_SLENDER AiscSlender(STEEL_SHAPE shape);
/// AISC 360 Table B4.1: the section reaches A Fy (`compressed`: no slender plate) and Z Fy (`bent`:
/// all are compact). False: the sheet says which plate is too slender.
bool AiscPlastic(const T_STEEL_SHAPE& s, double Fy, double E, bool compressed, bool bent,
                 CCodeSheet& sheet);

/// Plastic strength of W-shapes (McGuire, Gallagher, Ziemian): p, my (major), mz (minor) over the
/// plastic values; 1 on the surface.
std::optional<double> WideFlangeSurface(double p, double my, double mz, CCodeSheet& sheet);
