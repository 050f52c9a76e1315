#include "json/resultjson.h"

#include "qm_rps/pushover/fema440coefficients.h"
#include "qm_rps/pushover/report/pushovercells.h"
#include "json/hingesatjson.h"

namespace {

void WriteFactors(CJsonText& w, const T_PUSH_EVALUATION& e)
{
    const T_PUSH_FACTORS& f = e.factors;
    w.Key("factors").Object();
    w.Member("gamma", f.gamma).Member("alpha", f.alpha).Member("mass", f.mass);
    w.Member("gravity", f.gravity).Member("eigen_based", f.eigenBased).Member("mode", f.mode);
    w.Member("note", e.gammaNote);
    w.End();
}

void Write(CJsonText& w, const std::optional<T_PERF_POINT>& p)
{
    if (!p) return w.Value(nullptr);
    w.Object();
    w.Member("Sd", p->Sd).Member("Sa", p->Sa).Member("D", p->D).Member("V", p->V);
    w.Member("T_eff", p->Teff).Member("damping", p->damping);
    w.End();
}

/// The members of a target displacement; null where its derivation did not come so far.
void WriteMembers(CJsonText& w, const T_TARGET_DISP& t, bool derived)
{
    const struct {
        const char* key;
        std::optional<double> value;
    } rows[] = {{"T_star", t.Tstar}, {"Tc", t.Tc}, {"Se", t.Se},        {"ay", t.ay},
                {"dy", t.dy},        {"Fy", t.Fy}, {"m_star", t.mStar}, {"det", t.det},
                {"dt", t.dt},        {"qu", t.qu}};
    for (const auto& row : rows)
        w.Member(row.key, derived ? row.value : std::nullopt);
    if (!derived) return;
    w.Member("branch", t.qu ? "short period" : "medium or long period");
    w.Member("capped", t.capped).Member("bilinear_fits", t.iterations);
}

/// How each target displacement came about, found or not.
void WriteDerivation(CJsonText& w, const T_PUSH_EVALUATION& e)
{
    w.Key("derivation").List();
    for (std::size_t i = 0; i < e.targets.size(); ++i) {
        const T_TARGET_DISP& t = e.targets[i];
        w.Object();
        w.Member("limit_state", e.targets.size() > 1 ? kLimitStateNames[i] : "SD");
        w.Member("found", t.found);
        WriteMembers(w, t, t.Tstar > 0.0);
        if (t.found) w.Member("line", TargetLine(t, e.factors.gamma));
        w.End();
    }
    w.End();
}

void WriteTarget(CJsonText& w, const T_PUSH_EVALUATION& e)
{
    w.Key("target");
    if (!e.IsTarget() || e.result == 0) return w.Value(nullptr);
    const bool one = e.eval.method == PUSH_METHOD::Ec8Opcm;
    if (!one) w.List();
    for (std::size_t i = 0; i < (one ? 1 : e.targets.size()); ++i) {
        w.Object();
        if (!one) w.Member("limit_state", kLimitStateNames[i]);
        WriteMembers(w, e.targets[i], e.targets[i].found);
        w.End();
    }
    if (!one) w.End();
}

void WriteLimitStates(CJsonText& w, const T_PUSH_EVALUATION& e)
{
    w.Key("limit_states").List();
    for (const T_LIMIT_ROW& r : e.limitStates) {
        w.Object();
        w.Member("name", r.name).Member("demand", r.demand).Member("demand_step", r.demandStep);
        w.Member("capacity", r.capacity).Member("capacity_step", r.capacityStep);
        w.Member("remark", r.remark.empty() ? std::nullopt : std::optional(r.remark));
        w.End();
    }
    w.End();
}

void Write(CJsonText& w, const T_PERFPT_TRIAL& t)
{
    const auto add = [&](const char* key, const std::optional<double>& v) {
        if (v) w.Member(key, *v);
    };
    w.Object();
    w.Member("trial", t.trial).Member("dpi", t.dpi).Member("api", t.api);
    add("dy", t.dy);
    add("ay", t.ay);
    add("alpha", t.alpha);
    add("mu", t.mu);
    if (t.row) w.Member("coefficients", Fema440RowText(*t.row));
    add("kappa", t.kappa);
    add("beta_eff", t.betaEff);
    add("SRa", t.SRa);
    add("SRv", t.SRv);
    add("T_eff", t.Teff);
    add("M", t.M);
    add("Di", t.Di);
    add("Ai", t.Ai);
    w.End();
}

void Write(CJsonText& w, const T_ADDITIONAL_STEP& s)
{
    w.Object();
    w.Member("step", s.step).Member("D", s.D).Member("V", s.V);
    w.Member("Sd", s.Sd).Member("Sa", s.Sa);
    w.End();
}

void Write(CJsonText& w, const T_ADDITIONAL_POINT& p)
{
    w.Object();
    w.Member("spectrum", p.spectrum).Member("status", StatusName(p.result));
    w.Key("performance_point");
    Write(w, p.point);
    w.Key("outcome").Object();
    w.Member("name", OutcomeName(p.outcome));
    w.End();
    w.End();
}

template <class T>
void WriteList(CJsonText& w, const char* key, const std::vector<T>& items)
{
    w.Key(key).List();
    for (const T& item : items)
        Write(w, item);
    w.End();
}

void WriteOutcome(CJsonText& w, const T_PUSH_EVALUATION& e)
{
    const std::string advice = OutcomeAdvice(e.outcome);
    w.Key("outcome").Object();
    w.Member("name", OutcomeName(e.outcome));
    w.Member("advice", e.pointNote.empty() ? advice : advice + " " + e.pointNote);
    w.End();
    w.Key("messages").List();
    for (const auto& m : e.messages) {
        w.Object();
        w.Member("key", m.key).Member("text", m.text);
        w.End();
    }
    w.End();
}

/// First change of slope and, of ATC-40 B, the periods by ductility.
void WriteSlope(CJsonText& w, const T_PUSH_EVALUATION& e)
{
    w.Key("first_slope_change");
    if (e.slopeChange) {
        w.Object();
        w.Member("Sd", e.slopeChange->x).Member("Sa", e.slopeChange->y);
        w.End();
    } else {
        w.Value(nullptr);
    }
    w.Key("periods_by_ductility").List();
    for (std::size_t i = 0; i < e.teffs.size() && i < kTeffDuctilities.size(); ++i) {
        w.Object();
        w.Member("mu", kTeffDuctilities[i]).Member("T_eff", e.teffs[i]);
        w.End();
    }
    w.End();
}

/// What the plotted curve reaches, and the displacements of the further nodes.
void WriteCurve(CJsonText& w, const T_PLOTTED_CURVE& c)
{
    w.Key("curve").Object();
    w.Member("plot_type", static_cast<int>(c.type));
    w.Member("largest_displacement", c.largestX).Member("largest_force", c.largestY);
    if (!c.monitored.empty()) {
        w.Key("monitored").List();
        for (const T_MONITORED_NODE& node : c.monitored) {
            w.Object();
            w.Member("node", node.node).Member("has_results", node.hasResults);
            w.Items("displacement", node.x, kJsonNested);
            w.End();
        }
        w.End();
    }
    w.End();
}

void Write(CJsonText& w, const T_PUSH_EVALUATION& e, const T_HINGES_AT* hinges)
{
    w.Object();
    w.Member("name", e.eval.name).Member("push", e.eval.push);
    w.Member("method", MethodName(e.eval.method));
    w.Member("procedure", std::string_view(&e.procedure, 1));
    w.Member("status", StatusName(e.Status()));
    WriteFactors(w, e);
    w.Key("capacity").Object();
    w.Items("Sd", e.capacity.Sd, kJsonNested).Items("Sa", e.capacity.Sa, kJsonNested);
    if (!e.steps.empty() && e.StepAt(e.steps.size() - 1) + 1 != std::ssize(e.steps))
        w.Items("step", e.steps, kJsonNested); // else it is the index
    w.End();
    w.Key("performance_point");
    Write(w, e.point);
    WriteTarget(w, e);
    WriteLimitStates(w, e);
    WriteOutcome(w, e);
    if (e.IsTarget())
        w.Member("curve_stays_elastic", e.elastic);
    else
        WriteSlope(w, e);
    WriteCurve(w, e.curve);
    if (!e.IsTarget()) WriteList(w, "all_points", e.allPoints);
    if (!e.additionalSteps.empty()) WriteList(w, "additional_steps", e.additionalSteps);
    if (!e.additionalPoints.empty()) WriteList(w, "additional_points", e.additionalPoints);
    if (e.IsTarget()) WriteDerivation(w, e);
    w.Member("trials", e.trace.size());
    WriteList(w, "trace", e.trace);
    if (hinges) WriteHingesAt(w, *hinges);
    w.End();
}

} // namespace

const char* StatusName(int result)
{
    static constexpr const char* kStatus[] = {"not found", "found", "elastic", "beyond the push"};
    return kStatus[result];
}

void WriteResults(CJsonText& w, const std::vector<T_PUSH_EVALUATION>& results,
                  const std::vector<T_HINGES_AT>& hinges)
{
    w.List();
    for (std::size_t i = 0; i < results.size(); ++i)
        Write(w, results[i], i < hinges.size() ? &hinges[i] : nullptr);
    w.End();
}

std::string ResultJson(const std::vector<T_PUSH_EVALUATION>& results,
                       const std::vector<T_HINGES_AT>& hinges)
{
    CJsonText w(JSON_REALS::WithPoint);
    WriteResults(w, results, hinges);
    return w.Text();
}
