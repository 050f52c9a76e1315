#include "qm_rps/pushover/evaluation/pushovercomparison.h"

#include "qm_rps/pushover/adrsformulas.h"

#include <algorithm>

namespace {

struct T_METHOD_ROW {
    PUSH_METHOD method;
    char procedure;
    const char* label;
    const char* state; // limit state that stands for a target-displacement method
};

// clang-format off
constexpr std::array<T_METHOD_ROW, 8> kMethods{{
    {PUSH_METHOD::Atc40,   'A', "ATC-40 A",    nullptr},
    {PUSH_METHOD::Atc40,   'B', "ATC-40 B",    nullptr},
    {PUSH_METHOD::Fema440, 'A', "FEMA440 A",   nullptr},
    {PUSH_METHOD::Fema440, 'B', "FEMA440 B",   nullptr},
    {PUSH_METHOD::Fema440, 'C', "FEMA440 C",   nullptr},
    {PUSH_METHOD::Ec8Opcm, 'A', "EC8 SD",      "SD"},
    {PUSH_METHOD::Ntc2008, 'A', "NTC2008 SLV", "SLV"},
    {PUSH_METHOD::Ntc2018, 'A', "NTC2018 SLV", "SLV"},
}};
// clang-format on

/// state: the one whose demand is taken; null: there is none.
T_COMPARISON_ROW RowOf(const std::string& label, const T_LIMIT_ROW* state,
                       const T_PUSH_EVALUATION& e)
{
    T_COMPARISON_ROW row;
    row.label = label;
    row.outcome = e.outcome;
    if (e.point) {
        row.found = true;
        row.Sd = e.point->Sd;
        row.Sa = e.point->Sa;
        row.D = e.point->D;
        row.V = e.point->V;
    }
    if (!state || !state->demand) return row;
    const double Sd = e.factors.gamma != 0.0 ? *state->demand / e.factors.gamma : 0.0;
    const std::optional<double> Sa = CapacityAt(e.capacity, Sd);
    if (!Sa) return row; // beyond the push: no force belongs to it
    row.found = true;
    // That of the whole evaluation may be of another state, which lies beyond the push.
    if (row.outcome.code == PUSH_OUTCOME::TargetBeyond) row.outcome = {PUSH_OUTCOME::TargetFound};
    row.D = *state->demand;
    row.Sd = Sd;
    row.Sa = *Sa;
    row.V = BaseShear(*Sa, e.factors.alpha, e.factors.mass, e.factors.gravity);
    return row;
}

const T_LIMIT_ROW* StateNamed(const T_PUSH_EVALUATION& e, std::string_view name)
{
    const auto at = std::ranges::find(e.limitStates, name, &T_LIMIT_ROW::name);
    return at == e.limitStates.end() ? nullptr : &*at;
}

/// SD of Eurocode 8, SLV of NTC; where that is not asked for, the last state with a demand.
const T_LIMIT_ROW* ComparedState(const T_PUSH_EVALUATION& e)
{
    const T_LIMIT_ROW* last = nullptr;
    for (const T_LIMIT_ROW& state : e.limitStates) {
        if (state.demand && (state.name == "SD" || state.name == "SLV")) return &state;
        if (state.demand) last = &state;
    }
    return last;
}

void CalcSpread(T_PUSH_COMPARISON& c)
{
    double sum = 0.0;
    for (const T_COMPARISON_ROW& row : c.rows) {
        if (!row.found) continue;
        c.minD = c.count == 0 ? row.D : std::min(c.minD, row.D);
        c.maxD = std::max(c.maxD, row.D);
        sum += row.D;
        ++c.count;
    }
    if (c.count > 0) c.meanD = sum / c.count;
}

} // namespace

std::optional<double> CapacityAt(const T_ADRS_CURVE& curve, double Sd)
{
    if (curve.Sd.empty() || Sd > *std::ranges::max_element(curve.Sd)) return std::nullopt;
    const double first = curve.Sd.front();
    if (Sd < first) return curve.Sa.front() * Sd / first;
    return CurveAccelAt(curve.View(), Sd);
}

T_PUSH_COMPARISON ComparisonOf(std::vector<T_PUSH_EVALUATION> results)
{
    T_PUSH_COMPARISON c;
    for (const T_PUSH_EVALUATION& e : results) {
        const T_LIMIT_ROW* const state = ComparedState(e);
        const std::string label = state ? e.eval.name + " " + state->name : e.eval.name;
        c.rows.push_back(RowOf(label, state, e));
    }
    c.results = std::move(results);
    CalcSpread(c);
    return c;
}

std::vector<std::string> RemarksOf(const T_PUSH_COMPARISON& comparison)
{
    std::vector<std::string> texts;
    for (const T_PUSH_EVALUATION& e : comparison.results)
        for (const auto& m : e.messages)
            if (std::ranges::find(texts, m.text) == texts.end()) texts.push_back(m.text);
    return texts;
}

int ComparePushover(CPushEvaluator& evaluator, const T_COMPARISON_CASE& asked,
                    T_PUSH_COMPARISON& out, T_FINDING& refusal)
{
    T_PUSH_COMPARISON c;
    evaluator.SetStoreSteps(false);
    for (const T_METHOD_ROW& method : kMethods) {
        T_EVAL_D eval;
        eval.name = method.label;
        eval.push = asked.push;
        eval.spectrum = asked.spectrum;
        eval.method = method.method;
        eval.procedure = method.procedure;
        eval.behavior = asked.behavior;
        if (asked.progress) asked.progress(c.rows.size(), kMethods.size());
        if (!evaluator.SetEvaluation(eval, refusal)) return 0;
        evaluator.Evaluate();
        const T_PUSH_EVALUATION& result = evaluator.Result();
        const T_LIMIT_ROW* const state = method.state ? StateNamed(result, method.state) : nullptr;
        c.rows.push_back(RowOf(method.label, state, result));
        c.results.push_back(evaluator.Result());
    }
    if (asked.progress) asked.progress(kMethods.size(), kMethods.size());
    CalcSpread(c);
    out = std::move(c);
    return 1;
}
