#include "iteratecommands.h"

#include "console/console.h"
#include "inputfile.h"
#include "output.h"
#include "qm_base/say.h"
#include "qm_rps/factors/checks/ulfitemchecks.h"
#include "qm_rps/factors/checks/ulfstagechecks.h"
#include "qm_rps/factors/ulfstageresults.h"
#include "qm_rps/ulfiterationdochost.h"
#include "qm_rps/unknownloadfactoriteranal.h"
#include "ulfrun.h"
#include "json/jsontext.h"

#ifdef QM_UI
#include "qm_ui/factors/iterationplot.h"
#endif

#include <algorithm>
#include <cstdio>
#include <filesystem>
#include <unistd.h>

namespace {

/// Wants every iteration, and the report as the options say; shows a line on a terminal that
/// changes with each iteration.
class CIteratePerson : public IUlfIterationPerson {
public:
    explicit CIteratePerson(bool overwrite) : m_overwrite(overwrite) {}
    void Solved(const T_ULF_ITER_STEP&, const std::optional<T_FINDING>&) override {}
    ULF_ITER_WISH Wish(const T_ULF_ITER_STEP&) override { return ULF_ITER_WISH::Iterate; }
    bool MayOverwrite(const std::string&) override { return m_overwrite; }
    bool MayReplace(const std::string&) override { return m_overwrite; }
    bool GoesOn(int done, int required) override
    {
        if (done != m_shown && isatty(STDERR_FILENO)) {
            ShowOnTerminal(
                Say("IDS_QM_CLI_ITERATIONS_DONE", std::to_string(done), std::to_string(required)),
                false);
        }
        m_shown = done;
        return !CInterrupt::IsAsked();
    }

private:
    bool m_overwrite;
    int m_shown = -1;
};

struct T_END_WORDS {
    ULF_ITER_END end;
    const char* status; // in files
    const char* key;    // of the same in words
    EXIT_CODE code;
};
constexpr T_END_WORDS kEnds[] = {
    {ULF_ITER_END::Converged, "converged", "IDS_QM_CLI_CONVERGED", EXIT_CODE::Done},
    {ULF_ITER_END::Required, "not converged", "IDS_QM_CLI_NOT_CONVERGED", EXIT_CODE::NotFound},
    {ULF_ITER_END::Declined, "declined", "IDS_QM_CLI_DECLINED", EXIT_CODE::NotFound},
    {ULF_ITER_END::Cancelled, "cancelled", "IDS_QM_CLI_CANCELLED", EXIT_CODE::NotFound},
    {ULF_ITER_END::NotSolved, "no factors found", "IDS_QM_CLI_NO_FACTORS", EXIT_CODE::NotFound},
    {ULF_ITER_END::ReportNotWritten, "report not written", "IDS_QM_CLI_NO_REPORT",
     EXIT_CODE::NoAccess},
    {ULF_ITER_END::NotSaved, "model copy not saved", "IDS_QM_CLI_NO_COPY", EXIT_CODE::NoAccess},
    {ULF_ITER_END::NotScaled, "pretension not changed", "IDS_QM_CLI_NOT_SCALED",
     EXIT_CODE::BadInput},
    {ULF_ITER_END::NotAnalysed, "not analysed", "IDS_QM_CLI_NOT_ANALYSED", EXIT_CODE::BadInput},
};

T_END_WORDS WordsOfEnd(ULF_ITER_END end)
{
    for (const T_END_WORDS& words : kEnds)
        if (words.end == end) return words;
    return kEnds[0];
}

/// What a run has left beside its history.
struct T_ITERATE_RESULT {
    bool met = false;                     // the factors meet the constraints
    std::vector<T_ULF_ANALYSED> analysed; // of the last copy; empty where nothing was applied
    std::vector<T_ULF_STAY> stays;
    T_UNITS units;
    bool linearForecast = false;
};

T_END_WORDS WordsOf(const CUlfIteration& run, const T_ITERATE_OPTIONS& o, const T_ITERATE_RESULT& r)
{
    const bool done = run.End() == ULF_ITER_END::Required ? o.iterations == 0
                                                          : run.End() == ULF_ITER_END::Converged;
    if (done && !r.met)
        return {run.End(), "constraints not met", "IDS_QM_CLI_CONSTRAINTS_NOT_MET",
                EXIT_CODE::NotFound};
    if (done && !std::ranges::all_of(r.analysed, &T_ULF_ANALYSED::Agrees))
        return {run.End(), "analysed structure differs", "IDS_QM_CLI_ANALYSED_DIFFERS",
                EXIT_CODE::NotFound};
    if (run.End() == ULF_ITER_END::Required && o.iterations == 0)
        return {run.End(), "solved", "IDS_QM_CLI_SOLVED", EXIT_CODE::Done};
    return WordsOfEnd(run.End());
}

void Write(CJsonText& w, const T_ULF_ITER_STEP& step)
{
    w.Object(kJsonOneLine);
    w.Member("iteration", step.iteration).Member("file", step.file);
    w.Member("tolerance", step.tolerance);
    w.Key("factors").List(kJsonOneLine);
    for (const T_ULF_ITER_ROW& row : step.rows) {
        w.Object(kJsonOneLine);
        w.Member("place", row.place).Member("case", row.load).Member("factor", row.factor + 0.0);
        w.Member("pretension", row.pretension);
        w.End();
    }
    w.End();
    w.End();
}

void Write(CJsonText& w, const T_ITERATE_RESULT& r)
{
    w.Key("analysed").List({2, 1, true});
    for (const T_ULF_ANALYSED& a : r.analysed) {
        w.Object(kJsonOneLine);
        w.Member("name", a.name).Member("place", a.place).Member("unit", a.unit);
        w.Member("forecast", a.forecast + 0.0).Member("analysed", a.analysed + 0.0);
        w.Member("allowed", a.allowed).Member("agrees", a.Agrees());
        w.End();
    }
    w.End();
    w.Key("stays").List({2, 1, true});
    for (const T_ULF_STAY& s : r.stays) {
        w.Object(kJsonOneLine);
        w.Member("element", s.element).Member("case", s.load);
        w.Member("unit", std::string(NameOf(r.units.force)));
        w.Member("start", s.start).Member("factor", s.Factor()).Member("pretension", s.now);
        w.Member("force", s.force);
        w.End();
    }
    w.End();
    w.Member("linear_forecast", r.linearForecast);
}

std::string HistoryJson(const CUlfIteration& run, const T_ITERATE_RESULT& result,
                        const char* status)
{
    CJsonText w(JSON_REALS::Shortest);
    w.Object({1, 0});
    w.Member("status", status).Member("report", run.ReportPath());
    w.Key("history").List({2, 1, true});
    for (const T_ULF_ITER_STEP& step : run.History())
        Write(w, step);
    w.End();
    w.Items("applied", UlfIterApplied(run.History()), kJsonOneLine);
    Write(w, result);
    w.End();
    return w.Text();
}

void PrintHistory(const CUlfIteration& run)
{
    std::printf("%9s %14s  %s\n", Say("IDS_QM_CLI_ITERATION").c_str(),
                Say("IDS_QM_CLI_TOLERANCE").c_str(), Say("IDS_QM_CLI_MODEL").c_str());
    for (const T_ULF_ITER_STEP& step : run.History())
        std::printf("%9d %14.6g  %s\n", step.iteration, step.tolerance, step.file.c_str());
    if (run.History().empty()) return;
    const std::vector<double> applied = UlfIterApplied(run.History());
    std::printf("\n%-30s %-16s %16s %16s  %s\n", Say("IDS_QM_CLI_STAGE_STEP").c_str(),
                Say("IDS_QM_CLI_LOAD_CASE").c_str(), Say("IDS_QM_CLI_FACTOR").c_str(),
                Say("IDS_QM_CLI_APPLIED").c_str(), Say("IDS_QM_CLI_PRETENSION").c_str());
    const std::vector<T_ULF_ITER_ROW>& rows = run.History().back().rows;
    for (std::size_t i = 0; i < rows.size(); ++i)
        std::printf("%-30s %-16s %16.9g %16.9g  %s\n", rows[i].place.c_str(), rows[i].load.c_str(),
                    rows[i].factor + 0.0, applied[i],
                    Say(rows[i].pretension ? "IDS_QM_CLI_YES" : "IDS_QM_CLI_NO").c_str());
}

void PrintAnalysed(const T_ITERATE_RESULT& r)
{
    if (r.analysed.empty()) return;
    std::size_t width = 10;
    for (const T_ULF_ANALYSED& a : r.analysed)
        width = std::max(width, UlfNameAt(a.name, a.place).size());
    const int columns = static_cast<int>(width);
    std::printf("\n%-*s %15s %15s %13s %-6s %s\n", columns, Say("IDS_QM_CLI_CONSTRAINT").c_str(),
                Say("IDS_QM_CLI_FORECAST").c_str(), Say("IDS_QM_CLI_ANALYSED").c_str(),
                Say("IDS_QM_CLI_DIFFERENCE").c_str(), Say("IDS_QM_CLI_UNIT").c_str(),
                Say("IDS_QM_CLI_STATE").c_str());
    for (const T_ULF_ANALYSED& a : r.analysed) {
        std::printf("%-*s %15.7g %15.7g %13.3g %-6s %s\n", columns,
                    UlfNameAt(a.name, a.place).c_str(), a.Shown(a.forecast), a.Shown(a.analysed),
                    a.Shown(a.analysed - a.forecast), a.unit.c_str(),
                    Say(a.Agrees() ? "IDS_QM_CLI_AGREES" : "IDS_QM_CLI_DIFFERS").c_str());
    }
    if (r.linearForecast) std::printf("%s\n", Say("IDS_QM_ULF_LINEAR_FORECAST").c_str());
}

EXIT_CODE CheckOptions(const T_ITERATE_OPTIONS& o)
{
    CUnknownLoadFactorIterAnal trial;
    if (!trial.Set({o.iterations, o.tolerance}))
        return Complain(EXIT_CODE::Usage, Say("IDS_QM_CLI_ITERATE_LIMITS"));
    if (o.overwrite && o.append)
        return Complain(EXIT_CODE::Usage, Say("IDS_QM_CLI_ITERATE_EITHER"));
    if (const EXIT_CODE code = CheckPlotName(o.plot); code != EXIT_CODE::Done) return code;
    const std::string report = UlfIterReportPath(o.file);
    std::error_code ignored;
    if (std::filesystem::equivalent(report, o.file, ignored))
        return Complain(EXIT_CODE::Usage, o.file + ": " + Say("IDS_QM_CLI_REPORT_IS_INPUT"));
    for (int i = 1; i <= o.iterations && !o.overwrite; ++i)
        if (const std::string copy = UlfIterCopyPath(o.file, i);
            std::filesystem::exists(copy, ignored))
            return Complain(EXIT_CODE::NoAccess, copy + ": " + Say("IDS_QM_CLI_COPY_THERE"));
    if (!o.overwrite && !o.append && std::filesystem::exists(report, ignored))
        return Complain(EXIT_CODE::NoAccess, report + ": " + Say("IDS_QM_CLI_REPORT_THERE"));
    std::vector<T_OUTPUT> outputs{{o.json, OUTPUT_KIND::Json}, {o.plot, OUTPUT_KIND::Picture}};
    if (!o.append) outputs.push_back({report, OUTPUT_KIND::Text});
    for (int i = 1; i <= o.iterations; ++i)
        outputs.push_back({UlfIterCopyPath(o.file, i), OUTPUT_KIND::Document});
    return CheckOutputs(o.file, outputs, o.overwrite);
}

EXIT_CODE WriteResults(const CUlfIteration& run, const T_ITERATE_OPTIONS& o,
                       const T_ITERATE_RESULT& result, const char* status)
{
    if (!o.json.empty()) {
        const EXIT_CODE code = WriteOutput(o.json, HistoryJson(run, result, status));
        if (code != EXIT_CODE::Done) return code;
    }
    if (o.json != "-") {
        PrintHistory(run);
        std::printf("%s", StayTable(result.stays, result.units).c_str());
        PrintAnalysed(result);
    }
#ifdef QM_UI
    if (!o.plot.empty() && !run.History().empty())
        return WritePicture(IterationPlot(o.item, {o.iterations, o.tolerance}, run.History()),
                            o.plot);
#endif
    return EXIT_CODE::Done;
}

/// Finds the item and says what is wrong with it, and what is worth a warning.
EXIT_CODE FindItem(CDBDoc& doc, const T_ITERATE_OPTIONS& o, T_ULSI_D& item)
{
    int key = 0;
    if (!doc.Attr().FindUlsi(o.item, key))
        return Complain(EXIT_CODE::Usage, o.file + ": " + Say("IDS_QM_CLI_NO_STAGE_ITEM", o.item));
    item = doc.Data().Model().ulfStageItems.at(key);
    item.sumStageLoads |= o.sumStageLoads;
    if (const auto findings = CheckUlfStageItem(item, key, doc.Data()); !findings.empty())
        return Complain(EXIT_CODE::BadInput, o.file + ": " + findings.front().text);
    for (const T_FINDING& f : UlfStageItemWarnings(item, doc.Data()))
        Complain(EXIT_CODE::Done, o.file + ": " + Say("IDS_QM_CLI_ULF_WARNING", f.text));
    return EXIT_CODE::Done;
}

T_ITERATE_RESULT ResultOf(const CDBDoc& doc, CUlfIterationDocHost& host, const CUlfIteration& run,
                          double tolerance)
{
    T_ITERATE_RESULT r;
    r.units = doc.Data().Units();
    if (!host.Result()) return r;
    r.met = std::ranges::all_of(UlfResultRows(*host.Result()), &T_ULF_RESULT_ROW::met);
    r.linearForecast = host.Result()->linearForecast;
    if (run.History().size() < 2) return r; // nothing was applied
    r.analysed = host.Analysed(tolerance);
    r.stays = host.Stays();
    return r;
}

} // namespace

EXIT_CODE RunUlfIterate(const T_ITERATE_OPTIONS& o)
{
    if (const EXIT_CODE code = CheckOptions(o); code != EXIT_CODE::Done) return code;
    CDBDoc doc;
    if (const EXIT_CODE code = OpenInput(doc, o.file); code != EXIT_CODE::Done) return code;
    T_ULSI_D item;
    if (const EXIT_CODE code = FindItem(doc, o, item); code != EXIT_CODE::Done) return code;
    if (const EXIT_CODE code = AnalyseStages(doc, o.file); code != EXIT_CODE::Done) return code;

    CUlfIterationDocHost host(doc, item);
    CIteratePerson person(o.overwrite);
    CUnknownLoadFactorIterAnal* settings = CUnknownLoadFactorIterAnal::Of(doc.DynModules());
    if (!settings || !settings->Set({o.iterations, o.tolerance}))
        return Complain(EXIT_CODE::Usage, Say("IDS_QM_CLI_ITERATE_REFUSED"));
    CUlfIteration run(host, person, settings->Settings());
    const CInterrupt interrupt;
    const int done = run.Run();
    if (isatty(STDERR_FILENO) && run.History().size() > 1) std::fprintf(stderr, "\n");
    const T_ITERATE_RESULT result = ResultOf(doc, host, run, o.tolerance);
    const T_END_WORDS words =
        host.IsSaveRefused() ? WordsOfEnd(ULF_ITER_END::NotSaved) : WordsOf(run, o, result);
    const std::string said = run.Said() ? run.Said()->text : std::string();
    const std::string reason = host.Error().empty() ? said : host.Error();
    if (!done || words.code != EXIT_CODE::Done)
        Complain(words.code, Say("IDS_QM_CLI_FILE_ITEM", o.file, o.item) + ": " + Say(words.key) +
                                 (reason.empty() ? "" : ": " + reason));
    const EXIT_CODE written = WriteResults(run, o, result, words.status);
    return words.code == EXIT_CODE::Done ? written : words.code;
}
