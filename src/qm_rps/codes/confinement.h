// Concrete confined by hoops or spirals: strength and strains of the core.
#pragma once

#include "qm_rps/codes/codesheet.h"

/// A rectangular core within hoops.
struct T_RECT_CORE {
    double bx = 0.0, by = 0.0;  // core between the centre lines of the hoop, m
    double hoopDiameter = 0.0;  // m
    double spacing = 0.0;       // of the hoops, centre to centre, m
    double areaX = 0.0;         // of all legs that run along x, one layer, m2
    double areaY = 0.0;         // along y
    double longRatio = 0.0;     // longitudinal steel over the area of the core
    std::vector<double> gaps{}; // between restrained bars, over all four faces, m
};

/// A circular core.
struct T_ROUND_CORE {
    double diameter = 0.0; // between centre lines, m
    double hoopDiameter = 0.0;
    double spacing = 0.0;
    double longRatio = 0.0;
    bool spiral = false;
};

struct T_CONFINED {
    double effectiveness = 0.0; // ke or alpha
    double pressure = 0.0;      // effective lateral pressure, Pa
    double strength = 0.0;      // fcc
    double peakStrain = 0.0;    // at fcc
    double ultimateStrain = 0.0;
};

struct T_CONFINED_MATERIAL {
    double fc = 0.0;           // of the plain concrete: mean, or characteristic; Pa
    double peakStrain = 0.002; // of the plain concrete (Mander)
    double fyh = 0.0;          // of the hoops
    double hoopStrain = 0.0;   // at their largest stress (Mander's eps_cu); 0: eps_cu is 0.004
};

/// Mander, Priestley, Park 1988: fcc from an effective lateral pressure; the strain with it.
std::optional<T_CONFINED> ManderConfined(double pressure, const T_CONFINED_MATERIAL& m,
                                         CCodeSheet& sheet);
/// `gaps` are clear distances between bars. Where the pressures of x and y differ, their mean is
/// taken, with a warning: Mander's chart for two pressures is not in here.
std::optional<T_CONFINED> ManderRectangular(const T_RECT_CORE& core, const T_CONFINED_MATERIAL& m,
                                            CCodeSheet& sheet);
std::optional<T_CONFINED> ManderCircular(const T_ROUND_CORE& core, const T_CONFINED_MATERIAL& m,
                                         CCodeSheet& sheet);

/// NTC 2018 [4.1.8] to [4.1.12], and EN 1992-1-1 3.1.9; fc is fck, `gaps` between bar centres.
std::optional<T_CONFINED> NtcConfined(double pressure, double fck, CCodeSheet& sheet);
std::optional<T_CONFINED> NtcRectangular(const T_RECT_CORE& core, const T_CONFINED_MATERIAL& m,
                                         CCodeSheet& sheet);
std::optional<T_CONFINED> NtcCircular(const T_ROUND_CORE& core, const T_CONFINED_MATERIAL& m,
                                      CCodeSheet& sheet);

/// Confinement effectiveness of EN 1998-3 (A.2). Circolare 2019 C8.7.2.3.2: 0 where the hoops are
/// not closed by hooks of 135 degrees.
struct T_HOOP_GRIP {
    double bo = 0.0, ho = 0.0;  // core to the centre lines of the hoop
    double spacing = 0.0;       // sh
    std::vector<double> gaps{}; // bi between restrained bars, all around, m
    bool hooks135 = true;
};
std::optional<double> HoopEffectiveness(const T_HOOP_GRIP& grip, CCodeSheet& sheet);

/// EN 1998-3 A.3.2.2(8): strength and strains with (A.9). `load` is alpha rho_sx fyw, Pa.
std::optional<T_CONFINED> Annex3Confined(double load, double fc, CCodeSheet& sheet);
