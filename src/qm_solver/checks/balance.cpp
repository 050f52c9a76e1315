#include "qm_solver/checks/balance.h"

#include "qm_solver/sparse/symmetricproduct.h"

#include <algorithm>
#include <array>
#include <cmath>

namespace solver {

namespace {

constexpr double kBalance = 1e-5;

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

} // namespace

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

} // namespace solver
