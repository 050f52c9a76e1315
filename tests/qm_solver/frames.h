// Small frames for the tests of the analysis engine.
#pragma once

#include "qm_solver/framemodel.h"

#include <initializer_list>

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

inline void Fix(T_FRAME& frame, std::size_t node, std::initializer_list<int> directions)
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

} // namespace sample
