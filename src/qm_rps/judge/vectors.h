// Vectors of three components.
#pragma once

#include <array>
#include <numeric>

using T_VECTOR = std::array<double, 3>;

inline double Dot(const T_VECTOR& a, const T_VECTOR& b)
{
    return std::inner_product(a.begin(), a.end(), b.begin(), 0.0);
}

inline T_VECTOR Cross(const T_VECTOR& a, const T_VECTOR& b)
{
    return {a[1] * b[2] - a[2] * b[1], a[2] * b[0] - a[0] * b[2], a[0] * b[1] - a[1] * b[0]};
}

/// a + factor b.
inline T_VECTOR Plus(const T_VECTOR& a, const T_VECTOR& b, double factor)
{
    return {a[0] + factor * b[0], a[1] + factor * b[1], a[2] + factor * b[2]};
}
