#include "resultjson.h"

#include "qm_rps/pushover/fema440coefficients.h"

#include <nlohmann/json.hpp>

namespace {

using json = nlohmann::ordered_json;

template <class T>
json OrNull(const std::optional<T>& v)
{
    return v ? json(*v) : json(nullptr);
}

const char* StatusName(int result)
{
    static constexpr const char* kStatus[] = {"not found", "found", "elastic"};
    return kStatus[result];
}

json FactorsJson(const T_PUSH_FACTORS& f)
{
    return {{"gamma", f.gamma},
            {"alpha", f.alpha},
            {"mass", f.mass},
            {"gravity", f.gravity},
            {"eigen_based", f.eigenBased},
            {"mode", f.mode}};
}

json PointJson(const std::optional<T_PERF_POINT>& p)
{
    if (!p) return nullptr;
    return {{"Sd", p->Sd}, {"Sa", p->Sa},      {"D", p->D},
            {"V", p->V},   {"T_eff", p->Teff}, {"damping", OrNull(p->damping)}};
}

json OneTargetJson(const T_TARGET_DISP& t)
{
    if (!t.found)
        return {{"T_star", nullptr}, {"Tc", nullptr}, {"Se", nullptr},     {"ay", nullptr},
                {"dy", nullptr},     {"Fy", nullptr}, {"m_star", nullptr}, {"det", nullptr},
                {"dt", nullptr},     {"qu", nullptr}};
    return {{"T_star", t.Tstar},
            {"Tc", t.Tc},
            {"Se", t.Se},
            {"ay", t.ay},
            {"dy", t.dy},
            {"Fy", t.Fy},
            {"m_star", t.mStar},
            {"det", t.det},
            {"dt", t.dt},
            {"qu", OrNull(t.qu)},
            {"branch", t.qu ? "short period" : "medium or long period"},
            {"capped", t.capped},
            {"bilinear_fits", t.iterations}};
}

/// How each target displacement came about, found or not.
json DerivationJson(const T_PUSH_EVALUATION& e)
{
    json all = json::array();
    for (std::size_t i = 0; i < e.targets.size(); ++i) {
        T_TARGET_DISP t = e.targets[i];
        json state{{"limit_state", e.targets.size() > 1 ? kLimitStateNames[i] : "SD"},
                   {"found", t.found}};
        t.found = t.Tstar > 0.0;
        state.update(OneTargetJson(t));
        all.push_back(state);
    }
    return all;
}

json TargetJson(const T_PUSH_EVALUATION& e)
{
    if (!e.IsTarget() || e.result == 0) return nullptr;
    if (e.eval.method == PUSH_METHOD::Ec8Opcm) return OneTargetJson(e.targets.front());
    json states = json::array();
    for (std::size_t i = 0; i < e.targets.size(); ++i) {
        json state{{"limit_state", kLimitStateNames[i]}};
        state.update(OneTargetJson(e.targets[i]));
        states.push_back(state);
    }
    return states;
}

json LimitStatesJson(const T_PUSH_EVALUATION& e)
{
    json rows = json::array();
    for (const T_LIMIT_ROW& r : e.limitStates)
        rows.push_back({{"name", r.name},
                        {"demand", OrNull(r.demand)},
                        {"demand_step", OrNull(r.demandStep)},
                        {"capacity", OrNull(r.capacity)},
                        {"capacity_step", OrNull(r.capacityStep)},
                        {"remark", r.remark.empty() ? json(nullptr) : json(r.remark)}});
    return rows;
}

json TrialJson(const T_PERFPT_TRIAL& t)
{
    json row{{"trial", t.trial}, {"dpi", t.dpi}, {"api", t.api}};
    const auto add = [&](const char* key, const std::optional<double>& v) {
        if (v) row[key] = *v;
    };
    add("dy", t.dy);
    add("ay", t.ay);
    add("alpha", t.alpha);
    add("mu", t.mu);
    if (t.row) row["coefficients"] = Fema440RowText(*t.row);
    add("kappa", t.kappa);
    add("beta_eff", t.betaEff);
    add("SRa", t.SRa);
    add("SRv", t.SRv);
    add("T_eff", t.Teff);
    add("M", t.M);
    add("Di", t.Di);
    add("Ai", t.Ai);
    return row;
}

void AddPoints(json& o, const T_PUSH_EVALUATION& e)
{
    if (!e.IsTarget()) {
        o["all_points"] = json::array();
        for (const T_PERF_POINT& p : e.allPoints)
            o["all_points"].push_back(PointJson(p));
    }
    if (!e.additionalSteps.empty()) o["additional_steps"] = json::array();
    for (const T_ADDITIONAL_STEP& s : e.additionalSteps)
        o["additional_steps"].push_back(
            {{"step", s.step}, {"D", s.D}, {"V", s.V}, {"Sd", s.Sd}, {"Sa", s.Sa}});
    if (!e.additionalPoints.empty()) o["additional_points"] = json::array();
    for (const T_ADDITIONAL_POINT& p : e.additionalPoints)
        o["additional_points"].push_back({{"spectrum", p.spectrum},
                                          {"status", StatusName(p.result)},
                                          {"performance_point", PointJson(p.point)},
                                          {"outcome", {{"name", OutcomeName(p.outcome)}}}});
}

/// The advice, with what the balanced points add to it.
std::string Advice(const T_PUSH_EVALUATION& e)
{
    const std::string advice = OutcomeAdvice(e.outcome);
    return e.pointNote.empty() ? advice : advice + " " + e.pointNote;
}

json EvaluationJson(const T_PUSH_EVALUATION& e)
{
    json o{{"name", e.eval.name},
           {"push", e.eval.push},
           {"method", MethodName(e.eval.method)},
           {"procedure", std::string(1, e.procedure)},
           {"status", StatusName(e.result)},
           {"factors", FactorsJson(e.factors)},
           {"capacity", {{"Sd", e.capacity.Sd}, {"Sa", e.capacity.Sa}}},
           {"performance_point", PointJson(e.point)},
           {"target", TargetJson(e)},
           {"limit_states", LimitStatesJson(e)},
           {"outcome", {{"name", OutcomeName(e.outcome)}, {"advice", Advice(e)}}},
           {"messages", json::array()}};
    o["factors"]["note"] = e.gammaNote;
    AddPoints(o, e);
    if (e.IsTarget()) o["derivation"] = DerivationJson(e);
    for (const auto& m : e.messages)
        o["messages"].push_back({{"key", m.key}, {"text", m.text}});
    o["trials"] = e.trace.size();
    o["trace"] = json::array();
    for (const T_PERFPT_TRIAL& t : e.trace)
        o["trace"].push_back(TrialJson(t));
    return o;
}

} // namespace

std::string ResultJson(const std::vector<T_PUSH_EVALUATION>& results)
{
    json all = json::array();
    for (const T_PUSH_EVALUATION& e : results)
        all.push_back(EvaluationJson(e));
    return all.dump(1) + "\n";
}
