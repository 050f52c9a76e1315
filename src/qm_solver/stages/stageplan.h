// The stages of a staged model as a timetable: what is active when.
#pragma once

#include "qm_solver/frameresult.h"
#include "qm_solver/stagedmodel.h"

#include <optional>

namespace solver {

/// What stands in a stage.
struct T_ACTIVE {
    std::vector<std::size_t> elements; // ascending
    std::vector<T_DIRS6> held;         // by node
    bool operator==(const T_ACTIVE&) const = default;
};

/// Load cases that change at a step.
struct T_LOAD_CHANGE {
    std::vector<std::size_t> off, on;
};

struct T_STAGE_PLAN {
    std::vector<T_ACTIVE> active;                   // by stage
    std::vector<std::vector<T_LOAD_CHANGE>> change; // by stage and step from 0
    std::vector<int> bornIn;                        // by element: the stage, -1 never
};

/// The first fault of the stages as BadModel with stage and element, node or load case; else the
/// plan is filled: an element is born once and leaves once, supports and loads come only when they
/// are away and go only when they are there, steps exist.
std::optional<T_SOLVER_ERROR> MakePlan(const T_STAGED_MODEL& model, T_STAGE_PLAN& plan);

} // namespace solver
