// Forces and rotations of member ends in the steps of a push. SI.
#pragma once

#include "qm_rps/push/endforces.h"

/// A beam element: flexible length between its rigid offsets, local axes.
struct T_MEMBER_AXES {
    int nodeI = 0, nodeJ = 0; // ids
    std::array<double, 3> offsetI{}, offsetJ{};
    std::array<double, 3> x{}, y{}, z{};
    double length = 0.0;
};
/// Nothing where the offsets leave no length.
std::optional<T_MEMBER_AXES> AxesOf(const T_MODEL& model, const T_ELEM_D& element);

/// Forces and deformations of an end.
struct T_END_STATE : T_END_FORCES {
    double chord = 0.0;  // rotation of the end, that of its hinge included, less that of the chord;
                         // of a brace its elongation
    double flowed = 0.0; // deformation of the hinge at the end, 0 without one
    double hingeMoment = 0.0; // of a brace: force
    double largestV = 0.0;    // magnitude, up to this state
};
inline constexpr std::array<double T_END_STATE::*, 8> kEndStateMembers{
    &T_END_STATE::N,     &T_END_STATE::M,      &T_END_STATE::V,           &T_END_STATE::across,
    &T_END_STATE::chord, &T_END_STATE::flowed, &T_END_STATE::hingeMoment, &T_END_STATE::largestV};
/// On the straight line from a (0) to b (1); beyond them too.
T_END_STATE Between(const T_END_STATE& a, const T_END_STATE& b, double at);

/// The state of an end in a step. `hinge`: its component among those of the run; -1: none.
T_END_STATE EndState(const T_END_PLACE& place, const T_MEMBER_AXES& axes, long hinge,
                     const T_STEP_FORCES& step);

/// A path of states: straight from each to the next one. Index 0 is the state that the push starts
/// from.
struct T_JUDGED_PATH {
    std::vector<T_END_STATE> gravity; // by end, under the initial loads alone; empty: not known
    std::vector<double> displacement, baseReaction; // of the control, totals
    std::vector<std::vector<T_END_STATE>> ends;     // by state and end
};
/// Index of the first state with the largest base reaction, by its magnitude in the direction of
/// the push.
std::size_t LargestShearAt(const T_JUDGED_PATH& path);
