// Accelerated fixed-point iteration.
#pragma once

#include <deque>
#include <span>
#include <vector>

namespace solver {

/// Next argument of x = g(x) from those before: the mix of the last few whose residuals g(x) - x
/// cancel best (Anderson, Iterative procedures for nonlinear integral equations, J. ACM 12, 1965;
/// depth 4). Where plain iteration shrinks the error by a factor each time this does what a secant
/// method does.
class CFixedPoint {
public:
    /// x and g(x) of an iterate; returns the next x.
    std::vector<double> Next(std::span<const double> x, std::span<const double> g);

private:
    struct T_ITERATE {
        std::vector<double> g, residual;
    };
    std::deque<T_ITERATE> m_past;
};

} // namespace solver
