// Small structures with plastic hinges, and how they are pushed.
#pragma once

#include "frames.h"
#include "qm_solver/pushsolver.h"

namespace sample {

inline T_HINGE_SIDE Side(std::vector<T_BACKBONE_POINT> points,
                         UNLOADING unloading = UNLOADING::Elastic)
{
    T_HINGE_SIDE side;
    side.points = std::move(points);
    side.unloading = unloading;
    return side;
}

/// A column of length 2 along Z, clamped below; E I 100 about both axes, A 1e4.
inline T_PUSH_MODEL Column()
{
    T_PUSH_MODEL model;
    model.frame = Empty();
    AddNode(model.frame, {0, 0, 0});
    AddNode(model.frame, {0, 0, 2});
    Fix(model.frame, 0, {0, 1, 2, 3, 4, 5});
    Join(model.frame, ELEMENT_KIND::Beam, 0, 1);
    model.frame.materials[0].E = 100.0;
    model.frame.sections[0].Iy = model.frame.sections[0].Iz = 1.0;
    model.frame.sections[0].A = 1e4;
    return model;
}

/// The same law for both signs of My at a place of an element.
inline void AddHinge(T_PUSH_MODEL& model, const T_HINGE_SIDE& side, std::size_t element = 0,
                     double at = 0.0)
{
    T_PUSH_HINGE hinge;
    hinge.element = element;
    hinge.at = at;
    hinge.laws.push_back({4, side, side, 0.0, {}});
    model.hinges.push_back(hinge);
}

/// A unit force at a node along a direction, by displacement of that node.
inline T_PUSH_STAGE PushTo(double target, std::size_t node = 1, int direction = 0)
{
    T_PUSH_STAGE stage;
    T_NODAL_LOAD load;
    load.node = node;
    load.load[static_cast<std::size_t>(direction)] = 1.0;
    stage.loads.nodal.push_back(load);
    stage.node = node;
    stage.direction = direction;
    stage.target = target;
    return stage;
}

struct T_PUSHED {
    CPushSolver solver;
    std::vector<T_PUSH_STEP> steps;
    std::vector<T_PUSH_EVENT> events;
    T_PUSH_END end;
    T_SOLVER_ERROR error;
    int done = 0;
};

/// mostSteps: after so many the run is cancelled.
inline T_PUSHED Pushed(const T_PUSH_MODEL& model, std::vector<T_PUSH_STAGE> stages,
                       std::size_t mostSteps = 1000)
{
    T_PUSHED run;
    T_PUSH_SINK sink;
    sink.step = [&](const T_PUSH_STEP& step) {
        run.steps.push_back(step);
        return run.steps.size() < mostSteps;
    };
    sink.event = [&](const T_PUSH_EVENT& event) { run.events.push_back(event); };
    run.done =
        run.solver.Prepare(model, run.error) && run.solver.Run(stages, sink, run.end, run.error);
    return run;
}

} // namespace sample
