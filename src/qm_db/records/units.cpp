#include "qm_db/records/units.h"

#include "qm_db/records/evalnames.h"

#include <charconv>
#include <cstddef>

namespace {

// SI values of one unit, in the order of FORCE_UNIT and LENGTH_UNIT; NIST SP 811 appendix B (exact
// where exact there).
constexpr std::array<double, kForceNames.size()> kForce{
    1.0, 1e3, 1e6, 9.80665, 9806.65, 4.4482216152605, 4448.2216152605};
constexpr std::array<double, kLengthNames.size()> kLength{1e-3, 1e-2, 1.0, 0.0254, 0.3048};

double Power(double base, int exponent)
{
    double p = 1.0;
    for (int i = 0; i < (exponent < 0 ? -exponent : exponent); ++i)
        p *= base;
    return exponent < 0 ? 1.0 / p : p;
}

} // namespace

std::string_view NameOf(FORCE_UNIT unit)
{
    return kForceNames[static_cast<std::size_t>(unit)];
}
std::string_view NameOf(LENGTH_UNIT unit)
{
    return kLengthNames[static_cast<std::size_t>(unit)];
}
double NewtonsPer(FORCE_UNIT unit)
{
    return kForce[static_cast<std::size_t>(unit)];
}
double MetresPer(LENGTH_UNIT unit)
{
    return kLength[static_cast<std::size_t>(unit)];
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
