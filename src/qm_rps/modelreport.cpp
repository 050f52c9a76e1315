#include "qm_rps/modelreport.h"

#include "qm_base/say.h"
#include "qm_rps/evaluatedsteps.h"
#include "qm_rps/judgedevaluation.h"
#include "qm_rps/push/casecheck.h"
#include "qm_rps/push/pushresultlist.h"
#include "qm_rps/push/pushwarnings.h"
#include "qm_rps/pushovercalculators.h"
#include "qm_rps/unknownloadfactoritemdlg.h"
#include "qm_rps/unknownloadfactorresultdlg.h"
#include "qm_rps/unknownstageitemdlg.h"

#include <algorithm>

namespace {

using C = REPORT_CHAPTER;

/// Computes what chapters show, as long as it is wanted.
class CCollector {
public:
    CCollector(CDBDoc& doc, const T_REPORT_OPTIONS& options)
        : m_doc(doc), m_options(options), m_chapters(ChosenChapters(options))
    {
    }

    /// 0: no more is wanted.
    int Collect(T_REPORT_DATA& out)
    {
        if (Asked(C::Pushes) && Goes()) ReadRuns(out);
        if (Asked(C::Evaluations) || Asked(C::Judgement)) Evaluate(out);
        if (Asked(C::Evaluations) && Goes()) ReadHinges(out);
        if (Asked(C::Judgement)) Judge(out);
        if (Asked(C::Factors)) Solve(out);
        if (Asked(C::Stages) && Goes()) AnalyseStages(out);
        if (Asked(C::Remarks)) Check(out);
        return m_cancelled ? 0 : 1;
    }

private:
    bool Asked(C chapter) const { return std::ranges::count(m_chapters, chapter) > 0; }
    bool Goes() const { return !m_cancelled; }
    bool Tell(const std::string& what)
    {
        if (!m_cancelled && m_options.progress && !m_options.progress(what)) m_cancelled = true;
        return !m_cancelled;
    }
    PUSH_PROGRESS_FN Steps()
    {
        return [this](const T_PUSH_PROGRESS& p) { return Tell(p.name); };
    }

    void ReadRuns(T_REPORT_DATA& out)
    {
        auto runs = std::make_shared<std::vector<T_PUSH_RUN>>();
        CPushRun reader(m_doc);
        for (const T_PUSH_RESULT_ID& id : PushResultsOf(m_doc)) {
            if (!Tell(id.name)) return;
            T_PUSH_RUN run;
            std::string error;
            if (reader.Read(id.key, id.turn, run, error))
                runs->push_back(std::move(run));
            else
                out.runFaults.push_back(id.name + ": " + error);
        }
        out.runs = std::move(runs);
        for (std::string& warning : PushWarnings(m_doc))
            out.runFaults.push_back(std::move(warning));
    }

    void Evaluate(T_REPORT_DATA& out)
    {
        CPushEvaluator evaluator(m_doc, RunPerfPtProcedure);
        evaluator.SetStoreSteps(false);
        for (const T_EVAL_D& eval : EvaluationsOf(m_doc)) {
            if (!Tell(eval.name)) return;
            T_FINDING refusal;
            if (!evaluator.SetEvaluation(eval, refusal)) {
                T_PUSH_EVALUATION refused;
                refused.eval = eval;
                refused.messages.push_back({refusal.messageKey, refusal.text});
                out.evaluations.push_back(std::make_shared<const T_PUSH_EVALUATION>(refused));
                continue;
            }
            evaluator.Evaluate();
            out.evaluations.push_back(
                std::make_shared<const T_PUSH_EVALUATION>(evaluator.Result()));
        }
    }

    void ReadHinges(T_REPORT_DATA& out)
    {
        std::vector<T_PUSH_EVALUATION> results;
        for (const auto& result : out.evaluations)
            results.push_back(*result);
        out.hinges = HingesOfEvaluations(m_doc, results, Steps());
    }

    void Judge(T_REPORT_DATA& out)
    {
        for (const auto& result : out.evaluations) {
            if (!Tell(result->eval.name)) return;
            if (auto judgement = JudgementForReport(m_doc, *result, {}, Steps()))
                out.judgements.push_back(
                    std::make_shared<const T_JUDGEMENT>(std::move(*judgement)));
        }
    }

    template <class DIALOG, class RECORD>
    void SolveAll(const T_TABLE<RECORD>& items, T_REPORT_DATA& out)
    {
        for (const auto& [key, item] : items) {
            if (!Tell(item.name)) return;
            T_SOLVED_ITEM& solved = out.items.emplace_back();
            solved.name = item.name;
            DIALOG dialog(m_doc, key);
            if (!dialog.OnAnalyse({}, solved.fault)) continue;
            const T_ULF_CALCULATION& calculation = dialog.Calculate();
            solved.result = calculation.result;
            if (!solved.result && calculation.said) solved.fault = calculation.said->text;
            for (const T_FINDING& f : dialog.Warnings())
                out.findings.emplace_back(item.name, f.text);
            if (!solved.result) continue;
            solved.checked = Checked(item, *calculation.run, *solved.result);
            solved.stays = solved.checked.stays;
            if (solved.stays.empty())
                solved.stays = CUnknownLoadFactorResultDlg(m_doc, *solved.result).Stays();
        }
    }
    T_ULF_CHECKED Checked(const T_ULFI_D&, const T_ULF_RUN& run, const T_ULF_RESULT& result)
    {
        return CheckUlf(m_doc, run, result);
    }
    T_ULF_CHECKED Checked(const T_ULSI_D& item, const T_ULF_RUN& run, const T_ULF_RESULT& result)
    {
        return CheckUlfStages(m_doc, item, run, result);
    }
    void Solve(T_REPORT_DATA& out)
    {
        SolveAll<CUnknownLoadFactorItemDlg>(m_doc.Data().Model().ulfItems, out);
        SolveAll<CUnknownStageItemDlg>(m_doc.Data().Model().ulfStageItems, out);
    }

    /// The results that the chapter reads, where there are none of the model as it is.
    void AnalyseStages(T_REPORT_DATA& out)
    {
        if (m_doc.Data().Model().stages.empty() || m_doc.Post().CheckStagedResult()) return;
        T_ANALYSIS_OPTIONS options;
        options.allCases = false;
        options.progress = [this](std::size_t, std::size_t) { return Tell({}); };
        T_ANALYSIS_ERROR error;
        if (!m_doc.RunAnalysis(options, error)) out.stageFault = error.text;
    }

    void Check(T_REPORT_DATA& out)
    {
        for (const T_CASE_REMARK& remark : CheckCase(m_doc))
            out.findings.emplace_back(remark.where, remark.finding.text);
    }

    CDBDoc& m_doc;
    const T_REPORT_OPTIONS& m_options;
    std::vector<C> m_chapters;
    bool m_cancelled = false;
};

} // namespace

int MakeModelReport(CDBDoc& doc, const T_REPORT_OPTIONS& options, T_DOCUMENT& out)
{
    T_REPORT_DATA data;
    if (!CCollector(doc, options).Collect(data)) return 0;
    out = WriteReport(doc, data, options);
    return 1;
}
