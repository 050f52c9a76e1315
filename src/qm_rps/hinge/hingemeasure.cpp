#include "qm_rps/hinge/hingemeasure.h"

#include <charconv>
#include <cmath>
#include <limits>
#include <optional>

namespace {

constexpr double kZeroTheta = 1e-7;
constexpr double kSnap = 1e-13; // relative; a few rounding errors of the conversion
constexpr int kMaxDigits = 17;

using T_CONVERT = double (*)(double, double);

/// The shortest decimal near `value` that `back` turns into `target` exactly; else `value`.
/// Shortest decimal near `value`, of at most `digits` digits, that converts back to the target
/// within `off`; nothing where there is none.
std::optional<double> ShortDecimal(double value, double target, double thetaY, T_CONVERT back,
                                   int maxDigits, double off)
{
    char text[40];
    for (int digits = 1; digits <= maxDigits; ++digits) {
        const auto end =
            std::to_chars(text, text + sizeof text, value, std::chars_format::general, digits);
        double candidate = 0.0;
        std::from_chars(text, end.ptr, candidate);
        if (std::fabs(candidate - value) > kSnap * std::fabs(value)) continue;
        if (std::fabs(back(candidate, thetaY) - target) <= off) return candidate;
    }
    return std::nullopt;
}

double ShortestPreimage(double value, double target, double thetaY, SKEL_MEASURE to)
{
    if (!std::isfinite(value) || std::fabs(thetaY) < kZeroTheta) return value;
    const T_CONVERT back = to == SKEL_MEASURE::Plastic ? RatioFromPlastic : PlasticFromRatio;
    constexpr int kEntered = 15; // digits that a person enters at most
    if (to == SKEL_MEASURE::DDy) {
        // A plastic deformation that went through the units of a file may be off in its last bits.
        const double lastBits = 4.0 * std::numeric_limits<double>::epsilon() * std::fabs(target);
        for (const double off : {0.0, lastBits}) {
            if (const auto v = ShortDecimal(value, target, thetaY, back, kEntered, off)) return *v;
        }
    }
    return ShortDecimal(value, target, thetaY, back, kMaxDigits, 0.0).value_or(value);
}

template <class SIDE>
auto ValuesOf(SIDE& s)
{
    return std::array{&s.B.deform, &s.C.deform, &s.D.deform, &s.E.deform, &s.IO, &s.LS, &s.CP};
}

void ConvertSide(T_SKEL_SIDE& side, double sign, SKEL_MEASURE to)
{
    const bool plastic = to == SKEL_MEASURE::Plastic;
    const T_CONVERT f = plastic ? PlasticFromRatio : RatioFromPlastic;
    const double theta = std::fabs(side.yieldDeform);
    for (double* v : ValuesOf(side)) {
        const double entered = sign * *v;
        const double converted = ShortestPreimage(f(entered, theta), entered, theta, to);
        *v = converted == 0.0 ? 0.0 : sign * converted; // no -0
    }
}

void RestoreSide(T_SKEL_SIDE& now, const T_SKEL_SIDE& was, const T_SKEL_SIDE& after,
                 const T_SKEL_SIDE& before)
{
    if (was.yieldDeform != before.yieldDeform) return;
    const auto n = ValuesOf(now);
    const auto w = ValuesOf(was), a = ValuesOf(after), b = ValuesOf(before);
    for (std::size_t i = 0; i < n.size(); ++i)
        if (*w[i] == *a[i]) *n[i] = *b[i];
}

} // namespace

double PlasticFromRatio(double ratio, double thetaY)
{
    return std::fabs(thetaY) < kZeroTheta ? 0.0 : (ratio - 1.0) * thetaY;
}

double RatioFromPlastic(double plastic, double thetaY)
{
    return std::fabs(thetaY) < kZeroTheta ? 0.0 : 1.0 + plastic / thetaY;
}

void ConvertSides(T_SIDES<T_SKEL_SIDE>& sides, SKEL_MEASURE to)
{
    ConvertSide(sides.pos, 1.0, to);
    ConvertSide(sides.neg, -1.0, to);
}

void RestoreSides(T_SIDES<T_SKEL_SIDE>& now, const T_SIDES<T_SKEL_SIDE>& was,
                  const T_SIDES<T_SKEL_SIDE>& after, const T_SIDES<T_SKEL_SIDE>& before)
{
    RestoreSide(now.pos, was.pos, after.pos, before.pos);
    RestoreSide(now.neg, was.neg, after.neg, before.neg);
}
