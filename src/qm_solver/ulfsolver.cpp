#include "qm_solver/ulfsolver.h"

#include "qm_solver/factors/ulflinear.h"
#include "qm_solver/factors/ulfsquare.h"

T_ULF_ANSWER SolveUlf(const T_ULF_PROBLEM& problem)
{
    if (problem.objective < 1 || problem.objective > 3) {
        T_ULF_ANSWER unknown;
        unknown.code = ULF_UNKNOWN_OBJECTIVE;
        return unknown;
    }
    const T_ULF_SCALED scaled = ScaleUlf(problem);
    T_ULF_ANSWER answer;
    for (const auto precision : {ULF_PRECISION::Double, ULF_PRECISION::LongDouble}) {
        answer = problem.objective == 2 ? SolveUlfSquare(problem, scaled, precision)
                                        : SolveUlfLinear(problem, scaled, precision);
        // Rows that nearly repeat each other: what rounding has lost is there in longer numbers.
        if (answer.code != ULF_NOT_CERTIFIED && answer.code != ULF_ITERATION_LIMIT) break;
    }
    return answer;
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
