#include "qm_db/casefile/jsonnumber.h"

#include <array>
#include <charconv>
#include <cmath>
#include <limits>

namespace {

constexpr double kFixedFrom = 1e-5;
constexpr double kFixedTo = 1e15;

/// The value rounded to that many significant digits.
double Rounded(double value, int digits)
{
    std::array<char, 40> text;
    const auto end = std::to_chars(text.data(), text.data() + text.size(), value,
                                   std::chars_format::scientific, digits - 1);
    double rounded = 0.0;
    std::from_chars(text.data(), end.ptr, rounded);
    return rounded;
}

/// Shortest text of a double that times the factor gives `si` to the bit. A text of up to 15 digits
/// is found by rounding; else one of the neighbours of the quotient may have fewer digits.
std::optional<std::string> ExactText(double si, double guess, double factor)
{
    const double short15 = Rounded(guess, 15);
    if (short15 * factor == si) return NumberText(short15);

    std::optional<std::string> best;
    constexpr double inf = std::numeric_limits<double>::infinity();
    for (const double candidate :
         {guess, std::nextafter(guess, -inf), std::nextafter(guess, inf)}) {
        if (candidate * factor != si) continue;
        std::string text = NumberText(candidate);
        if (!best || text.size() < best->size()) best = std::move(text);
    }
    return best;
}

} // namespace

std::string NumberText(double value)
{
    if (value == 0.0) return std::signbit(value) ? "-0.0" : "0";
    const double size = std::fabs(value);
    const auto format = size >= kFixedFrom && size < kFixedTo ? std::chars_format::fixed
                                                              : std::chars_format::scientific;
    std::array<char, 40> text;
    const auto end = std::to_chars(text.data(), text.data() + text.size(), value, format);
    return {text.data(), end.ptr};
}

std::optional<std::string> SiText(double si, const T_UNITS& units, T_DIM dim)
{
    const double factor = SiFactor(units, dim);
    const double guess = si / factor;
    if (!std::isfinite(si) || !std::isfinite(guess)) return std::nullopt;
    if (factor == 1.0 || si == 0.0) return NumberText(si);
    if (auto text = ExactText(si, guess, factor)) return text;
    // No double times the factor gives the stored value; the guess gives its neighbour.
    if (!std::isfinite(guess * factor)) return std::nullopt;
    return NumberText(guess);
}
