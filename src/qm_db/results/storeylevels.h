// Storeys as drifts are taken from them: the nodes with results, each with the node below it.
#pragma once

#include <array>
#include <cstddef>
#include <optional>
#include <vector>

/// Drift ratios of a storey, or of several of which only the top one has results.
struct T_STOREY_DRIFT {
    int storey = 0;      // key of the level at the top
    double plain = 0.0;  // largest over the vertical node pairs, with its sign
    double centre = 0.0; // at the level's centre of mass
};

struct T_LEVEL_NODE {
    std::array<double, 2> plan{};                    // X, Y (length)
    double mass = 0.0;                               // in the direction of the push
    const std::vector<double>* moves = nullptr;      // displacement by step
    std::optional<std::size_t> below = std::nullopt; // node of the level below under this one
};

struct T_LEVEL {
    int storey = 0;      // key
    double height = 0.0; // from the level below, or from the ground (length)
    std::vector<T_LEVEL_NODE> nodes;
};

/// Gives each node of a level the nearest node below it in plan, within 1 % of the height; a node
/// that has none there (a set-back, a beam without column) is left without.
void PairWithBelow(T_LEVEL& level, const T_LEVEL& below);

/// Drifts of a level in a step (index from 0), positive in the direction of the push. `below` is
/// the level below, null: the ground, which is at rest. A node without one below counts against
/// the mean of the level below. Centre: weighted by mass, without mass by number.
T_STOREY_DRIFT DriftOf(const T_LEVEL& level, const T_LEVEL* below, std::size_t step);
