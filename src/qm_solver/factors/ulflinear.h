// Smallest sum of |w x| and smallest largest |w x|.
#pragma once

#include "qm_solver/factors/ulfactiveset.h"
#include "qm_solver/factors/ulfanswer.h"

/// Objectives 1 and 3. The linear objective gets a small quadratic term (1e-2, 1e-4, 1e-6, and
/// 1e-8 for rows that nearly repeat each other); below some positive size of it the answer is the
/// optimum of the linear objective that has the smallest square sum (Mangasarian 1984), so it is
/// taken as soon as its certificate for the linear objective holds. The method starts from y = 0
/// with every |y| at its kink, which is optimal there. Otherwise the linear programming library is
/// asked (ulffallback.h), and where there is no solution MeetUlf says why.
T_ULF_ANSWER SolveUlfLinear(const T_ULF_PROBLEM& problem, const T_ULF_SCALED& scaled,
                            ULF_PRECISION precision);

/// The objective as rows and costs. Objective 1: sum of cost * |y|, with an elastic row per
/// unknown where the sign is free. Objective 3: unknown nVar is the largest cost * |y|, in `unit`.
struct T_ULF_LINEAR {
    double unit = 1.0; // of the objective
    T_ULF_ROWS rows;
    std::vector<double> cost;       // one per unknown of `rows`
    std::vector<std::size_t> start; // rows that hold y = 0
};
T_ULF_LINEAR LinearUlf(int objective, const T_ULF_SCALED& scaled);
