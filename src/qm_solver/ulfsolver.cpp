#include "qm_solver/ulfsolver.h"

#include "qm_solver/factors/ulflinear.h"
#include "qm_solver/factors/ulfsquare.h"

namespace {

T_ULF_ANSWER SolveScaled(const T_ULF_PROBLEM& problem, const T_ULF_SCALED& scaled)
{
    T_ULF_ANSWER answer;
    for (const auto precision : {ULF_PRECISION::Double, ULF_PRECISION::LongDouble}) {
        answer = problem.objective == 2 ? SolveUlfSquare(problem, scaled, precision)
                                        : SolveUlfLinear(problem, scaled, precision);
        // Rows that nearly repeat each other: what rounding has lost is there in longer numbers.
        if (answer.code != ULF_NOT_CERTIFIED && answer.code != ULF_ITERATION_LIMIT) break;
    }
    return answer;
}

} // namespace

/// Where sizes of columns can't be told from units of rows, that metric may be worse than that of
/// the weights, which then decides.
T_ULF_ANSWER SolveUlf(const T_ULF_PROBLEM& problem)
{
    if (problem.objective < 1 || problem.objective > 3) {
        T_ULF_ANSWER unknown;
        unknown.code = ULF_UNKNOWN_OBJECTIVE;
        return unknown;
    }
    const T_ULF_SCALED scaled = ScaleUlf(problem);
    T_ULF_ANSWER answer = SolveScaled(problem, scaled);
    std::vector<long double> weights = UlfWeights(problem.weights);
    if (answer.code == ULF_SOLVED || scaled.metric == weights) return answer;
    T_ULF_ANSWER other = SolveScaled(problem, ScaleUlf(problem, std::move(weights)));
    if (other.code != ULF_SOLVED) return answer;
    // Beside a column that is felt much more, its rows would forgive what others miss.
    if (CertifyUlf(problem, scaled, other.x, other.multipliers).violation > kUlfFeasibleTol)
        return answer;
    other.byWeights = true;
    return other;
}

T_ULF_ANSWER MeetUlf(const T_ULF_PROBLEM& problem)
{
    const T_ULF_SCALED scaled = ScaleUlf(problem);
    T_ULF_ANSWER answer;
    for (const auto precision : {ULF_PRECISION::Double, ULF_PRECISION::LongDouble}) {
        std::vector<long double> y;
        answer = MeetUlf(scaled, precision, y);
        if (answer.code == ULF_ITERATION_LIMIT) continue;
        if (answer.code != ULF_SOLVED) break; // a contradiction, with its proof
        const T_ULF_CERTIFICATE met =
            CertifyUlf(problem, scaled, UnscaleUlf(scaled, y), answer.multipliers);
        if (met.violation <= kUlfFeasibleTol) break;
        answer.code = met.violation <= kUlfRelaxedTol ? ULF_RELAXED : ULF_NOT_CERTIFIED;
    }
    return answer;
}
