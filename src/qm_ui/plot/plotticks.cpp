#include "qm_ui/plot/plotticks.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <cmath>

namespace {

constexpr double kEps = 1e-9;        // of a step: an end that is a tick but for rounding
constexpr int kMaxTicks = 1000;      // against a range that no double can divide
constexpr double kLinearBelow = 0.7; // decades: a narrower log axis takes linear steps

std::string FixedText(double value, int decimals)
{
    std::array<char, 400> buf;
    const auto res = std::to_chars(buf.data(), buf.data() + buf.size(), value,
                                   std::chars_format::fixed, decimals);
    return res.ec == std::errc() ? std::string(buf.data(), res.ptr) : std::string("?");
}

double TimesPowerOfTen(double value, int exponent)
{
    return exponent >= 0 ? value * std::pow(10.0, exponent) : value / std::pow(10.0, -exponent);
}

// Common power of the labels, a multiple of three: none while plain numbers stay short.
int LabelExponent(T_PLOT_RANGE r)
{
    const double top = std::max(std::fabs(r.lo), std::fabs(r.hi));
    if (top >= 1e-2 * (1 + kEps) && top < 1e5) return 0;
    return 3 * static_cast<int>(std::floor(std::log10(top) / 3.0));
}

std::string StepLabel(const T_PLOT_STEP& step, double count, int exponent)
{
    if (count == 0.0) return "0";
    const int power = step.exponent10 - exponent;
    return FixedText(TimesPowerOfTen(count * step.mantissa, power), std::max(0, -power));
}

T_PLOT_TICKS LinearTicks(T_PLOT_RANGE r, int maxCount)
{
    T_PLOT_TICKS ticks;
    const T_PLOT_STEP step = NicePlotStep(r.hi - r.lo, maxCount);
    const double size = step.Value(1);
    ticks.exponent10 = LabelExponent(r);
    const double first = std::ceil(r.lo / size - kEps);
    const double last = std::min(std::floor(r.hi / size + kEps), first + kMaxTicks);
    for (double i = first; i <= last; ++i)
        ticks.major.push_back({step.Value(i), StepLabel(step, i, ticks.exponent10)});
    const int parts = step.mantissa == 2 ? 4 : 5;
    const double minorFirst = std::ceil(r.lo / size * parts - kEps);
    const double minorLast = std::floor(r.hi / size * parts + kEps);
    for (double i = minorFirst; i <= std::min(minorLast, minorFirst + kMaxTicks); ++i)
        if (std::fmod(i, parts) != 0.0) ticks.minor.push_back(step.Value(i / parts));
    return ticks;
}

std::string LogLabel(int mantissa, int exponent)
{
    if (exponent >= -3 && exponent <= 4)
        return FixedText(TimesPowerOfTen(mantissa, exponent), std::max(0, -exponent));
    const std::string power = PowerOfTenText(exponent);
    return mantissa == 1 ? power : std::to_string(mantissa) + "\u00d7" + power;
}

T_PLOT_TICKS LogTicks(T_PLOT_RANGE r, int maxCount)
{
    T_PLOT_TICKS ticks;
    const double decades = std::log10(r.hi) - std::log10(r.lo);
    const int stride = std::max(1, static_cast<int>(std::ceil(decades / std::max(1, maxCount))));
    const bool fine = stride == 1 && 3.0 * decades <= maxCount; // room for 1, 2 and 5
    const int last = static_cast<int>(std::ceil(std::log10(r.hi)));
    for (int k = static_cast<int>(std::floor(std::log10(r.lo))); k <= last; ++k) {
        for (int m = 1; m <= 9; ++m) {
            const double v = TimesPowerOfTen(m, k);
            if (v < r.lo * (1 - kEps) || v > r.hi * (1 + kEps)) continue;
            if ((m == 1 && k % stride == 0) || (fine && (m == 2 || m == 5)))
                ticks.major.push_back({v, LogLabel(m, k)});
            else if (m == 1 || stride == 1)
                ticks.minor.push_back(v);
        }
    }
    return ticks;
}

} // namespace

double T_PLOT_STEP::Value(double count) const
{
    return TimesPowerOfTen(count * mantissa, exponent10);
}

T_PLOT_STEP NicePlotStep(double span, int maxCount)
{
    const double least = span / std::max(1, maxCount) * (1 - kEps);
    T_PLOT_STEP step{1, static_cast<int>(std::floor(std::log10(least)))};
    for (const int m : {1, 2, 5}) {
        step.mantissa = m;
        if (step.Value(1) >= least) return step;
    }
    return {1, step.exponent10 + 1};
}

T_PLOT_TICKS MakePlotTicks(T_PLOT_RANGE range, bool log, int maxCount)
{
    if (log && std::log10(range.hi) - std::log10(range.lo) >= kLinearBelow)
        return LogTicks(range, maxCount);
    return LinearTicks(range, maxCount);
}

std::string PowerOfTenText(int n)
{
    static constexpr std::array<const char*, 10> kRaised{"\u2070", "\u00b9", "\u00b2", "\u00b3",
                                                         "\u2074", "\u2075", "\u2076", "\u2077",
                                                         "\u2078", "\u2079"};
    std::string text = n < 0 ? "10\u207b" : "10";
    for (const char c : std::to_string(std::abs(n)))
        text += kRaised[static_cast<std::size_t>(c - '0')];
    return text;
}

std::string PlotNumberText(double value, int digits)
{
    std::array<char, 64> buf;
    const auto res = std::to_chars(buf.data(), buf.data() + buf.size(), value,
                                   std::chars_format::general, digits);
    return res.ec == std::errc() ? std::string(buf.data(), res.ptr) : std::string("?");
}
