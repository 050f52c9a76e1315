// Root of a function between two places where it has opposite signs.
#pragma once

#include <algorithm>
#include <cmath>
#include <limits>

namespace solver {

/// x is the nearer end of the bracket that is left, other its other end.
struct T_BRACKET {
    double x = 0.0, f = 0.0, other = 0.0, fOther = 0.0;
};

/// T. R. Chandrupatla's choice between inverse quadratic interpolation and bisection (1997). Ends
/// when |f| is at most `tol`, or when the bracket can't get narrower: then f jumps there.
template <class F>
T_BRACKET BracketRoot(const F& f, double a, double fa, double b, double fb, double tol)
{
    constexpr int kMaxIterations = 200;
    constexpr double kNarrow = 2.0 * std::numeric_limits<double>::epsilon();
    double x1 = a, f1 = fa, x2 = b, f2 = fb, t = 0.5;
    for (int i = 0; i < kMaxIterations && std::min(std::fabs(f1), std::fabs(f2)) > tol; ++i) {
        const double x = x1 + t * (x2 - x1), fx = f(x);
        double x3 = x2, f3 = f2;
        if ((fx > 0.0) == (f1 > 0.0))
            x3 = x1, f3 = f1;
        else
            x2 = x1, f2 = f1;
        x1 = x, f1 = fx;
        const double narrow = kNarrow * std::max({std::fabs(x1), std::fabs(x2), 1e-300}) /
                              std::max(std::fabs(x2 - x1), 1e-300);
        if (narrow > 0.5) break;
        const double xi = (x1 - x2) / (x3 - x2), phi = (f1 - f2) / (f3 - f2);
        t = 0.5;
        if (phi * phi < xi && (1.0 - phi) * (1.0 - phi) < 1.0 - xi)
            t = f1 / (f2 - f1) * f3 / (f2 - f3) +
                (x3 - x1) / (x2 - x1) * f1 / (f3 - f1) * f2 / (f3 - f2);
        t = std::clamp(t, narrow, 1.0 - narrow);
    }
    if (std::fabs(f1) <= std::fabs(f2)) return {x1, f1, x2, f2};
    return {x2, f2, x1, f1};
}

} // namespace solver
