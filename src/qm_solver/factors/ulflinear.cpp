#include "qm_solver/factors/ulflinear.h"

#include "qm_solver/factors/ulffallback.h"
#include "qm_solver/factors/ulfsquare.h"

#include <algorithm>
#include <cmath>

namespace {

constexpr double kQuadratic[] = {1e-2, 1e-4, 1e-6, 1e-8};

/// |y| = y + 2 max(0, -y): an elastic row y >= 0 with the cap 2; with a sign |y| is linear.
T_ULF_LINEAR SumRows(const T_ULF_SCALED& s)
{
    T_ULF_LINEAR p;
    p.rows.SetWide(s.rows, s.rhs, s.nEq, s.nVar, s.nVar);
    for (std::size_t j = 0; j < s.nVar; ++j) {
        p.cost.push_back(s.sign < 0 ? -s.cost[j] : s.cost[j]);
        if (s.cost[j] > 0.0) p.start.push_back(p.rows.Size());
        if (s.sign != 0)
            p.rows.AddShort({j, static_cast<double>(-s.sign), j, 0.0});
        else if (s.cost[j] > 0.0)
            p.rows.AddShort({j, -1.0, j, 0.0}, 0.0, 2.0 * s.cost[j]);
    }
    return p;
}

/// Smallest t with cost * |y| <= t.
T_ULF_LINEAR LargestRows(const T_ULF_SCALED& s)
{
    T_ULF_LINEAR p;
    p.rows.SetWide(s.rows, s.rhs, s.nEq, s.nVar, s.nVar + 1);
    p.cost.assign(s.nVar + 1, 0.0);
    p.cost[s.nVar] = 1.0;
    p.start.push_back(p.rows.Size());
    p.rows.AddShort({s.nVar, -1.0, s.nVar, 0.0});
    for (std::size_t j = 0; j < s.nVar; ++j) {
        if (!(s.cost[j] > 0.0)) continue;
        const double length = std::hypot(s.cost[j], 1.0);
        const double own = s.cost[j] / length, most = -1.0 / length;
        if (s.sign >= 0) p.rows.AddShort({j, own, s.nVar, most});
        if (s.sign <= 0) p.rows.AddShort({j, -own, s.nVar, most});
    }
    AddUlfSigns(s, p.rows);
    return p;
}

} // namespace

T_ULF_LINEAR LinearUlf(int objective, const T_ULF_SCALED& scaled)
{
    return objective == 1 ? SumRows(scaled) : LargestRows(scaled);
}

T_ULF_ANSWER SolveUlfLinear(const T_ULF_PROBLEM& problem, const T_ULF_SCALED& scaled,
                            ULF_PRECISION precision)
{
    const T_ULF_LINEAR linear = LinearUlf(problem.objective, scaled);
    CUlfActiveSet method(linear.rows, precision);
    T_ULF_ANSWER answer;
    for (double quadratic : kQuadratic) {
        std::vector<double> gradient = linear.cost;
        for (double& g : gradient)
            g /= quadratic;
        method.SetObjective(gradient, 1.0 / quadratic);
        if (method.Steps() == 0) method.Start(linear.start);
        const ULF_STEP step = method.Solve(0, linear.rows.Size());
        if (step == ULF_STEP::Infeasible) {
            std::vector<long double> any;
            T_ULF_ANSWER why = MeetUlf(scaled, precision, any);
            if (why.code != ULF_SOLVED) return why;
        }
        if (step != ULF_STEP::Done) break;
        std::vector<long double> multipliers = method.MultipliersOf(linear.cost, 1.0);
        multipliers.resize(scaled.nCon);
        AcceptUlf(problem, scaled, method.Y().first(scaled.nVar), std::move(multipliers), answer);
        answer.quadratic = quadratic;
        if (answer.code != ULF_NOT_CERTIFIED) return answer;
    }
    return SolveUlfFallback(problem, scaled, precision);
}
