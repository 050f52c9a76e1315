// Units: the store holds SI (N, m, kg, s); a document has current units for force and length.
#pragma once

#include <array>
#include <optional>
#include <string_view>

enum class FORCE_UNIT { N, kN, MN, kgf, tonf, lbf, kips };
enum class LENGTH_UNIT { mm, cm, m, in, ft };

/// Exponents of force and length of a quantity; time is always in seconds.
/// A stress is {1, -2}; a mass is {1, -1} (force * s2 / length); a ratio is {0, 0}.
struct T_DIM {
    int force = 0;
    int length = 0;
    bool operator==(const T_DIM&) const = default;
};

inline constexpr T_DIM kDimNone{0, 0};
inline constexpr T_DIM kDimLength{0, 1};
inline constexpr T_DIM kDimForce{1, 0};
inline constexpr T_DIM kDimMoment{1, 1};
inline constexpr T_DIM kDimMass{1, -1};
inline constexpr T_DIM kDimAccel{0, 1};
inline constexpr T_DIM kDimStress{1, -2};

struct T_UNITS {
    FORCE_UNIT force = FORCE_UNIT::kN;
    LENGTH_UNIT length = LENGTH_UNIT::m;
    bool operator==(const T_UNITS&) const = default;
};

/// "kN" or "in".
std::string_view NameOf(FORCE_UNIT unit);
std::string_view NameOf(LENGTH_UNIT unit);

/// SI value of one unit: N per force unit (1 kip = 4448.2216152605 N, 1 kgf = 9.80665 N exactly),
/// m per length unit (1 in = 0.0254 m exactly).
double NewtonsPer(FORCE_UNIT unit);
double MetresPer(LENGTH_UNIT unit);

/// SI value of one unit of a quantity of that dimension.
double SiFactor(const T_UNITS& units, T_DIM dim);
/// Value in `units` to SI, and back (SI divided by the factor, so that round numbers stay round).
inline double ToSi(double value, const T_UNITS& units, T_DIM dim)
{
    return value * SiFactor(units, dim);
}
inline double FromSi(double value, const T_UNITS& units, T_DIM dim)
{
    return value / SiFactor(units, dim);
}

/// The same, but of the values that convert back to exactly this SI value one with at most 15
/// digits where there is one: entered digits come back as entered.
double ShortFromSi(double value, const T_UNITS& units, T_DIM dim);
