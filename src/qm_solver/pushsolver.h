// Nonlinear static analysis of a frame with plastic hinges, from event to event.
#pragma once

#include "qm_solver/pushresult.h"

#include <memory>

namespace solver {

/// The elastic frame is factorised once; all that is plastic lives in the small space of the
/// hinges: forces s = s0 + lambda sL + Z q, Z the influence of unit plastic deformations. Laws are
/// piecewise linear, so the path is too and its vertices are found exactly.
class CPushSolver {
public:
    CPushSolver();
    ~CPushSolver();
    CPushSolver(CPushSolver&&) noexcept;
    CPushSolver& operator=(CPushSolver&&) noexcept;

    /// Checks frame and hinges, assembles and factorises. 1 done; 0 error filled (a hinge at fault
    /// is named by its element) and the solver holds no model.
    [[nodiscard]] int Prepare(T_PUSH_MODEL model, T_SOLVER_ERROR& error);

    /// Modes of the prepared model with the springs of its hinges, without loads; see CFrameSolver.
    [[nodiscard]] int Modes(std::size_t count, std::vector<T_MODE>& out, T_SOLVER_ERROR& error);

    /// Pushes through these stages, which go one after the other from the initial loads on; the
    /// factor is kept, so that several runs cost one. 1 done, `end` says how; 0 error filled.
    [[nodiscard]] int Run(std::span<const T_PUSH_STAGE> stages, const T_PUSH_SINK& sink,
                          T_PUSH_END& end, T_SOLVER_ERROR& error);

    const T_PUSH_COST& Cost() const;

    /// Forces of all elements in a step of the last run, the starts of its stages included, by the
    /// model's indices.
    [[nodiscard]] int Forces(const T_PUSH_STEP& step, T_RESULT& out, T_SOLVER_ERROR& error);

private:
    struct T_STATE;
    std::unique_ptr<T_STATE> m_state;
};

} // namespace solver
