// Movements of nodes and of rigid bodies: their names, and the largest one of a shape.
#pragma once

#include <array>
#include <cstddef>
#include <span>

namespace solver {

/// Keys of what a node is free to do, by direction.
inline constexpr std::array<const char*, 6> kMotionKeys{
    "IDS_QM_ENGINE_MOVE_X", "IDS_QM_ENGINE_MOVE_Y", "IDS_QM_ENGINE_MOVE_Z",
    "IDS_QM_ENGINE_TURN_X", "IDS_QM_ENGINE_TURN_Y", "IDS_QM_ENGINE_TURN_Z"};

/// Full index (6 * node + direction) of the largest translation of a shape, or of the largest
/// rotation where translations are nothing beside it. The first of equal ones. Shape not empty.
std::size_t LargestMovement(std::span<const double> full);

} // namespace solver
