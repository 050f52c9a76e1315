#include "evaluatecommands.h"

#include "evaluate/overviewoutput.h"
#include "inputfile.h"
#include "output.h"
#include "push/pushfirst.h"
#include "qm_base/say.h"
#include "qm_db/recordfacts.h"
#include "qm_rps/evaluatedsteps.h"
#include "qm_rps/judgedevaluation.h"
#include "qm_rps/push/pushatpointtext.h"
#include "qm_rps/push/pushended.h"
#include "qm_rps/pushover/evaluation/pushovercomparison.h"
#include "qm_rps/pushover/report/pushoverintro.h"
#include "qm_rps/pushover/report/pushoverreport.h"
#include "qm_rps/pushovercalculators.h"
#include "qm_rps/pushovercurvedlg.h"
#include "resulttable.h"
#include "json/resultjson.h"

#ifdef QM_UI
#include "qm_ui/pushover/comparisonplot.h"
#include "qm_ui/pushover/evaluationplot.h"
#endif

#include <algorithm>
#include <cstdio>
#include <unistd.h>
#include <vector>

namespace {

/// Shows how far evaluations are, where they take long and somebody looks at it.
std::function<void(std::size_t, std::size_t)> ProgressOf(const CDBDoc& doc)
{
    constexpr int kManySteps = 100000; // about a tenth of a second each
    const auto& results = doc.Data().Content().results;
    const bool isLong = std::ranges::any_of(
        results, [](const auto& entry) { return entry.second->StepCount() >= kManySteps; });
    if (!isLong || !isatty(STDERR_FILENO)) return [](std::size_t, std::size_t) {};
    return [](std::size_t done, std::size_t total) {
        ShowOnTerminal(Say("IDS_QM_CLI_EVALUATING", std::to_string(done), std::to_string(total)),
                       done == total);
    };
}

/// Additional steps and spectra of the driver's evaluation. What it refuses is said on stderr and
/// left out, the others stand; false where it refused one. `points`: some evaluation takes spectra,
/// so that a target displacement is not blamed for taking none.
bool AddExtras(CPushOverCurveDlg& driver, const T_EVALUATE_OPTIONS& options, bool points)
{
    bool all = true;
    const auto refused = [&](const std::string& what) {
        const std::string name = Say("IDS_QM_CLI_EVALUATION_QUOTED", driver.Result().eval.name);
        Complain(EXIT_CODE::Usage, name + ": " + what + ": " + driver.Refusal().text);
        all = false;
    };
    for (const int step : options.steps) {
        if (!driver.OnPushoverCurveAddStep(step))
            refused(Say("IDS_QM_CLI_STEP_NUMBER", std::to_string(step)));
    }
    if (driver.Result().IsTarget() && points) return all;
    for (const std::string& spectrum : options.spectra) {
        if (!driver.CalcAdditionalPerformancePoint(spectrum))
            refused(Say("IDS_QM_CLI_SPECTRUM_QUOTED", spectrum));
    }
    return all;
}

/// Why the results of this push could not be read (a damaged block); empty when they could.
std::string ReadFault(CDBDoc& doc, const std::string& push)
{
    const auto name = FindPush(doc.Data().Model(), push);
    if (!name) return {};
    if (const IPushRun* const run = doc.Post().RunOf(name->key, name->turn)) return run->Error();
    const T_RESULT_MAP& results = doc.Data().Content().results;
    const auto it = results.find(name->key);
    return name->turn != 0 || it == results.end() ? std::string() : it->second->Error();
}

/// The first name that no evaluation has; empty: each has one.
std::string UnknownName(CDBDoc& doc, const T_EVALUATE_OPTIONS& o)
{
    const auto unknown = std::ranges::find_if(
        o.only, [&doc](const std::string& name) { return EvaluationsOf(doc, name).empty(); });
    return unknown == o.only.end() ? std::string() : *unknown;
}

/// What was asked for, in the order of the names; nothing where one of them is unknown.
std::vector<T_EVAL_D> AskedFor(CDBDoc& doc, const T_EVALUATE_OPTIONS& o)
{
    if (!UnknownName(doc, o).empty()) return {};
    std::vector<T_EVAL_D> all;
    for (const std::string& name : o.only) {
        const std::vector<T_EVAL_D> named = EvaluationsOf(doc, name);
        all.insert(all.end(), named.begin(), named.end());
    }
    if (o.only.empty()) all = EvaluationsOf(doc);
    std::erase_if(all, [&](const T_EVAL_D& eval) {
        return !o.push.empty() && eval.push != o.push && !IsTurnOf(eval.push, o.push);
    });
    return all;
}

EXIT_CODE NothingAsked(CDBDoc& doc, const T_EVALUATE_OPTIONS& o)
{
    if (const std::string unknown = UnknownName(doc, o); !unknown.empty())
        return Complain(EXIT_CODE::Usage,
                        doc.Path() + ": " + Say("IDS_QM_CLI_NO_EVALUATION", unknown));
    if (!o.push.empty())
        return Complain(EXIT_CODE::Usage,
                        doc.Path() + ": " + Say("IDS_QM_CLI_NO_EVALUATION_OF", o.push));
    return Complain(EXIT_CODE::BadInput, doc.Path() + ": " + Say("IDS_QM_CLI_NO_EVALUATIONS"));
}

/// `extras`: whether every additional step and point was listed.
EXIT_CODE EvaluateAll(CDBDoc& doc, const T_EVALUATE_OPTIONS& options,
                      std::vector<T_PUSH_EVALUATION>& out, bool& extras)
{
    CPushOverCurveDlg driver(doc);
    driver.SetSpectrumShow(SPECTRUM_SHOW::Period);
    const std::vector<T_EVAL_D> all = AskedFor(doc, options);
    const bool points = std::ranges::any_of(
        all, [](const T_EVAL_D& eval) { return eval.method < PUSH_METHOD::Ec8Opcm; });
    const auto progress = ProgressOf(doc);
    for (const T_EVAL_D& eval : all) {
        progress(out.size(), all.size());
        if (!driver.SetEvaluation(eval))
            return Complain(EXIT_CODE::BadInput,
                            doc.Path() + ": " + Say("IDS_QM_CLI_EVALUATION_QUOTED", eval.name) +
                                ": " + driver.Refusal().text);
        driver.Evaluate();
        if (const std::string fault = ReadFault(doc, eval.push); !fault.empty())
            return Complain(EXIT_CODE::BadInput, fault);
        extras = AddExtras(driver, options, points) && extras;
        out.push_back(driver.Result());
    }
    progress(all.size(), all.size());
    return out.empty() ? NothingAsked(doc, options) : EXIT_CODE::Done;
}

/// The load cases that the evaluations need are pushed where they have no results.
EXIT_CODE PushEvaluated(CDBDoc& doc, const T_EVALUATE_OPTIONS& o)
{
    std::set<int> keys;
    for (const T_EVAL_D& eval : AskedFor(doc, o))
        if (const auto push = FindPush(doc.Data().Model(), eval.push)) keys.insert(push->key);
    return PushWhereMissing(doc, o.file, keys);
}

/// Where the results of so many evaluations go.
std::vector<T_OUTPUT> OutputsOf(const T_EVALUATE_OPTIONS& o, std::size_t count)
{
    std::vector<T_OUTPUT> outputs{
        {o.json, OUTPUT_KIND::Json}, {o.report, OUTPUT_KIND::Text}, {o.curve, OUTPUT_KIND::Text}};
    for (const std::string& plot : {o.plot, o.plotDemand})
        for (std::size_t i = 0; i < count && !plot.empty(); ++i)
            outputs.push_back({NumberedPath(plot, i, count), OUTPUT_KIND::Picture});
    for (const T_OUTPUT& output : OverviewOutputs(o))
        outputs.push_back(output);
    return outputs;
}

/// The pictures that were asked for, one for each evaluation.
EXIT_CODE WritePlots(const std::string& path, const std::vector<T_PUSH_EVALUATION>& results,
                     bool demand)
{
#ifdef QM_UI
    for (std::size_t i = 0; i < results.size(); ++i) {
        const std::string file = NumberedPath(path, i, results.size());
        if (const EXIT_CODE code =
                WritePicture(demand ? DemandPlot(results[i]) : EvaluationPlot(results[i]), file);
            code != EXIT_CODE::Done)
            return code;
    }
    return EXIT_CODE::Done;
#else
    (void)results;
    (void)demand;
    return CheckPlotName(path);
#endif
}

/// Reports of several evaluations follow one another in one file.
EXIT_CODE WriteReports(CDBDoc& doc, const T_EVALUATE_OPTIONS& o,
                       const std::vector<T_PUSH_EVALUATION>& results,
                       const std::vector<T_HINGES_AT>& hinges)
{
    T_JUDGE_OPTIONS options;
    options.code = HingeCodeNamed(o.code);
    std::string text;
    for (std::size_t i = 0; i < results.size(); ++i) {
        if (!o.plain) text += PushoverIntroText(results[i], doc.Data().Model());
        text += PushoverReportText(results[i]) + HingesAtReport(hinges[i]) +
                ReportOfJudgement(doc, results[i], options, ProgressOnTerminal(doc));
    }
    return WriteOutput(o.report, text);
}

EXIT_CODE WriteCurves(const std::string& path, const std::vector<T_PUSH_EVALUATION>& results)
{
    std::string text;
    for (const T_PUSH_EVALUATION& e : results)
        text += PushoverCurveText(e);
    return WriteOutput(path, text);
}

/// Keeps the limit-state steps that the evaluations found; a file that can't be written is no
/// failure of the evaluation.
void StoreSteps(CDBDoc& doc)
{
    T_FILE_ERROR error;
    if (!doc.SaveModel(error))
        Complain(EXIT_CODE::Done, Say("IDS_QM_CLI_STEPS_NOT_STORED", error.text));
}

EXIT_CODE WriteResults(CDBDoc& doc, const T_EVALUATE_OPTIONS& o,
                       const std::vector<T_PUSH_EVALUATION>& results,
                       const std::vector<T_HINGES_AT>& hinges)
{
    EXIT_CODE code = EXIT_CODE::Done;
    const auto ok = [&] { return code == EXIT_CODE::Done; };
    if (!o.json.empty()) code = WriteOutput(o.json, ResultJson(results, hinges));
    if (ok() && !o.report.empty()) code = WriteReports(doc, o, results, hinges);
    if (ok() && !o.curve.empty()) code = WriteCurves(o.curve, results);
    if (ok() && !o.plot.empty()) code = WritePlots(o.plot, results, false);
    if (ok() && !o.plotDemand.empty()) code = WritePlots(o.plotDemand, results, true);
    return code;
}

void PrintTables(const std::vector<T_PUSH_EVALUATION>& results,
                 const std::vector<T_HINGES_AT>& hinges)
{
    std::string text = ResultTable(results);
    for (const T_HINGES_AT& at : hinges)
        text += HingesAtTable(at);
    std::fwrite(text.data(), 1, text.size(), stdout);
}

} // namespace

EXIT_CODE RunCompare(const T_COMPARE_OPTIONS& o)
{
    if (const EXIT_CODE code = CheckPlotName(o.plot); code != EXIT_CODE::Done) return code;
    if (const EXIT_CODE code = CheckOutputs(
            o.file, {{o.json, OUTPUT_KIND::Json}, {o.plot, OUTPUT_KIND::Picture}}, o.overwrite);
        code != EXIT_CODE::Done)
        return code;
    CDBDoc doc;
    if (const EXIT_CODE code = OpenInput(doc, o.file); code != EXIT_CODE::Done) return code;
    if (const auto push = FindPush(doc.Data().Model(), o.push))
        if (const EXIT_CODE code = PushWhereMissing(doc, o.file, {push->key});
            code != EXIT_CODE::Done)
            return code;
    T_PUSH_COMPARISON comparison;
    CPushEvaluator evaluator(doc, RunPerfPtProcedure);
    T_FINDING refusal;
    if (!ComparePushover(evaluator, {o.push, o.spectrum, o.behavior, ProgressOf(doc)}, comparison,
                         refusal))
        return Complain(EXIT_CODE::Usage, o.file + ": " + refusal.text);
    if (const std::string fault = ReadFault(doc, o.push); !fault.empty())
        return Complain(EXIT_CODE::BadInput, fault);
    EXIT_CODE code = EXIT_CODE::Done;
    if (!o.json.empty()) code = WriteOutput(o.json, ResultJson(comparison.results));
#ifdef QM_UI
    if (code == EXIT_CODE::Done && !o.plot.empty())
        code = WritePicture(ComparisonPlot(comparison), o.plot);
#endif
    if (code != EXIT_CODE::Done) return code;
    if (o.json != "-") {
        std::printf("%s", ComparisonTable(comparison).c_str());
        if (const auto remark = PushRemark(doc, o.push))
            std::printf("! %s\n", remark->text.c_str());
    }
    const bool all = std::ranges::all_of(comparison.rows, &T_COMPARISON_ROW::found);
    return all ? EXIT_CODE::Done : EXIT_CODE::NotFound;
}

EXIT_CODE RunEvaluate(const T_EVALUATE_OPTIONS& o)
{
    for (const std::string& plot : {o.plot, o.plotDemand, o.overlay, o.bars})
        if (const EXIT_CODE code = CheckPlotName(plot); code != EXIT_CODE::Done) return code;
    CDBDoc doc;
    if (const EXIT_CODE code = OpenInput(doc, o.file); code != EXIT_CODE::Done) return code;
    const std::size_t count = AskedFor(doc, o).size();
    if (const EXIT_CODE code = CheckOutputs(o.file, OutputsOf(o, count), o.overwrite);
        code != EXIT_CODE::Done)
        return code;
    if (const EXIT_CODE code = PushEvaluated(doc, o); code != EXIT_CODE::Done) return code;
    std::vector<T_PUSH_EVALUATION> results;
    bool extras = true;
    if (const EXIT_CODE code = EvaluateAll(doc, o, results, extras); code != EXIT_CODE::Done)
        return code;
    const std::vector<T_HINGES_AT> hinges = HingesAtPoints(doc, results);
    if (const EXIT_CODE code = WriteResults(doc, o, results, hinges); code != EXIT_CODE::Done)
        return code;
    if (const EXIT_CODE code = WriteOverview(doc, o, results); code != EXIT_CODE::Done) return code;
    if (o.json != "-" && o.summary != "-") PrintTables(results, hinges);
    if (o.trace && o.json != "-") {
        for (const T_PUSH_EVALUATION& e : results)
            std::printf("%s", TraceTable(e).c_str());
    }
    if (IsModelFile(o.file) && !o.noStore && doc.Data().IsModified()) StoreSteps(doc);
    if (!extras) return EXIT_CODE::Usage;
    for (const T_PUSH_EVALUATION& e : results) {
        if (e.Status() != kPerfPtFound && e.Status() != kPerfPtElastic) return EXIT_CODE::NotFound;
    }
    return EXIT_CODE::Done;
}
