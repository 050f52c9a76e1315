// Storeys of any model from the heights of its nodes.
#pragma once

#include "qm_base/finding.h"
#include "qm_db/records.h"

#include <string>
#include <vector>

/// Nodes at one height, in SI.
struct T_LEVEL_OF_NODES {
    double elevation = 0.0; // mean of its nodes
    double lowest = 0.0, highest = 0.0;
    std::vector<int> nodes; // ascending
    bool isGround = false;  // the lowest level, or all of its nodes are held sideways
};

/// Levels from bottom to top. Nodes join the level below while they are within the tolerance of its
/// lowest node, so that a slope makes no endless level. Of a plane XY model Y is the height.
std::vector<T_LEVEL_OF_NODES> LevelsOf(const T_MODEL& model, double tolerance);

/// One storey for each level that is not the ground, named "1F", "2F" ... and as high as the
/// distance to the level below. Levels that are not taken (`taken` by index; empty: all) go with
/// the storey above: its height reaches down past them. 1 done; 0 fault filled: no such level, a
/// tolerance that is negative or joins everything.
[[nodiscard]] int StoreysFromLevels(const std::vector<T_LEVEL_OF_NODES>& levels,
                                    const std::vector<bool>& taken,
                                    const std::vector<std::string>& names,
                                    std::vector<T_STOR_D>& out, T_FINDING& fault);
