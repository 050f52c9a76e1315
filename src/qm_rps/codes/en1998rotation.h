// Chord rotations of concrete members by EN 1998-3 Annex A, and where the Circolare 2019 differs.
// Strengths are means over the confidence factor, in Pa; the formulas are printed in MPa.
#pragma once

#include "qm_rps/codes/codebackbone.h"

enum class EN_BASIS { En1998, Circolare2019 };
/// Confidence factor by knowledge level 1 to 3 (KL, LC): 1.35, 1.20, 1.00.
std::optional<double> ConfidenceFactor(int knowledgeLevel, CCodeSheet& sheet);

/// A member end; the side that the moment compresses is the one of AsPrime.
struct T_EN_MEMBER {
    double b = 0.0, h = 0.0;      // width (of the web), depth, m
    double d = 0.0, dPrime = 0.0; // effective depth, depth of the compression bars, m
    double fc = 0.0, fy = 0.0, fyw = 0.0, Es = 200e9, Ec = 0.0;
    double As = 0.0, AsPrime = 0.0, AsWeb = 0.0; // tension, compression, between them, m2
    double barDiameter = 0.0;                    // dbL of the tension bars, m
    double axial = 0.0;                          // N, compression positive
    double shearSpan = 0.0;                      // LV = M / V, m
    double alpha = 0.0;                          // confinement effectiveness (A.2)
    double hoopRatio = 0.0;                      // rho_sx = Asx / (bw sh)
    double diagonalRatio = 0.0;                  // rho_d
    bool wall = false;
    bool secondary = false;     // gamma_el = 1
    bool seismicDetails = true; // else the factor for old detailing
    double lapRatio = 0.0;      // lo / dbL of bars lapped at the end; 0: none
    bool smoothBars = false;    // Circolare alone
    EN_BASIS basis = EN_BASIS::En1998;
};

/// Yield by Panagiotakos and Fardis 2001 (EN 1998-3 A.3.2.4): the first of steel and concrete.
struct T_EN_YIELD {
    double xi = 0.0;        // neutral axis depth over d
    double curvature = 0.0; // phi_y, 1/m
    double moment = 0.0;    // My
    bool steelFirst = true;
};
std::optional<T_EN_YIELD> EnYield(const T_EN_MEMBER& m, CCodeSheet& sheet);

/// Forms of theta_y.
enum class THETA_Y {
    A10b,          // phi_y (LV + aV z)/3 + 0.0014 (1 + 1.5 h/LV) + phi_y dbL fy/(8 sqrt fc)
    A10bFirst,     // first printing: 0.0013 and 0.13 phi_y dbL fy/sqrt fc
    A10a,          // last term eps_y/(d - d') dbL fy/(6 sqrt fc)
    CircolareBeam, // [C8.7.2.7a]
    CircolareWall  // [C8.7.2.7b]
};
/// `cracked`: shear cracks before bending yields (VRd,c < My / LV): aV = 1.
std::optional<double> EnThetaY(const T_EN_MEMBER& m, THETA_Y form, double curvature, bool cracked,
                               CCodeSheet& sheet);

/// (A.1) theta_um.
std::optional<double> EnThetaUm(const T_EN_MEMBER& m, CCodeSheet& sheet);
/// (A.3) plastic part of theta_um.
std::optional<double> EnThetaPlastic(const T_EN_MEMBER& m, CCodeSheet& sheet);

/// Length of the plastic hinge for (A.4): with the confinement of EN 1992-1-1, or (A.9) with the
/// confinement of A.3.2.2(8).
enum class LPL_FORM { WithEn1992Confinement, A9 };
std::optional<double> EnHingeLength(const T_EN_MEMBER& m, LPL_FORM form, CCodeSheet& sheet);
/// (A.4) theta_um from yield and ultimate curvature.
std::optional<double> EnThetaFromCurvature(const T_EN_MEMBER& m, LPL_FORM form, double thetaY,
                                           double yieldCurvature, double ultimateCurvature,
                                           CCodeSheet& sheet);

/// DL = theta_y, SD = 0.75 theta_um, NC = theta_um; Circolare: SLD, SLV, SLC.
std::optional<T_CHORD_LIMITS> EnChordLimits(double thetaY, double thetaUm, EN_BASIS basis,
                                            CCodeSheet& sheet);

bool SoundMember(const T_EN_MEMBER& m, CCodeSheet& sheet);
