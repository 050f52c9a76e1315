// Evaluations: what was asked, how the answer came about, what it says; member verdicts.
#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_db/recordfacts.h"
#include "qm_rps/document/reportmaker.h"
#include "qm_rps/judge/judgementtext.h"
#include "qm_rps/push/pushatpointcells.h"
#include "qm_rps/pushover/explain/evaluationfacts.h"
#include "qm_rps/pushover/explain/spectrumof.h"
#include "qm_rps/pushover/outcometext.h"
#include "qm_rps/pushover/report/pushovercells.h"

#include <algorithm>

namespace {

/// Bad: a limit state is not met. Warning: nothing was found, or nothing is known of a state.
DOC_TONE ToneOf(const T_PUSH_EVALUATION& e)
{
    bool unchecked = false;
    for (const T_LIMIT_ROW& row : e.limitStates) {
        if (row.remark == "NG" || row.remark == "N/A") return DOC_TONE::Bad;
        unchecked = unchecked || row.remark == kNotChecked;
    }
    return unchecked || e.result == 0 || e.IsOld() ? DOC_TONE::Warning : DOC_TONE::Plain;
}

DOC_TONE ToneOf(const T_LIMIT_ROW& row)
{
    if (row.remark == "OK") return DOC_TONE::Good;
    return row.remark.empty()          ? DOC_TONE::Plain
           : row.remark == kNotChecked ? DOC_TONE::Warning
                                       : DOC_TONE::Bad;
}

T_DOC_TABLE LimitStates(const T_REPORT_WORK& work, const T_PUSH_EVALUATION& e)
{
    T_DOC_TABLE table =
        DocTable(Say("IDS_QM_REPORT_LIMIT_STATES"), PushoverStateCells(e), work.limit);
    for (const T_LIMIT_ROW& row : e.limitStates)
        table.tones.push_back(ToneOf(row));
    return table;
}

void AddOutcome(T_REPORT_WORK& work, const T_PUSH_EVALUATION& e, T_DOC_CHAPTER& part)
{
    part.blocks.emplace_back(
        DocText(OutcomeText(e.outcome) + ". " + OutcomeAdvice(e.outcome), ToneOf(e)));
    const auto warn = [&](const std::string& text) {
        part.blocks.emplace_back(DocText(text, DOC_TONE::Warning));
        work.Remark(part.title, text);
    };
    if (!e.pointNote.empty()) warn(e.pointNote);
    for (const auto& message : e.messages)
        warn(message.text);
    if (!e.limitStates.empty() && ToneOf(e) == DOC_TONE::Bad)
        work.Remark(part.title, Say("IDS_QM_REPORT_STATE_NOT_MET"));
}

/// How a search begins and how it ends: what lies between is long where it does not settle.
T_TABLE_LIMIT TrialLimit(const T_REPORT_WORK& work)
{
    constexpr std::size_t kMost = 40, kLast = 25;
    if (work.limit.most == 0) return {0};
    return work.limit.most < kMost ? T_TABLE_LIMIT{work.limit.most, work.limit.most / 2}
                                   : T_TABLE_LIMIT{kMost, kLast};
}

/// What hinges and storeys do at the points of an evaluation.
void AddHinges(T_REPORT_WORK& work, const T_HINGES_AT& at, T_DOC_CHAPTER& part)
{
    const std::string caption = Say("IDS_QM_REPORT_HINGES_AT", at.push);
    if (!at.note.empty()) {
        part.blocks.emplace_back(DocText(caption + ": " + at.note, DOC_TONE::Warning));
        work.Remark(part.title, caption + ": " + at.note);
    }
    if (at.points.empty()) return;
    part.blocks.emplace_back(DocTable(caption, PointCells(at), work.limit));
    if (T_TEXT_TABLE worst = WorstHingeCells(at); !worst.rows.empty())
        part.blocks.emplace_back(
            DocTable(Say("IDS_QM_REPORT_WORST_HINGES"), std::move(worst), work.limit));
    if (T_TEXT_TABLE storeys = StoreyCells(at); !storeys.rows.empty())
        part.blocks.emplace_back(
            DocTable(Say("IDS_QM_REPORT_STOREYS_AT"), std::move(storeys), work.limit));
}

void AddEvaluation(T_REPORT_WORK& work, std::size_t i, T_DOC_CHAPTER& chapter)
{
    const auto& shared = work.data.evaluations[i];
    const T_PUSH_EVALUATION& e = *shared;
    T_DOC_CHAPTER part{e.eval.name};
    part.blocks.emplace_back(T_DOC_FACTS{Say("IDS_QM_REPORT_INPUTS"),
                                         InputsOf(e, SpectrumOf(work.Model(), e.eval.spectrum))});
    AddOutcome(work, e, part);
    if (!e.capacity.Sd.empty())
        part.blocks.emplace_back(T_DOC_PICTURE{e.eval.name, T_EVALUATION_VIEW{shared}});
    if (!e.limitStates.empty()) part.blocks.emplace_back(LimitStates(work, e));
    for (T_FACT_GROUP& group : FactsOf(e))
        part.blocks.emplace_back(T_DOC_FACTS{std::move(group.title), std::move(group.facts)});
    if (!e.trace.empty())
        part.blocks.emplace_back(
            DocTable(Say("IDS_QM_REPORT_TRIALS"), PushoverTrialCells(e), TrialLimit(work)));
    if (i < work.data.hinges.size()) AddHinges(work, work.data.hinges[i], part);
    chapter.parts.push_back(std::move(part));
}

using T_RESULT = std::shared_ptr<const T_PUSH_EVALUATION>;

/// The evaluations that asked the same of the same curve, in their order.
std::vector<std::vector<T_RESULT>> Comparable(const std::vector<T_RESULT>& results)
{
    std::vector<std::vector<T_RESULT>> groups;
    for (const T_RESULT& e : results) {
        if (e->capacity.Sd.empty()) continue;
        const auto isSame = [&](const auto& group) {
            return group.front()->eval.push == e->eval.push &&
                   group.front()->eval.spectrum == e->eval.spectrum;
        };
        const auto at = std::ranges::find_if(groups, isSame);
        if (at == groups.end())
            groups.push_back({e});
        else
            at->push_back(e);
    }
    return groups;
}

T_TEXT_TABLE ComparisonCells(const T_PUSH_COMPARISON& c, const T_UNITS& units)
{
    const std::string L(NameOf(units.length)), F(NameOf(units.force));
    T_TEXT_TABLE table{{{Say("IDS_QM_REPORT_EVALUATION")},
                        {Say("IDS_QM_FACT_LOAD_CASE")},
                        {Say("IDS_QM_FACT_SPECTRUM")},
                        {"D (" + L + ")", true},
                        {"V (" + F + ")", true},
                        {"Teff, T* (s)", true},
                        {Say("IDS_QM_REPORT_OUTCOME")}},
                       {}};
    for (std::size_t i = 0; i < c.rows.size(); ++i) {
        const T_COMPARISON_ROW& row = c.rows[i];
        const T_PUSH_EVALUATION& e = c.results[i];
        const auto number = [](bool known, double value) {
            return known ? FormatText("%.6g", value) : std::string("-");
        };
        const auto target = std::ranges::find_if(e.targets, &T_TARGET_DISP::found);
        const bool isTarget = target != e.targets.end();
        table.rows.push_back({row.label, e.eval.push, e.eval.spectrum, number(row.found, row.D),
                              number(row.found, row.V),
                              number(e.point || isTarget, e.point    ? e.point->Teff
                                                          : isTarget ? target->Tstar
                                                                     : 0.0),
                              OutcomeText(row.outcome)});
    }
    return table;
}

/// All evaluations in one table and as bars, then those of one curve and spectrum in one picture.
void AddComparison(T_REPORT_WORK& work, T_DOC_CHAPTER& chapter)
{
    const std::vector<T_RESULT>& results = work.data.evaluations;
    if (results.size() < 2) return;
    T_DOC_CHAPTER part{Say("IDS_QM_REPORT_COMPARISON")};
    std::vector<T_PUSH_EVALUATION> all;
    for (const T_RESULT& e : results)
        all.push_back(*e);
    const T_PUSH_COMPARISON c = ComparisonOf(std::move(all));
    T_DOC_TABLE table = DocTable({}, ComparisonCells(c, work.Units()), {0});
    for (const T_RESULT& e : results)
        table.tones.push_back(ToneOf(*e));
    part.blocks.emplace_back(std::move(table));
    T_BARS_VIEW bars{
        Say("IDS_QM_REPORT_COMPARED"), "D (" + std::string(NameOf(work.Units().length)) + ")", {}};
    for (const T_COMPARISON_ROW& row : c.rows)
        if (row.found) bars.bars.emplace_back(row.label, row.D);
    if (bars.bars.size() > 1)
        part.blocks.emplace_back(T_DOC_PICTURE{Say("IDS_QM_REPORT_COMPARED"), std::move(bars)});
    for (const auto& group : Comparable(results)) {
        if (group.size() < 2) continue;
        std::vector<T_PUSH_EVALUATION> same;
        for (const T_RESULT& e : group)
            same.push_back(*e);
        part.blocks.emplace_back(
            T_DOC_PICTURE{Say("IDS_QM_REPORT_COMPARED_ON", group.front()->eval.push,
                              group.front()->eval.spectrum),
                          T_COMPARISON_VIEW{std::make_shared<const T_PUSH_COMPARISON>(
                              ComparisonOf(std::move(same)))}});
    }
    chapter.parts.push_back(std::move(part));
}

DOC_TONE ToneOf(VERDICT verdict)
{
    constexpr std::array tones{DOC_TONE::Good, DOC_TONE::Bad, DOC_TONE::Warning};
    return tones[static_cast<std::size_t>(verdict)];
}

T_TEXT_TABLE WithCapitals(T_TEXT_TABLE table)
{
    for (T_TEXT_COLUMN& column : table.columns)
        column.head = Capital(std::move(column.head));
    return table;
}

void AddJudgement(T_REPORT_WORK& work, const std::shared_ptr<const T_JUDGEMENT>& j,
                  T_DOC_CHAPTER& chapter)
{
    T_DOC_CHAPTER part{j->evaluation};
    if (!j->note.empty()) {
        part.blocks.emplace_back(DocText(j->note, DOC_TONE::Warning));
        work.Remark(part.title, j->note);
        chapter.parts.push_back(std::move(part));
        return;
    }
    part.blocks.emplace_back(DocText(WholeVerdictText(*j), ToneOf(j->Verdict())));
    for (const std::string& note : JudgementNotes(*j)) {
        part.blocks.emplace_back(DocText(note, DOC_TONE::Warning));
        work.Remark(part.title, note);
    }
    if (T_TEXT_TABLE limits = JudgedLimitsTable(*j); !limits.rows.empty())
        part.blocks.emplace_back(
            DocTable(Say("IDS_QM_JUDGE_LIMITS"), WithCapitals(std::move(limits)), work.limit));
    constexpr std::size_t kMostEnds = 20;
    for (std::size_t s = 0; s < j->states.size(); ++s) {
        const T_JUDGED_STATE& state = j->states[s];
        std::string caption = StateAtText(*j, state) + ": " + VerdictCountText(state.all);
        for (T_JUDGED_PART& rows : JudgedParts(*j, state, kMostEnds)) {
            T_DOC_TABLE table = DocTable(std::move(caption), WithCapitals(rows.table), {0});
            for (const VERDICT verdict : rows.verdicts)
                table.tones.push_back(ToneOf(verdict));
            part.blocks.emplace_back(std::move(table));
            caption.clear();
        }
        for (const std::string& why : UncheckedTexts(state)) {
            const std::string text = VerdictText(VERDICT::NotChecked) + ": " + why;
            part.blocks.emplace_back(DocText(text, DOC_TONE::Warning));
            work.Remark(part.title, text);
        }
        if (!state.shearAt.empty()) {
            part.blocks.emplace_back(DocText(state.shearAt, DOC_TONE::Warning));
            work.Remark(part.title, state.shearAt);
        }
        if (&state == WorstState(*j))
            part.blocks.emplace_back(T_DOC_PICTURE{StateAtText(*j, state), T_JUDGEMENT_VIEW{j, s}});
    }
    chapter.parts.push_back(std::move(part));
}

} // namespace

void FillEvaluationsChapter(T_REPORT_WORK& work, T_DOC_CHAPTER& chapter)
{
    AddComparison(work, chapter);
    for (std::size_t i = 0; i < work.data.evaluations.size(); ++i)
        AddEvaluation(work, i, chapter);
}

void FillJudgementChapter(T_REPORT_WORK& work, T_DOC_CHAPTER& chapter)
{
    for (const auto& judgement : work.data.judgements)
        AddJudgement(work, judgement, chapter);
}
