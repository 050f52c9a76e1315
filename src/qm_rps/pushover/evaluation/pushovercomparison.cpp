#include "qm_rps/pushover/evaluation/pushovercomparison.h"

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

T_COMPARISON_ROW RowOf(const T_METHOD_ROW& method, const T_PUSH_EVALUATION& e,
                       const CPushEvaluator& evaluator)
{
    T_COMPARISON_ROW row;
    row.label = method.label;
    row.outcome = e.outcome;
    if (e.point) {
        row.found = true;
        row.Sd = e.point->Sd;
        row.Sa = e.point->Sa;
        row.D = e.point->D;
        row.V = e.point->V;
    }
    for (const T_LIMIT_ROW& state : e.limitStates) {
        if (!method.state || state.name != method.state || !state.demand) continue;
        const double Sd = e.factors.gamma != 0.0 ? *state.demand / e.factors.gamma : 0.0;
        const std::optional<double> Sa = CapacityAt(e.capacity, Sd);
        if (!Sa) continue; // beyond the push: no force belongs to it
        row.found = true;
        row.D = *state.demand;
        row.Sd = Sd;
        row.Sa = row.V = *Sa;
        evaluator.TransferToDispAndReac(nullptr, &row.V);
    }
    return row;
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
        c.rows.push_back(RowOf(method, evaluator.Result(), evaluator));
        c.results.push_back(evaluator.Result());
    }
    if (asked.progress) asked.progress(kMethods.size(), kMethods.size());
    CalcSpread(c);
    out = std::move(c);
    return 1;
}
