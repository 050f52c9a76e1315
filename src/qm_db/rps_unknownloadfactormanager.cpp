#include "qm_db/rps_unknownloadfactormanager.h"

#include "qm_solver/ulfexact.h"
#include "qm_solver/ulfsolver.h"

#include <algorithm>
#include <exception>
#include <vector>

namespace {

enum MODE : int { EQUATIONS = 0, OPTIMISE = 1 };

} // namespace

int CRps_UnknownLoadFactorManager::Calc_UnknownLoadFactor(int mode, int ncon, int nvar, int neq,
                                                          std::span<const double> coefficients,
                                                          std::span<const double> rhs,
                                                          std::span<double> factors,
                                                          std::span<const double> weights, int iobj,
                                                          int isign, int& error)
{
    std::fill(factors.begin(), factors.end(), 0.0);
    error = ULF_BAD_INPUT;
    const bool isExact = mode == EQUATIONS;
    const T_ULF_PROBLEM problem{nvar, isExact ? 0 : neq,  coefficients, rhs, weights,
                                iobj, isExact ? 0 : isign};
    if ((mode != OPTIMISE && !isExact) || ncon < 0 || rhs.size() != static_cast<std::size_t>(ncon))
        return 1;
    if (!CheckUlfProblem(problem) || factors.size() != weights.size()) return 1;
    try {
        std::vector<double> x;
        if (isExact) {
            T_ULF_EXACT exact;
            if (!SolveUlfExact(problem, exact)) return 1;
            error = exact.unmet.empty() ? ULF_SOLVED : ULF_EQUALITIES_CONTRADICT;
            // Of the many solutions of equations that repeat each other the objective chooses.
            const T_ULF_PROBLEM loose{nvar, ncon, coefficients, rhs, weights, iobj, isign};
            if (exact.rank < nvar && error == ULF_SOLVED && CheckUlfProblem(loose))
                if (T_ULF_ANSWER best = SolveUlf(loose); !best.x.empty()) exact.x = best.x;
            x = std::move(exact.x);
        } else {
            T_ULF_ANSWER answer = SolveUlf(problem);
            x = std::move(answer.x);
            error = answer.code;
        }
        std::copy(x.begin(), x.end(), factors.begin());
    } catch (const std::exception&) { // out of memory
        error = ULF_NOT_CERTIFIED;
    }
    return error == ULF_NOT_CERTIFIED ? 0 : 1;
}
