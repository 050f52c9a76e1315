// Names of the case file for hinges and what they refer to, in the order of their enumerations.
#pragma once

#include <array>

inline constexpr std::array<const char*, 4> kMatlNames{"concrete", "steel", "composite", "masonry"};
inline constexpr std::array<const char*, 7> kShapeNames{"value", "rectangle", "circle", "pipe",
                                                        "box",   "I",         "channel"};
inline constexpr std::array<const char*, 5> kHingeElementNames{"beam-column", "wall", "truss",
                                                               "general link", "point spring"};
inline constexpr std::array<const char*, 3> kDefinitionNames{
    "moment-rotation", "moment-curvature lumped", "moment-curvature distributed"};
inline constexpr std::array<const char*, 5> kInteractionNames{"P", "My-Mz", "Vy-Vz", "PMM", "user"};
inline constexpr std::array<const char*, 4> kLocationNames{"I-end", "J-end", "both ends",
                                                           "center"}; // from 1
inline constexpr std::array<const char*, 7> kSkelNames{
    "bilinear", "trilinear", "slip bilinear", "slip trilinear", "FEMA", "EC8", "compression only"};
inline constexpr std::array<const char*, 2> kMeasureNames{"D/Dy", "plastic"};
inline constexpr std::array<const char*, 5> kStiffnessNames{"6EI/L", "3EI/L", "2EI/L", "user",
                                                            "elastic"};
inline constexpr std::array<const char*, 5> kUnloadNames{"origin", "nonlinear elastic", "bilinear",
                                                         "stiffness degrading", "degrading slip"};
inline constexpr std::array<const char*, 3> kGapNames{"both", "positive", "negative"};

/// T_POLC_CONTROL::incrementMethod; any other value than 1 is force control.
inline constexpr std::array<const char*, 2> kIncrementNames{"force", "displacement"};
