#include "qm_rps/pushover/overview/evaluationentry.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_db/recordfacts.h"
#include "qm_rps/pushover/evaluation/pushovercomparison.h"
#include "qm_rps/pushover/outcometext.h"
#include "qm_rps/pushover/overview/evaluationcards.h"

#include <algorithm>
#include <cmath>

namespace {

constexpr const char* kEc8State = "SD";
constexpr std::size_t kNtcState = static_cast<std::size_t>(LIMIT_STATE::SLV);

/// The row of the state that stands for the evaluation; null: none has a demand.
const T_LIMIT_ROW* RowOfAnswer(const T_PUSH_EVALUATION& e)
{
    const char* const wanted =
        e.eval.method == PUSH_METHOD::Ec8Opcm ? kEc8State : kLimitStateNames[kNtcState];
    const T_LIMIT_ROW* first = nullptr;
    for (const T_LIMIT_ROW& row : e.limitStates) {
        if (!row.demand) continue;
        if (row.name == wanted) return &row;
        if (!first) first = &row;
    }
    return first;
}

/// Where Sd lies between two steps: the index behind it and the share of the way to it.
std::optional<std::pair<std::size_t, double>> Between(const std::vector<double>& Sd, double at)
{
    for (std::size_t i = 1; i < Sd.size(); ++i)
        if (Sd[i - 1] <= at && at <= Sd[i] && Sd[i] > Sd[i - 1])
            return std::pair{i, (at - Sd[i - 1]) / (Sd[i] - Sd[i - 1])};
    return std::nullopt;
}

std::optional<double> DriftAt(CDBDoc& doc, const T_PUSH_EVALUATION& e)
{
    const std::optional<T_EVALUATION_ANSWER> answer = AnswerOf(e);
    const auto push = FindPush(doc.Data().Model(), e.eval.push);
    const auto at = answer ? Between(e.capacity.Sd, answer->Sd) : std::nullopt;
    if (!at || !push) return std::nullopt;
    CStepDrift drift(doc, *push, e.eval.driftKind.value_or(1));
    // The curve's first point stands for a tenth of the first step, which has no results.
    constexpr double kFirstShare = 0.1;
    const auto of = [&](std::size_t i) -> std::optional<double> {
        if (i > 0) return drift.Of(e.StepAt(i));
        const std::optional<double> first = drift.Of(e.StepAt(1));
        return first ? std::optional(kFirstShare * *first) : std::nullopt;
    };
    const std::optional<double> before = of(at->first - 1), after = of(at->first);
    if (!before || !after) return std::nullopt;
    return std::lerp(std::fabs(*before), std::fabs(*after), at->second);
}

constexpr const char* kVerdictKeys[] = {
    "IDS_QM_EVAL_OK",          "IDS_QM_EVAL_PARTLY",    "IDS_QM_EVAL_NG",     "IDS_QM_EVAL_BEYOND",
    "IDS_QM_EVAL_NOT_CHECKED", "IDS_QM_EVAL_NOT_FOUND", "IDS_QM_EVAL_REFUSED"};

bool HasRemark(const T_PUSH_EVALUATION& e, std::initializer_list<const char*> remarks)
{
    return std::ranges::any_of(e.limitStates, [&](const T_LIMIT_ROW& row) {
        return std::ranges::find(remarks, row.remark) != remarks.end();
    });
}

/// Names of the limit states with one of these remarks.
std::string StatesWith(const T_PUSH_EVALUATION& e, std::initializer_list<const char*> remarks)
{
    std::string names;
    for (const T_LIMIT_ROW& row : e.limitStates)
        if (std::ranges::find(remarks, row.remark) != remarks.end())
            names += (names.empty() ? "" : ", ") + row.name;
    return names;
}

/// Names of the limit states whose demand is compared with nothing.
std::string StatesNotCompared(const T_PUSH_EVALUATION& e)
{
    std::string names;
    for (const T_LIMIT_ROW& row : e.limitStates)
        if (row.demand && row.remark.empty()) names += (names.empty() ? "" : ", ") + row.name;
    return names;
}

std::string ValueText(const char* symbol, double value, std::string_view unit)
{
    return FormatText("%s = %.4g ", symbol, value) + std::string(unit);
}

} // namespace

std::optional<T_EVALUATION_ANSWER> AnswerOf(const T_PUSH_EVALUATION& e)
{
    if (e.point) return T_EVALUATION_ANSWER{{}, e.point->Sd, e.point->D, e.point->Sa, e.point->V};
    const T_LIMIT_ROW* const row = RowOfAnswer(e);
    const T_PUSH_FACTORS& f = e.factors;
    // On a curve without a yield point tables show no demand either.
    if (!row || e.elastic || f.gamma == 0.0) return std::nullopt;
    T_EVALUATION_ANSWER answer{
        row->name, std::fabs(*row->demand / f.gamma), std::fabs(*row->demand), {}, {}};
    answer.Sa = CapacityAt(e.capacity, answer.Sd);
    if (answer.Sa) answer.V = std::fabs(*answer.Sa * f.mass * f.gravity * f.alpha);
    return answer;
}

const T_TARGET_DISP* TargetOfAnswer(const T_PUSH_EVALUATION& e)
{
    const T_LIMIT_ROW* const row = RowOfAnswer(e);
    if (!row) return nullptr;
    const auto name = std::ranges::find(kLimitStateNames, row->name,
                                        [](const char* n) { return std::string(n); });
    const bool ec8 = e.eval.method == PUSH_METHOD::Ec8Opcm;
    // Eurocode 8 has one target, that of SD; the demands of DL and NC are shares of it.
    const std::size_t i = ec8 ? (row->name == kEc8State ? 0 : e.targets.size())
                              : static_cast<std::size_t>(name - kLimitStateNames.begin());
    return i < e.targets.size() && e.targets[i].found ? &e.targets[i] : nullptr;
}

T_EVALUATION_ENTRY EntryOf(CDBDoc& doc, const T_EVAL_D& eval, const T_PUSH_EVALUATION& result,
                           const std::string& refused)
{
    if (!refused.empty()) return {eval, {}, refused, {}};
    return {eval, result, {}, DriftAt(doc, result)};
}

T_EVALUATION_ENTRY EvaluateEntry(CDBDoc& doc, CPushEvaluator& evaluator, const T_EVAL_D& eval)
{
    T_FINDING refusal;
    evaluator.SetStoreSteps(false);
    if (!evaluator.SetEvaluation(eval, refusal)) return EntryOf(doc, eval, {}, refusal.text);
    (void)evaluator.Evaluate(); // the outcome stands in the result
    return EntryOf(doc, eval, evaluator.Result(), {});
}

EVALUATION_VERDICT VerdictOf(const T_EVALUATION_ENTRY& entry)
{
    using V = EVALUATION_VERDICT;
    constexpr int kBeyondPush = 3; // T_PUSH_EVALUATION::Status
    const T_PUSH_EVALUATION& e = entry.result;
    if (!entry.refused.empty()) return V::Refused;
    if (e.Status() == 0) return V::NoPoint;
    if (e.IsOld()) return V::NotChecked;
    if (e.Status() == kBeyondPush) return V::BeyondPush;
    if (HasRemark(e, {"NG", "N/A"})) return V::NotGood;
    if (HasRemark(e, {kNotChecked})) return V::NotChecked;
    if (!HasRemark(e, {"OK"})) return V::NotChecked;
    return StatesNotCompared(e).empty() ? V::Ok : V::PartlyOk;
}

std::string VerdictText(EVALUATION_VERDICT verdict)
{
    return Say(kVerdictKeys[static_cast<std::size_t>(verdict)]);
}

std::string VerdictReason(const T_EVALUATION_ENTRY& entry)
{
    const T_PUSH_EVALUATION& e = entry.result;
    switch (VerdictOf(entry)) {
    case EVALUATION_VERDICT::Refused:
        return entry.refused;
    case EVALUATION_VERDICT::NoPoint:
        return OutcomeText(e.outcome) + ": " + OutcomeAdvice(e.outcome);
    case EVALUATION_VERDICT::BeyondPush:
        return Say("IDS_QM_EVAL_WHY_BEYOND");
    case EVALUATION_VERDICT::NotGood:
        return Say("IDS_QM_EVAL_WHY_NG", StatesWith(e, {"NG", "N/A"}));
    case EVALUATION_VERDICT::PartlyOk:
        return Say("IDS_QM_EVAL_WHY_PARTLY", StatesWith(e, {"OK"}), StatesNotCompared(e));
    case EVALUATION_VERDICT::Ok:
        return Say("IDS_QM_EVAL_WHY_OK", StatesWith(e, {"OK"}));
    default:
        break;
    }
    if (e.IsOld()) return Say("IDS_QM_EVAL_WHY_OLD");
    if (!e.IsTarget()) return Say("IDS_QM_EVAL_WHY_POINT");
    const std::string states = StatesWith(e, {kNotChecked});
    return states.empty() ? Say("IDS_QM_EVAL_WHY_NONE") : Say("IDS_QM_EVAL_WHY_STATES", states);
}

std::string MethodText(const T_EVAL_D& eval)
{
    std::string text = MethodName(eval.method);
    if (!ProceduresOf(eval.method).empty()) text += std::string(" ") + eval.procedure.value_or('A');
    return text;
}

std::string ResultText(const T_EVALUATION_ENTRY& entry)
{
    const T_PUSH_EVALUATION& e = entry.result;
    if (!entry.refused.empty()) return entry.refused;
    const std::optional<T_EVALUATION_ANSWER> answer = AnswerOf(e);
    if (!answer) return OutcomeText(e.outcome) + ": " + OutcomeAdvice(e.outcome);
    std::string text = answer->state.empty() ? std::string() : answer->state + ": ";
    text += ValueText("D", answer->D, NameOf(e.units.length));
    if (answer->V) text += ", " + ValueText("V", *answer->V, NameOf(e.units.force));
    return text;
}

T_TEXT_TABLE OverviewCells(std::span<const T_EVALUATION_ENTRY> entries)
{
    T_TEXT_TABLE t;
    for (const char* const key : {"IDS_QM_EVAL_EVALUATION", "IDS_QM_UI_HEAD_METHOD",
                                  "IDS_QM_UI_HEAD_PUSHOVER", "IDS_QM_UI_HEAD_SPECTRUM"})
        t.columns.push_back({Say(key)});
    const T_EVALUATION_ENTRY none;
    for (const T_CARD& card : CardsOf(entries.empty() ? none : entries.front()))
        t.columns.push_back(
            {card.symbol + (card.unit.empty() ? "" : " (" + card.unit + ")"), true});
    for (const char* const key : {"IDS_QM_UI_PUSH_STATE", "IDS_QM_EVAL_VERDICT", "IDS_QM_EVAL_WHY"})
        t.columns.push_back({Say(key)});
    for (const T_EVALUATION_ENTRY& entry : entries) {
        const T_EVAL_D& eval = entry.eval;
        std::vector<std::string> row{eval.name, MethodText(eval), eval.push, eval.spectrum};
        for (const T_CARD& card : CardsOf(entry))
            row.push_back(card.NumberText());
        const auto answer = AnswerOf(entry.result);
        row.push_back(answer && !answer->state.empty() ? answer->state : "-");
        row.push_back(VerdictText(VerdictOf(entry)));
        row.push_back(VerdictReason(entry));
        t.rows.push_back(std::move(row));
    }
    return t;
}
