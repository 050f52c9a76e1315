// What a code gives for one side of a component of a member end, and what it is made of. SI.
#pragma once

#include "qm_rps/codes/asce41connection.h"
#include "qm_rps/codes/codebackbone.h"

#include <algorithm>
#include <array>
#include <limits>
#include <vector>

/// Aisc342: columns of steel alone.
enum class HINGE_CODE { Asce17, Asce13, Fema356, Aisc342, En1998, Circolare2019 };
inline constexpr std::array<const char*, 6> kHingeCodeNames{
    "ASCE41-17", "ASCE41-13", "FEMA356", "AISC342-22", "EN1998-3", "Circolare2019"};
/// Chord rotations with DL, SD, NC; else plastic rotations with IO, LS, CP.
inline bool IsChordCode(HINGE_CODE code)
{
    return code >= HINGE_CODE::En1998;
}

/// What is asked for, beside the members. SI.
struct T_CODE_OPTIONS {
    HINGE_CODE code = HINGE_CODE::Asce17;
    bool secondary = false;           // members
    double tie = 0.0;                 // strength of what ties spandrels
    std::vector<double> axialRange{}; // from, to: FEMA curves at axial forces within; empty: none
    std::optional<T_STEEL_CONNECTION> connection{}; // of steel beams, ASCE 41-17
    bool operator==(const T_CODE_OPTIONS&) const = default;
};

/// What a member is to the codes. Steep (above 45 degrees): column, wall, pier; else beam,
/// spandrel.
enum class MEMBER_KIND { Beam, Column, Wall, Brace, Pier, Spandrel };
inline constexpr std::array<const char*, 6> kMemberKindNames{"beam",  "column", "wall",
                                                             "brace", "pier",   "spandrel"};

/// Their hinges hang on the axial force; the others are taken without one.
inline bool IsUpright(MEMBER_KIND kind)
{
    return kind == MEMBER_KIND::Column || kind == MEMBER_KIND::Wall || kind == MEMBER_KIND::Pier;
}

/// Of a push, at the step at which the hinge yields.
struct T_PUSHED_SHEAR {
    double shear = 0.0, shearSpan = 0.0; // V; M / V within LeastSpan and LongestSpan
};

/// What a hinge stands on.
struct T_MEMBER_END {
    HINGE_CODE code = HINGE_CODE::Asce17;
    bool secondary = false; // member
    MEMBER_KIND kind = MEMBER_KIND::Beam;
    bool aboutY = true;
    T_SECT_D section; // with its properties
    T_MATL_D material;
    double clear = 0.0;              // length between the offsets
    double axial = 0.0;              // compression positive
    std::optional<double> gravity{}; // of that, what Eq. (10-3) of ASCE 41 counts; empty: all
    double EI = 0.0;                 // of the model: up to yield it bends with 6 EI / clear
    double EA = 0.0;                 // of the model
    double GA = 0.0;  // of the model, across the axis of bending; 0: no shear deformation
    double tie = 0.0; // of spandrels: strength of what ties the wall there; 0: nothing
    std::optional<T_PUSHED_SHEAR> pushed{}; // else V of both ends' strengths, shear span clear / 2

    std::optional<T_STEEL_CONNECTION> connection{};
    T_STEEL_JOINT joint{}; // of the connection

    double shearSpan = 0.0; // M / V of a state; 0: of `pushed`, or clear / 2

    double ShearSpan() const
    {
        if (shearSpan > 0.0) return shearSpan;
        return pushed ? pushed->shearSpan : clear / 2.0;
    }
    bool HasAxial() const { return IsUpright(kind); }
    /// Along the shear force.
    double Depth() const
    {
        const bool round = section.shape == SECT_SHAPE::Circle || section.shape == SECT_SHAPE::Pipe;
        return section.size[aboutY || round ? 0 : 1];
    }
    /// A point without a moment close to the end does not make a member squat.
    double LeastSpan() const { return std::min(Depth(), clear / 2.0); }
    /// Where the loads along a beam take its shear away, M / V says nothing of its chord; a wall
    /// goes on over several storeys.
    double LongestSpan() const
    {
        return HasAxial() ? std::numeric_limits<double>::infinity() : clear;
    }
    /// Rotation of an end at a moment, with the same moment at the other: what bends elastically
    /// lies between the rigid offsets.
    double Turn(double moment) const { return moment * clear / (6.0 * EI); }
    /// Displacement of one end across the other under a shear force, bent by equal end moments.
    double Sway(double shear) const
    {
        const double bending = shear * clear * clear * clear / (12.0 * EI);
        return bending + (GA > 0.0 ? shear * clear / GA : 0.0);
    }
};

struct T_CODE_SIDE {
    double strength = 0.0;       // moment or force, at the axial force
    double strengthAtZero = 0.0; // without one
    double shear = 0.0;          // at the strengths of both ends, no load along the member
    double shearStrength = 0.0;  // 0: not told
    double hingeLength = 0.0;    // chord codes: Lpl
    T_CODE_BACKBONE bone;
    /// Of a hinge of shear in the middle of the member, where shear may fail first; in the
    /// displacement of one end across the other.
    std::optional<T_CODE_BACKBONE> shearBone{};
    std::vector<T_CODE_TRACE> trace;
    std::vector<T_CODE_WARNING> warnings;
};

/// V of an end on its sheet: of the push, or of the strengths at both ends.
inline double ShearOf(const T_MEMBER_END& end, double capacity, CCodeSheet& sheet)
{
    constexpr auto K = CODE_MARK::Computed;
    const bool ofState = end.shearSpan > 0.0;
    sheet.Put("LV", end.ShearSpan(), kDimLength, "",
              ofState      ? "M/V of the state"
              : end.pushed ? "M/V of the push, at least min(h; clear length/2)"
                           : "clear length/2",
              K);
    return sheet.Put("V", end.pushed ? end.pushed->shear : capacity, kDimForce, "",
                     !end.pushed ? "(My(+) + My(-))/clear length"
                     : ofState   ? "of the state"
                                 : "of the push, where the hinge yields",
                     K);
}
