#include "qm_solver/checks/movement.h"

#include <cmath>

namespace solver {

namespace {

/// A rotation is taken only where translations are this small beside it: they scale with length.
constexpr double kPureRotation = 1.0e-8;
constexpr double kEqual = 1.0e-6; // movements of symmetric nodes differ by rounding

} // namespace

std::size_t LargestMovement(std::span<const double> full)
{
    std::array<std::size_t, 2> at{0, 3};
    for (std::size_t i = 0; i < full.size(); ++i) {
        std::size_t& best = at[i % 6 < 3 ? 0 : 1];
        if (std::fabs(full[i]) > std::fabs(full[best]) * (1.0 + kEqual)) best = i;
    }
    return std::fabs(full[at[0]]) > kPureRotation * std::fabs(full[at[1]]) ? at[0] : at[1];
}

} // namespace solver
