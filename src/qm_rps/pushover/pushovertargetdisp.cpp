#include "qm_rps/pushover/pushovertargetdisp.h"

#include "qm_db/compfunc.h"
#include "qm_rps/pushover/adrsformulas.h"

#include <algorithm>
#include <cmath>
#include <numbers>

namespace {

constexpr double kTolerance = 1e-10; // of the step searches

int Compare(double a, double b)
{
    return CCompFunc::CompRealTol(a, b, kTolerance);
}

double PeriodFactor(double T)
{
    return T / (2.0 * std::numbers::pi) * (T / (2.0 * std::numbers::pi));
}

/// Nearer end of the interval i, i+1; the lower one at the midpoint.
std::size_t NearerEnd(std::span<const double> d, std::size_t i, double t)
{
    return Compare(d[i + 1] - t, t - d[i]) < 0 ? i + 1 : i;
}

T_TARGET_DISP& None(T_TARGET_DISP& t, PUSH_OUTCOME code)
{
    t.found = false;
    t.outcome = {code, 0};
    return t;
}

} // namespace

T_TARGET_DISP CalcTargetDisp(const T_BILINEAR& bilinear, double gravity, double Se, double Tc,
                             bool capAt3)
{
    T_TARGET_DISP t;
    t.ay = bilinear.ay;
    t.dy = bilinear.dy;
    t.Se = Se;
    t.Tc = Tc;
    if (!(t.ay > 0.0)) return None(t, PUSH_OUTCOME::BilinearTooShort);
    t.Tstar = SecantPeriod(t.dy, t.ay, gravity);
    t.det = Se * gravity * PeriodFactor(t.Tstar);
    if (!std::isfinite(t.Tstar) || !std::isfinite(t.det)) return None(t, PUSH_OUTCOME::NoTarget);
    if (t.Tstar >= Tc) {
        t.dt = t.det;
    } else {
        if (t.Tstar == 0.0) return None(t, PUSH_OUTCOME::NoTarget);
        const double qu = Se / t.ay;
        t.qu = qu;
        if (qu == 0.0) return None(t, PUSH_OUTCOME::ZeroDemand);
        t.dt = qu <= 1.0 ? t.det : t.det / qu * (1.0 + (qu - 1.0) * Tc / t.Tstar);
        if (t.det > t.dt) return None(t, PUSH_OUTCOME::NoTarget); // kept as a guard, on purpose
        if (capAt3 && t.dt > 3.0 * t.det) {
            t.dt = 3.0 * t.det;
            t.capped = true;
        }
    }
    if (!std::isfinite(t.dt)) return None(t, PUSH_OUTCOME::NoTarget);
    t.found = true;
    t.outcome = {PUSH_OUTCOME::TargetFound, 0};
    return t;
}

std::vector<int> FindNearestSteps(std::span<const double> d, std::span<const double> demands)
{
    std::vector<int> steps(demands.size(), kStepNone);
    for (std::size_t i = 0; i + 1 < d.size(); ++i) {
        for (std::size_t k = 0; k < demands.size(); ++k) {
            const double t = demands[k];
            if (Compare(d[i], t) > 0 || Compare(t, d[i + 1]) >= 0) continue;
            steps[k] = static_cast<int>(NearerEnd(d, i, t));
        }
    }
    for (std::size_t k = 0; k < demands.size() && !d.empty(); ++k) {
        if (demands[k] == d.back()) steps[k] = static_cast<int>(d.size()) - 1;
    }
    return steps;
}

std::optional<int> FindDriftStep(int peak, int last, double limit, const T_DRIFT_OF_STEP& drift)
{
    const auto atPeak = drift(peak);
    if (!atPeak) return std::nullopt;
    if (*atPeak <= limit) return peak;
    double chosenDrift = 1.0;
    int chosen = last;
    for (int i = 1; i <= peak; ++i) {
        const auto value = drift(i);
        if (!value) return std::nullopt;
        if (!(std::fabs(*value - limit) < std::fabs(chosenDrift - limit))) continue;
        chosenDrift = *value;
        chosen = i;
    }
    return chosen;
}

std::optional<T_LEVEL_CROSSING> FindStrengthDrop(std::span<const double> d,
                                                 std::span<const double> V, int peak, double level,
                                                 double dMin)
{
    for (auto i = static_cast<std::size_t>(peak); i + 1 < d.size(); ++i) {
        if (Compare(d[i], dMin) < 0) continue;
        const bool rises = Compare(V[i], level) <= 0 && Compare(level, V[i + 1]) <= 0;
        const bool falls = Compare(V[i], level) >= 0 && Compare(level, V[i + 1]) >= 0;
        if (!falls && !rises) continue;
        T_LEVEL_CROSSING c;
        c.d = Compare(V[i], V[i + 1]) == 0
                  ? d[i]
                  : d[i] + (d[i + 1] - d[i]) * (level - V[i]) / (V[i + 1] - V[i]);
        c.step = static_cast<int>(NearerEnd(d, i, c.d));
        return c;
    }
    return std::nullopt;
}

double FindRise(std::span<const double> d, std::span<const double> V, double level)
{
    const double same = V.empty() ? 0.0 : kSameOnCurve * std::fabs(*std::ranges::max_element(V));
    for (std::size_t k = 1; k < d.size(); ++k) {
        if (V[k - 1] <= level + same && level + same < V[k])
            return d[k - 1] +
                   (d[k] - d[k - 1]) / (V[k] - V[k - 1]) * std::max(level - V[k - 1], 0.0);
    }
    return 0.0;
}

double CalcBehaviourDisp(const T_BILINEAR& bilinear, double gravity, double Tstar, double Tc,
                         double q)
{
    const double elastic = bilinear.ay * gravity * PeriodFactor(Tstar);
    if (Tstar >= Tc) return elastic * q;
    return elastic * q / q * (1.0 + (q - 1.0) * Tc / Tstar); // EN 1998-1 (B.8) with qu = q
}
