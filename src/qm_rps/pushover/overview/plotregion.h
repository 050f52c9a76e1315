// The part of the capacity spectrum that an engineer looks at: demand, point and targets.
#pragma once

#include "qm_rps/pushover/pushevaluation.h"

#include <span>

/// From the origin to here, in the units of the results; Sa in g.
struct T_PLOT_REGION {
    double Sd = 0.0, Sa = 0.0;
    bool operator==(const T_PLOT_REGION&) const = default;
};

/// Holds every answer, the demand's lines, the last trial and the yield points with room around
/// them, and what demand and capacity reach there. Empty: no evaluation has found anything, so
/// that the whole curve is worth a look.
std::optional<T_PLOT_REGION> RegionOf(std::span<const T_PUSH_EVALUATION* const> evaluations);
