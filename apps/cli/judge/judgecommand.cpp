#include "judge/judgecommand.h"

#include "console/console.h"
#include "inputfile.h"
#include "output.h"
#include "push/pushfirst.h"
#include "qm_base/say.h"
#include "qm_rps/judge/judgementsheet.h"
#include "qm_rps/judge/judgementtext.h"
#include "qm_rps/judgedevaluation.h"
#include "qm_rps/pushover/report/pushoverintro.h"
#include "qm_rps/pushover/report/pushoverreport.h"
#include "qm_rps/pushovercalculators.h"
#include "json/judgementjson.h"

#ifdef QM_UI
#include "qm_ui/push/judgedrawing.h"
#endif

#include <algorithm>
#include <cstdio>
#include <unistd.h>

namespace {

constexpr std::size_t kRowsOnTerminal = 20; // of each limit state

T_JUDGE_OPTIONS OptionsOf(const T_JUDGE_COMMAND& o)
{
    T_JUDGE_OPTIONS options;
    options.code = HingeCodeNamed(o.code);
    options.secondary = o.members == "secondary";
    for (const T_LEVELS& names : kLevelNames)
        for (std::size_t i = 0; i < kLevels; ++i)
            if (o.level == names[i]) options.level = i;
    options.factors = o.factors;
    options.trace = o.trace;
    return options;
}

EXIT_CODE FindEvaluations(CDBDoc& doc, const T_JUDGE_COMMAND& o, std::vector<T_EVAL_D>& out)
{
    const std::vector<std::string> names =
        o.evaluations.empty() ? std::vector<std::string>{""} : o.evaluations;
    for (const std::string& name : names) {
        const std::vector<T_EVAL_D> found = EvaluationsOf(doc, name);
        if (found.empty())
            return name.empty() ? Complain(EXIT_CODE::BadInput,
                                           o.file + ": " + Say("IDS_QM_CLI_NO_EVALUATIONS"))
                                : Complain(EXIT_CODE::Usage,
                                           o.file + ": " + Say("IDS_QM_CLI_NO_EVALUATION", name));
        out.insert(out.end(), found.begin(), found.end());
    }
    return EXIT_CODE::Done;
}

EXIT_CODE CheckFiles(const T_JUDGE_COMMAND& o, std::size_t count)
{
    if (const EXIT_CODE code = CheckPlotName(o.plot); code != EXIT_CODE::Done) return code;
    std::vector<T_OUTPUT> outputs{{o.json, OUTPUT_KIND::Json},
                                  {o.report, OUTPUT_KIND::Text},
                                  {o.sheet, OUTPUT_KIND::Sheet},
                                  {o.csv, OUTPUT_KIND::Text}};
    for (std::size_t i = 0; i < count && !o.plot.empty(); ++i)
        outputs.push_back({NumberedPath(o.plot, i, count), OUTPUT_KIND::Picture});
    return CheckOutputs(o.file, outputs, o.overwrite);
}

/// Evaluates, and judges what was found.
EXIT_CODE JudgeAll(CDBDoc& doc, const T_JUDGE_COMMAND& o, const std::vector<T_EVAL_D>& evaluations,
                   std::vector<T_PUSH_EVALUATION>& results, std::vector<T_JUDGEMENT>& out)
{
    CPushEvaluator evaluator(doc, RunPerfPtProcedure);
    evaluator.SetStoreSteps(false);
    const CInterrupt interrupt;
    const T_JUDGE_OPTIONS options = OptionsOf(o);
    for (const T_EVAL_D& eval : evaluations) {
        T_FINDING refusal;
        if (!evaluator.SetEvaluation(eval, refusal))
            return Complain(EXIT_CODE::BadInput,
                            o.file + ": " + Say("IDS_QM_CLI_EVALUATION_QUOTED", eval.name) + ": " +
                                refusal.text);
        (void)evaluator.Evaluate();
        results.push_back(evaluator.Result());
        out.push_back(JudgeEvaluation(doc, results.back(), options, ProgressOnTerminal(doc)));
    }
    return EXIT_CODE::Done;
}

EXIT_CODE WriteDrawings(CDBDoc& doc, const T_JUDGE_COMMAND& o,
                        const std::vector<T_JUDGEMENT>& judgements)
{
#ifdef QM_UI
    for (std::size_t i = 0; i < judgements.size() && !o.plot.empty(); ++i) {
        const T_JUDGED_STATE* const state = WorstState(judgements[i]);
        if (!state) continue;
        std::string error;
        if (!WritePictureFile(JudgementDrawing(doc, judgements[i], *state),
                              NumberedPath(o.plot, i, judgements.size()), error))
            return Complain(EXIT_CODE::NoAccess, error);
    }
    return EXIT_CODE::Done;
#else
    (void)doc;
    (void)judgements;
    return CheckPlotName(o.plot);
#endif
}

EXIT_CODE WriteAll(CDBDoc& doc, const T_JUDGE_COMMAND& o,
                   const std::vector<T_PUSH_EVALUATION>& results,
                   const std::vector<T_JUDGEMENT>& judgements)
{
    EXIT_CODE code = EXIT_CODE::Done;
    if (!o.json.empty()) code = WriteOutput(o.json, JudgementJson(judgements, o.trace));
    if (code == EXIT_CODE::Done && !o.report.empty()) {
        std::string text;
        for (std::size_t i = 0; i < results.size(); ++i) {
            if (!o.plain) text += PushoverIntroText(results[i], doc.Data().Model());
            text += PushoverReportText(results[i]) + JudgementText(judgements[i], 0);
            if (o.trace) text += JudgementTrace(judgements[i]);
        }
        code = WriteOutput(o.report, text);
    }
    if (code == EXIT_CODE::Done && !o.csv.empty())
        code = WriteOutput(o.csv, JudgementCsv(judgements));
    T_FILE_ERROR error;
    if (code == EXIT_CODE::Done && !o.sheet.empty() &&
        !WriteSheet(o.sheet, JudgementSheet(judgements), error))
        code = ReportFileError(error);
    return code == EXIT_CODE::Done ? WriteDrawings(doc, o, judgements) : code;
}

bool IsWhole(const T_JUDGEMENT& judgement)
{
    return judgement.note.empty() && !judgement.states.empty() &&
           std::ranges::all_of(judgement.states, [](const T_JUDGED_STATE& state) {
               return state.found == AT_POINT::Reached;
           });
}

} // namespace

std::vector<std::string> JudgedLevelNames()
{
    std::vector<std::string> out;
    for (const T_LEVELS& names : kLevelNames)
        out.insert(out.end(), names.begin(), names.end());
    return out;
}

EXIT_CODE RunJudge(const T_JUDGE_COMMAND& o)
{
    CDBDoc doc;
    if (const EXIT_CODE code = OpenInput(doc, o.file); code != EXIT_CODE::Done) return code;
    std::vector<T_EVAL_D> evaluations;
    if (const EXIT_CODE code = FindEvaluations(doc, o, evaluations); code != EXIT_CODE::Done)
        return code;
    if (const EXIT_CODE code = CheckFiles(o, evaluations.size()); code != EXIT_CODE::Done)
        return code;
    std::set<int> keys;
    for (const T_EVAL_D& eval : evaluations)
        if (const auto push = FindPush(doc.Data().Model(), eval.push)) keys.insert(push->key);
    if (const EXIT_CODE code = PushWhereMissing(doc, o.file, keys); code != EXIT_CODE::Done)
        return code;
    // A load case that is pushed in several directions has them now.
    evaluations.clear();
    if (const EXIT_CODE code = FindEvaluations(doc, o, evaluations); code != EXIT_CODE::Done)
        return code;
    std::vector<T_PUSH_EVALUATION> results;
    std::vector<T_JUDGEMENT> judgements;
    if (const EXIT_CODE code = JudgeAll(doc, o, evaluations, results, judgements);
        code != EXIT_CODE::Done)
        return code;
    if (const EXIT_CODE code = WriteAll(doc, o, results, judgements); code != EXIT_CODE::Done)
        return code;
    if (o.json != "-") {
        const std::size_t rows = !o.all && isatty(STDOUT_FILENO) ? kRowsOnTerminal : 0;
        for (const T_JUDGEMENT& judgement : judgements) {
            std::string text = JudgementText(judgement, rows);
            if (o.trace) text += JudgementTrace(judgement);
            std::fwrite(text.data(), 1, text.size(), stdout);
        }
    }
    if (IsModelFile(o.file) && !o.noStore && doc.Data().IsModified()) {
        T_FILE_ERROR error;
        if (!doc.SaveModel(error)) return ReportFileError(error);
    }
    return std::ranges::all_of(judgements, IsWhole) ? EXIT_CODE::Done : EXIT_CODE::NotFound;
}
