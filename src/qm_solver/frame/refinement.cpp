#include "qm_solver/frame/refinement.h"

#include "qm_solver/model/fine.h"

#include <algorithm>
#include <cmath>
#include <limits>

namespace solver {

namespace {

constexpr double kEps = std::numeric_limits<double>::epsilon();
constexpr double kRisk = 1.0e-8; // estimated loss from which a solution is refined
constexpr double kShrinks = 0.5; // an error that is more of the one before is rounding
constexpr std::size_t kRounds = 20;

/// Bound of the relative error of a column from the rounding of the matrix and its factor.
double Loss(std::span<const double> diagonal, std::span<const double> side,
            std::span<const double> x)
{
    double apart = 0.0, work = 0.0;
    for (std::size_t q = 0; q < x.size(); ++q) {
        apart += std::fabs(diagonal[q]) * x[q] * x[q];
        work += side[q] * x[q];
    }
    return apart > 0.0 ? kEps * apart / std::fabs(work) : 0.0;
}

/// Largest value, those of rotations times `lever`.
double Size(const CFrameDofs& dofs, double lever, std::span<const double> x)
{
    double size = 0.0;
    for (std::size_t q = 0; q < x.size(); ++q) {
        const double value = std::fabs(x[q]) * (dofs.Owner(q) % 6 < 3 ? 1.0 : lever);
        size = value <= size ? size : value; // a NaN comes through
    }
    return size;
}

/// x + rest += change.
void Add(std::span<const double> change, std::span<double> x, std::span<double> rest)
{
    for (std::size_t q = 0; q < x.size(); ++q) {
        const CFine sum = CFine(x[q]) + rest[q] + change[q];
        x[q] = sum.Value();
        rest[q] = sum.Rest();
    }
}

std::vector<double> Diagonal(const T_SYMMETRIC_MATRIX& k)
{
    std::vector<double> diagonal(k.Size(), 0.0);
    for (std::size_t i = 0; i < k.Size(); ++i) // the first entry of a row of the upper triangle
        if (k.rowStart[i] < k.rowStart[i + 1])
            diagonal[i] = k.value[static_cast<std::size_t>(k.rowStart[i])];
    return diagonal;
}

} // namespace

int Refine(const CCaseBlock& block, const CFrameDofs& dofs, double extent,
           const T_SYMMETRIC_MATRIX& k, std::span<const double> sides, CSparseFactor& factor,
           T_SOLUTION& solution, T_SOLVER_REASON& reason)
{
    const std::size_t n = k.Size(), count = block.Size();
    const std::vector<double> diagonal = Diagonal(k);
    const auto column = [&](auto& of, std::size_t c) { return std::span(of).subspan(c * n, n); };
    solution.fine.assign(count, 0);
    solution.accuracy.assign(count, {});
    for (std::size_t c = 0; c < count; ++c)
        solution.fine[c] = !(Loss(diagonal, column(sides, c), column(solution.x, c)) <= kRisk);
    std::vector<char> open = solution.fine; // columns that are still improved
    const auto some = [&] {
        return std::any_of(open.begin(), open.end(), [](char o) { return o; });
    };
    if (!some()) return 1;
    solution.rest.assign(solution.x.size(), 0.0);
    for (std::size_t round = 0; round < kRounds && some(); ++round) {
        std::vector<double> change = block.Unbalanced(solution, open);
        const std::vector<double> unbalanced = change;
        if (!factor.Solve(change, count, reason)) return 0;
        for (std::size_t c = 0; c < count; ++c) {
            if (!open[c]) continue;
            T_ACCURACY& accuracy = solution.accuracy[c];
            const auto x = column(solution.x, c);
            const double size = Size(dofs, extent, x);
            const double share = Size(dofs, extent, column(change, c)) / size;
            const double force = Size(dofs, 1.0 / extent, column(unbalanced, c)) /
                                 Size(dofs, 1.0 / extent, column(sides, c));
            const double error = std::max(share, force);
            const bool shrinks = round == 0 || error <= kShrinks * accuracy.error;
            if (round == 0) accuracy.unrefined = share;
            if (shrinks || !(error <= accuracy.error)) accuracy.error = error;
            if (shrinks) Add(column(change, c), x, column(solution.rest, c));
            open[c] = shrinks && error > kEps;
        }
    }
    return 1;
}

} // namespace solver
