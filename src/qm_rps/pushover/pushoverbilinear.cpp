#include "qm_rps/pushover/pushoverbilinear.h"

#include "qm_rps/pushover/adrsformulas.h"

#include <algorithm>
#include <cmath>

namespace {

double At(double x, double x0, double y0, double x1, double y1)
{
    return x1 == x0 ? y1 : y0 + (y1 - y0) * (x - x0) / (x1 - x0);
}

/// Displacement at a level that the segment up to point i reaches: its end where it is flat.
double DispAt(const T_ADRS_VIEW& c, std::size_t i, double level, double same)
{
    const double a = c.Sa[i - 1], b = c.Sa[i];
    if (std::fabs(b - a) <= same) return c.Sd[i];
    return At(std::clamp(level, std::min(a, b), std::max(a, b)), a, c.Sd[i - 1], b, c.Sd[i]);
}

/// Displacement where the curve first reaches a level, walking up from the origin. same: what
/// forces may differ by and be equal.
double FirstReach(const T_ADRS_VIEW& c, double level, double same)
{
    for (std::size_t i = 1; i < c.Size(); ++i) {
        if (c.Sa[i] >= level - same) return DispAt(c, i, level, same);
    }
    return c.Sd.back();
}

/// Where the curve has fallen to a level after its peak, else its last point.
T_CURVE_PLACE FirstFall(const T_ADRS_VIEW& c, std::size_t peak, double level, double same)
{
    for (std::size_t i = peak + 1; i < c.Size(); ++i) {
        if (c.Sa[i] <= level + same) return {i - 1, DispAt(c, i, level, same), level};
    }
    return PlaceAt(c, c.Size() - 1);
}

} // namespace

T_BILINEAR_OPTIONS BilinearDefaults(BILINEAR_RULE rule)
{
    if (rule == BILINEAR_RULE::Masonry) return {rule, 0.7, 0.8, false};
    return {rule, 0.6, 0.85, false};
}

std::size_t FirstMaximum(std::span<const double> V)
{
    if (V.empty()) return 0;
    const double largest = *std::ranges::max_element(V);
    const double least = largest - kSameOnCurve * std::fabs(largest);
    return static_cast<std::size_t>(std::ranges::find_if(V, [=](double v) { return v >= least; }) -
                                    V.begin());
}

T_CURVE_PLACE PlaceAt(const T_ADRS_VIEW& c, std::size_t point)
{
    return {point, c.Sd[point], c.Sa[point]};
}

T_CURVE_PLACE FirstPlaceAt(const T_ADRS_VIEW& c, double d)
{
    for (std::size_t i = 0; i + 1 < c.Size(); ++i) {
        if (c.Sd[i] <= d && d <= c.Sd[i + 1])
            return {i, d, At(d, c.Sd[i], c.Sa[i], c.Sd[i + 1], c.Sa[i + 1])};
    }
    return PlaceAt(c, c.Size() - 1);
}

double CurveAccelAt(const T_ADRS_VIEW& c, double d)
{
    return FirstPlaceAt(c, d).Sa;
}

double AreaTo(const T_ADRS_VIEW& c, const T_CURVE_PLACE& place)
{
    double sum = 0.0;
    for (std::size_t i = 0; i < place.before; ++i)
        sum += (c.Sa[i] + c.Sa[i + 1]) / 2.0 * (c.Sd[i + 1] - c.Sd[i]);
    return sum + (c.Sa[place.before] + place.Sa) / 2.0 * (place.Sd - c.Sd[place.before]);
}

int CalcBilinearEc8(const T_ADRS_VIEW& curve, const T_CURVE_PLACE& dm, bool peak, T_BILINEAR& out)
{
    double ay = dm.Sa;
    for (std::size_t i = 0; peak && i <= dm.before; ++i)
        ay = std::max(ay, curve.Sa[i]);
    if (!(ay > 0.0) || !(dm.Sd > 0.0)) return 0;
    const double dy = std::min(2.0 * (dm.Sd - AreaTo(curve, dm) / ay), dm.Sd);
    if (!(dy > 0.0)) return 0;
    out = {dy, ay, curve.Sd.back(), ay};
    return 1;
}

int CalcBilinearNtc(const T_ADRS_VIEW& curve, const T_BILINEAR_OPTIONS& options, T_BILINEAR& out)
{
    const std::size_t peak = FirstMaximum(curve.Sa);
    const double Fbu = curve.Sa[peak], same = kSameOnCurve * Fbu;
    const double reach = FirstReach(curve, options.secant * Fbu, same);
    if (!(Fbu > 0.0) || !(reach > 0.0)) return 0;
    const double k = options.secant * Fbu / reach;
    const T_CURVE_PLACE end = FirstFall(curve, peak, options.drop * Fbu, same);
    const double du = end.Sd;
    const double root = du * du - 2.0 * AreaTo(curve, end) / k;
    const double ay = options.peak || root < 0.0 ? Fbu : k * (du - std::sqrt(root));
    if (!(ay > 0.0) || !std::isfinite(ay)) return 0;
    out = {ay / k, ay, du, ay};
    return 1;
}
