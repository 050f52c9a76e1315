// What a source has to show at a step: movements, forces of members, reactions. SI.
#pragma once

#include "qm_rps/view/viewframe.h"

struct T_NODE_VALUES {
    std::size_t node = 0; // of the scene
    T_DOF6 values{};
};

/// A list that is empty has its reason beside it: what was not analysed is said, not shown as 0.
struct T_VIEW_RESULTS {
    std::vector<T_DOF6> moved; // by node of the scene; of a mode in its own normalisation
    std::string noMoves;
    std::vector<T_ELEM_FORCES> force; // by line of the scene
    std::string noForces;
    std::vector<T_NODE_VALUES> reactions; // of held nodes: on the structure, global
    std::string noReactions;
};

/// What is wanted of a source: reading has its price in large models.
struct T_VIEW_WANTED {
    bool forces = false, reactions = false;
};

/// Of the lines and nodes of this scene.
[[nodiscard]] T_VIEW_RESULTS ReadViewResults(CDBDoc& doc, const T_FRAME_SCENE& scene,
                                             const T_SHAPE_SOURCE& source, int step,
                                             const T_VIEW_WANTED& wanted);

/// Nodes that the ground holds: restrained by themselves (not by the model's plane) or by springs.
[[nodiscard]] std::set<int> HeldNodes(const T_MODEL& model);

/// Lines, of these elements (empty: all), that join two nodes of one rigid diaphragm in its plane:
/// it keeps their ends apart, so that they have no axial force but that of loads on themselves.
[[nodiscard]] std::size_t CountInDiaphragms(const T_MODEL& model, const T_FRAME_SCENE& scene,
                                            const std::set<int>& elements = {});
/// Says so in the user's language.
std::string RigidFloorNote(std::size_t members);
