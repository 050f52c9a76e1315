#include "qm_ui/pushover/comparisonplot.h"

#include "qm_base/msgfunction.h"
#include "qm_base/textformat.h"
#include "qm_rps/pushover/outcometext.h"
#include "qm_ui/pushover/adrscurve.h"
#include "qm_ui/pushover/evaluationplot.h"

#include <algorithm>
#include <vector>

namespace {

using zql::lib::MMSGFunction;

/// Performance points as circles, target displacements as squares. Points that lie closer than
/// 2 % of the picture share one label.
void AddRows(T_PLOT& plot, const T_PUSH_COMPARISON& c, double width)
{
    std::vector<std::size_t> order;
    for (std::size_t i = 0; i < c.rows.size(); ++i) {
        if (c.rows[i].found) order.push_back(i);
    }
    std::ranges::stable_sort(order, {}, [&](std::size_t i) { return c.rows[i].Sd; });
    std::size_t head = 0; // label that the point at hand may join
    for (std::size_t k = 0; k < order.size(); ++k) {
        const T_COMPARISON_ROW& row = c.rows[order[k]];
        const PLOT_MARKER marker =
            c.results[order[k]].IsTarget() ? PLOT_MARKER::Square : PLOT_MARKER::Circle;
        const bool joins = k > 0 && row.Sd - plot.labels[head].x < 0.02 * width;
        if (joins) plot.labels[head].text += "\n" + row.label;
        if (!joins) head = plot.labels.size();
        plot.labels.push_back({row.Sd, row.Sa, joins ? std::string() : row.label, marker, false});
    }
}

void AddNotes(T_PLOT& plot, const T_PUSH_COMPARISON& c, const std::string& unit)
{
    for (const T_COMPARISON_ROW& row : c.rows)
        plot.notes.push_back(
            row.found ? FormatText("%s: D = %.4g %s", row.label.c_str(), row.D, unit.c_str())
                      : row.label + ": " + OutcomeText(row.outcome));
    if (c.count > 0)
        plot.notes.push_back(MMSGFunction::Format(
            "IDS_QM_UI_PLOT_SPREAD", {FormatText("%.4g", c.minD), FormatText("%.4g", c.maxD), unit,
                                      FormatText("%.3g", c.maxD / c.minD)}));
}

} // namespace

T_PLOT ComparisonPlot(const T_PUSH_COMPARISON& c)
{
    T_PLOT plot;
    if (c.results.empty()) return plot;
    const T_PUSH_EVALUATION& first = c.results.front();
    const std::string unit(NameOf(first.units.length));
    plot.title = MMSGFunction::Format("IDS_QM_UI_PLOT_ALL_METHODS", {ShownPushName(first)});
    plot.subtitle = MMSGFunction::Format("IDS_QM_UI_PLOT_ALL_SUBTITLE", {first.eval.spectrum});
    plot.x.title = MMSGFunction::GetValue("IDS_PUSHOVER_Spectral_Displ_") + " (" + unit + ")";
    plot.y.title = MMSGFunction::GetValue("IDS_PUSHOVER_Spectral_Accel__g_");
    AddAdrsCurve(plot, MMSGFunction::GetValue("IDS_QM_UI_PLOT_DEMAND").c_str(), first.demand,
                 PLOT_LINE::Solid, 1.6, {20, 64, 140});
    AddAdrsCurve(plot, MMSGFunction::GetValue("IDS_QM_UI_PLOT_CAPACITY").c_str(), first.capacity,
                 PLOT_LINE::Solid, 2.6, {0, 0, 0});
    for (const T_PUSH_EVALUATION& e : c.results) {
        if (e.eval.method != PUSH_METHOD::Ec8Opcm || !e.bilinear) continue;
        const T_BILINEAR& b = *e.bilinear;
        AddAdrsCurve(plot, (MMSGFunction::GetValue("IDS_QM_UI_PLOT_BILINEAR") + " (EC8)").c_str(),
                     {{0.0, b.dy, b.du}, {0.0, b.ay, b.au}}, PLOT_LINE::DashDot, 1.6,
                     {20, 110, 60});
    }
    AddNotes(plot, c, unit);
    double x = 0.0, y = 0.0;
    for (const double d : first.capacity.Sd)
        x = std::max(x, d);
    for (const T_COMPARISON_ROW& row : c.rows)
        x = std::max(x, row.Sd);
    for (const double a : first.demand.Sa)
        y = std::max(y, a);
    AddRows(plot, c, x);
    if (x > 0.0 && y > 0.0) {
        plot.x.range = T_PLOT_RANGE{0.0, 1.12 * x};
        plot.y.range = T_PLOT_RANGE{0.0, 1.1 * y};
    }
    return plot;
}
