#include "qm_rps/push/endforces.h"

#include <algorithm>

const solver::T_VEC6& ForcesAt(int element, bool atJ, const T_STEP_FORCES& step)
{
    const auto at = std::ranges::lower_bound(step.elements, element);
    const auto& forces = step.result.force[static_cast<std::size_t>(at - step.elements.begin())];
    return atJ ? forces.back() : forces.front();
}

T_END_FORCES EndForces(const T_END_PLACE& place, const T_STEP_FORCES& step)
{
    const solver::T_VEC6& end = ForcesAt(place.element, place.atJ, step);
    T_END_FORCES f;
    f.N = -end[0];
    if (place.component == HINGE_COMPONENT::Fx) return f;
    const bool aboutY = place.component == HINGE_COMPONENT::My;
    f.M = end[aboutY ? 4 : 5];
    f.across = end[aboutY ? 5 : 4];
    f.V = end[aboutY ? 2 : 1];
    return f;
}
