#include "qm_db/casefile/casereader.h"
#include "qm_db/casefile/jsonnames.h"

#include <algorithm>

namespace {

/// Number of procedures of a method: the first ones of A, B, C. The target-displacement methods
/// have none.
std::size_t ProcedureCount(PUSH_METHOD method)
{
    if (method == PUSH_METHOD::Atc40) return 2;
    return method == PUSH_METHOD::Fema440 ? 3 : 0;
}

template <class T>
bool HasName(const T_TABLE<T>& table, const std::string& name)
{
    return std::any_of(table.begin(), table.end(),
                       [&](const auto& entry) { return entry.second.name == name; });
}

auto IsBetween(int low, int high)
{
    return [low, high](int v) { return v >= low && v <= high; };
}

void ReadProcedure(CJsonReader& in, T_EVAL_D& eval)
{
    if (!in.Has("procedure")) return;
    const std::size_t count = ProcedureCount(eval.method);
    if (count == 0) return in.FailAt("procedure", "only ATC-40 and FEMA440 have procedures");
    eval.procedure = *kProcedures[static_cast<std::size_t>(
        in.Choice("procedure", std::span(kProcedures).first(count), "procedure"))];
}

void ReadDamping(CJsonReader& in, T_EVAL_D& eval)
{
    in.Get("behavior", eval.behavior);
    in.CheckIf("behavior", eval.behavior, IsBetween(0, 3), "the behavior is 0, 1, 2 or 3");
    in.Get("elastic_damping", eval.elasticDamping);
    in.CheckIf(
        "elastic_damping", eval.elasticDamping, [](double d) { return d >= 0.0 && d <= 100.0; },
        "damping is 0 to 100 per cent");
    in.Get("user_damping", eval.userDamping);
    in.CheckIf(
        "user_damping", eval.userDamping,
        [](const std::array<double, 4>& p) { return p[0] > 0.0 && p[2] > 0.0; },
        "both beta must be above 0");
    in.CheckIf(
        "user_damping", eval.userDamping,
        [](const std::array<double, 4>& p) { return p[0] <= p[2]; }, "beta2 is below beta1");
}

void ReadBilinear(CJsonReader in, T_EVAL_BILINEAR& bilinear)
{
    const auto isFraction = [](double v) { return v > 0.0 && v <= 1.0; };
    in.Keys({"rule", "secant", "drop", "iterate"});
    if (in.Has("rule"))
        bilinear.rule = kBilinearRules[static_cast<std::size_t>(
            in.Choice("rule", kBilinearRules, "bilinear rule"))];
    in.Get("secant", bilinear.secant);
    in.CheckIf("secant", bilinear.secant, isFraction, "the fraction is above 0 and up to 1");
    in.Get("drop", bilinear.drop);
    in.CheckIf("drop", bilinear.drop, isFraction, "the fraction is above 0 and up to 1");
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
    ReadDamping(in, eval);
    in.Get("eigen_factors", eval.eigenFactors);
    in.Get("masonry", eval.masonry);
    in.Get("drift_kind", eval.driftKind);
    in.CheckIf("drift_kind", eval.driftKind, IsBetween(1, 2), "the drift kind is 1 or 2");
    in.Get("plot_type", eval.plotType);
    in.CheckIf("plot_type", eval.plotType, IsBetween(0, 8), "the plot type is 0 to 8");
    in.Get("alpha_in_percent", eval.alphaInPercent);
    if (in.Has("bilinear")) ReadBilinear(in.Member("bilinear"), eval.bilinear.emplace());
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
