#include "qm_db/records/units.h"

#include <charconv>
#include <cstddef>

namespace {

struct T_UNIT_ROW {
    std::string_view name;
    double si; // SI value of one unit
};

// Rows in the order of FORCE_UNIT; NIST SP 811 appendix B (exact where exact there).
constexpr std::array<T_UNIT_ROW, 7> kForce{{{"N", 1.0},
                                            {"kN", 1e3},
                                            {"MN", 1e6},
                                            {"kgf", 9.80665},
                                            {"tonf", 9806.65},
                                            {"lbf", 4.4482216152605},
                                            {"kips", 4448.2216152605}}};

// Rows in the order of LENGTH_UNIT.
constexpr std::array<T_UNIT_ROW, 5> kLength{
    {{"mm", 1e-3}, {"cm", 1e-2}, {"m", 1.0}, {"in", 0.0254}, {"ft", 0.3048}}};

template <class E, std::size_t N>
std::optional<E> FromName(const std::array<T_UNIT_ROW, N>& rows, std::string_view name)
{
    for (std::size_t i = 0; i < N; ++i) {
        if (rows[i].name == name) return static_cast<E>(i);
    }
    return std::nullopt;
}

double Power(double base, int exponent)
{
    double p = 1.0;
    for (int i = 0; i < (exponent < 0 ? -exponent : exponent); ++i)
        p *= base;
    return exponent < 0 ? 1.0 / p : p;
}

} // namespace

std::optional<FORCE_UNIT> ForceUnitFromName(std::string_view name)
{
    return FromName<FORCE_UNIT>(kForce, name);
}

std::optional<LENGTH_UNIT> LengthUnitFromName(std::string_view name)
{
    return FromName<LENGTH_UNIT>(kLength, name);
}

std::string_view NameOf(FORCE_UNIT unit)
{
    return kForce[static_cast<std::size_t>(unit)].name;
}
std::string_view NameOf(LENGTH_UNIT unit)
{
    return kLength[static_cast<std::size_t>(unit)].name;
}
double NewtonsPer(FORCE_UNIT unit)
{
    return kForce[static_cast<std::size_t>(unit)].si;
}
double MetresPer(LENGTH_UNIT unit)
{
    return kLength[static_cast<std::size_t>(unit)].si;
}

double SiFactor(const T_UNITS& units, T_DIM dim)
{
    return Power(NewtonsPer(units.force), dim.force) * Power(MetresPer(units.length), dim.length);
}

double ShortFromSi(double value, const T_UNITS& units, T_DIM dim)
{
    const double plain = FromSi(value, units, dim);
    std::array<char, 32> text{};
    const auto end = std::to_chars(text.data(), text.data() + text.size(), plain,
                                   std::chars_format::general, 15);
    double rounded = plain;
    std::from_chars(text.data(), end.ptr, rounded);
    return ToSi(rounded, units, dim) == value ? rounded : plain;
}
