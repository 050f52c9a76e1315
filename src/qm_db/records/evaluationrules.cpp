#include "qm_db/records/evaluationrules.h"

#include "qm_base/msgfunction.h"
#include "qm_db/records/pushnames.h"
#include "qm_db/records/rulehead.h"

#include <algorithm>
#include <cmath>

namespace {

constexpr const char* kUserPoints = "IDS_PUSHOVER_Wrong_Input_";
constexpr const char* kFraction = "IDS_DB_PO_CURVE_PP_BETWEEN_0_1";
constexpr const char* kFractionReason = "IDS_QM_CASE_FRACTION";

using E = T_EVAL_D;

/// Absent options have defaults, which are in range.
bool IsBetween(const std::optional<int>& v, int low, int high)
{
    return !v || (*v >= low && *v <= high);
}
bool IsFraction(const std::optional<double>& v)
{
    return !v || (*v > 0.0 && *v <= 1.0); // a NaN fails
}

/// Up to four, none of them twice.
bool AreFewNodes(const E& e)
{
    std::vector<int> nodes = e.monitoredNodes;
    std::ranges::sort(nodes);
    return nodes.size() <= kMostMonitoredNodes && std::ranges::adjacent_find(nodes) == nodes.end();
}

// beta1, kappa1, beta2, kappa2
bool HasPoints(const E& e)
{
    return e.userDamping.has_value();
}
bool ArePointsFinite(const E& e)
{
    return std::ranges::all_of(*e.userDamping, [](double v) { return std::isfinite(v); });
}
bool ArePointsAbove0(const E& e)
{
    return (*e.userDamping)[0] > 0.0 && (*e.userDamping)[2] > 0.0;
}

constexpr T_RECORD_RULE<E> kRules[] = {
    {{.message = "IDS_QM_EVAL_BEHAVIOR",
      .field = "behavior",
      .caseKey = "behavior",
      .reason = "IDS_QM_CASE_BEHAVIOR"},
     [](const E& e) { return IsBetween(e.behavior, 0, kUserBehavior); }},
    {{.message = "IDS_QM_UI_PUSH_BAD_DAMPING",
      .field = "elasticDamping",
      .caseKey = "elastic_damping",
      .reason = "IDS_QM_CASE_DAMPING_PCT"},
     [](const E& e) {
         const double pct = e.elasticDamping.value_or(0.0);
         return pct >= 0.0 && pct <= 100.0;
     }},
    {{.message = kUserPoints, .field = "userDamping"}, ArePointsFinite, HasPoints},
    {{.message = kUserPoints,
      .field = "userDamping",
      .caseKey = "user_damping",
      .reason = "IDS_QM_CASE_BETA_ABOVE_0"},
     ArePointsAbove0,
     [](const E& e) { return HasPoints(e) && ArePointsFinite(e); }},
    {{.message = kUserPoints,
      .field = "userDamping",
      .caseKey = "user_damping",
      .reason = "IDS_QM_CASE_BETA_ORDER"},
     [](const E& e) { return (*e.userDamping)[0] <= (*e.userDamping)[2]; },
     [](const E& e) { return HasPoints(e) && ArePointsFinite(e) && ArePointsAbove0(e); }},
    {{.message = "IDS_QM_EVAL_DRIFT_KIND",
      .field = "driftKind",
      .caseKey = "drift_kind",
      .reason = "IDS_QM_CASE_DRIFT_KIND"},
     [](const E& e) { return IsBetween(e.driftKind, 1, 2); }},
    {{.message = "IDS_QM_EVAL_PLOT_TYPE",
      .field = "plotType",
      .caseKey = "plot_type",
      .reason = "IDS_QM_CASE_PLOT_TYPE"},
     [](const E& e) { return IsBetween(e.plotType, 0, 8); }},
    {{.message = kFraction,
      .field = "bilinear.secant",
      .caseKey = "secant",
      .reason = kFractionReason},
     [](const E& e) { return !e.bilinear || IsFraction(e.bilinear->secant); }},
    {{.message = kFraction, .field = "bilinear.drop", .caseKey = "drop", .reason = kFractionReason},
     [](const E& e) { return !e.bilinear || IsFraction(e.bilinear->drop); }},
    {{.message = "IDS_QM_EVAL_WEIGHT",
      .field = "weight",
      .caseKey = "weight",
      .reason = "IDS_QM_CASE_ABOVE_0"},
     [](const E& e) { return !e.weight || (*e.weight > 0.0 && std::isfinite(*e.weight)); }},
    {{.message = "IDS_QM_EVAL_MONITORED",
      .field = "monitoredNodes",
      .caseKey = "monitored_nodes",
      .reason = "IDS_QM_EVAL_MONITORED"},
     AreFewNodes},
};

/// Its message names method and procedure.
void CheckProcedure(const T_EVAL_D& evaluation, std::vector<T_FINDING>& out)
{
    const char procedure = evaluation.procedure.value_or('A');
    const auto index = static_cast<std::size_t>(procedure - 'A');
    if (index < std::max<std::size_t>(ProceduresOf(evaluation.method).size(), 1)) return;
    constexpr const char* kKey = "IDS_QM_NO_SUCH_PROCEDURE";
    T_FINDING f = FindingOf(T_RECORD_HEAD{.message = kKey, .field = "procedure"}, {});
    f.text = zql::lib::MMSGFunction::Format(
        kKey, {MethodName(evaluation.method), std::string(1, procedure)});
    out.push_back(std::move(f));
}

template <class T>
bool HasName(const T_TABLE<T>& table, const std::string& name)
{
    return std::ranges::any_of(table, [&](const auto& entry) { return entry.second.name == name; });
}

struct T_REFERENCES {
    const T_EVAL_D& evaluation;
    const T_MODEL& model;
};
constexpr T_RECORD_RULE<T_REFERENCES> kReferences[] = {
    {{.message = "IDS_QM_UI_PUSH_NO_CASE", .field = "push"},
     [](const T_REFERENCES& r) { return FindPush(r.model, r.evaluation.push).has_value(); }},
    {{.message = "IDS_QM_UI_PUSH_NO_SPECTRUM", .field = "spectrum"},
     [](const T_REFERENCES& r) { return HasName(r.model.spectra, r.evaluation.spectrum); }},
    {{.message = "IDS_QM_EVAL_NO_NODE", .field = "monitoredNodes"},
     [](const T_REFERENCES& r) {
         return std::ranges::all_of(r.evaluation.monitoredNodes,
                                    [&](int node) { return r.model.nodes.contains(node); });
     }},
};

} // namespace

const char* MethodName(PUSH_METHOD method)
{
    return kMethodNames[static_cast<std::size_t>(static_cast<int>(method) - kFirstMethod)];
}

std::span<const char* const> ProceduresOf(PUSH_METHOD method)
{
    const std::span<const char* const> all(kProcedures);
    if (method == PUSH_METHOD::Fema440) return all;
    return all.first(method == PUSH_METHOD::Atc40 ? 2 : 0);
}

std::vector<T_FINDING> OptionFindings(const T_EVAL_D& evaluation)
{
    std::vector<T_FINDING> out;
    CheckProcedure(evaluation, out);
    WalkRules(kRules, evaluation, {}, out);
    return out;
}

std::vector<T_FINDING> EvaluationFindings(const T_EVAL_D& evaluation, const T_MODEL& model)
{
    std::vector<T_FINDING> out;
    WalkRules(kReferences, {evaluation, model}, {}, out);
    const std::vector<T_FINDING> options = OptionFindings(evaluation);
    out.insert(out.end(), options.begin(), options.end());
    return out;
}

const char* EvaluationFault(const T_EVAL_D& evaluation, std::string_view caseKey)
{
    return FaultOf(std::span<const T_RECORD_RULE<T_EVAL_D>>(kRules), evaluation, caseKey);
}
