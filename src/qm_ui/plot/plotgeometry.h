// Pixel geometry of a plot: points, boxes, decimation and clipping of lines.
#pragma once

#include <vector>

/// A place on the page, px to the right and down.
struct T_PLOT_PX {
    double x = 0.0;
    double y = 0.0;
    bool operator==(const T_PLOT_PX&) const = default;
};

/// A rectangle on the page: top left corner and size, px.
struct T_PLOT_BOX {
    double x = 0.0;
    double y = 0.0;
    double w = 0.0;
    double h = 0.0;
    [[nodiscard]] double Right() const { return x + w; }
    [[nodiscard]] double Bottom() const { return y + h; }
    [[nodiscard]] bool Holds(T_PLOT_PX p) const;
    [[nodiscard]] bool Holds(const T_PLOT_BOX& b) const;
    [[nodiscard]] bool Meets(const T_PLOT_BOX& b) const; // they share more than an edge
    [[nodiscard]] T_PLOT_PX Nearest(T_PLOT_PX p) const;  // the point of the box nearest to p
    bool operator==(const T_PLOT_BOX&) const = default;
};

using PLOT_RUN = std::vector<T_PLOT_PX>; // points joined by a line

/// Thins a run: of neighbouring points in one pixel column (floor(x / columnPx)) the first, the
/// lowest, the highest and the last stay, in their order. All kept points are points of the run,
/// so that extremes survive; a run that rises in x keeps at most four points per column.
[[nodiscard]] PLOT_RUN DecimateRun(const PLOT_RUN& run, double columnPx);

/// The part of the segment a-b inside the box; false when there is none (a and b stay then).
/// Method: Liang and Barsky (1984), parametric line clipping.
[[nodiscard]] bool ClipSegment(const T_PLOT_BOX& box, T_PLOT_PX& a, T_PLOT_PX& b);

/// The parts of the run inside the box. A run of one point inside comes back as that point.
[[nodiscard]] std::vector<PLOT_RUN> ClipRun(const T_PLOT_BOX& box, const PLOT_RUN& run);

/// Distance of two places, px.
[[nodiscard]] double PlotDistance(T_PLOT_PX a, T_PLOT_PX b);
