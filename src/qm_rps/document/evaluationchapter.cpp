// Evaluations: what was asked, how the answer came about, what it says; member verdicts.
#include "qm_base/say.h"
#include "qm_db/recordfacts.h"
#include "qm_rps/document/reportmaker.h"
#include "qm_rps/judge/judgementtext.h"
#include "qm_rps/push/pushatpointtext.h"
#include "qm_rps/pushover/explain/evaluationfacts.h"
#include "qm_rps/pushover/explain/spectrumof.h"
#include "qm_rps/pushover/report/pushovercells.h"

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
        DocText(OutcomeName(e.outcome) + ". " + OutcomeAdvice(e.outcome), ToneOf(e)));
    if (!e.pointNote.empty()) part.blocks.emplace_back(DocText(e.pointNote, DOC_TONE::Warning));
    for (const auto& message : e.messages) {
        part.blocks.emplace_back(DocText(message.text, DOC_TONE::Warning));
        work.Remark(part.title, message.text);
    }
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
            DocTable(Say("IDS_QM_REPORT_TRIALS"), PushoverTrialCells(e), work.limit));
    if (i < work.data.hinges.size())
        if (const std::string text = HingesAtReport(work.data.hinges[i]); !text.empty())
            part.blocks.emplace_back(DocMono(text));
    chapter.parts.push_back(std::move(part));
}

DOC_TONE ToneOf(VERDICT verdict)
{
    constexpr std::array tones{DOC_TONE::Good, DOC_TONE::Bad, DOC_TONE::Warning};
    return tones[static_cast<std::size_t>(verdict)];
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
    part.blocks.emplace_back(DocMono(JudgedLimitsText(*j)));
    constexpr std::size_t kMostEnds = 20;
    for (std::size_t s = 0; s < j->states.size(); ++s) {
        const T_JUDGED_STATE& state = j->states[s];
        T_DOC_TABLE table = DocTable(StateAtText(*j, state) + ": " + VerdictCountText(state.all),
                                     JudgedTable(*j, state, kMostEnds), {});
        for (std::size_t r = 0; r < table.table.rows.size(); ++r)
            table.tones.push_back(ToneOf(state.rows[r].verdict));
        part.blocks.emplace_back(std::move(table));
        for (const std::string& why : UncheckedTexts(state))
            part.blocks.emplace_back(DocText(why, DOC_TONE::Warning));
        if (&state == WorstState(*j))
            part.blocks.emplace_back(T_DOC_PICTURE{StateAtText(*j, state), T_JUDGEMENT_VIEW{j, s}});
    }
    chapter.parts.push_back(std::move(part));
}

} // namespace

void FillEvaluationsChapter(T_REPORT_WORK& work, T_DOC_CHAPTER& chapter)
{
    for (std::size_t i = 0; i < work.data.evaluations.size(); ++i)
        AddEvaluation(work, i, chapter);
}

void FillJudgementChapter(T_REPORT_WORK& work, T_DOC_CHAPTER& chapter)
{
    for (const auto& judgement : work.data.judgements)
        AddJudgement(work, judgement, chapter);
}
