// Crossings of lines and curves in the ADRS plane (Sd to the right, Sa upwards).
// Curves are polylines given by two arrays of equal length. "First" is first in walk order, index
// 0 outward. Everything is free of scale: see CMathFunc::mathIntersectLine2.
#pragma once

#include "qm_db/mathfunc.h"

#include <optional>
#include <span>

/// A polyline in ADRS: spectral displacement (length) and spectral acceleration (g).
struct T_ADRS_VIEW {
    std::span<const double> Sd;
    std::span<const double> Sa;
    std::size_t Size() const { return Sd.size(); }
    T_POINT2 At(std::size_t i) const { return {Sd[i], Sa[i]}; }
};

class CCurveCrossing {
public:
    /// First crossing of the half line from the origin through `toward`. A crossing at the origin
    /// itself does not count; a segment along the line does not cross it.
    static std::optional<T_POINT2> HalfLine(T_POINT2 toward, const T_ADRS_VIEW& curve);
    /// First crossing of the half line of period T, Sa = (2 pi / T)^2 Sd / g.
    static std::optional<T_POINT2> PeriodLine(double T, double gravity, const T_ADRS_VIEW& curve);
    /// First crossing of the vertical half line upwards from (d, 0).
    static std::optional<T_POINT2> Vertical(double d, const T_ADRS_VIEW& curve);
    /// First crossing of the segment P1-P2.
    static std::optional<T_POINT2> Segment(T_POINT2 P1, T_POINT2 P2, const T_ADRS_VIEW& curve);

    /// Crossing of the capacity curve with a demand curve whose points ascend in period: the first
    /// capacity segment that crosses any demand segment, and on it the crossing nearest its start.
    /// Linear in the number of points, since both curves are ordered by their radial angle.
    static std::optional<T_POINT2> CapacityWithDemand(const T_ADRS_VIEW& capacity,
                                                      const T_ADRS_VIEW& demand);
};
