// What the other parts of a hinge type do not keep: yield surface, user interaction, masonry.
#pragma once

#include "qm_rps/hinge/hingefindings.h"

/// Names of the points of an interaction curve.
inline constexpr std::array<const char*, 10> kPmPointNames{"E(c)", "D(c)", "C(c)", "B(c)", "A(c)",
                                                           "A(t)", "B(t)", "C(t)", "D(t)", "E(t)"};

/// A level of a yield surface: where findings have it, and the names of its strengths.
struct T_YIELD_LEVEL_NAMES {
    const char* prefix;             // "crack.", "yield."
    const char* tension;            // "PC(t)"
    const char *moment, *momentMax; // "MC", "MY": "MCy(+)", "MYy,max(+)"
    bool crack = false;             // else the yield level
};
/// The levels that a curve type fixes: trilinear (and slip trilinear) crack and yield, Eurocode one
/// with its own names, else the yield level.
std::vector<T_YIELD_LEVEL_NAMES> YieldLevels(SKEL_TYPE type);

/// First every strength and moment > 0 (a missing crack level counts as zeros; the axial strengths
/// belong to both axes and are always checked), then for each point -1 < M/MY,max < 1 of (+) and
/// (-), then along each curve P/Pmax falling on the tension side and on the compression side. An
/// axis that is not used is not checked. Under IDS_CMD_IEHP_YIELD.
std::vector<T_FINDING> YieldSurfaceFindings(const T_YIELD_SURFACE& surface, SKEL_TYPE type);

/// Along each curve neither P nor M rises (equal values pass); with a balanced point M may rise
/// before it first falls. Then Pmax >= 0. Keys: IDS_PUSHOVER_Wrong_Data_in_P_values,
/// IDS_PUSHOVER_PMAX_POS.
std::vector<T_FINDING> PmmFindings(const T_PMM_TABLE& table);

std::vector<T_FINDING> MasonryFindings(const T_MASONRY_HINGE& masonry);
