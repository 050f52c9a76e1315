// Movements of nodes and of rigid bodies: their names, and the largest one of a shape.
#pragma once

#include <array>
#include <cstddef>
#include <span>

namespace solver {

inline constexpr std::array<const char*, 6> kMotionName{
    "move along X", "move along Y", "move along Z", "turn about X", "turn about Y", "turn about Z"};

/// Full index (6 * node + direction) of the largest translation of a shape, or of the largest
/// rotation where translations are nothing beside it. The first of equal ones. Shape not empty.
std::size_t LargestMovement(std::span<const double> full);

} // namespace solver
