#include "qm_ui/evaluate/deskplot.h"

#include "qm_ui/evaluate/overlayplot.h"
#include "qm_ui/pushover/pushovercurveplot.h"

#include <algorithm>

namespace {

T_PLOT_RANGE WholeOf(const T_PLOT& plot, std::vector<double> T_PLOT_SERIES::*values)
{
    T_PLOT_RANGE whole{0.0, 0.0};
    for (const T_PLOT_SERIES& series : plot.series)
        for (const double value : series.*values) {
            whole.lo = std::min(whole.lo, value);
            whole.hi = std::max(whole.hi, value);
        }
    return whole;
}

/// The ends that are set over those of the picture. A span that is none leaves the picture's.
void Narrow(const T_PLOT& plot, T_PLOT_AXIS& axis, std::vector<double> T_PLOT_SERIES::*values,
            const T_AXIS_SPAN& span)
{
    if (!span.lo && !span.hi) return;
    const T_PLOT_RANGE whole = axis.range ? *axis.range : WholeOf(plot, values);
    const T_PLOT_RANGE wanted{span.lo.value_or(whole.lo), span.hi.value_or(whole.hi)};
    if (wanted.lo < wanted.hi) axis.range = wanted;
}

} // namespace

T_PLOT DeskPlot(CEvaluationDeskDlg& desk)
{
    const std::vector<const T_PUSH_EVALUATION*> overlaid = desk.Overlaid();
    T_PLOT plot = overlaid.empty()
                      ? PushoverCurvePlot(desk.Pictured(), desk.m_show, desk.Shown().Trial())
                      : OverlayPlot(overlaid, std::nullopt);
    plot.notes.clear(); // their values stand on the cards
    Narrow(plot, plot.x, &T_PLOT_SERIES::x, desk.XSpan());
    Narrow(plot, plot.y, &T_PLOT_SERIES::y, desk.YSpan());
    return plot;
}
