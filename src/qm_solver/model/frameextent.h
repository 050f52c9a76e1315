// Size of a frame.
#pragma once

#include "qm_solver/framemodel.h"

#include <algorithm>

namespace solver {

/// Largest side of the box around the nodes; 1 if all are in one place. Compares rotations with
/// displacements and moments with forces.
inline double Extent(const T_FRAME& frame)
{
    double extent = 0.0;
    for (std::size_t d = 0; d < 3 && !frame.nodes.empty(); ++d) {
        const auto [low, high] = std::minmax_element(
            frame.nodes.begin(), frame.nodes.end(),
            [d](const T_NODE& a, const T_NODE& b) { return a.xyz[d] < b.xyz[d]; });
        extent = std::max(extent, high->xyz[d] - low->xyz[d]);
    }
    return extent > 0.0 ? extent : 1.0;
}

} // namespace solver
