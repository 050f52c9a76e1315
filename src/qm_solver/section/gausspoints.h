// Gauss-Legendre points and weights on 0 ... 1.
#pragma once

#include <array>

namespace solver {

struct T_GAUSS_POINT {
    double at, weight;
};

/// Exact to degree 5.
inline constexpr std::array<T_GAUSS_POINT, 3> kGauss3{
    {{0.5, 4.0 / 9.0}, {0.1127016653792583, 5.0 / 18.0}, {0.8872983346207417, 5.0 / 18.0}}};

/// Exact to degree 31; half of the points, the others mirror them about 0.5.
inline constexpr std::array<T_GAUSS_POINT, 8> kHalfGauss16{
    {{0.5 - 0.5 * 0.9894009349916499, 0.5 * 0.0271524594117541},
     {0.5 - 0.5 * 0.9445750230732326, 0.5 * 0.0622535239386478},
     {0.5 - 0.5 * 0.8656312023878318, 0.5 * 0.0951585116824929},
     {0.5 - 0.5 * 0.7554044083550030, 0.5 * 0.1246289712555339},
     {0.5 - 0.5 * 0.6178762444026438, 0.5 * 0.1495959888165768},
     {0.5 - 0.5 * 0.4580167776572274, 0.5 * 0.1691565193950026},
     {0.5 - 0.5 * 0.2816035507792589, 0.5 * 0.1826034150449236},
     {0.5 - 0.5 * 0.0950125098376374, 0.5 * 0.1894506104550685}}};

/// f(point, weight) over 16 points.
template <class F>
void ForGauss16(const F& f)
{
    for (const auto& [at, weight] : kHalfGauss16) {
        f(at, weight);
        f(1.0 - at, weight);
    }
}

} // namespace solver
