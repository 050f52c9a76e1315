#include "qm_ui/plot/plotscale.h"

#include "qm_ui/plot/plotticks.h"

#include <algorithm>
#include <cmath>

namespace {

constexpr double kMaxSize = 1e150; // beyond it, spans and products would overflow
constexpr double kMinLog = 1e-150;
constexpr double kMinRelSpan = 1e-10; // narrower ranges run into the digits of a double
constexpr double kAir = 0.04;         // free part of the span at an end that is not zero
constexpr int kAutoSteps = 10;

T_PLOT_RANGE Widen(T_PLOT_RANGE r)
{
    if (CPlotScale::IsUsable(r, false)) return r;
    const double d = r.lo == 0.0 ? 1.0 : 0.2 * std::fabs(r.lo);
    return {r.lo - d, r.hi + d};
}

T_PLOT_RANGE RoundLinear(T_PLOT_RANGE r)
{
    r = Widen(r);
    if (r.lo > 0.0 && r.lo <= 0.5 * r.hi) r.lo = 0.0;
    if (r.hi < 0.0 && r.hi >= 0.5 * r.lo) r.hi = 0.0;
    const double air = kAir * (r.hi - r.lo);
    const double half = 0.5 * NicePlotStep(r.hi - r.lo, kAutoSteps).Value(1);
    if (r.lo != 0.0) r.lo = half * std::floor((r.lo - air) / half);
    if (r.hi != 0.0) r.hi = half * std::ceil((r.hi + air) / half);
    return r;
}

// The largest 1-2-5 number not above value, or the smallest not below it.
double Round125(double value, bool up)
{
    constexpr double kEps = 1e-9;
    const double decade = std::pow(10.0, std::floor(std::log10(value) + kEps));
    const double m = value / decade;
    if (up) return decade * (m <= 1 + kEps ? 1 : m <= 2 + kEps ? 2 : m <= 5 + kEps ? 5 : 10);
    return decade * (m >= 5 - kEps ? 5 : m >= 2 - kEps ? 2 : 1);
}

} // namespace

CPlotScale::CPlotScale(T_PLOT_RANGE range, bool log, double pxLo, double pxHi)
    : m_range(range), m_log(log), m_pxLo(pxLo), m_pxHi(pxHi)
{
}

bool CPlotScale::CanShow(double value, bool log)
{
    return log ? value >= kMinLog && value <= kMaxSize : std::fabs(value) <= kMaxSize;
}

bool CPlotScale::IsUsable(T_PLOT_RANGE range, bool log)
{
    const double size = std::max(std::fabs(range.lo), std::fabs(range.hi));
    return CanShow(range.lo, log) && CanShow(range.hi, log) &&
           range.hi - range.lo > kMinRelSpan * size;
}

double CPlotScale::ToLine(double value) const
{
    return m_log ? std::log10(value) : value;
}

double CPlotScale::FromLine(double line) const
{
    return m_log ? std::pow(10.0, line) : line;
}

double CPlotScale::ToPixel(double value) const
{
    const double lo = ToLine(m_range.lo);
    return m_pxLo + (ToLine(value) - lo) / (ToLine(m_range.hi) - lo) * (m_pxHi - m_pxLo);
}

double CPlotScale::ToValue(double px) const
{
    const double lo = ToLine(m_range.lo);
    return FromLine(lo + (px - m_pxLo) / (m_pxHi - m_pxLo) * (ToLine(m_range.hi) - lo));
}

T_PLOT_RANGE CPlotScale::RangeWithValueAt(double value, double px, double span) const
{
    const double width = (ToLine(m_range.hi) - ToLine(m_range.lo)) * span;
    const double lo = ToLine(value) - (px - m_pxLo) / (m_pxHi - m_pxLo) * width;
    const T_PLOT_RANGE r{FromLine(lo), FromLine(lo + width)};
    return IsUsable(r, m_log) ? r : m_range;
}

T_PLOT_RANGE AutoPlotRange(const std::vector<double>& values, bool log)
{
    T_PLOT_RANGE r{kMaxSize, -kMaxSize};
    for (const double v : values) {
        if (!CPlotScale::CanShow(v, log)) continue;
        r.lo = std::min(r.lo, v);
        r.hi = std::max(r.hi, v);
    }
    if (r.lo > r.hi) return log ? T_PLOT_RANGE{1.0, 10.0} : T_PLOT_RANGE{0.0, 1.0};
    if (!log) return RoundLinear(r);
    r = {Round125(r.lo, false), Round125(r.hi, true)};
    return r.hi > r.lo * 1.5 ? r : T_PLOT_RANGE{r.lo * 0.5, r.hi * 2.0};
}
