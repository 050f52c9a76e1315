#include "qm_rps/judge/endstate.h"

#include "qm_rps/judge/vectors.h"

#include <algorithm>
#include <cmath>

namespace {

/// Length; the vector becomes a unit vector. 0: it is none.
double Normalise(T_VECTOR& v)
{
    const double size = std::sqrt(Dot(v, v));
    if (size > 0.0)
        for (double& c : v)
            c /= size;
    return size;
}

/// Displacement and rotation of a node in a step; nodes without any are at rest.
T_DOF6 MoveOf(const T_RUN_DATA& data, std::size_t step, int node)
{
    const auto at = std::ranges::lower_bound(data.nodes, node);
    if (at == data.nodes.end() || *at != node) return {};
    return data.displacement[step][static_cast<std::size_t>(at - data.nodes.begin())];
}

/// The end of the flexible part moves with its node, rigidly.
T_VECTOR EndMove(const T_DOF6& node, const T_VECTOR& offset)
{
    return Plus({node[0], node[1], node[2]}, Cross({node[3], node[4], node[5]}, offset), 1.0);
}

/// Of the J-end of the flexible part from the I-end.
T_VECTOR MovedApart(const T_MEMBER_AXES& axes, const T_DOF6& i, const T_DOF6& j)
{
    return Plus(EndMove(j, axes.offsetJ), EndMove(i, axes.offsetI), -1.0);
}

double ChordRotation(const T_END_PLACE& place, const T_MEMBER_AXES& axes, const T_RUN_DATA& data,
                     std::size_t step)
{
    const T_DOF6 i = MoveOf(data, step, axes.nodeI), j = MoveOf(data, step, axes.nodeJ);
    const T_VECTOR moved = MovedApart(axes, i, j);
    const T_DOF6& own = place.atJ ? j : i;
    const T_VECTOR turn{own[3], own[4], own[5]};
    // A right-hand turn about y moves +x towards -z, one about z towards +y.
    if (place.component == HINGE_COMPONENT::My)
        return Dot(turn, axes.y) + Dot(moved, axes.z) / axes.length;
    return Dot(turn, axes.z) - Dot(moved, axes.y) / axes.length;
}

} // namespace

std::optional<T_MEMBER_AXES> AxesOf(const T_MODEL& model, const T_ELEM_D& e)
{
    constexpr double kVertical = 1e-6;
    T_MEMBER_AXES axes;
    axes.nodeI = e.nodeI;
    axes.nodeJ = e.nodeJ;
    axes.offsetI = e.offset.I;
    axes.offsetJ = e.offset.J;
    axes.x = Plus(Plus(model.nodes.at(e.nodeJ).xyz, e.offset.J, 1.0),
                  Plus(model.nodes.at(e.nodeI).xyz, e.offset.I, 1.0), -1.0);
    axes.length = Normalise(axes.x);
    if (!(axes.length > 0.0)) return {};
    T_VECTOR reference = e.zAxis;
    if (reference == T_VECTOR{})
        reference = std::hypot(axes.x[0], axes.x[1]) < kVertical ? T_VECTOR{1.0, 0.0, 0.0}
                                                                 : T_VECTOR{0.0, 0.0, 1.0};
    axes.z = Plus(reference, axes.x, -Dot(reference, axes.x));
    if (!(Normalise(axes.z) > 0.0)) return {};
    axes.y = Cross(axes.z, axes.x);
    return axes;
}

T_END_STATE Between(const T_END_STATE& a, const T_END_STATE& b, double at)
{
    T_END_STATE s;
    for (double T_END_STATE::*m : kEndStateMembers)
        s.*m = a.*m + at * (b.*m - a.*m);
    return s;
}

T_END_STATE EndState(const T_END_PLACE& place, const T_MEMBER_AXES& axes, long hinge,
                     const T_STEP_FORCES& step)
{
    T_END_STATE s{EndForces(place, step)};
    if (place.component == HINGE_COMPONENT::Fx) {
        s.chord = Dot(MovedApart(axes, MoveOf(step.run.data, step.step, axes.nodeI),
                                 MoveOf(step.run.data, step.step, axes.nodeJ)),
                      axes.x);
    } else {
        s.chord = ChordRotation(place, axes, step.run.data, step.step);
    }
    if (hinge < 0) return s;
    const T_PUSH_HINGE_SERIES& series = step.run.hinges[static_cast<std::size_t>(hinge)];
    s.flowed = series.deformation[step.step];
    s.hingeMoment = series.force[step.step];
    return s;
}

std::size_t LargestShearAt(const T_JUDGED_PATH& path)
{
    constexpr double kSame = 1e-9; // of the largest: a level branch has its first state
    if (path.displacement.empty()) return 0;
    // Reaction and displacement have one sign while the push goes on; what unloads first counts.
    const double way = path.displacement.back() < path.displacement.front() ? -1.0 : 1.0;
    double largest = 0.0;
    for (const double v : path.baseReaction)
        largest = std::max(largest, way * v);
    const auto at = std::ranges::find_if(
        path.baseReaction, [&](double v) { return way * v >= largest * (1.0 - kSame); });
    return at == path.baseReaction.end() ? 0
                                         : static_cast<std::size_t>(at - path.baseReaction.begin());
}
