// Pushover load cases as stages of the engine.
#pragma once

#include "qm_db/recordfacts.h"
#include "qm_rps/push/pushpatterns.h"

#include <optional>

/// One result of a load case: the case itself, or one of the directions of its static angle.
struct T_PUSH_CASE {
    std::string name; // of a direction "NAME@90"
    int key = 0;
    std::optional<double> angle; // degrees
    int turn = 0;                // so many times the static angle
    std::size_t direction = 0;   // 0 to 5: X to RZ; of a turned case the axis nearest to `along`
    solver::T_VEC3 along{};      // unit vector of displacement and base reaction; 0: a rotation
    std::size_t controlNode = 0; // of the engine
    /// Those of the cases that it starts from, the first one first; its own is the last.
    std::vector<solver::T_PUSH_STAGE> stages;
    std::vector<double> evaluated{}; // of its additional displacements: asked for by evaluations
};
/// Displacements of one push that are so near are the same; of the value.
inline constexpr double kSameDisplacement = 1e-9;

/// What several load cases of a model can be run on: loads before the push, and P-Delta.
struct T_PUSH_BASIS {
    std::vector<T_PUSH_INITIAL_LOAD> initialLoads;
    PUSH_P_DELTA pDelta = PUSH_P_DELTA::None;
    bool operator==(const T_PUSH_BASIS&) const = default;
};

/// The chain of load cases that end in this one, the first one first: keys. 1 done; 0 `error` says
/// which is missing, goes in a circle, or can't be pushed.
[[nodiscard]] int PushChainOf(const T_MODEL& model, int key, std::vector<int>& out,
                              std::string& error);
/// The basis of a chain is that of its first case.
[[nodiscard]] int PushBasisOf(const T_MODEL& model, const std::vector<int>& chain,
                              T_PUSH_BASIS& out, std::string& error);

/// The results of a load case. An increment function gives the stored steps: at each whole number
/// of its steps, and at its last one, the fraction of the load (of the displacement, where that is
/// controlled) that its rows say, straight between them, from 0. With a static angle the loads, the
/// direction of control and the displacement are turned by it, twice it ... below 360 degrees.
/// 1 done; 0 `error` says why; `out` unchanged.
[[nodiscard]] int BuildPushCases(const T_MODEL& model, const CAnalysisModel& frame,
                                 const std::vector<int>& chain, const MODE_SHAPE_FN& modeShape,
                                 std::vector<T_PUSH_CASE>& out, std::string& error);

/// Stored steps as fractions of the way to the target, and the fraction of the load or displacement
/// that the target is.
struct T_PUSH_INCREMENTS {
    std::vector<double> fractions; // rising, the last is 1
    double target = 1.0;
};
T_PUSH_INCREMENTS EqualIncrements(int count);
T_PUSH_INCREMENTS IncrementsOf(const T_POFC_D& function);
