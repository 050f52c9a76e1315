// What a member end can take, and the share of it that a step takes: rotations and shear by a
// code. SI.
#pragma once

#include "qm_rps/generate/memberend.h"
#include "qm_rps/judge/endstate.h"

/// What an end is judged by.
enum class JUDGE_BASIS {
    Nothing,  // there is a reason
    Code,     // a code, from section and reinforcement
    Criteria, // the acceptance criteria of its hinge
};

/// Limit states from the lightest: IO, LS, CP; DL, SD, NC; SLD, SLV, SLC.
inline constexpr std::size_t kLevels = 3;
using T_LEVELS = std::array<const char*, kLevels>;
inline constexpr std::array<T_LEVELS, 3> kLevelNames{
    {{"IO", "LS", "CP"}, {"DL", "SD", "NC"}, {"SLD", "SLV", "SLC"}}};

enum class JUDGE_MODE { Rotation, Shear };
inline constexpr std::array<const char*, 2> kModeNames{"rotation", "shear"};

/// Partial factors of brittle checks.
struct T_JUDGE_FACTORS {
    double gammaC = 1.5, gammaS = 1.15; // EN 1998-3, Circolare: strengths in shear
    double gamma = 1.3;                 // ASCE 41: force-controlled actions
    bool operator==(const T_JUDGE_FACTORS&) const = default;
};

struct T_JUDGED_END {
    T_END_PLACE place;
    T_MEMBER_AXES axes;
    bool column = false;
    std::string storey; // empty: none
    JUDGE_BASIS basis = JUDGE_BASIS::Nothing;
    std::string why;                    // Nothing: the reason
    T_MEMBER_END member;                // Code
    T_SIDES<std::vector<double>> marks; // Criteria: deformations of the hinge at IO, LS, CP
    double spring = 0.0;                // stiffness of its hinge in series, 0: rigid until it flows
    long hinge = -1;                    // of the run

    const T_LEVELS& Levels() const;
    std::string Code() const; // "EN1998-3", "hinge type", ""
};

/// Demand and capacity of one check at one limit state.
struct T_CHECK {
    double demand = 0.0, capacity = 0.0;
    /// Empty: no capacity at all is asked for.
    std::optional<double> Ratio() const;
    bool Holds() const { return demand <= capacity; }
};

/// The checks of an end in a state.
struct T_END_CHECKS {
    double LV = 0.0;        // shear span that the rotations took; 0: none
    double thetaY = 0.0;    // 0: not known
    double ductility = 0.0; // theta / theta_y; 0: not known
    std::array<std::optional<T_CHECK>, kLevels> rotation, shear;
    std::string whyNoRotation, whyNoShear;
    std::vector<T_CODE_TRACE> rotationTrace, shearTrace;
    std::vector<T_CODE_WARNING> warnings;

    const std::optional<T_CHECK>& Of(JUDGE_MODE mode, std::size_t level) const
    {
        return mode == JUDGE_MODE::Rotation ? rotation[level] : shear[level];
    }
};

/// What a state is judged with besides itself.
struct T_STATE_CONTEXT {
    T_END_STATE shear;                    // where the shear demand is read
    std::optional<double> gravityShear{}; // of the initial loads; empty: not known
    T_JUDGE_FACTORS factors;
};

/// Rotations: EN 1998-3, Circolare: |chord rotation| against DL, SD, NC at N and LV = M / V of the
/// state. ASCE 41, FEMA 356: plastic rotation against kappa times IO, LS, CP at N. Criteria: the
/// deformation of the hinge against its own.
/// LV is at least the depth of the section, or half the clear length of a squat member (a moment
/// that is almost 0 says nothing of either); of rotations at most the clear length.
/// Shear: EN 1998-3 (A.12) with the strengths over CF and gamma_M, at the ductility theta / theta_y
/// of the state; VRd,max of EN 1992-1-1. ASCE 41-17 7.5.3.2: gamma chi (V - VG) + VG against kappa
/// times the strength with lower-bound strengths.
T_END_CHECKS CheckEnd(const T_JUDGED_END& end, const T_END_STATE& state,
                      const T_STATE_CONTEXT& with);
