// Names of the case file for the structure, its loads and unknown load factors, in the order of
// their enumerations and numbers.
#pragma once

#include <array>

inline constexpr std::array<const char*, 4> kElemKindNames{"beam", "truss", "link", "spring"};
inline constexpr std::array<const char*, 6> kReleaseNames{"Dx", "Dy", "Dz", "Rx", "Ry", "Rz"};
inline constexpr std::array<const char*, 3> kAxisNames{"X", "Y", "Z"};
inline constexpr std::array<const char*, 3> kPlaneNames{"XY", "XZ", "YZ"};

/// By STIRRUP_HOOKS, by MATL_KNOWLEDGE.
inline constexpr std::array<const char*, 3> kHookNames{"135", "90", "none"};
inline constexpr std::array<const char*, 3> kKnowledgeNames{"KL1", "KL2", "KL3"};
/// By BOND_KIND.
inline constexpr std::array<const char*, 2> kBondNames{"irregular", "regular"};

inline constexpr std::array<const char*, 2> kLoadAxesNames{"local", "global"};
inline constexpr std::array<const char*, 3> kLoadDirectionNames{"x", "y", "z"};
inline constexpr std::array<const char*, 3> kBeamLoadNames{"distributed", "point", "moment"};

inline constexpr std::array<const char*, 4> kUlfcTypeNames{"reaction", "displacement", "truss",
                                                           "beam"};
inline constexpr std::array<const char*, 6> kReactionNames{"FX", "FY", "FZ", "MX", "MY", "MZ"};
inline constexpr std::array<const char*, 6> kBeamForceNames{"axial",   "shear y",  "shear z",
                                                            "torsion", "moment y", "moment z"};
inline constexpr std::array<const char*, 5> kPositionNames{"I", "1/4", "2/4", "3/4", "J"};
/// By STAGE_BIRTH.
inline constexpr std::array<const char*, 2> kStageBirthNames{"deformed", "design"};
inline constexpr std::array<const char*, 2> kStageStepNames{"first", "last"};

inline constexpr std::array<const char*, 3> kObjectiveNames{"linear", "square", "min-max"};
inline constexpr std::array<const char*, 3> kSignNames{"negative", "free", "positive"};

/// Chapters of a report in their order.
inline constexpr std::array<const char*, 10> kReportChapterNames{
    "model",       "loads",     "modes",   "hinges", "pushes",
    "evaluations", "judgement", "factors", "stages", "remarks"};
