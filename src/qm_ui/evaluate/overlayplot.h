// Pictures of several evaluations: their spectra in one plot, and bars of one of their figures.
#pragma once

#include "qm_rps/pushover/overview/evaluationcards.h"
#include "qm_rps/pushover/overview/plotregion.h"
#include "qm_ui/plot/plotdata.h"

#include <span>

/// Capacity spectra (one where several share it), demands (likewise), reduced demands, bilinear
/// curves and answers, in one colour for each evaluation. Shows the region; empty: all of it.
/// The evaluations have the same units.
T_PLOT OverlayPlot(std::span<const T_PUSH_EVALUATION* const> evaluations,
                   const std::optional<T_PLOT_REGION>& region);

/// One bar for each entry, with its value and verdict in words; an entry without the figure says
/// so. Bars have the colours of the verdicts.
T_PLOT BarsPlot(std::span<const T_EVALUATION_ENTRY> entries, CARD card);

/// Of lists, bars and pictures.
T_PLOT_COLOR VerdictColor(EVALUATION_VERDICT verdict);
