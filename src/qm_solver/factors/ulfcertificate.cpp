#include "qm_solver/factors/ulfcertificate.h"

#include <algorithm>
#include <cmath>

namespace {

using T_LONG = std::vector<long double>;

long double Norm(const T_LONG& v)
{
    long double sum = 0.0L;
    for (long double e : v)
        sum += e * e;
    return std::sqrt(sum);
}

/// Largest violation of rows and signs, scaled.
long double Violation(const T_ULF_PROBLEM& problem, const T_ULF_SCALED& s,
                      std::span<const double> x, const T_LONG& y)
{
    long double most = 0.0L;
    for (std::size_t i = 0; i < s.nCon; ++i) {
        const std::span<const double> row = problem.Row(i);
        long double v = -static_cast<long double>(problem.rhs[i]);
        for (std::size_t j = 0; j < s.nVar; ++j)
            v += static_cast<long double>(row[j]) * x[j];
        v /= s.rowNorm[i] * s.rhsScale;
        most = std::max(most, i < s.nEq ? std::fabs(v) : v);
    }
    for (std::size_t j = 0; s.sign != 0 && j < s.nVar; ++j)
        most = std::max(most, -s.sign * y[j]);
    return most;
}

/// Minus the sum of multiplier times row: what the rows pull with, per unknown.
T_LONG Pull(const T_ULF_PROBLEM& problem, const T_ULF_SCALED& s,
            std::span<const long double> multipliers)
{
    T_LONG pull(s.nVar);
    for (std::size_t i = 0; i < s.nCon; ++i) {
        if (!(std::fabs(multipliers[i]) > 0.0L)) continue;
        const long double f = multipliers[i] / s.rowNorm[i];
        const std::span<const double> row = problem.Row(i);
        for (std::size_t j = 0; j < s.nVar; ++j)
            pull[j] -= f * row[j] / s.weight[j];
    }
    return pull;
}

/// Conditions on the pull of each objective; with a sign restriction the unknown may also be
/// pushed against zero.
long double Stationary(int objective, const T_ULF_SCALED& s, const T_LONG& y, const T_LONG& pull)
{
    long double most = 0.0L, sum = 0.0L;
    for (std::size_t j = 0; j < s.nVar; ++j) {
        const long double out = s.sign ? std::max(0.0L, s.sign * pull[j]) : std::fabs(pull[j]);
        if (objective == 1) most = std::max(most, out - s.cost[j]);
        if (objective == 2) // y follows the pull, or is zero where that has the wrong sign
            most = std::max(most, std::fabs(y[j] - (s.sign ? s.sign * out : pull[j])));
        if (objective == 3 && !(s.cost[j] > 0.0)) most = std::max(most, out);
        sum += s.cost[j] * out;
    }
    return objective == 3 ? std::max(most, sum - 1.0L) : most;
}

long double Objective(int objective, std::span<const double> cost, const T_LONG& y)
{
    long double value = 0.0L;
    for (std::size_t j = 0; j < y.size(); ++j) {
        if (objective == 1) value += cost[j] * std::fabs(y[j]);
        if (objective == 2) value += y[j] * y[j] / 2;
        if (objective == 3) value = std::max(value, cost[j] * std::fabs(y[j]));
    }
    return value;
}

/// Primal objective less the dual one: c|y| + b * m, or y * y + b * m for the square sum.
long double Gap(const T_ULF_PROBLEM& problem, const T_ULF_SCALED& s, const T_LONG& y,
                std::span<const long double> multipliers)
{
    const long double value = Objective(problem.objective, s.cost, y);
    long double gap = problem.objective == 2 ? 2 * value : value;
    for (std::size_t i = 0; i < s.nCon; ++i)
        if (std::fabs(multipliers[i]) > 0.0L)
            gap += multipliers[i] * problem.rhs[i] / (s.rowNorm[i] * s.rhsScale);
    return std::fabs(gap) / std::max(1.0L, value);
}

} // namespace

bool T_ULF_CERTIFICATE::Holds(double rowTol) const
{
    return violation <= rowTol && stationary <= kUlfStationaryTol && gap <= kUlfGapTol;
}

T_ULF_CERTIFICATE CertifyUlf(const T_ULF_PROBLEM& problem, const T_ULF_SCALED& s,
                             std::span<const double> x, std::span<const long double> multipliers)
{
    T_LONG y(s.nVar);
    for (std::size_t j = 0; j < s.nVar; ++j)
        y[j] = s.weight[j] * x[j] / s.rhsScale;
    const long double size = std::max(1.0L, Norm(y));
    long double negative = 0.0L;
    for (std::size_t i = s.nEq; i < s.nCon; ++i)
        negative = std::max(negative, -multipliers[i]);
    const T_LONG pull = Pull(problem, s, multipliers);
    const long double miss = Stationary(problem.objective, s, y, pull);
    const long double unit = problem.objective == 2 ? size : 1.0L;
    T_ULF_CERTIFICATE c;
    c.violation = static_cast<double>(Violation(problem, s, x, y) / size);
    c.stationary = static_cast<double>(std::max(miss, negative) / unit);
    c.gap = static_cast<double>(Gap(problem, s, y, multipliers));
    c.objective = UlfObjective(problem, x);
    return c;
}

double UlfObjective(const T_ULF_PROBLEM& problem, std::span<const double> x)
{
    T_LONG y(x.size());
    std::vector<double> cost;
    const T_LONG weight = UlfWeights(problem.weights);
    for (std::size_t j = 0; j < x.size(); ++j) {
        y[j] = weight[j] * x[j];
        cost.push_back(problem.weights[j] > 0.0 ? 1.0 : 0.0);
    }
    const long double value = Objective(problem.objective, cost, y);
    return static_cast<double>(problem.objective == 2 ? 2 * value : value);
}
