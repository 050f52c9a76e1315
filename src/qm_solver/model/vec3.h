// Arithmetic of small vectors and matrices.
#pragma once

#include "qm_solver/framemodel.h"

#include <cmath>

namespace solver {

using T_VEC12 = std::array<double, 12>;
using T_MATRIX12 = std::array<T_VEC12, 12>;
using T_AXES = std::array<T_VEC3, 3>; // rows: unit vectors x, y, z in global axes

inline T_VEC3 Minus(const T_VEC3& a, const T_VEC3& b)
{
    return {a[0] - b[0], a[1] - b[1], a[2] - b[2]};
}
inline T_VEC3 Plus(const T_VEC3& a, const T_VEC3& b)
{
    return {a[0] + b[0], a[1] + b[1], a[2] + b[2]};
}
inline T_VEC3 Scaled(const T_VEC3& a, double factor)
{
    return {factor * a[0], factor * a[1], factor * a[2]};
}
inline double Dot(const T_VEC3& a, const T_VEC3& b)
{
    return a[0] * b[0] + a[1] * b[1] + a[2] * b[2];
}
inline T_VEC3 Cross(const T_VEC3& a, const T_VEC3& b)
{
    return {a[1] * b[2] - a[2] * b[1], a[2] * b[0] - a[0] * b[2], a[0] * b[1] - a[1] * b[0]};
}
inline double Norm(const T_VEC3& a)
{
    return std::sqrt(Dot(a, a));
}

inline T_VEC3 ToLocal(const T_AXES& axes, const T_VEC3& v)
{
    return {Dot(axes[0], v), Dot(axes[1], v), Dot(axes[2], v)};
}
inline T_VEC3 ToGlobal(const T_AXES& axes, const T_VEC3& v)
{
    T_VEC3 sum{};
    for (std::size_t k = 0; k < 3; ++k)
        sum = Plus(sum, Scaled(axes[k], v[k]));
    return sum;
}

/// Three components of a long vector.
template <class V>
T_VEC3 Part(const V& v, std::size_t first)
{
    return {v[first], v[first + 1], v[first + 2]};
}
template <class V>
void AddPart(V& v, std::size_t first, const T_VEC3& part)
{
    for (std::size_t k = 0; k < 3; ++k)
        v[first + k] += part[k];
}

} // namespace solver
