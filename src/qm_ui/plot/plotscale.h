// Maps values of one axis to pixels and back.
#pragma once

#include "qm_ui/plot/plotdata.h"

#include <vector>

/// Linear or log10 map of a range of values to a range of pixels.
/// Range: lo < hi, both above zero on a log axis; pxLo may lie above pxHi (y axis of a screen).
/// State: none after construction.
class CPlotScale {
public:
    CPlotScale() = default;
    CPlotScale(T_PLOT_RANGE range, bool log, double pxLo, double pxHi);

    /// A value that has a place on this kind of axis: finite, of sane size, above zero if log.
    [[nodiscard]] static bool CanShow(double value, bool log);
    /// Both ends can be shown and lo < hi, far enough apart for double precision.
    [[nodiscard]] static bool IsUsable(T_PLOT_RANGE range, bool log);

    [[nodiscard]] bool CanShow(double value) const { return CanShow(value, m_log); }
    [[nodiscard]] double ToPixel(double value) const;
    [[nodiscard]] double ToValue(double px) const;
    [[nodiscard]] T_PLOT_RANGE Range() const { return m_range; }
    [[nodiscard]] bool IsLog() const { return m_log; }

    /// The range with `span` times the present span (in decades if log) that shows `value` at `px`.
    /// Where that range is not usable, the present range.
    [[nodiscard]] T_PLOT_RANGE RangeWithValueAt(double value, double px, double span) const;

private:
    [[nodiscard]] double ToLine(double value) const; // value, or its log10
    [[nodiscard]] double FromLine(double line) const;

    T_PLOT_RANGE m_range;
    bool m_log = false;
    double m_pxLo = 0.0;
    double m_pxHi = 1.0;
};

/// The range that shows all values, rounded outwards: with some air to half a tick step on a linear
/// axis, which starts at zero when the data comes near it, and to 1-2-5 on a log axis. Values that
/// can't be shown are ignored; no value at all gives 0..1 (1..10 if log).
[[nodiscard]] T_PLOT_RANGE AutoPlotRange(const std::vector<double>& values, bool log);
