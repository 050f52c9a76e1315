// Load factor optimizer: finds the factors of unknown load cases so that constraints on responses
// hold, either as a square system of equations or as the minimum of an objective.
#pragma once

#include "qm_rps/factors/optproblem.h"

class COptDsgn {
public:
    /// The solver's interface, see CRps_UnknownLoadFactorManager::Calc_UnknownLoadFactor: mode (1
    /// optimise, 0 equations), NCON, NVAR, NEQ, matrix, right-hand sides, factors (written),
    /// weights, IOBJ, ISIGN, error code (written). Not 0: done.
    using Solver =
        std::function<int(int mode, int ncon, int nvar, int neq, std::span<const double> matrix,
                          std::span<const double> rhs, std::span<double> factors,
                          std::span<const double> weights, int iobj, int isign, int& code)>;

    /// Sources of responses; not owned, must outlive this object. A construction-stage problem
    /// needs the second one.
    explicit COptDsgn(IUlfResponse& staticSource, IUlfResponse* stageSource = nullptr);

    T_OPT_DUMP m_dump; // where the problem is written as the solver gets it; as made: nowhere
    /// Another solver than the one of this library.
    void SetSolver(Solver solver) { m_solver = std::move(solver); }

    /// 1 factors found; 0 not: key and message say why and the factors are 0. What the run did
    /// learn (coefficients, system, code) is filled in both cases.
    [[nodiscard]] int Run(const T_OPT_PROBLEM& problem, T_OPT_ANSWER& answer);

private:
    [[nodiscard]] int CheckProblem(const T_OPT_PROBLEM& problem, T_OPT_ANSWER& answer) const;
    [[nodiscard]] int ReadRows(const T_OPT_PROBLEM& problem, std::vector<T_OPT_ROW>& rows,
                               T_OPT_ANSWER& answer);
    int CallSolver(const T_OPT_PROBLEM& problem, T_OPT_ANSWER& answer);
    [[nodiscard]] int SolveExact(const T_OPT_PROBLEM& problem, T_OPT_ANSWER& answer);
    [[nodiscard]] int SolveOptimum(const T_OPT_PROBLEM& problem, T_OPT_ANSWER& answer);

    IUlfResponse& m_static;
    IUlfResponse* m_stage;
    Solver m_solver;
};
