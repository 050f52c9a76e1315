// What the nonlinear push gives: stored steps, the vertices of the path, and how it ended.
#pragma once

#include "qm_solver/frameresult.h"
#include "qm_solver/pushmodel.h"

#include <functional>
#include <span>

namespace solver {

/// Part of a backbone that a hinge component is on: 0 not yet flowed, k between vertex k and k + 1
/// (counting from 1), the number of vertices beyond the last one. Negative side: negative.
using T_HINGE_PLACE = int;

/// State of one law of a hinge.
struct T_HINGE_STATE {
    double deformation = 0.0; // of the hinge, beyond the elastic member, with its sign
    double force = 0.0;       // moment or force, with its sign
    T_HINGE_PLACE place = 0;  // the furthest part of the side that is loaded or was loaded last
};

/// A stored step. Displacements and reactions are totals, the initial loads included.
struct T_PUSH_STEP {
    std::size_t stage = 0;     // of the list that was run
    double loadFactor = 0.0;   // of the loads of the stage
    double displacement = 0.0; // of the control node along the control, total
    T_VEC6 base{};             // sum of the reactions, forces and moments about the origin, global
    double residual = 0.0;     // forces out of balance over the largest force, whole structure
    bool additional = false;   // asked for by the user
    std::vector<T_VEC6> nodes; // displacements by node, global
    std::vector<T_HINGE_STATE> hinges; // law after law, hinge after hinge
    std::vector<double> axial;         // by hinge: axial force at its place, tension positive
};

/// What a hinge does at a vertex of the path.
enum class HINGE_TURN {
    Point,   // reached a vertex of its backbone: `point` counts from 1 (yield)
    Unload,  // left the backbone
    Reload,  // came back to it
    Slip,    // began to move without force
    Contact, // came to the end of its gap, or of its slip
    Leap     // gave way where no path of equilibrium leads on
};

/// One hinge at a vertex of the path.
struct T_HINGE_EVENT {
    std::size_t hinge = 0, law = 0;      // places in the model's hinges and in their laws
    HINGE_TURN turn = HINGE_TURN::Point; // what it does
    int point = 0;                       // of a vertex
    bool positive = true;                // side
};

/// A vertex of the path. Stage -1: the initial loads.
struct T_PUSH_EVENT {
    int stage = 0;
    double loadFactor = 0.0, displacement = 0.0; // as in a step
    T_VEC6 base{};                               // as in a step
    std::vector<T_HINGE_EVENT> hinges;           // those that turn there, together
};

/// How a run ended.
enum class PUSH_OUTCOME {
    Reached,       // the target
    NoEquilibrium, // load control: the largest load that the structure carries
    DriftStop,     // the stops that were asked for
    PeakFractionStop,
    StiffnessStop,
    MarkStop,
    StrengthLossStop,
    LastPointStop,
    InitialLoads,  // the structure does not carry them
    NoPath,        // no way on: the hinges allow none in which they all go on loading
    SnapBack,      // the control displacement fell back to its start
    AxialStrength, // an axial force beyond the interaction curve of a hinge
    TooManyEvents,
    OutOfBalance, // a step does not keep equilibrium
    Cancelled,
    Mechanism,      // that does not move the control node, under loads that can't grow
    ReachedByLeaps, // the target, over places without a path of equilibrium
};

/// The end of a run, and what brought it about.
struct T_PUSH_END {
    PUSH_OUTCOME outcome = PUSH_OUTCOME::Reached; // why
    std::size_t stage = 0;                        // where
    double loadFactor = 0.0, displacement = 0.0;  // where it ended
    long hinge = -1;                              // the one that ended it, -1 none
    long drift = -1;                              // entry of the model's drifts
};

/// Work of one run, for statements about its cost.
struct T_PUSH_COST {
    std::size_t events = 0, columns = 0, factorisations = 0, solves = 0;
};

/// Receives steps and events in their order while the run goes on.
struct T_PUSH_SINK {
    std::function<bool(const T_PUSH_STEP&)> step;   // false: cancel
    std::function<void(const T_PUSH_EVENT&)> event; // may be empty
    /// State before the first step of a stage: load factor 0. May be empty.
    std::function<void(const T_PUSH_STEP&)> start;
};

} // namespace solver
