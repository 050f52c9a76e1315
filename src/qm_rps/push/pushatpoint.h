// What every hinge does at given displacements of the control node.
#pragma once

#include "qm_rps/push/pushrun.h"

enum class PUSH_POINT { Performance, Demand, Capacity };

/// A displacement of the control node that has a name.
struct T_PUSH_POINT {
    PUSH_POINT kind = PUSH_POINT::Performance;
    std::string state;         // of a demand or capacity: the limit state
    double displacement = 0.0; // m
};

/// A component that has flowed. The ratio is its deformation over that of CP, of a law without
/// acceptance criteria over that of C; empty where the law has neither.
struct T_HINGE_AT_POINT {
    T_PUSH_LAW_PLACE place;
    double deformation = 0.0, force = 0.0; // SI, with their signs
    PUSH_STATE state = PUSH_STATE::Elastic;
    std::optional<double> ratio;
};

struct T_STOREY_AT_POINT {
    std::string name;
    double displacement = 0.0, drift = 0.0;
    std::optional<double> shear; // empty: not known
};

enum class AT_POINT {
    Reached,
    Beyond, // the push ends before
    NoStep, // nearer, but no step: the push starts behind it, or is controlled by something else
};

struct T_PUSH_AT_POINT {
    T_PUSH_POINT point;
    AT_POINT found = AT_POINT::Beyond; // what follows is of a point that was reached
    int step = 0;                      // of the run, from 1
    double loadFactor = 0.0;
    std::array<std::size_t, kPushStateNames.size()> states{}; // components by state
    /// At most kMostWorst, none is elastic: those beyond C, then by falling ratio, equal ones by
    /// element, place on it and component.
    std::vector<T_HINGE_AT_POINT> worst;
    std::vector<T_STOREY_AT_POINT> storeys;
};
inline constexpr std::size_t kMostWorst = 10;

/// What a ratio counts in: "CP" or "C".
const char* RatioOf(const T_PUSH_LAW_PLACE& place);

/// The points of a run that has them as steps; of several steps there the first one.
std::vector<T_PUSH_AT_POINT> PushAtPoints(const T_PUSH_RUN& run,
                                          const std::vector<T_PUSH_POINT>& points);

/// The points of an evaluation on the push that it rests on.
struct T_HINGES_AT {
    std::string evaluation, push;
    T_UNITS units;
    std::string note; // why there are no points although the push is ours; else empty
    std::vector<T_PUSH_AT_POINT> points; // empty: another program's push, or nothing was found
};
