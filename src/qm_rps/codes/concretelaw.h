// Concrete as the codes define it from its characteristic strength.
#pragma once

#include "qm_rps/codes/codesheet.h"

/// Parabola-rectangle of concrete in compression, EN 1992-1-1 3.1.7: fck (1 - (1 - eps / peak)^n)
/// up to the peak strain, then fck up to the crushing strain.
struct T_CONCRETE_LAW {
    double n = 2.0;
    double peakStrain = 0.002;   // eps_c2
    double crushStrain = 0.0035; // eps_cu2
    bool operator==(const T_CONCRETE_LAW&) const = default;
};
/// Strongest concrete that the law is for, C90/105.
inline constexpr double kMaxFckMpa = 90.0;
/// EN 1992-1-1 Table 3.1, by its formulas; fck in MPa, at most kMaxFckMpa.
T_CONCRETE_LAW ConcreteLaw(double fckMpa);

/// The other columns of EN 1992-1-1 Table 3.1; Pa.
struct T_CONCRETE_CLASS {
    double fck = 0.0, fcm = 0.0, fctm = 0.0, fctk005 = 0.0, fctk095 = 0.0, Ecm = 0.0;
    double bilinearStrain = 0.0; // eps_c3
    double lambda = 0.0;         // depth of the rectangular block over the neutral axis depth
    double eta = 0.0;            // its stress over the strength
};
/// 12 to 90 MPa.
std::optional<T_CONCRETE_CLASS> ConcreteClass(double fck, CCodeSheet& sheet);

/// ACI 318 22.2.2.4.3: depth of the rectangular block over the neutral axis depth.
double AciBeta1(double fc, CCodeSheet& sheet);

/// Balanced reinforcement ratio of a rectangle, ACI 318: eps_cu = 0.003 with fy in tension.
double BalancedRatio(double fc, double fy, double Es, CCodeSheet& sheet);
