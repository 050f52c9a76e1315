// A member of steel as the codes' formulas take it: I, box and pipe with their strengths. SI.
#pragma once

#include "qm_rps/codes/asce41steel.h"
#include "qm_rps/codes/steelinteraction.h"
#include "qm_rps/generate/codeside.h"

struct T_STEEL_BASIS {
    const T_MEMBER_END& end;
    T_STEEL_SHAPE shape;
    T_STEEL_PLASTIC_STRENGTH strength; // with fy
    double fy = 0.0;    // ASCE 41: expected; else the mean over the confidence factor
    double lower = 0.0; // ASCE 41: lower bound
    double E = 0.0;
    double Z = 0.0, I = 0.0;   // about the axis of bending
    double iy = 0.0, iz = 0.0; // radii of gyration
    double axial = 0.0;        // that counts

    double Least() const { return iy < iz ? iy : iz; }
    /// I, Z and plates as ASCE 41 takes them.
    T_STEEL_MEMBER Member() const;
};

/// I, box, pipe or channel with its fillet: an I without one is welded; other shapes are refused.
std::optional<T_STEEL_SHAPE> SteelShapeOf(const T_SECT_D& section, CCodeSheet& sheet);

/// ASCE 41: the material's mean, else Fy times the
/// factor of Table 9-3. EN 1998-3, Circolare: the mean, else Fy with a warning, over the confidence
/// factor. Refuses channels, other shapes and materials.
std::optional<T_STEEL_BASIS> SteelBasis(const T_MEMBER_END& end, CCodeSheet& sheet);

/// The edition of ASCE 41 whose rules hold; AISC 342 takes the strengths of 41-17.
ASCE_EDITION SteelEdition(const T_MEMBER_END& end);

/// Plastic moment with an axial force of either sign: ASCE 41, or EN 1993-1-1 6.2.9.
std::optional<double> SteelMoment(const T_STEEL_BASIS& in, double axial, CCodeSheet& sheet);
/// Shear strength across the axis of bending with a yield strength: EN 1993-1-1 6.2.6 with EN
/// 1993-1-5 5, or AISC 360 G.
std::optional<double> SteelShear(const T_STEEL_BASIS& in, double fy, CCodeSheet& sheet);

/// Under a moment about y the section may buckle sideways: an I, a flat bar and what is given by
/// values; round and hollow sections do not (EN 1993-1-1 6.3.2.1(2)).
inline bool BucklesSideways(const T_SECT_D& section)
{
    const bool closed = section.shape == SECT_SHAPE::Circle || section.shape == SECT_SHAPE::Pipe ||
                        section.shape == SECT_SHAPE::Box;
    return !closed;
}
/// The message that it is not checked.
inline constexpr const char* kNoSidewaysKey = "IDS_QM_WARN_SIDEWAYS";
