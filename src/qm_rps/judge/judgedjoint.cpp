#include "qm_rps/judge/judgedjoint.h"

#include "qm_rps/judge/vectors.h"

#include <cmath>
#include <numbers>

namespace {

/// What a member does to the node at its end, global.
struct T_ON_NODE {
    T_VECTOR force{}, moment{};
};

/// Forces at J act on the member, those at I on the node (signs of an analysis).
T_ON_NODE OnNode(const T_JUDGED_JOINT::T_PART& part, const T_STEP_FORCES& step)
{
    const solver::T_VEC6& end = ForcesAt(part.element, part.atJ, step);
    const double sign = part.atJ ? -1.0 : 1.0;
    const std::array<const T_VECTOR*, 3> axes{&part.axes.x, &part.axes.y, &part.axes.z};
    T_ON_NODE out;
    for (std::size_t i = 0; i < axes.size(); ++i) {
        out.force = Plus(out.force, *axes[i], sign * end[i]);
        out.moment = Plus(out.moment, *axes[i], sign * end[3 + i]);
    }
    return out;
}

} // namespace

T_END_STATE JointState(const T_JUDGED_JOINT& joint, const T_STEP_FORCES& step)
{
    const T_VECTOR axis = Cross(joint.up, joint.forth); // turns the top forth
    T_END_STATE s;
    for (const T_JUDGED_JOINT::T_PART& beam : joint.beams)
        s.M += Dot(OnNode(beam, step).moment, axis);
    if (!joint.above) return s;
    const T_VECTOR force = OnNode(*joint.above, step).force;
    s.V = -Dot(force, joint.forth);
    s.N = -ForcesAt(joint.above->element, joint.above->atJ, step)[0];
    return s;
}

std::string PlaneName(const std::array<double, 3>& forth, std::size_t up)
{
    constexpr double kTenths = 10.0; // of a degree are told
    const std::size_t first = up == 0 ? 1 : 0, second = up == 2 ? 1 : 2;
    double degrees = std::atan2(forth[second], forth[first]) * 180.0 / std::numbers::pi;
    degrees = std::round(degrees * kTenths) / kTenths;
    if (degrees == 0.0) return kAxisNames[first];
    if (degrees == 90.0) return kAxisNames[second];
    return kAxisNames[first] + std::string(degrees > 0.0 ? "+" : "") + CodeNumber(degrees);
}
