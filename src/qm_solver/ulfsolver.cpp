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
    return problem.objective == 2 ? SolveUlfSquare(problem, scaled)
                                  : SolveUlfLinear(problem, scaled);
}
