// Shear strength of concrete members as designed: EN 1992-1-1 6.2 and ACI 318.
#pragma once

#include "qm_rps/codes/codesheet.h"

struct T_SHEAR_SECTION {
    double bw = 0.0, d = 0.0, Ag = 0.0;  // m, m, m2
    double fc = 0.0, fyw = 0.0;          // characteristic or assessed strengths, Pa
    double tensionRatio = 0.0;           // rho_l = Asl / (bw d)
    double axial = 0.0;                  // N, compression positive
    double legArea = 0.0, spacing = 0.0; // Asw of one set of legs, m2; m. legArea 0: no hoops
};

struct T_EN_SHEAR {
    double concrete = 0.0; // VRd,c
    double hoops = 0.0;    // VRd,s
    double strut = 0.0;    // VRd,max
    double VRd = 0.0;      // min(VRd,s; VRd,max) with hoops, else VRd,c
};
/// Partial factors are 1 for an assessed strength. cotTheta 1 to 2.5; z = 0.9 d.
struct T_EN_SHEAR_OPTIONS {
    double gammaC = 1.5, gammaS = 1.15;
    double cotTheta = 1.0;
    bool addConcrete = false; // NTC, existing members: VRd = min(VRd,c + VRd,s; VRd,max)
    double alphaCc = 1.0;     // 3.1.6, of fcd
};
std::optional<T_EN_SHEAR> EnShear(const T_SHEAR_SECTION& s, const T_EN_SHEAR_OPTIONS& options,
                                  CCodeSheet& sheet);

struct T_ACI_SHEAR {
    double concrete = 0.0, hoops = 0.0, Vn = 0.0;
};
/// ACI 318-19 Table 22.5.5.1, normal weight: lambda = 1, else 0.75. Vc has the size effect where
/// there are no hoops, or less than 9.6.3.4 asks for; at most 5 lambda sqrt(f'c) bw d.
std::optional<T_ACI_SHEAR> AciShear(const T_SHEAR_SECTION& s, double lambda, CCodeSheet& sheet);

/// ACI 318 18.10.4.1, slender walls (hw / lw >= 2): Vn = (2 sqrt(f'c) + rho_t fyt) Acv in psi, not
/// above 10 sqrt(f'c) Acv. `ratio` is that of the horizontal bars.
std::optional<double> AciWallShear(double area, double fc, double fyt, double ratio,
                                   CCodeSheet& sheet);
