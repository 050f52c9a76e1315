// Analysis of a structure that is built in stages.
#pragma once

#include "qm_solver/framesolver.h"
#include "qm_solver/stagedmodel.h"

namespace solver {

/// Sums of load cases by their group.
enum class STAGE_SUM { Dead, Erection, Rest, All };

/// What runs have cost since Prepare.
struct T_STAGED_COST {
    std::size_t analyses = 0;       // symbolic, one for each active part that differs
    std::size_t factorisations = 0; // numeric
    std::size_t iterations = 0;     // the most that a step took; 1 without second order
    T_ACCURACY accuracy;            // of the displacements that are known worst
};

/// Forward analysis in total form. In each step, for each load case c on its own,
///   K u_c = P_c + sum over elements of (K_e b_ce + their initial forces) - K held_c,
/// K being that of the active elements and supports, b_ce the displacement of an element's nodes at
/// its birth, and held_c what supports (and diaphragms and equal displacements that gained nodes)
/// hold: the displacement that was there when they came. Forces of an element follow from u - b. An
/// element, support or load that goes is left out. So what stays behind when a load goes belongs to
/// its case, and the results of cases superpose.
///
/// Loads: the weight of a case with self weight comes with each element that is born while it acts.
/// Temperature, initial tension and settlement go with their element or support; forces on what
/// goes or is not there are an error.
///
/// Geometric stiffness: K(N) = K_E + K_G(N), N the axial force by all load cases together. K_G acts
/// on the whole displacement, also that before the element's birth: the force lies along the
/// displaced chord. Given N the cases stay linear and superpose. Sag: E A of a cable becomes
///   E A / (1 + (w a)^2 E A / (12 N^3)),
/// w weight per length, a length in plan (Z is vertical): the tangent of the parabola at N (Ernst,
/// Der E-Modul von Seilen unter Beruecksichtigung des Durchhanges, Der Bauingenieur 40, 1965). It
/// is taken over the whole stretch since birth, so that the force is N = T + E_eq A / L times
/// stretch, T the initial tension (and temperature): near N = T it is exact, away from it the
/// stretch is that of the tangent. At least 1e-3 E; without tension this least. N by accelerated
/// fixed-point iteration in each step until displacements and N change by 1e-12 of the largest (or
/// by no less than before, below 1e-9: rounding); at most 50, else NotConverged.
class CStagedSolver {
public:
    CStagedSolver();
    ~CStagedSolver();
    CStagedSolver(CStagedSolver&&) noexcept;
    CStagedSolver& operator=(CStagedSolver&&) noexcept;

    /// Checks the stages and does the symbolic part for each active part. 1 done; 0 error filled
    /// (with the stage) and the solver holds no model.
    [[nodiscard]] int Prepare(const T_STAGED_MODEL& model, T_SOLVER_ERROR& error);

    /// Another solver of the same prepared model, without results, that repeats no symbolic part.
    /// Both share their factors: only one of them may run at a time, while results of the other can
    /// be read. Without a prepared model it has none either.
    [[nodiscard]] CStagedSolver Again() const;

    /// Runs all stages with these load cases; again with others as often as wanted, which repeats
    /// no symbolic part. Progress counts steps. 1 done; 0 error filled (stage, load case), no
    /// results.
    [[nodiscard]] int Run(std::span<const T_LOAD_CASE> cases, T_SOLVER_ERROR& error,
                          const ProgressFn& progress = {});

    std::size_t StageCount() const;
    int StepCount(std::size_t stage) const;
    const T_STAGED_COST& Cost() const;

    /// Results at the end of a step: the sum of factor times load case, one factor per case. What
    /// is not there has zeros. Each call goes through the model once. 1 done; 0 there is no such
    /// result, `out` cleared.
    [[nodiscard]] int Read(std::size_t stage, int step, std::span<const double> factors,
                           T_RESULT& out) const;
    [[nodiscard]] int ReadCase(std::size_t stage, int step, std::size_t loadCase,
                               T_RESULT& out) const;
    [[nodiscard]] int ReadSum(std::size_t stage, int step, STAGE_SUM sum, T_RESULT& out) const;

private:
    struct T_STATE;
    std::unique_ptr<T_STATE> m_state;
};

} // namespace solver
