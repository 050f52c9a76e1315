#include "qm_ui/pushover/evaluationplot.h"

#include "qm_base/msgfunction.h"
#include "qm_base/textformat.h"
#include "qm_rps/pushover/adrsformulas.h"
#include "qm_rps/pushover/outcometext.h"
#include "qm_rps/pushover/report/pushovercells.h"
#include "qm_ui/pushover/adrscurve.h"

#include <algorithm>
#include <array>
#include <cmath>

namespace {

constexpr T_PLOT_COLOR kBlack{0, 0, 0}, kBlue{20, 64, 140}, kRed{184, 40, 30}, kOchre{190, 120, 20},
    kGreen{20, 110, 60}, kGray{120, 120, 120};

using zql::lib::MMSGFunction;

/// "D demand = 12.3 m".
std::string ValueText(const std::string& what, double value, const char* format,
                      const std::string& unit)
{
    return what + " = " + FormatText(format, value) + (unit.empty() ? "" : " " + unit);
}

std::string LengthUnit(const T_PUSH_EVALUATION& e)
{
    return std::string(NameOf(e.units.length));
}
std::string ForceUnit(const T_PUSH_EVALUATION& e)
{
    return std::string(NameOf(e.units.force));
}

/// The elastic demand; for NTC one curve for each enabled limit state.
void AddDemands(T_PLOT& plot, const T_PUSH_EVALUATION& e)
{
    if (e.stateDemands.empty()) {
        AddAdrsCurve(plot, MMSGFunction::GetValue("IDS_QM_UI_PLOT_DEMAND").c_str(), e.demand,
                     PLOT_LINE::Solid, 1.6, kBlue);
        return;
    }
    constexpr std::array<PLOT_LINE, 4> kLines{PLOT_LINE::Dot, PLOT_LINE::DashDot, PLOT_LINE::Dash,
                                              PLOT_LINE::Solid};
    for (std::size_t i = 0; i < e.stateDemands.size(); ++i) {
        const std::string name =
            MMSGFunction::GetValue("IDS_QM_UI_PLOT_DEMAND") + " " + kLimitStateNames[i];
        AddAdrsCurve(plot, name.c_str(), e.stateDemands[i], kLines[i], 1.6, kBlue);
    }
}

void AddRadial(T_PLOT& plot, const char* what, double T, double gravity)
{
    if (!(T > 0.0) || !std::isfinite(T)) return;
    T_PLOT_GUIDE g;
    g.kind = PLOT_GUIDE::Radial;
    g.value = RadialSlope(T, gravity);
    g.label = FormatText("%s = %.3g s", what, T);
    g.line = PLOT_LINE::Dot;
    plot.guides.push_back(std::move(g));
}

double PeriodOfFirstStep(const T_PUSH_EVALUATION& e)
{
    if (e.capacity.Sd.size() < 2 || !(e.capacity.Sa[1] > 0.0)) return 0.0;
    return SecantPeriod(e.capacity.Sd[1], e.capacity.Sa[1], e.factors.gravity);
}

/// Trial points, numbered where they are few.
void AddTrials(T_PLOT& plot, const T_PUSH_EVALUATION& e)
{
    if (e.trace.empty()) return;
    T_ADRS_CURVE points;
    for (const T_PERFPT_TRIAL& t : e.trace) {
        points.Sd.push_back(t.dpi);
        points.Sa.push_back(t.api);
    }
    AddAdrsCurve(plot, MMSGFunction::GetValue("IDS_QM_UI_PLOT_TRIALS").c_str(), points,
                 PLOT_LINE::None, 1.0, kOchre, PLOT_MARKER::Square);
    constexpr std::size_t kNumbered = 6;
    if (e.trace.size() > kNumbered) return;
    for (const T_PERFPT_TRIAL& t : e.trace)
        plot.labels.push_back({t.dpi, t.api, std::to_string(t.trial), PLOT_MARKER::None, false});
}

void AddPoint(T_PLOT& plot, const T_PUSH_EVALUATION& e)
{
    if (!e.point) return;
    const T_PERF_POINT& p = *e.point;
    const std::string title = MMSGFunction::GetValue(e.result == 2 ? "IDS_QM_UI_PLOT_ELASTIC_POINT"
                                                                   : "IDS_QM_UI_PLOT_POINT");
    plot.labels.push_back({p.Sd, p.Sa,
                           FormatText("%s\nSd = %.4g %s, Sa = %.4g g", title.c_str(), p.Sd,
                                      LengthUnit(e).c_str(), p.Sa),
                           PLOT_MARKER::Circle, true});
}

/// The first change of slope, and the effective periods by ductility as lines; T0 has one anyway.
void AddSlopeAndPeriods(T_PLOT& plot, const T_PUSH_EVALUATION& e)
{
    if (e.slopeChange)
        plot.labels.push_back({e.slopeChange->x, e.slopeChange->y,
                               MMSGFunction::GetValue("IDS_QM_UI_PLOT_SLOPE_CHANGE"),
                               PLOT_MARKER::Plus, false});
    for (std::size_t i = 1; i < e.teffs.size(); ++i)
        AddRadial(plot, TeffName(i).c_str(), e.teffs[i], e.factors.gravity);
}

/// Other points where demand equals capacity, additional steps and points.
void AddExtras(T_PLOT& plot, const T_PUSH_EVALUATION& e)
{
    const auto isAnswer = [&](const T_PERF_POINT& p) {
        return e.point && std::fabs(p.Sd - e.point->Sd) <= 0.02 * p.Sd;
    };
    for (const T_PERF_POINT& p : e.allPoints) {
        if (!isAnswer(p))
            plot.labels.push_back({p.Sd, p.Sa, MMSGFunction::GetValue("IDS_QM_UI_PLOT_BALANCED"),
                                   PLOT_MARKER::Triangle, false});
    }
    for (const T_ADDITIONAL_STEP& s : e.additionalSteps)
        plot.labels.push_back({s.Sd, s.Sa, PlotStepText(s.step), PLOT_MARKER::Plus, false});
    for (const T_ADDITIONAL_POINT& p : e.additionalPoints) {
        if (p.point)
            plot.labels.push_back(
                {p.point->Sd, p.point->Sa, p.spectrum, PLOT_MARKER::Cross, false});
    }
}

void AddTargets(T_PLOT& plot, const T_PUSH_EVALUATION& e)
{
    if (e.bilinear) {
        const T_BILINEAR& b = *e.bilinear;
        AddAdrsCurve(plot, MMSGFunction::GetValue("IDS_QM_UI_PLOT_BILINEAR").c_str(),
                     {{0.0, b.dy, b.du}, {0.0, b.ay, b.au}}, PLOT_LINE::DashDot, 1.6, kGreen);
    }
    for (const T_GUIDE_LINE& line : e.guideLines) {
        T_PLOT_GUIDE g;
        g.value = line.Sd;
        g.label = line.label;
        g.line = line.kind == T_GUIDE_LINE::KIND::Demand ? PLOT_LINE::Dash : PLOT_LINE::DashDot;
        g.color = line.kind == T_GUIDE_LINE::KIND::Demand ? kRed : kGreen;
        plot.guides.push_back(std::move(g));
    }
}

void SetRanges(T_PLOT& plot, const T_PUSH_EVALUATION& e)
{
    double x = 0.0, y = 0.0;
    const auto widen = [&](const T_ADRS_CURVE& c) {
        for (const double v : c.Sd)
            x = std::max(x, v);
        for (const double v : c.Sa)
            y = std::max(y, v);
    };
    widen(e.capacity);
    widen(e.locus);
    for (const T_PERFPT_TRIAL& t : e.trace)
        x = std::max(x, t.dpi);
    for (const T_GUIDE_LINE& g : e.guideLines)
        x = std::max(x, g.Sd);
    if (!IsOtherPlot(e)) x = std::max(x, e.curve.largestX);
    for (const double a : e.demand.Sa)
        y = std::max(y, a);
    for (const T_ADRS_CURVE& c : e.stateDemands) {
        for (const double a : c.Sa)
            y = std::max(y, a);
    }
    if (x > 0.0 && y > 0.0) {
        plot.x.range = T_PLOT_RANGE{0.0, 1.12 * x};
        plot.y.range = T_PLOT_RANGE{0.0, 1.1 * y};
    }
}

} // namespace

std::string PlotStepText(int step)
{
    return MMSGFunction::Format("IDS_QM_UI_PLOT_STEP", {std::to_string(step)});
}

std::string ShownPushName(const T_PUSH_EVALUATION& e)
{
    return e.IsOld() ? MMSGFunction::Format("IDS_QM_UI_PUSH_OLD_NAME", {e.eval.push}) : e.eval.push;
}

std::string PlotSubtitle(const T_PUSH_EVALUATION& e)
{
    std::string method = MethodName(e.eval.method);
    if (!e.IsTarget())
        method +=
            " " + MMSGFunction::Format("IDS_QM_UI_PLOT_PROCEDURE", {std::string(1, e.procedure)});
    return MMSGFunction::Format("IDS_QM_UI_PLOT_SUBTITLE",
                                {method, ShownPushName(e), e.eval.spectrum});
}

void AddEvaluationNotes(T_PLOT& plot, const T_PUSH_EVALUATION& e)
{
    plot.notes.push_back(MMSGFunction::GetValue("IDS_QM_UI_PLOT_OUTCOME") + ": " +
                         OutcomeText(e.outcome));
    if (e.point) {
        plot.notes.push_back(FormatText("D = %.5g %s", e.point->D, LengthUnit(e).c_str()));
        plot.notes.push_back(FormatText("V = %.5g %s", e.point->V, ForceUnit(e).c_str()));
        plot.notes.push_back(FormatText("T_eff = %.4g s", e.point->Teff));
        if (e.point->damping)
            plot.notes.push_back(ValueText(MMSGFunction::GetValue("IDS_QM_UI_PLOT_DAMPING"),
                                           *e.point->damping, "%.4g", "%"));
        plot.notes.push_back(MMSGFunction::GetValue("IDS_QM_UI_PUSH_TRIALS") + ": " +
                             std::to_string(e.trace.size()));
    }
    for (const T_LIMIT_ROW& row : e.limitStates) {
        if (row.demand)
            plot.notes.push_back(
                ValueText(MMSGFunction::Format("IDS_QM_UI_PLOT_STATE_DEMAND", {row.name}),
                          *row.demand, "%.4g", LengthUnit(e)));
    }
    plot.notes.push_back(FormatText("Gamma = %.4g, m* = %.5g %s s2/%s", e.factors.gamma, e.mStar,
                                    ForceUnit(e).c_str(), LengthUnit(e).c_str()));
}

namespace {

/// A curve of Sd and Sa over its periods: T = 2 pi sqrt(Sd / (Sa g)); points without force have
/// none.
T_ADRS_CURVE OverPeriods(const T_ADRS_CURVE& c, double gravity)
{
    T_ADRS_CURVE out;
    for (std::size_t i = 0; i < c.Sd.size(); ++i) {
        if (!(c.Sa[i] > 0.0)) continue;
        out.Sd.push_back(SecantPeriod(c.Sd[i], c.Sa[i], gravity));
        out.Sa.push_back(c.Sa[i]);
    }
    return out;
}

} // namespace

T_PLOT DemandPlot(const T_PUSH_EVALUATION& e)
{
    const bool byPeriod = e.shownOver == SPECTRUM_SHOW::Period;
    T_PUSH_EVALUATION shown;
    const auto take = [&](const T_ADRS_CURVE& c) {
        return byPeriod ? OverPeriods(c, e.factors.gravity) : c;
    };
    shown.demand = take(e.demand);
    for (const T_ADRS_CURVE& c : e.stateDemands)
        shown.stateDemands.push_back(take(c));
    T_PLOT plot;
    plot.title = e.eval.spectrum;
    plot.x.title = byPeriod ? "T (s)"
                            : MMSGFunction::GetValue("IDS_PUSHOVER_Spectral_Displ_") + " (" +
                                  LengthUnit(e) + ")";
    plot.y.title = MMSGFunction::GetValue("IDS_PUSHOVER_Spectral_Accel__g_");
    AddDemands(plot, shown);
    AddAdrsCurve(plot, MMSGFunction::GetValue("IDS_QM_UI_PLOT_REDUCED").c_str(), take(e.reduced),
                 PLOT_LINE::Dash, 1.8, kRed);
    return plot;
}

void AddMonitoredNodes(T_PLOT& plot, const T_PUSH_EVALUATION& e)
{
    for (const T_MONITORED_NODE& node : e.curve.monitored) {
        if (!node.hasResults) continue;
        T_PLOT_SERIES s;
        s.name = MMSGFunction::Format("IDS_QM_UI_PUSH_NODE_COLUMN", {std::to_string(node.node)});
        s.x = node.x;
        s.y = e.curve.y;
        s.line = PLOT_LINE::Dot;
        s.marker = PLOT_MARKER::None;
        s.color = kGray;
        plot.series.push_back(std::move(s));
    }
}

T_PLOT EvaluationPlot(const T_PUSH_EVALUATION& e)
{
    T_PLOT plot;
    plot.title = e.eval.name;
    plot.subtitle = MMSGFunction::GetValue("IDS_PUSHOVER_Capacity_Spectrum_vs_Demand_Spectrum") +
                    ", " + PlotSubtitle(e);
    plot.x.title =
        MMSGFunction::GetValue("IDS_PUSHOVER_Spectral_Displ_") + " (" + LengthUnit(e) + ")";
    plot.y.title = MMSGFunction::GetValue("IDS_PUSHOVER_Spectral_Accel__g_");
    AddDemands(plot, e);
    AddAdrsCurve(plot, MMSGFunction::GetValue("IDS_QM_UI_PLOT_WORKING").c_str(), e.working,
                 PLOT_LINE::DashDot, 1.4, kGray);
    AddAdrsCurve(plot, MMSGFunction::GetValue("IDS_QM_UI_PLOT_REDUCED").c_str(), e.reduced,
                 PLOT_LINE::Dash, 1.8, kRed);
    AddAdrsCurve(plot, MMSGFunction::GetValue("IDS_QM_UI_PLOT_CAPACITY").c_str(), e.capacity,
                 PLOT_LINE::Solid, 2.6, kBlack);
    AddAdrsCurve(plot, MMSGFunction::GetValue("IDS_QM_UI_PLOT_LOCUS").c_str(), e.locus,
                 PLOT_LINE::Dot, 1.6, kGreen, PLOT_MARKER::Triangle);
    AddTargets(plot, e);
    AddTrials(plot, e);
    AddPoint(plot, e);
    AddExtras(plot, e);
    AddSlopeAndPeriods(plot, e);
    if (!IsOtherPlot(e)) AddMonitoredNodes(plot, e);
    AddRadial(plot, "T0", PeriodOfFirstStep(e), e.factors.gravity);
    if (e.point) AddRadial(plot, "T_eff", e.point->Teff, e.factors.gravity);
    SetRanges(plot, e);
    AddEvaluationNotes(plot, e);
    return plot;
}
