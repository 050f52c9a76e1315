#include "qm_ui/evaluationplot.h"

#include "qm_base/textformat.h"
#include "qm_ui/adrscurve.h"

#include <algorithm>
#include <array>
#include <cmath>

namespace {

constexpr T_PLOT_COLOR kBlack{0, 0, 0}, kBlue{20, 64, 140}, kRed{184, 40, 30}, kOchre{190, 120, 20},
    kGreen{20, 110, 60}, kGray{120, 120, 120};

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
        AddAdrsCurve(plot, "Elastic demand", e.demand, PLOT_LINE::Solid, 1.6, kBlue);
        return;
    }
    constexpr std::array<PLOT_LINE, 4> kLines{PLOT_LINE::Dot, PLOT_LINE::DashDot, PLOT_LINE::Dash,
                                              PLOT_LINE::Solid};
    for (std::size_t i = 0; i < e.stateDemands.size(); ++i) {
        const std::string name = std::string("Elastic demand ") + kLimitStateNames[i];
        AddAdrsCurve(plot, name.c_str(), e.stateDemands[i], kLines[i], 1.6, kBlue);
    }
}

void AddRadial(T_PLOT& plot, const char* what, double T, double gravity)
{
    if (!(T > 0.0) || !std::isfinite(T)) return;
    T_PLOT_GUIDE g;
    g.kind = PLOT_GUIDE::Radial;
    g.value = 4.0 * std::acos(-1.0) * std::acos(-1.0) / (T * T * gravity);
    g.label = FormatText("%s = %.3g s", what, T);
    g.line = PLOT_LINE::Dot;
    plot.guides.push_back(std::move(g));
}

double PeriodOfFirstStep(const T_PUSH_EVALUATION& e)
{
    if (e.capacity.Sd.size() < 2 || !(e.capacity.Sa[1] > 0.0)) return 0.0;
    return 2.0 * std::acos(-1.0) *
           std::sqrt(e.capacity.Sd[1] / (e.capacity.Sa[1] * e.factors.gravity));
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
    AddAdrsCurve(plot, "Trial points", points, PLOT_LINE::None, 1.0, kOchre, PLOT_MARKER::Square);
    constexpr std::size_t kNumbered = 6;
    if (e.trace.size() > kNumbered) return;
    for (const T_PERFPT_TRIAL& t : e.trace)
        plot.labels.push_back({t.dpi, t.api, std::to_string(t.trial), PLOT_MARKER::None, false});
}

void AddPoint(T_PLOT& plot, const T_PUSH_EVALUATION& e)
{
    if (!e.point) return;
    const T_PERF_POINT& p = *e.point;
    const char* const title = e.result == 2 ? "Performance point (elastic)" : "Performance point";
    plot.labels.push_back(
        {p.Sd, p.Sa,
         FormatText("%s\nSd = %.4g %s, Sa = %.4g g", title, p.Sd, LengthUnit(e).c_str(), p.Sa),
         PLOT_MARKER::Circle, true});
}

/// Other points where demand equals capacity, additional steps and points.
void AddExtras(T_PLOT& plot, const T_PUSH_EVALUATION& e)
{
    const auto isAnswer = [&](const T_PERF_POINT& p) {
        return e.point && std::fabs(p.Sd - e.point->Sd) <= 0.02 * p.Sd;
    };
    for (const T_PERF_POINT& p : e.allPoints) {
        if (!isAnswer(p))
            plot.labels.push_back({p.Sd, p.Sa, "demand = capacity", PLOT_MARKER::Triangle, false});
    }
    for (const T_ADDITIONAL_STEP& s : e.additionalSteps)
        plot.labels.push_back(
            {s.Sd, s.Sa, FormatText("step %d", s.step), PLOT_MARKER::Plus, false});
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
        AddAdrsCurve(plot, "Bilinear capacity", {{0.0, b.dy, b.du}, {0.0, b.ay, b.au}},
                     PLOT_LINE::DashDot, 1.6, kGreen);
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

void AddNotes(T_PLOT& plot, const T_PUSH_EVALUATION& e)
{
    plot.notes.push_back("Outcome: " + OutcomeName(e.outcome));
    if (e.point) {
        plot.notes.push_back(FormatText("D = %.5g %s", e.point->D, LengthUnit(e).c_str()));
        plot.notes.push_back(FormatText("V = %.5g %s", e.point->V, ForceUnit(e).c_str()));
        plot.notes.push_back(FormatText("T_eff = %.4g s", e.point->Teff));
        if (e.point->damping)
            plot.notes.push_back(FormatText("Effective damping = %.4g %%", *e.point->damping));
        plot.notes.push_back(FormatText("Trials: %zu", e.trace.size()));
    }
    for (const T_LIMIT_ROW& row : e.limitStates) {
        if (row.demand)
            plot.notes.push_back(FormatText("%s demand = %.4g %s", row.name.c_str(), *row.demand,
                                            LengthUnit(e).c_str()));
    }
    plot.notes.push_back(FormatText("Gamma = %.4g, m* = %.5g %s s2/%s", e.factors.gamma, e.mStar,
                                    ForceUnit(e).c_str(), LengthUnit(e).c_str()));
}

} // namespace

T_PLOT EvaluationPlot(const T_PUSH_EVALUATION& e)
{
    T_PLOT plot;
    plot.title = e.eval.name;
    plot.subtitle = std::string(MethodName(e.eval.method)) +
                    (e.IsTarget() ? "" : std::string(" procedure ") + e.procedure) + ", pushover " +
                    e.eval.push + ", spectrum " + e.eval.spectrum;
    plot.x.title = "Spectral displacement Sd (" + LengthUnit(e) + ")";
    plot.y.title = "Spectral acceleration Sa (g)";
    AddDemands(plot, e);
    AddAdrsCurve(plot, "Working demand of the last trial", e.working, PLOT_LINE::DashDot, 1.4,
                 kGray);
    AddAdrsCurve(plot, "Reduced demand", e.reduced, PLOT_LINE::Dash, 1.8, kRed);
    AddAdrsCurve(plot, "Capacity", e.capacity, PLOT_LINE::Solid, 2.6, kBlack);
    AddAdrsCurve(plot, "Locus of demand points", e.locus, PLOT_LINE::Dot, 1.6, kGreen,
                 PLOT_MARKER::Triangle);
    AddTargets(plot, e);
    AddTrials(plot, e);
    AddPoint(plot, e);
    AddExtras(plot, e);
    AddRadial(plot, "T0", PeriodOfFirstStep(e), e.factors.gravity);
    if (e.point) AddRadial(plot, "T_eff", e.point->Teff, e.factors.gravity);
    SetRanges(plot, e);
    AddNotes(plot, e);
    return plot;
}
