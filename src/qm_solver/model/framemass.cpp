#include "qm_solver/model/framemass.h"

#include "qm_solver/model/vec3.h"

namespace solver {

double ElementMass(const T_FRAME& frame, const T_ELEMENT& element)
{
    if (element.kind != ELEMENT_KIND::Beam && element.kind != ELEMENT_KIND::Truss) return 0.0;
    const T_VEC3 i = Plus(frame.nodes[element.i].xyz, element.offsetI);
    const T_VEC3 j = Plus(frame.nodes[element.j].xyz, element.offsetJ);
    return frame.materials[element.material].density * frame.sections[element.section].A *
           Norm(Minus(j, i));
}

std::vector<T_VEC3> LumpedMass(const T_FRAME& frame)
{
    std::vector<T_VEC3> mass;
    mass.reserve(frame.nodes.size());
    for (const T_NODE& node : frame.nodes)
        mass.push_back(node.mass);
    for (const T_ELEMENT& element : frame.elements) {
        const double half = 0.5 * ElementMass(frame, element);
        if (half == 0.0) continue;
        AddPart(mass[element.i], 0, {half, half, half});
        AddPart(mass[element.j], 0, {half, half, half});
    }
    return mass;
}

} // namespace solver
