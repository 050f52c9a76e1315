// Linear static analysis of a frame, and its modes. Direct stiffness method with a sparse direct
// factorisation that all load cases share.
#pragma once

#include "qm_solver/frameresult.h"

#include <functional>
#include <memory>
#include <span>

namespace solver {

/// Progress of a long run: done and total parts; returns false to cancel.
using ProgressFn = std::function<bool(std::size_t done, std::size_t total)>;

class CFrameSolver {
public:
    CFrameSolver();
    ~CFrameSolver();
    CFrameSolver(CFrameSolver&&) noexcept;
    CFrameSolver& operator=(CFrameSolver&&) noexcept;

    /// Checks the model, assembles and factorises. 1 done; 0 error filled and the solver holds no
    /// model. A model that can move is a Mechanism: the error names the part, node and direction.
    [[nodiscard]] int Prepare(const T_FRAME& frame, T_SOLVER_ERROR& error);

    /// Solves load cases of the prepared model; results in their order. Right-hand sides go in
    /// blocks. 1 done; 0 error filled, `out` cleared.
    [[nodiscard]] int Solve(std::span<const T_LOAD_CASE> cases, std::vector<T_RESULT>& out,
                            T_SOLVER_ERROR& error, const ProgressFn& progress = {});

    /// The lowest modes of the prepared model, ascending in frequency, at most as many as there are
    /// degrees of freedom with mass. Mass: nodal masses and, with density, half of each beam's and
    /// truss's mass at either node. 1 done; 0 error filled, `out` cleared.
    [[nodiscard]] int Modes(std::size_t count, std::vector<T_MODE>& out, T_SOLVER_ERROR& error,
                            const ProgressFn& progress = {});

private:
    struct T_STATE;
    std::unique_ptr<T_STATE> m_state;
};

} // namespace solver
