// Words of the case file that belong to no record, and dimensions of the steps of load cases.
#pragma once

#include "qm_db/records/evalnames.h"

inline constexpr const char* kCaseFormat = "qm-rps case 1";
inline constexpr const char* kPushControlMember = "pushover_control";
inline constexpr const char* kStateBeforePush = "state before push";

/// Dimension of the displacements and of the base reactions of a load case (direction 1 to 6).
inline constexpr T_DIM DisplacementDim(int direction)
{
    return direction <= 3 ? kDimLength : kDimNone; // a rotation is in radians
}
inline constexpr T_DIM ReactionDim(int direction)
{
    return direction <= 3 ? kDimForce : kDimMoment;
}
