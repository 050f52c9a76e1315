// Small frames for the tests of the analysis engine.
#pragma once

#include "qm_solver/framemodel.h"

#include <utility>

namespace sample {

using namespace solver;

inline T_FRAME Empty()
{
    T_FRAME frame;
    T_MATERIAL steel;
    steel.E = 2.1e8;
    steel.G = 8.1e7;
    frame.materials.push_back(steel);
    T_SECTION section;
    section.A = 5.4e-3;
    section.J = 2.1e-7;
    section.Iy = 3.7e-5;
    section.Iz = 1.3e-5;
    frame.sections.push_back(section);
    return frame;
}

inline std::size_t AddNode(T_FRAME& frame, T_VEC3 xyz)
{
    T_NODE node;
    node.xyz = xyz;
    frame.nodes.push_back(node);
    return frame.nodes.size() - 1;
}

inline void Fix(T_FRAME& frame, std::size_t node, const std::vector<int>& directions)
{
    for (int d : directions)
        frame.nodes[node].fixed[static_cast<std::size_t>(d)] = true;
}

inline void Join(T_FRAME& frame, ELEMENT_KIND kind, std::size_t i, std::size_t j,
                 T_VEC6 stiffness = {})
{
    T_ELEMENT e;
    e.kind = kind;
    e.i = i;
    e.j = j;
    e.stiffness = stiffness;
    frame.elements.push_back(e);
}

/// A tower of beams with nodal and distributed mass, irregular; four nodes a storey, clamped feet.
/// Elements 8 s + 2 c are columns, 8 s + 2 c + 1 floor beams.
inline T_FRAME IrregularTower(std::size_t storeys)
{
    T_FRAME frame = Empty();
    frame.materials[0].density = 7.85;
    for (std::size_t s = 0; s <= storeys; ++s)
        for (auto [x, y] : {std::pair{0.0, 0.0}, {5.0, 0.3}, {5.5, 4.0}, {-0.2, 4.4}})
            AddNode(frame, {x, y, 3.0 * double(s) + 0.1 * x});
    for (std::size_t n = 0; n + 4 < frame.nodes.size(); ++n) {
        Join(frame, ELEMENT_KIND::Beam, n, n + 4);
        Join(frame, ELEMENT_KIND::Beam, n + 4, 4 * (n / 4 + 1) + (n + 1) % 4);
        frame.nodes[n + 4].mass = {1.0, 1.5, n % 3 ? 0.5 : 0.0};
    }
    for (std::size_t n = 0; n < 4; ++n)
        Fix(frame, n, {0, 1, 2, 3, 4, 5});
    return frame;
}

} // namespace sample
