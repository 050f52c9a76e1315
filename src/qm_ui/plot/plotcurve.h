// The visible pixels of series and guide lines.
#pragma once

#include "qm_ui/plot/plotdata.h"
#include "qm_ui/plot/plotgeometry.h"
#include "qm_ui/plot/plotscale.h"

#include <vector>

/// The series in pixels, cut into runs at points that can't be shown on these axes.
[[nodiscard]] std::vector<PLOT_RUN> MapSeries(const T_PLOT_SERIES& series, const CPlotScale& x,
                                              const CPlotScale& y);

/// The runs thinned to two columns per px and clipped to the area.
[[nodiscard]] std::vector<PLOT_RUN> VisibleLines(const std::vector<PLOT_RUN>& runs,
                                                 const T_PLOT_BOX& area);

/// The places of markers in the area. A long series on a line shows some of its markers only;
/// markers without a line lose those only that would cover one another (one per 2 x 2 px stays).
[[nodiscard]] std::vector<T_PLOT_PX> VisibleMarkers(const std::vector<PLOT_RUN>& runs,
                                                    const T_PLOT_BOX& area, bool onLine);

/// The guide line over the whole area in pixels, not clipped, drawn towards its labelled end (up or
/// to the right). Empty when it has no place on these axes.
[[nodiscard]] PLOT_RUN MapGuide(const T_PLOT_GUIDE& guide, const CPlotScale& x, const CPlotScale& y,
                                const T_PLOT_BOX& area);
