#include "qm_rps/judge/spectrumfactor.h"

#include <cmath>

namespace {

constexpr double kClose = 1e-6; // of the target
constexpr int kMostTrials = 120;
constexpr double kStride = 1.5;

} // namespace

std::optional<double> FactorFor(double target, double guess, const DISPLACEMENT_AT_FACTOR& at)
{
    if (!(target > 0.0) || !(guess > 0.0) || !std::isfinite(guess)) return {};
    int trials = 0;
    // Distance to the target over the target; without an answer as far beyond as it can be told.
    const auto miss = [&](double factor) {
        ++trials;
        const std::optional<double> found = at(factor);
        return found ? (*found - target) / target : 1.0;
    };
    double low = guess, missLow = miss(low);
    while (missLow >= 0.0 && trials < kMostTrials / 2)
        missLow = miss(low /= kStride);
    double high = low * kStride, missHigh = miss(high);
    while (missHigh < 0.0 && trials < kMostTrials / 2) {
        low = high;
        missLow = missHigh;
        missHigh = miss(high *= kStride);
    }
    if (missLow >= 0.0 || missHigh < 0.0) return {};
    bool halve = false;
    constexpr double kNothing = 1e-14; // of the factor: the answer jumps
    while (trials < kMostTrials && high - low > kNothing * high) {
        const double share = halve ? 0.5 : missLow / (missLow - missHigh);
        const double middle = low + share * (high - low);
        const double found = miss(middle);
        if (std::fabs(found) <= 0.1 * kClose) return middle;
        const double before = high - low;
        (found < 0.0 ? low : high) = middle;
        (found < 0.0 ? missLow : missHigh) = found;
        halve = high - low > 0.5 * before;
    }
    if (-missLow <= kClose) return low;
    return missHigh <= kClose ? std::optional(high) : std::nullopt;
}
