// The curve of a hinge as a code gives it: from plastic deformations and acceptance values to the
// points B to E. Deformations are total ones (from zero), strengths are divided by the yield
// strength: what a FEMA or Eurocode curve of a hinge type is filled from, in either measure.
#pragma once

#include "qm_rps/codes/codetable.h"

#include <array>

struct T_CODE_POINT {
    double deform = 0.0;   // total: rotation or drift in rad, elongation in m
    double strength = 0.0; // over the yield strength
};

/// Names of the three acceptance values: IO, LS, CP or DL, SD, NC.
enum class CODE_LEVELS { IoLsCp, DlSdNc };

struct T_CODE_BACKBONE {
    CODE_LEVELS levels = CODE_LEVELS::IoLsCp;
    double yield = 0.0;       // force or moment
    double yieldDeform = 0.0; // at yield
    T_CODE_POINT B, C, D, E;
    std::optional<std::array<double, 3>> acceptance{}; // total; absent: the code has none
    bool strengthLoss = true;                          // D lies below C
    bool forceControlled = false;                      // no plastic deformation may be counted on
    /// Of walls that shear controls: strength at cracking over the yield strength, on the elastic
    /// line; 0: none.
    double crackStrength = 0.0;

    /// A total deformation as plastic deformation, and as ratio D / Dy.
    double Plastic(double deform) const { return deform - yieldDeform; }
    double Ratio(double deform) const { return deform / yieldDeform; }
};

/// What the section adds to the code's table.
struct T_BACKBONE_IN {
    double yield = 0.0;
    double yieldDeform = 0.0;
    /// Slope from B to C over the elastic slope. ASCE 41: at most 0.10 for concrete, 0.03 of steel,
    /// 0 where shear controls.
    double slope = 0.0;
    /// Largest strength at C over the yield strength, where it is known (ultimate moment of the
    /// section); 0: not known.
    double strengthCap = 0.0;
    bool acceptance = true; // the table has acceptance values
    T_DIM dim = kDimNone;   // of the deformations; a length of braces
};
inline constexpr double kConcreteSlope = 0.10;
inline constexpr double kSteelSlope = 0.03;

/// B (theta_y, 1), C (theta_y + a, 1 + slope a / theta_y), D (theta_y + a, c), E (theta_y + b, c).
/// b <= a leaves no plateau from D to E: E is at D's deformation, without strength. Where there is
/// no strength to lose there (c = 0, or c not below C), E is at kEndOverUltimate of D's
/// deformation. b = 0 is force-controlled.
std::optional<T_CODE_BACKBONE> BackboneOfPlastic(const T_CODE_PLASTIC& p, const T_BACKBONE_IN& in,
                                                 CCodeSheet& sheet);

/// Chord rotations of EN 1998-3: B (theta_y, 1), C (theta_u, 1 or the section's), acceptance DL,
/// SD, NC. The code gives no strength beyond theta_u: D and E stand at strength `residual`, E at
/// kEndOverUltimate theta_u, with a warning.
struct T_CHORD_LIMITS {
    double DL = 0.0, SD = 0.0, NC = 0.0; // total
    double residual = 0.0;               // over the yield strength, [0, 1)
};
inline constexpr double kEndOverUltimate = 1.5;
std::optional<T_CODE_BACKBONE> BackboneOfChord(const T_CHORD_LIMITS& limits,
                                               const T_BACKBONE_IN& in, CCodeSheet& sheet);
