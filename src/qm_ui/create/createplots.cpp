#include "qm_ui/create/createplots.h"

#include "qm_base/say.h"
#include "qm_db/spectrumrules.h"
#include "qm_rps/dialog/unithead.h"

namespace {

constexpr double kGravity = 9.80665; // m/s2

} // namespace

T_PLOT CurvePlot(const T_CURVE_READ* read, const T_UNITS& units)
{
    T_PLOT plot;
    plot.title = Say("IDS_QM_NEW_PLOT_CURVE");
    plot.x.title = HeadWithUnit("d", kDimLength, units);
    plot.y.title = HeadWithUnit("V", kDimForce, units);
    plot.legend = false;
    if (!read) {
        plot.notes.push_back(Say("IDS_QM_NEW_NOTHING"));
        return plot;
    }
    T_PLOT_SERIES& curve = plot.series.emplace_back();
    curve.line = PLOT_LINE::Solid;
    constexpr std::size_t kMostMarks = 60; // points that are marked one by one
    curve.marker = read->points.size() <= kMostMarks ? PLOT_MARKER::Circle : PLOT_MARKER::None;
    curve.markerSize = 5.0;
    for (const T_CURVE_POINT& point : read->points) {
        curve.x.push_back(point.displacement);
        curve.y.push_back(point.force);
    }
    return plot;
}

T_PLOT SpectrumPlot(const T_SPFC_D& spectrum, SPECTRUM_AXES axes, const T_UNITS& units)
{
    T_PLOT plot;
    const bool overT = axes == SPECTRUM_AXES::Periods;
    plot.title = spectrum.name;
    plot.x.title = overT ? "T (s)" : HeadWithUnit("Sd", kDimLength, units);
    plot.y.title = "Sa (g)";
    if (const auto findings = RecordFindings({}, spectrum, 0); !findings.empty()) {
        plot.notes.push_back(findings.front().text);
        return plot;
    }
    for (const T_SPECTRUM_CURVE& curve :
         SpectrumCurves(spectrum, FromSi(kGravity, units, kDimAccel))) {
        T_PLOT_SERIES& series = plot.series.emplace_back();
        series.name = curve.name;
        series.x = overT ? curve.T : curve.Sd;
        series.y = curve.Sa;
        series.marker = PLOT_MARKER::None;
    }
    plot.legend = plot.series.size() > 1;
    return plot;
}
