// Names of the case file for units, pushover analysis, spectra and evaluations, in the order of
// their numbers, and what the directions of a load case are measured in.
#pragma once

#include "qm_db/records.h"

#include <array>

/// By FORCE_UNIT and LENGTH_UNIT.
inline constexpr std::array<const char*, 7> kForceNames{"N",    "kN",  "MN",  "kgf",
                                                        "tonf", "lbf", "kips"};
inline constexpr std::array<const char*, 5> kLengthNames{"mm", "cm", "m", "in", "ft"};

/// By PUSH_P_DELTA, PUSH_FAILURE, PUSH_FLOW and PUSH_STATE_STOP.
inline constexpr std::array<const char*, 3> kPDeltaNames{"none", "initial", "updated"};
inline constexpr std::array<const char*, 3> kPushFailureNames{"drop", "stop", "leap"};
inline constexpr std::array<const char*, 2> kPushFlowNames{"rotations", "associated"};
inline constexpr std::array<const char*, 3> kStateStopNames{"LS", "CP", "failed"};

/// In the order of the alternatives of T_SPFC_D::data.
inline constexpr std::array<const char*, 5> kSpectrumKinds{"atc40", "ec8-2004", "ec8-1994", "ntc",
                                                           "user"};
inline constexpr std::array<const char*, 5> kSoils{"A", "B", "C", "D", "E"};
inline constexpr std::array<const char*, 4> kTopographies{"T1", "T2", "T3", "T4"};

/// In the order of PUSH_METHOD, which starts at Fema440.
inline constexpr std::array<const char*, 5> kMethodNames{"FEMA440", "ATC-40", "EC8/OPCM", "NTC2008",
                                                         "NTC2018"};
inline constexpr int kFirstMethod = static_cast<int>(PUSH_METHOD::Fema440);
inline constexpr std::array<const char*, 3> kProcedures{"A", "B", "C"};
inline constexpr std::array<const char*, 3> kBilinearRules{"ec8", "ntc", "masonry"};
inline constexpr std::array<const char*, 2> kStrengthRules{"rule", "peak"};

/// Dimension of the displacements and of the base reactions of a load case (direction 1 to 6).
inline constexpr T_DIM DisplacementDim(int direction)
{
    return direction <= 3 ? kDimLength : kDimNone; // a rotation is in radians
}
inline constexpr T_DIM ReactionDim(int direction)
{
    return direction <= 3 ? kDimForce : kDimMoment;
}
