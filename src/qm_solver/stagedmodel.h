// What the analysis in construction stages takes: a frame, and what comes and goes at each stage.
#pragma once

#include "qm_solver/framemodel.h"

namespace solver {

/// Steps of a stage count from 1. The last one, whatever its number:
inline constexpr int kLastStep = -1;
/// The step at which elements and supports change.
inline constexpr int kFirstStep = 1;

/// Directions in which the ground holds a node. All false: when a support comes, those of the
/// node's `fixed`; when it goes, all that hold it.
struct T_STAGE_SUPPORT {
    std::size_t node = 0; // place in T_FRAME::nodes
    T_DIRS6 directions{}; // true: held there
};

/// A load case that comes or goes at the beginning of a step.
struct T_STAGE_LOAD {
    std::size_t loadCase = 0; // place among the load cases of the analysis
    int step = kFirstStep;    // from 1, or kLastStep
};

/// Elements and supports change at the first step, what goes before what comes; loads at theirs.
struct T_STAGE {
    std::vector<std::size_t> activateElements, deactivateElements;
    std::vector<T_STAGE_SUPPORT> activateSupports, deactivateSupports;
    std::vector<T_STAGE_LOAD> activateLoads, deactivateLoads;
    int steps = 1;         // at least 1
    double duration = 0.0; // in the user's unit of time; no result depends on it
};

/// Sums of load cases that stages keep beside the load cases themselves.
enum class LOAD_GROUP { Dead, Erection, Rest };

/// How an element joins a structure that has moved.
enum class BIRTH {
    /// Free of stress between its nodes where they are; a node that no element joined before is at
    /// its design position.
    OnDeformed,
    /// Its shape free of stress is that of the design: it is forced between displaced nodes.
    ToDesign,
};

/// How the stages are analysed.
struct T_STAGED_OPTIONS {
    BIRTH birth = BIRTH::OnDeformed; // of elements that come
    bool geometricStiffness = false; // of the axial forces of beams and trusses
    bool cableSag = false;           // equivalent modulus of cables
};

/// Nothing stands and no support holds before a stage activates it.
struct T_STAGED_MODEL {
    T_FRAME frame;
    std::vector<T_STAGE> stages;    // in the order of construction
    std::vector<LOAD_GROUP> groups; // by load case: their number is that of the load cases
    /// By element: trusses that sag, beside those with initial tension in a load case. May be
    /// empty.
    std::vector<char> cable;
    T_STAGED_OPTIONS options;
};

} // namespace solver
