#include "qm_solver/factors/ulfcertificate.h"

#include <algorithm>
#include <cmath>

namespace {

using T_LONG = std::vector<long double>;

constexpr long double kNothing = 1e-9L;           // part of the solution that costs nothing
constexpr long double kNothingBesideFree = 1e-6L; // likewise, of what free unknowns leave of it
constexpr long double kNothingOfSquares = 1e-6L;  // of the square of its length

constexpr long double kOfTerms = 1e-6L; // of the terms of a sum: 1e-15 of them is rounding

bool HasFree(const T_ULF_SCALED& s)
{
    return std::ranges::any_of(s.cost, [](double cost) { return !(cost > 0.0); });
}

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
            pull[j] -= f * row[j] / s.metric[j];
    }
    return pull;
}

/// What the rows pull unknown j with, term by term: the size of what rounding leaves of it.
T_LONG PullSize(const T_ULF_PROBLEM& problem, const T_ULF_SCALED& s,
                std::span<const long double> multipliers)
{
    T_LONG size(s.nVar);
    for (std::size_t i = 0; i < s.nCon; ++i)
        for (std::size_t j = 0; j < s.nVar; ++j)
            size[j] += std::fabs(multipliers[i] / s.rowNorm[i] * problem.Row(i)[j] / s.metric[j]);
    return size;
}

/// What the miss of unknown j is compared with. In the metric of the weights: 1, and of the square
/// sum the size of y. In others costs differ by orders of magnitude, and each counts by its own.
T_LONG Units(const T_ULF_PROBLEM& problem, const T_ULF_SCALED& s, const T_LONG& y,
             std::span<const long double> multipliers)
{
    if (s.isByWeight && problem.objective != 2) return T_LONG(s.nVar, 1.0L);
    if (s.isByWeight && !HasFree(s)) return T_LONG(s.nVar, std::max(1.0L, Norm(y)));
    T_LONG units = PullSize(problem, s, multipliers);
    const long double nothing = (HasFree(s) ? kNothingBesideFree : kNothing) * Norm(y);
    for (std::size_t j = 0; j < s.nVar; ++j) {
        const long double own = problem.objective == 2 ? s.cost[j] * std::fabs(y[j]) : 1.0L;
        units[j] = s.cost[j] * own + kOfTerms * units[j] + nothing;
    }
    return units;
}

/// Conditions on the pull of each objective; with a sign restriction the unknown may also be
/// pushed against zero. Relative to the units of the unknowns.
long double Stationary(int objective, const T_ULF_SCALED& s, const T_LONG& y, const T_LONG& pull,
                       const T_LONG& units, const T_LONG& noise)
{
    long double most = 0.0L, sum = 0.0L;
    for (std::size_t j = 0; j < s.nVar; ++j) {
        const long double out = s.sign ? std::max(0.0L, s.sign * pull[j]) : std::fabs(pull[j]);
        const long double cost = s.cost[j];
        long double miss = 0.0L;
        if (objective == 1) miss = out - cost;
        if (objective == 2) // y follows the pull, or is zero where that has the wrong sign
            miss = std::fabs(cost * cost * y[j] - (s.sign ? s.sign * out : pull[j]));
        if (objective == 3 && !(cost > 0.0L)) miss = out;
        if (objective == 3 && cost > 0.0L) sum += std::max(0.0L, out - noise[j]) / cost;
        most = std::max(most, miss / units[j]);
    }
    return objective == 3 ? std::max(most, sum - 1.0L) : most;
}

long double Objective(int objective, std::span<const double> cost, const T_LONG& y)
{
    long double value = 0.0L;
    for (std::size_t j = 0; j < y.size(); ++j) {
        const long double term = cost[j] * std::fabs(y[j]);
        if (objective == 1) value += term;
        if (objective == 2) value += term * term / 2;
        if (objective == 3) value = std::max(value, term);
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
    if (s.isByWeight && !(problem.objective == 2 && HasFree(s)))
        return std::fabs(gap) / std::max(1.0L, value);
    const long double size = Norm(y), nothing = kNothingOfSquares * size * size;
    return std::fabs(gap) > 0.0L ? std::fabs(gap) / std::max(value, nothing) : 0.0L;
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
        y[j] = s.metric[j] * x[j] / s.rhsScale;
    const long double size = std::max(1.0L, Norm(y));
    long double negative = 0.0L;
    for (std::size_t i = s.nEq; i < s.nCon; ++i)
        negative = std::max(negative, -multipliers[i]);
    const T_LONG pull = Pull(problem, s, multipliers), units = Units(problem, s, y, multipliers);
    T_LONG noise(s.nVar);
    if (!s.isByWeight) noise = PullSize(problem, s, multipliers);
    for (long double& n : noise)
        n *= kOfTerms * kUlfStationaryTol;
    const long double miss = Stationary(problem.objective, s, y, pull, units, noise);
    const long double unit = problem.objective == 2 ? size : 1.0L;
    T_ULF_CERTIFICATE c;
    c.violation = static_cast<double>(Violation(problem, s, x, y) / size);
    c.stationary = static_cast<double>(std::max(miss, negative / unit));
    c.gap = static_cast<double>(Gap(problem, s, y, multipliers));
    c.objective = UlfObjective(problem, x);
    return c;
}

double UlfObjective(const T_ULF_PROBLEM& problem, std::span<const double> x)
{
    const T_LONG factors(x.begin(), x.end());
    const long double value = Objective(problem.objective, problem.weights, factors);
    return static_cast<double>(problem.objective == 2 ? 2 * value : value);
}
