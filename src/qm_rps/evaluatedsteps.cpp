#include "qm_rps/evaluatedsteps.h"

#include "qm_rps/pushovercalculators.h"

#include <cmath>

std::vector<double> StepsOfEvaluations(CDBDoc& doc, std::span<const T_PUSH_RUN> runs)
{
    if (runs.size() != 1 || runs.front().cancelled) return {};
    const T_POLC_D record = doc.Data().Model().pushovers.at(runs.front().key);
    if (!record.additionalEvaluations) return {};
    std::vector<double> out;
    const double sign =
        record.control && record.control->masterNodeControl && record.control->masterMaxDispl < 0.0
            ? -1.0
            : 1.0;
    CPushEvaluator evaluator(doc, RunPerfPtProcedure);
    evaluator.SetStoreSteps(false);
    evaluator.SetFindAllPoints(false);
    for (const auto& entry : doc.Data().Model().evaluations) {
        T_EVAL_D eval;
        T_FINDING refusal;
        if (entry.second.push != record.name || !doc.Attr().GetEval(entry.first, eval) ||
            !evaluator.SetEvaluation(eval, refusal) || evaluator.Evaluate() == 0)
            continue;
        const T_PUSH_EVALUATION& result = evaluator.Result();
        const auto add = [&](double d) {
            // an evaluation counts from the start of the push, a step is told by the whole
            const double si = sign * std::fabs(ToSi(d, doc.Unit().Units(), kDimLength)) +
                              runs.front().startDisplacement;
            if (si != 0.0 && IsOnTheWay(record, si)) out.push_back(si);
        };
        if (result.point) add(result.point->D);
        for (const T_LIMIT_ROW& row : result.limitStates)
            if (row.demand) add(*row.demand);
    }
    return out;
}
