#include "qm_rps/pushover/report/pushovercells.h"

#include "qm_base/msgfunction.h"
#include "qm_base/textformat.h"
#include "qm_rps/pushover/fema440coefficients.h"
#include "qm_rps/pushover/report/pushoverreport.h"

#include <cmath>

namespace {

using zql::lib::MMSGFunction;
using ROW = std::vector<std::string>;

std::string Number(const std::optional<double>& v)
{
    return v ? FormatText("%.6g", *v) : "-";
}
/// A displacement of a limit state.
std::string State(const std::optional<double>& v)
{
    return v ? FormatText("%6.4g", *v) : "-";
}
std::string Step(const std::optional<int>& v)
{
    return v ? std::to_string(*v) : "-";
}

/// "D (m)".
std::string Head(const std::string& name, std::string_view unit)
{
    return name + " (" + std::string(unit) + ")";
}
std::string_view Length(const T_UNITS& units)
{
    return NameOf(units.length);
}
std::string_view Force(const T_UNITS& units)
{
    return NameOf(units.force);
}

void AddPointCells(const T_PUSH_EVALUATION& e, T_TEXT_TABLE& t)
{
    const std::string L(Length(e.units)), F(Force(e.units));
    const auto value = [&](auto get) { return e.point ? Number(get(*e.point)) : "-"; };
    t.rows.push_back(
        {"Sd (" + L + "), Sa (g)", PerfPointPair(e, &T_PERF_POINT::Sd, &T_PERF_POINT::Sa)});
    t.rows.push_back(
        {"D (" + L + "), V (" + F + ")", PerfPointPair(e, &T_PERF_POINT::D, &T_PERF_POINT::V)});
    t.rows.push_back({"Teff (s)", value([](const T_PERF_POINT& p) { return p.Teff; })});
    t.rows.push_back({"Deff (%)", value([](const T_PERF_POINT& p) { return p.damping; })});
    if (e.slopeChange)
        t.rows.push_back({MMSGFunction::Format("IDS_QM_UI_PUSH_SLOPE_CHANGE", {L}),
                          FormatText("%.6g, %.6g", e.slopeChange->x, e.slopeChange->y)});
    for (std::size_t i = 0; i < e.teffs.size() && i < kTeffDuctilities.size(); ++i)
        t.rows.push_back({TeffName(i) + " (s)", Number(e.teffs[i])});
    t.rows.push_back(
        {MMSGFunction::GetValue("IDS_QM_UI_PUSH_TRIALS"), std::to_string(e.trace.size())});
}

void AddTargetCells(const T_PUSH_EVALUATION& e, T_TEXT_TABLE& t)
{
    const std::string_view L = Length(e.units), F = Force(e.units);
    for (std::size_t i = 0; i < e.targets.size(); ++i) {
        const T_TARGET_DISP& d = e.targets[i];
        const std::string state = e.targets.size() > 1 ? kLimitStateNames[i] : "SD";
        if (d.found)
            t.rows.push_back({state + ": " + MMSGFunction::GetValue("IDS_QM_UI_PUSH_DERIVATION"),
                              TargetLine(d, e.factors.gamma)});
        const auto add = [&](const std::string& name, const std::optional<double>& v) {
            t.rows.push_back({state + ": " + name, d.found ? Number(v) : "-"});
        };
        add(Head("dt", L), e.factors.gamma * d.dt);
        add(Head("dt*", L), d.dt);
        add(Head("det*", L), d.det);
        add("T* (s)", d.Tstar);
        add("Tc (s)", d.Tc);
        add("Se(T*) (g)", d.Se);
        add("qu", d.qu);
        add(Head("Fy*", F), d.Fy);
        add(Head("dy*", L), d.dy);
    }
}

T_TEXT_COLUMN Column(std::string head)
{
    return {std::move(head), true};
}

} // namespace

std::string TeffName(std::size_t i)
{
    return i == 0 ? "T0" : FormatText("Teff(mu=%g)", kTeffDuctilities[i]);
}

std::string TargetLine(const T_TARGET_DISP& t, double gamma)
{
    if (!t.qu)
        return FormatText("(Long) det* = dt* = %g, Gamma = %g, Se(T*) = %g, T* = %g", t.dt, gamma,
                          t.Se, t.Tstar);
    // the blank before the second comma is meant
    return FormatText("(Short) T* = %g, Se(T*) = %g , det* = %g, dt* = %g, Gamma = %g", t.Tstar,
                      t.Se, t.det, t.dt, gamma);
}

std::string PerfPointPair(const T_PUSH_EVALUATION& e, double T_PERF_POINT::*first,
                          double T_PERF_POINT::*second)
{
    if (!e.point) return "-";
    const std::string cell = FormatText("%6.4g,  %6.4g", (*e.point).*first, (*e.point).*second);
    return e.result == 2 ? "Elastic(" + cell + ")" : cell;
}

T_TEXT_TABLE PushoverResultCells(const T_PUSH_EVALUATION& e)
{
    T_TEXT_TABLE t{{{MMSGFunction::GetValue("IDS_QM_UI_PUSH_VALUE_OF")},
                    Column(MMSGFunction::GetValue("IDS_QM_UI_PUSH_VALUE"))},
                   {}};
    t.rows.push_back({MMSGFunction::GetValue("IDS_QM_UI_PUSH_OUTCOME"), OutcomeName(e.outcome)});
    if (e.IsTarget())
        AddTargetCells(e, t);
    else
        AddPointCells(e, t);
    if (!e.curve.x.empty()) {
        const auto largest = [&](const std::string& title, double value) {
            t.rows.push_back(
                {MMSGFunction::Format("IDS_QM_UI_PUSH_LARGEST", {title}), Number(value)});
        };
        largest(PlotXTitle(e.curve.type, e.units), e.curve.largestX);
        largest(PlotYTitle(e.curve.type, e.units), e.curve.largestY);
    }
    t.rows.push_back({"Gamma", Number(e.factors.gamma)});
    t.rows.push_back({"alpha", Number(e.factors.alpha)});
    const std::string mass = std::string(Force(e.units)) + " s2/" + std::string(Length(e.units));
    t.rows.push_back({Head("m*", mass), Number(e.mStar)});
    return t;
}

T_TEXT_TABLE PushoverStateCells(const T_PUSH_EVALUATION& e)
{
    const std::string_view L = Length(e.units);
    T_TEXT_TABLE t{{{MMSGFunction::GetValue("IDS_QM_UI_PUSH_STATE")},
                    Column(Head(MMSGFunction::GetValue("IDS_QM_UI_PUSH_DEMAND"), L)),
                    Column(MMSGFunction::GetValue("IDS_QM_UI_PUSH_STEP")),
                    Column(Head(MMSGFunction::GetValue("IDS_QM_UI_PUSH_CAPACITY"), L)),
                    Column(MMSGFunction::GetValue("IDS_QM_UI_PUSH_STEP")),
                    {MMSGFunction::GetValue("IDS_QM_UI_PUSH_REMARK")}},
                   {}};
    for (const T_LIMIT_ROW& r : e.limitStates) {
        if (e.elastic)
            t.rows.push_back({r.name, "-", "-", kElasticText, "-", r.RemarkText()});
        else
            t.rows.push_back({r.name, State(r.demand), Step(r.demandStep), State(r.capacity),
                              Step(r.capacityStep), r.RemarkText()});
    }
    return t;
}

T_TEXT_TABLE PushoverTrialCells(const T_PUSH_EVALUATION& e)
{
    const std::string_view L = Length(e.units);
    struct T_CELL {
        const char* head;
        std::string_view unit;
        std::optional<double> T_PERFPT_TRIAL::*value;
    };
    using T = T_PERFPT_TRIAL;
    const T_CELL cells[] = {
        {"dy", L, &T::dy},    {"ay", "g", &T::ay},      {"alpha", "", &T::alpha},
        {"mu", "", &T::mu},   {"kappa", "", &T::kappa}, {"beta_eff", "%", &T::betaEff},
        {"SRa", "", &T::SRa}, {"SRv", "", &T::SRv},     {"Teff", "s", &T::Teff},
        {"M", "", &T::M},     {"Di", L, &T::Di},        {"Ai", "g", &T::Ai}};
    T_TEXT_TABLE t{{Column(Head("dpi", L)), Column("api (g)")}, {}};
    for (const T_CELL& c : cells)
        t.columns.push_back(Column(c.unit.empty() ? c.head : Head(c.head, c.unit)));
    t.columns.push_back({MMSGFunction::GetValue("IDS_QM_UI_PUSH_COEFFICIENTS")});
    for (const T& trial : e.trace) {
        ROW row{Number(trial.dpi), Number(trial.api)};
        for (const T_CELL& c : cells)
            row.push_back(Number(trial.*c.value));
        row.push_back(trial.row ? Fema440RowText(*trial.row) : "-");
        t.rows.push_back(std::move(row));
    }
    return t;
}

T_TEXT_TABLE PushoverCurveCells(const T_PUSH_EVALUATION& e)
{
    T_TEXT_TABLE t{
        {Column(PlotXTitle(e.curve.type, e.units)), Column(PlotYTitle(e.curve.type, e.units))}, {}};
    for (const T_MONITORED_NODE& node : e.curve.monitored)
        t.columns.push_back(Column(
            MMSGFunction::Format("IDS_QM_UI_PUSH_NODE_COLUMN", {std::to_string(node.node)})));
    for (std::size_t i = 0; i < e.curve.x.size(); ++i) {
        ROW row{Number(e.curve.x[i]), Number(e.curve.y[i])};
        for (const T_MONITORED_NODE& node : e.curve.monitored)
            row.push_back(node.hasResults ? Number(node.x[i]) : "-");
        t.rows.push_back(std::move(row));
    }
    return t;
}

T_TEXT_TABLE AdditionalStepCells(const T_PUSH_EVALUATION& e)
{
    const std::string_view L = Length(e.units);
    T_TEXT_TABLE t{{Column(MMSGFunction::GetValue("IDS_QM_UI_PUSH_STEP")), Column(Head("D", L)),
                    Column(Head("V", Force(e.units))), Column(Head("Sd", L)), Column("Sa (g)")},
                   {}};
    for (const T_ADDITIONAL_STEP& s : e.additionalSteps)
        t.rows.push_back(
            {std::to_string(s.step), Number(s.D), Number(s.V), Number(s.Sd), Number(s.Sa)});
    return t;
}

T_TEXT_TABLE AdditionalPointCells(const T_PUSH_EVALUATION& e)
{
    const std::string_view L = Length(e.units);
    T_TEXT_TABLE t{{{MMSGFunction::GetValue("IDS_QM_UI_HEAD_SPECTRUM")},
                    Column(Head("D", L)),
                    Column(Head("V", Force(e.units))),
                    Column(Head("Sd", L)),
                    Column("Sa (g)"),
                    {MMSGFunction::GetValue("IDS_QM_UI_PUSH_OUTCOME")}},
                   {}};
    for (const T_ADDITIONAL_POINT& p : e.additionalPoints) {
        const auto value = [&](double T_PERF_POINT::*member) {
            return p.point ? Number((*p.point).*member) : "-";
        };
        t.rows.push_back({p.spectrum, value(&T_PERF_POINT::D), value(&T_PERF_POINT::V),
                          value(&T_PERF_POINT::Sd), value(&T_PERF_POINT::Sa),
                          OutcomeName(p.outcome)});
    }
    return t;
}

std::string RemarkLine(const T_PUSH_EVALUATION& e)
{
    if (e.messages.empty()) return {};
    const std::string& first = e.messages.front().text;
    if (e.messages.size() == 1) return first;
    return MMSGFunction::Format("IDS_QM_UI_PUSH_MORE_REMARKS",
                                {first, std::to_string(e.messages.size() - 1)});
}

std::string OutcomeLines(const T_PUSH_EVALUATION& e)
{
    std::string text = OutcomeName(e.outcome) + ": " + OutcomeAdvice(e.outcome);
    if (!e.pointNote.empty()) text += "\n" + e.pointNote;
    for (const auto& m : e.messages)
        text += "\n! " + m.text;
    return text;
}

std::string PlotXTitle(PLOT_TYPE type, const T_UNITS& units)
{
    // A drift has no unit.
    return type == PLOT_TYPE::Drift ? PlotXLabel(type) : Head(PlotXLabel(type), Length(units));
}

std::string PlotYTitle(PLOT_TYPE type, const T_UNITS& units)
{
    // The label of a spectral acceleration has its unit; coefficients and factors have none.
    return type == PLOT_TYPE::BaseReaction ? Head(PlotYLabel(type), Force(units))
                                           : PlotYLabel(type);
}

bool IsOtherPlot(const T_PUSH_EVALUATION& e)
{
    return e.eval.plotType.value_or(static_cast<int>(e.eval.method)) !=
           static_cast<int>(e.eval.method);
}

std::optional<T_POINT2> PlaceOnCurve(const T_PUSH_EVALUATION& e, double Sd)
{
    const std::vector<double>& d = e.capacity.Sd;
    const T_PLOTTED_CURVE& c = e.curve;
    if (d.empty() || c.x.size() != d.size() || c.y.size() != d.size()) return std::nullopt;
    for (std::size_t i = 1; i < d.size(); ++i) {
        if (!(d[i - 1] <= Sd && Sd <= d[i] && d[i] > d[i - 1])) continue;
        const double t = (Sd - d[i - 1]) / (d[i] - d[i - 1]);
        return T_POINT2{std::lerp(c.x[i - 1], c.x[i], t), std::lerp(c.y[i - 1], c.y[i], t)};
    }
    return std::nullopt;
}
