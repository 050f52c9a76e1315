#include "qm_solver/checks/balance.h"

#include "qm_base/textformat.h"
#include "qm_solver/sparse/symmetricproduct.h"

#include <algorithm>
#include <array>
#include <cmath>

namespace solver {

namespace {

constexpr double kBalance = 1e-5;
constexpr double kKnown = 1e-6; // relative error of a refined solution

/// The largest force and the largest moment over the unknowns.
std::array<double, 2> Largest(const CFrameDofs& dofs, std::span<const double> values)
{
    std::array<double, 2> largest{};
    for (std::size_t q = 0; q < values.size(); ++q) {
        double& of = largest[dofs.Owner(q) % 6 < 3 ? 0 : 1];
        const double value = std::fabs(values[q]);
        of = value <= of ? of : value; // a NaN comes through
    }
    return largest;
}

/// Loads against the forces of the unknowns by the assembled matrix.
bool InBalance(const T_SYMMETRIC_MATRIX& k, const CFrameDofs& dofs, double extent,
               std::span<const double> loads, std::span<const double> x)
{
    std::vector<double> rest(loads.size());
    AddProduct<double>(k, x, rest);
    for (std::size_t q = 0; q < rest.size(); ++q)
        rest[q] -= loads[q];
    const std::array<double, 2> load = Largest(dofs, loads), off = Largest(dofs, rest);
    const double force = std::max(load[0], load[1] / extent);
    return off[0] <= kBalance * force && off[1] <= kBalance * force * extent;
}

} // namespace

int SolveBalanced(const CCaseBlock& block, const CFrameDofs& dofs, double extent,
                  const T_SYMMETRIC_MATRIX& k, CSparseFactor& factor, T_SOLUTION& solution,
                  std::size_t& column, T_SOLVER_REASON& reason)
{
    const std::vector<double> sides = block.RightSides();
    const std::size_t n = dofs.EquationCount(), count = block.Size();
    column = count;
    solution = {sides, {}, std::vector<char>(count, 0), std::vector<T_ACCURACY>(count)};
    if (n == 0) return 1; // everything is held
    if (!factor.Solve(solution.x, count, reason)) return 0;
    if (!Refine(block, dofs, extent, k, sides, factor, solution, reason)) return 0;
    for (std::size_t c = 0; c < count; ++c) {
        const double error = solution.accuracy[c].error;
        const bool fine = solution.fine[c] != 0;
        if (fine ? error <= kKnown
                 : InBalance(k, dofs, extent, std::span(sides).subspan(c * n, n),
                             std::span(solution.x).subspan(c * n, n)))
            continue;
        column = c;
        reason = "IDS_QM_ENGINE_OUT_OF_BALANCE";
        if (fine) reason = {"IDS_QM_ENGINE_DIGITS_LOST", {FormatText("%.1g", error)}};
        return 0;
    }
    return 1;
}

} // namespace solver
