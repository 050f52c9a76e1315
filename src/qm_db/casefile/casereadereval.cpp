#include "qm_db/casefile/casereader.h"
#include "qm_db/casefile/jsonnames.h"
#include "qm_db/records/evaluationrules.h"

#include <algorithm>

namespace {

template <class T>
bool HasName(const T_TABLE<T>& table, const std::string& name)
{
    return std::any_of(table.begin(), table.end(),
                       [&](const auto& entry) { return entry.second.name == name; });
}

/// A fault of the member where it breaks a rule of evaluations.
void Judge(CJsonReader& in, std::string_view key, const T_EVAL_D& eval)
{
    if (const char* const reason = EvaluationFault(eval, key)) in.FailAt(key, reason);
}

template <class T>
void GetJudged(CJsonReader& in, std::string_view key, std::optional<T>& out, const T_EVAL_D& eval)
{
    in.Get(key, out);
    Judge(in, key, eval);
}

void ReadProcedure(CJsonReader& in, T_EVAL_D& eval)
{
    if (!in.Has("procedure")) return;
    const auto offered = ProceduresOf(eval.method);
    if (offered.empty()) return in.FailAt("procedure", "only ATC-40 and FEMA440 have procedures");
    eval.procedure =
        *offered[static_cast<std::size_t>(in.Choice("procedure", offered, "procedure"))];
}

void ReadBilinear(CJsonReader in, T_EVAL_D& eval)
{
    T_EVAL_BILINEAR& bilinear = eval.bilinear.emplace();
    in.Keys({"rule", "secant", "drop", "iterate"});
    if (in.Has("rule"))
        bilinear.rule = kBilinearRules[static_cast<std::size_t>(
            in.Choice("rule", kBilinearRules, "bilinear rule"))];
    GetJudged(in, "secant", bilinear.secant, eval);
    GetJudged(in, "drop", bilinear.drop, eval);
    in.Get("iterate", bilinear.iterate);
}

void ReadReferences(CJsonReader& in, const T_MODEL& model, T_EVAL_D& eval)
{
    in.Get("push", eval.push);
    if (!HasName(model.pushovers, eval.push))
        in.FailAt("push", "there is no pushover load case " + QuotedText(eval.push));
    in.Get("spectrum", eval.spectrum);
    if (!HasName(model.spectra, eval.spectrum))
        in.FailAt("spectrum", "there is no spectrum " + QuotedText(eval.spectrum));
}

void ReadEvaluation(CJsonReader& in, int key, T_MODEL& model, std::set<std::string>& taken)
{
    T_EVAL_D eval;
    in.Keys({"name", "push", "method", "procedure", "spectrum", "behavior", "elastic_damping",
             "user_damping", "eigen_factors", "masonry", "drift_kind", "plot_type",
             "alpha_in_percent", "bilinear"});
    in.GetName("name", eval.name, taken);
    ReadReferences(in, model, eval);
    eval.method =
        static_cast<PUSH_METHOD>(kFirstMethod + in.Choice("method", kMethodNames, "method"));
    ReadProcedure(in, eval);
    GetJudged(in, "behavior", eval.behavior, eval);
    GetJudged(in, "elastic_damping", eval.elasticDamping, eval);
    GetJudged(in, "user_damping", eval.userDamping, eval);
    in.Get("eigen_factors", eval.eigenFactors);
    in.Get("masonry", eval.masonry);
    GetJudged(in, "drift_kind", eval.driftKind, eval);
    GetJudged(in, "plot_type", eval.plotType, eval);
    in.Get("alpha_in_percent", eval.alphaInPercent);
    if (in.Has("bilinear")) ReadBilinear(in.Member("bilinear"), eval);
    model.evaluations[key] = std::move(eval);
}

} // namespace

void ReadEvaluations(CJsonReader& root, T_MODEL& model)
{
    std::set<std::string> taken;
    ForEachRecord(root, "evaluations", [&](CJsonReader& item, std::size_t index) {
        ReadEvaluation(item, static_cast<int>(index) + 1, model, taken);
    });
}
