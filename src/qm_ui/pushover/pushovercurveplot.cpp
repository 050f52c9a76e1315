#include "qm_ui/pushover/pushovercurveplot.h"

#include "qm_base/msgfunction.h"
#include "qm_base/textformat.h"
#include "qm_rps/pushover/report/pushovercells.h"
#include "qm_rps/pushovercurvedampparamuser.h"
#include "qm_ui/pushover/evaluationplot.h"

namespace {

using zql::lib::MMSGFunction;
using KIND = T_GUIDE_LINE::KIND;

constexpr T_PLOT_COLOR kBlack{0, 0, 0}, kRed{184, 40, 30}, kGreen{20, 110, 60},
    kOchre{190, 120, 20}, kViolet{110, 40, 140};

/// On the curve of the other plot type: the point, the trials, the limit states, the steps.
void AddPlaces(T_PLOT& plot, const T_PUSH_EVALUATION& e)
{
    T_PLOT_SERIES trials;
    trials.name = MMSGFunction::GetValue("IDS_QM_UI_PLOT_TRIALS");
    trials.line = PLOT_LINE::None;
    trials.marker = PLOT_MARKER::Square;
    trials.color = kOchre;
    for (const T_PERFPT_TRIAL& t : e.trace) {
        const auto at = PlaceOnCurve(e, t.dpi);
        if (!at) continue;
        trials.x.push_back(at->x);
        trials.y.push_back(at->y);
    }
    if (!trials.x.empty()) plot.series.push_back(std::move(trials));
    if (const auto at = e.point ? PlaceOnCurve(e, e.point->Sd) : std::nullopt)
        plot.labels.push_back({at->x, at->y,
                               MMSGFunction::GetValue("IDS_QM_UI_PLOT_POINT") + "\n" +
                                   FormatText("x = %.4g, y = %.4g", at->x, at->y),
                               PLOT_MARKER::Circle, true});
    for (const T_GUIDE_LINE& line : e.guideLines)
        if (const auto at = PlaceOnCurve(e, line.Sd))
            plot.guides.push_back({PLOT_GUIDE::Vertical, at->x, line.label,
                                   line.kind == KIND::Demand ? PLOT_LINE::Dash : PLOT_LINE::DashDot,
                                   line.kind == KIND::Demand ? kRed : kGreen});
    for (const T_ADDITIONAL_STEP& s : e.additionalSteps) {
        const auto i = e.IndexOf(s.step);
        if (i && *i < e.curve.x.size())
            plot.labels.push_back(
                {e.curve.x[*i], e.curve.y[*i], PlotStepText(s.step), PLOT_MARKER::Plus, false});
    }
}

T_PLOT OtherPlot(const T_PUSH_EVALUATION& e)
{
    T_PLOT plot;
    plot.title = e.eval.name;
    plot.subtitle = PlotSubtitle(e);
    plot.x.title = PlotXTitle(e.curve.type, e.units);
    plot.y.title = PlotYTitle(e.curve.type, e.units);
    T_PLOT_SERIES curve;
    curve.name = MMSGFunction::GetValue("IDS_QM_UI_PLOT_CURVE");
    curve.x = e.curve.x;
    curve.y = e.curve.y;
    curve.line = PLOT_LINE::Solid;
    curve.marker = PLOT_MARKER::None;
    curve.width = 2.6;
    curve.color = kBlack;
    plot.series.push_back(std::move(curve));
    AddMonitoredNodes(plot, e);
    AddPlaces(plot, e);
    AddEvaluationNotes(plot, e);
    return plot;
}

/// The trial's point, its bilinear representation, and the point that it found.
void PointOutTrial(T_PLOT& plot, const T_PUSH_EVALUATION& e, int trial)
{
    if (trial < 1 || trial > static_cast<int>(e.trace.size())) return;
    const T_PERFPT_TRIAL& t = e.trace[static_cast<std::size_t>(trial) - 1];
    const std::string name = MMSGFunction::Format("IDS_QM_UI_PLOT_TRIAL", {std::to_string(trial)});
    if (IsOtherPlot(e)) {
        if (const auto at = PlaceOnCurve(e, t.dpi))
            plot.labels.push_back({at->x, at->y, name, PLOT_MARKER::Square, true});
        return;
    }
    if (t.dy && t.ay) {
        T_PLOT_SERIES s;
        s.name = MMSGFunction::Format("IDS_QM_UI_PLOT_TRIAL_BILINEAR", {std::to_string(trial)});
        s.x = {0.0, *t.dy, t.dpi};
        s.y = {0.0, *t.ay, t.api};
        s.line = PLOT_LINE::Dash;
        s.marker = PLOT_MARKER::None;
        s.color = kViolet;
        s.width = 2.0;
        plot.series.push_back(std::move(s));
    }
    plot.labels.push_back({t.dpi, t.api, name, PLOT_MARKER::Square, true});
    if (t.Di && t.Ai)
        plot.labels.push_back(
            {*t.Di, *t.Ai,
             MMSGFunction::Format("IDS_QM_UI_PLOT_TRIAL_FOUND", {std::to_string(trial)}),
             PLOT_MARKER::Cross, false});
}

bool IsShown(const T_PUSH_SHOW& show, KIND kind)
{
    if (!show.guideLines) return false;
    return kind == KIND::Demand     ? show.demandLines
           : kind == KIND::Capacity ? show.capacityLines
                                    : show.qStarLine;
}

void HideSymbols(T_PLOT& plot)
{
    std::erase_if(plot.series, [](const T_PLOT_SERIES& s) { return s.line == PLOT_LINE::None; });
    for (T_PLOT_SERIES& s : plot.series)
        s.marker = PLOT_MARKER::None;
    std::erase_if(plot.labels,
                  [](const T_PLOT_LABEL& l) { return l.marker == PLOT_MARKER::None && !l.bold; });
}

} // namespace

T_PLOT PushoverCurvePlot(const T_PUSH_EVALUATION& e, const T_PUSH_SHOW& show, int trial)
{
    if (e.curve.x.empty() && e.capacity.Sd.empty()) return {};
    T_PUSH_EVALUATION shown = e;
    std::erase_if(shown.guideLines,
                  [&](const T_GUIDE_LINE& line) { return !IsShown(show, line.kind); });
    T_PLOT plot = IsOtherPlot(shown) ? OtherPlot(shown) : EvaluationPlot(shown);
    if (!show.guideLines) plot.guides.clear(); // lines of the periods too
    if (!show.symbols) HideSymbols(plot);
    PointOutTrial(plot, shown, trial);
    return plot;
}

T_PLOT UserDampingPlot(const CPushOverCurveDampParamUser& points)
{
    T_PLOT plot;
    plot.x.title = MMSGFunction::GetValue("IDS_QM_UI_PLOT_BETA") + " (%)";
    plot.y.title = MMSGFunction::GetValue("IDS_QM_UI_PLOT_KAPPA");
    T_PLOT_SERIES s;
    s.name = "kappa";
    for (const T_POINT2& p : points.Curve()) {
        s.x.push_back(p.x);
        s.y.push_back(p.y);
    }
    s.line = PLOT_LINE::Solid;
    s.marker = PLOT_MARKER::None;
    plot.series.push_back(std::move(s));
    plot.labels.push_back({points.m_beta1, points.m_kappa1, "1", PLOT_MARKER::Circle, false});
    plot.labels.push_back({points.m_beta2, points.m_kappa2, "2", PLOT_MARKER::Circle, false});
    plot.legend = false;
    return plot;
}
