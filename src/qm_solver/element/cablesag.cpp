#include "qm_solver/element/cablesag.h"

#include <algorithm>
#include <cmath>

namespace solver {

namespace {

constexpr double kLeast = 1e-3; // so that a slack cable leaves the stiffness regular

} // namespace

double SagFactor(const T_FRAME& frame, const T_ELEMENT& element, double tension)
{
    const T_MATERIAL& material = frame.materials[element.material];
    const T_SECTION& section = frame.sections[element.section];
    const T_VEC3 &i = frame.nodes[element.i].xyz, &j = frame.nodes[element.j].xyz;
    const double across =
        material.density * section.A * frame.gravity * std::hypot(j[0] - i[0], j[1] - i[1]);
    if (!(across > 0.0)) return 1.0;
    if (!(tension > 0.0)) return kLeast;
    const double sag =
        across / tension * (across / tension) * material.E * section.StiffA() / (12.0 * tension);
    return std::max(kLeast, 1.0 / (1.0 + sag));
}

} // namespace solver
