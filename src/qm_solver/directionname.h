// Words for the six directions of a node and of a rigid body.
#pragma once

#include <array>

namespace solver {

inline constexpr std::array<const char*, 6> kMotionName{
    "move along X", "move along Y", "move along Z", "turn about X", "turn about Y", "turn about Z"};

} // namespace solver
