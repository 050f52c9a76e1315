// Target displacement of the N2 method (EN 1998-1 Annex B, NTC C7.3.4.2) on a bilinear curve, and
// the step searches and capacities of its limit states. Displacements in the model's length unit,
// accelerations in g, periods in s; SDOF unless stated.
#pragma once

#include "qm_rps/pushover/pushoverbilinear.h"

#include <functional>
#include <span>
#include <string>

/// Steps that were not found.
inline constexpr int kStepNone = -2;
/// Displacements that were not found.
inline constexpr double kDispNone = -2.0;

/// What a target displacement was derived from.
struct T_TARGET_DISP {
    bool found = false;
    double Tstar = 0.0; // period of the equivalent system
    double Tc = 0.0;    // end of the constant-acceleration range
    double Se = 0.0;    // elastic ordinate at T*, g
    double ay = 0.0, dy = 0.0;
    double Fy = 0.0;          // yield force, force unit
    double mStar = 0.0;       // mass
    double det = 0.0;         // elastic target
    double dt = 0.0;          // target
    std::optional<double> qu; // strength ratio; empty on the long-period branch
    bool capped = false;      // limited to 3 det (EN 1998-1 B.5)
    int iterations = 0;       // bilinear curves that were fitted
    T_OUTCOME outcome;
    bool operator==(const T_TARGET_DISP&) const = default;
};
inline auto Numbers(const T_TARGET_DISP& t)
{
    return std::tie(t.Tstar, t.Tc, t.Se, t.ay, t.dy, t.Fy, t.mStar, t.det, t.dt, t.qu);
}

/// Elastic and inelastic target displacement of a bilinear system. EN 1998-1 (B.7) to (B.9).
/// `capAt3` limits dt to 3 det: Eurocode 8 does, NTC does not. Fills everything but Fy and mStar;
/// `found` tells whether there is a target, `outcome` why not.
T_TARGET_DISP CalcTargetDisp(const T_BILINEAR& bilinear, double gravity, double Se, double Tc,
                             bool capAt3);

/// Step nearest to each demand: of the interval that holds it the nearer end, the lower one at
/// the midpoint; a later interval that holds it too overwrites. kStepNone beyond the curve.
std::vector<int> FindNearestSteps(std::span<const double> d, std::span<const double> demands);

/// Storey drift ratio of a step; empty where there is none.
using T_DRIFT_OF_STEP = std::function<std::optional<double>(int step)>;

/// Step up to the peak whose drift is nearest to a limit; the peak itself where its drift is
/// within the limit; `last` where no drift is nearer to the limit than 1. Empty where drifts are
/// missing.
std::optional<int> FindDriftStep(int peak, int last, double limit, const T_DRIFT_OF_STEP& drift);

/// First crossing of the force with a level, from the peak on, where the displacement is not below
/// `dMin`. The step is the nearer end of the interval, the lower one at the midpoint.
struct T_LEVEL_CROSSING {
    double d = 0.0;
    int step = 0;
};
std::optional<T_LEVEL_CROSSING> FindStrengthDrop(std::span<const double> d,
                                                 std::span<const double> V, int peak, double level,
                                                 double dMin);

/// Displacement at which the force first rises through a level, by more than rounding
/// (kSameOnCurve); 0 where it never does.
double FindRise(std::span<const double> d, std::span<const double> V, double level);

/// Displacement at which the behaviour factor reaches q on the bilinear curve.
double CalcBehaviourDisp(const T_BILINEAR& bilinear, double gravity, double Tstar, double Tc,
                         double q);
