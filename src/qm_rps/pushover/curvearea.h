// Area under a curve from its first point to a displacement, by running sums: each question costs
// a search, not a walk along the curve. The procedures ask at every trial.
#pragma once

#include "qm_rps/pushover/curvecrossing.h"

#include <vector>

class CCurveArea {
public:
    CCurveArea() = default;
    explicit CCurveArea(const T_ADRS_VIEW& curve);

    /// Whole trapezoids up to d, the last one cut; d beyond the curve: all of it. A curve that
    /// turns back ends with the segment that starts beyond d. `curve` is the one of the sums.
    double To(const T_ADRS_VIEW& curve, double d) const;

private:
    std::vector<double> m_sums;    // by point: area of the segments before it
    std::vector<double> m_largest; // by point: largest displacement up to it
};
