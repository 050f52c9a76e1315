#include "qm_rps/pushover/pushoverbilinear.h"

#include <algorithm>
#include <cmath>

namespace {

double At(double x, double x0, double y0, double x1, double y1)
{
    return x1 == x0 ? y1 : y0 + (y1 - y0) * (x - x0) / (x1 - x0);
}

/// Displacement where the curve first reaches a level, walking up from the origin.
double FirstReach(const T_ADRS_VIEW& c, double level)
{
    for (std::size_t i = 1; i < c.Size(); ++i) {
        if (c.Sa[i] >= level) return At(level, c.Sa[i - 1], c.Sd[i - 1], c.Sa[i], c.Sd[i]);
    }
    return c.Sd.back();
}

/// Displacement where the curve has fallen to a level after its peak, else the last one.
double FirstFall(const T_ADRS_VIEW& c, std::size_t peak, double level)
{
    for (std::size_t i = peak + 1; i < c.Size(); ++i) {
        if (c.Sa[i] <= level) return At(level, c.Sa[i - 1], c.Sd[i - 1], c.Sa[i], c.Sd[i]);
    }
    return c.Sd.back();
}

std::size_t FirstMaximumOf(std::span<const double> values)
{
    return static_cast<std::size_t>(std::max_element(values.begin(), values.end()) -
                                    values.begin());
}

} // namespace

T_BILINEAR_OPTIONS BilinearDefaults(BILINEAR_RULE rule)
{
    if (rule == BILINEAR_RULE::Masonry) return {rule, 0.7, 0.8, false};
    return {rule, 0.6, 0.85, false};
}

std::size_t FirstMaximum(const std::vector<double>& Sa)
{
    return FirstMaximumOf(Sa);
}

double CurveArea(const T_ADRS_VIEW& c, double d)
{
    double sum = 0.0;
    for (std::size_t i = 0; i + 1 < c.Size(); ++i) {
        if (d >= c.Sd[i + 1]) {
            sum += (c.Sa[i] + c.Sa[i + 1]) / 2.0 * (c.Sd[i + 1] - c.Sd[i]);
        } else if (c.Sd[i] <= d) {
            const double w = (d - c.Sd[i]) / (c.Sd[i + 1] - c.Sd[i]);
            const double Sad = c.Sa[i] + w * (c.Sa[i + 1] - c.Sa[i]);
            sum += (Sad + c.Sa[i]) / 2.0 * (d - c.Sd[i]);
        }
        if (c.Sd[i] > d)
            break; // a curve that turns back ends with the segment that starts beyond d
    }
    return sum;
}

double CurveAccelAt(const T_ADRS_VIEW& c, double d)
{
    for (std::size_t i = 0; i + 1 < c.Size(); ++i) {
        if (c.Sd[i] <= d && d <= c.Sd[i + 1])
            return At(d, c.Sd[i], c.Sa[i], c.Sd[i + 1], c.Sa[i + 1]);
    }
    return c.Sa.back();
}

int CalcBilinearEc8(const T_ADRS_VIEW& curve, double dm, double ay, T_BILINEAR& out)
{
    if (!(ay > 0.0) || !(dm > 0.0)) return 0;
    const double dy = std::min(2.0 * (dm - CurveArea(curve, dm) / ay), dm);
    if (!(dy > 0.0)) return 0;
    out = {dy, ay, curve.Sd.back(), ay};
    return 1;
}

int CalcBilinearNtc(const T_ADRS_VIEW& curve, const T_BILINEAR_OPTIONS& options, T_BILINEAR& out)
{
    const std::size_t peak = FirstMaximumOf(curve.Sa);
    const double Fbu = curve.Sa[peak];
    const double reach = FirstReach(curve, options.secant * Fbu);
    if (!(Fbu > 0.0) || !(reach > 0.0)) return 0;
    const double k = options.secant * Fbu / reach;
    const double du = FirstFall(curve, peak, options.drop * Fbu);
    const double root = du * du - 2.0 * CurveArea(curve, du) / k;
    const double ay = root >= 0.0 ? k * (du - std::sqrt(root)) : Fbu;
    if (!(ay > 0.0) || !std::isfinite(ay)) return 0;
    out = {ay / k, ay, du, ay};
    return 1;
}
