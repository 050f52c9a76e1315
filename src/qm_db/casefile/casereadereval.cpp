#include "qm_db/casefile/casereader.h"
#include "qm_db/casefile/jsonnames.h"
#include "qm_db/records/evaluationrules.h"
#include "qm_db/records/pushnames.h"

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

} // namespace

void JudgeEvaluation(CJsonReader& in, const T_MODEL& model, const T_EVAL_D& eval)
{
    if (!FindPush(model, eval.push))
        in.FailAt("push", "IDS_QM_CASE_NO_PUSHOVER", QuotedText(eval.push));
    if (!HasName(model.spectra, eval.spectrum))
        in.FailAt("spectrum", "IDS_QM_CASE_NO_SPECTRUM", QuotedText(eval.spectrum));
    for (const char* const key : {"behavior", "elastic_damping", "user_damping", "drift_kind",
                                  "plot_type", "weight", "monitored_nodes"})
        Judge(in, key, eval);
    if (!eval.bilinear) return;
    CJsonReader bilinear = in.Member("bilinear");
    for (const char* const key : {"secant", "drop"})
        Judge(bilinear, key, eval);
}
