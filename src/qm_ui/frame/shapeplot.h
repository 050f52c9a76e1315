// Picture of a frame that has moved: by loads before and after a change, or in a mode.
#pragma once

#include "qm_ui/plot/plotdata.h"

#include <array>
#include <cstddef>
#include <optional>
#include <string>
#include <vector>

struct T_SHAPE_NODE {
    int id = 0;
    std::array<double, 3> xyz{};
    bool support = false;
};

/// A straight member between two nodes; ends are at node plus offset.
struct T_SHAPE_MEMBER {
    std::size_t i = 0, j = 0;        // indices of nodes
    bool beam = true;                // bends with the rotations of its ends; else it stays straight
    bool pinI = false, pinJ = false; // a beam that is free to turn in bending at that end
    std::array<double, 3> offsetI{}, offsetJ{};
};

struct T_SHAPE_STATE {
    std::string name;                                // in the legend
    std::vector<std::array<double, 6>> displacement; // by node; translations, rotations (rad)
};

struct T_SHAPE {
    std::string title, subtitle;
    std::string lengthUnit; // of the coordinates and the displacements
    bool mode = false;      // displacements have no size: none is stated
    std::vector<T_SHAPE_NODE> nodes;
    std::vector<T_SHAPE_MEMBER> members;
    std::vector<T_SHAPE_STATE> states; // up to four are told apart
    std::optional<double> scale{};     // of the displacements; empty: a round number that fits
};

/// Points of a member that has moved, `count` of them (at least 2) from end I to end J, with the
/// displacements times `scale`: linear along the member, across it the cubic that fits the
/// displacements and rotations of the ends (Hermite). Loads along the member add nothing.
[[nodiscard]] std::vector<std::array<double, 3>> MemberShape(const T_SHAPE& shape,
                                                             const T_SHAPE_MEMBER& member,
                                                             const T_SHAPE_STATE* state,
                                                             double scale, std::size_t count);

/// The frame as it was in thin lines and every state over it, all states in one scale, which the
/// legend states. A frame in a plane parallel to two axes, and moving in it, is drawn in that
/// plane; any other in an isometric projection. States whose number of nodes differs from the
/// frame's, and members of nodes that are not there, are left out.
[[nodiscard]] T_PLOT ShapePlot(const T_SHAPE& shape);
