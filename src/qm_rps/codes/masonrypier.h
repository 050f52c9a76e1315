// Piers and spandrels of existing masonry: in-plane strength and drifts by NTC 2018 with the
// Circolare 2019, and piers by EN 1998-3 Annex C.
#pragma once

#include "qm_rps/codes/codesheet.h"

enum class MASONRY_BOND { Irregular, Regular };

struct T_PIER {
    double length = 0.0, thickness = 0.0, height = 0.0; // m
    double shearSpan = 0.0;  // h0 = M / V at the section that is checked, m
    double axial = 0.0;      // N, compression positive
    double fm = 0.0;         // mean compressive strength, Pa
    double tau0 = 0.0;       // mean shear strength, of the irregular bond
    double fv0 = 0.0;        // mean shear strength without compression; 0: not given
    double fb = 0.0;         // of the blocks, for the limit of fv; 0: not given
    double confidence = 1.0; // CF: strengths are divided by it
    MASONRY_BOND bond = MASONRY_BOND::Irregular;
    double interlocking = 1.0; // phi of the regular bond
    bool hollowBlocks = false; // modern hollow blocks: diagonal drift 0.004
};

enum class PIER_MODE { Flexure, Sliding, Diagonal };
struct T_PIER_STRENGTH {
    double moment = 0.0;             // Mu
    double flexure = 0.0;            // Mu / h0
    std::optional<double> sliding{}; // absent: fv0 is not given
    double diagonal = 0.0;
    PIER_MODE mode = PIER_MODE::Flexure;
    double strength = 0.0; // the least
    double drift = 0.0;    // ultimate, over the height, of the mode that governs
};
std::optional<T_PIER_STRENGTH> NtcPier(const T_PIER& pier, CCodeSheet& sheet);
/// Ultimate drift of a mode.
double NtcPierDrift(PIER_MODE mode, bool hollowBlocks, CCodeSheet& sheet);

/// EN 1998-3 Annex C.2, C.3: flexure and sliding; bond and tau0 do not count, there is no
/// diagonal, and drifts are those of AnnexCDrifts.
std::optional<T_PIER_STRENGTH> AnnexCPier(const T_PIER& pier, CCodeSheet& sheet);

/// NTC 2018 7.8.2.2.4, Circolare 2019 C8.7.1.3.1.1: a spandrel between piers, tied by something
/// that carries tension (tie beam, tie rod).
struct T_SPANDREL {
    double depth = 0.0, thickness = 0.0, length = 0.0; // m
    double tie = 0.0;                                  // strength of the tie, N
    double fm = 0.0;                                   // mean compressive strength, horizontal, Pa
    double tau0 = 0.0;                                 // mean shear strength
    double confidence = 1.0;
};
struct T_SPANDREL_STRENGTH {
    double moment = 0.0, shear = 0.0;            // Mu; Vt
    double bendingDrift = 0.0, shearDrift = 0.0; // ultimate, of the chord
};
std::optional<T_SPANDREL_STRENGTH> NtcSpandrel(const T_SPANDREL& spandrel, CCodeSheet& sheet);

/// EN 1998-3 Annex C: drifts of SD and NC; H0 is the height to the inflection point, D the depth.
struct T_PIER_DRIFTS {
    double SD = 0.0, NC = 0.0;
};
std::optional<T_PIER_DRIFTS> AnnexCDrifts(double H0, double D, bool flexure, bool secondary,
                                          CCodeSheet& sheet);
