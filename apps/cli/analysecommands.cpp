#include "analysecommands.h"

#include "analysistext.h"
#include "inputfile.h"
#include "output.h"
#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "json/analysisjson.h"

#ifdef QM_UI
#include "modelshape.h"
#endif

#include <algorithm>
#include <cstdio>
#include <unistd.h>

namespace {

/// What is shown: the cases with their results, and modes.
struct T_SHOWN {
    std::vector<T_SHOWN_CASE> cases;
    std::vector<T_CASE_RESULTS> results;
    std::vector<T_MODE_RESULTS> modes;
    std::vector<T_SHOWN_STAGE> stages;
};

/// Shows how far a long run is, where somebody looks at it.
bool ShowProgress(std::size_t done, std::size_t total)
{
    ShowOnTerminal(Say("IDS_QM_CLI_ANALYSING", std::to_string(done), std::to_string(total)),
                   done == total);
    return true;
}

EXIT_CODE ReadShown(CDBDoc& doc, const T_ANALYSE_OPTIONS& o, T_SHOWN& shown)
{
    for (const T_SHOWN_CASE& c : shown.cases) {
        std::string error;
        if (!ReadCaseResults(doc, c, shown.results.emplace_back(), error))
            return Complain(EXIT_CODE::BadInput, o.file + ": " + error);
    }
    for (T_SHOWN_STAGE& stage : shown.stages) {
        std::string error;
        if (!ReadStageResults(doc, stage.choice, stage.results, error))
            return Complain(EXIT_CODE::BadInput, o.file + ": " + error);
    }
    if (o.modes > 0) shown.modes = ReadModes(doc);
    return EXIT_CODE::Done;
}

#ifdef QM_UI
/// A mode, or the displacements of a load case.
EXIT_CODE DrawShape(CDBDoc& doc, const T_ANALYSE_OPTIONS& o, const T_SHOWN& shown)
{
    T_SHAPE shape = ShapeOfModel(doc);
    if (o.plotMode > 0) {
        if (static_cast<std::size_t>(o.plotMode) > shown.modes.size())
            return Complain(EXIT_CODE::Usage,
                            Say("IDS_QM_CLI_NO_MODE", std::to_string(o.plotMode)));
        const T_MODE_RESULTS& m = shown.modes[static_cast<std::size_t>(o.plotMode - 1)];
        shape.mode = true;
        const std::string number = std::to_string(o.plotMode);
        shape.subtitle = Say("IDS_PUSHOVER_Mode__d", number);
        shape.states.push_back(
            StateOf(Say("IDS_QM_PLOT_MODE", number, FormatText("%.4g", m.period)), m.shape));
        return WritePicture(ShapePlot(shape), o.plot);
    }
    const auto it = std::ranges::find_if(shown.cases, [&](const T_SHOWN_CASE& c) {
        return o.plotCase.empty() || c.name == o.plotCase;
    });
    if (it == shown.cases.end())
        return Complain(EXIT_CODE::Usage, Say("IDS_QM_CLI_NOT_SHOWN", o.plotCase));
    const auto index = static_cast<std::size_t>(it - shown.cases.begin());
    shape.subtitle = Say("IDS_QM_CLI_DISPLACEMENTS_OF", it->name);
    shape.states.push_back(StateOf(it->name, shown.results[index].displacements));
    return WritePicture(ShapePlot(shape), o.plot);
}
#endif

void PrintShown(const T_ANALYSE_OPTIONS& o, const T_SHOWN& shown, const T_UNITS& units)
{
    const bool tables = o.table || o.json.empty();
    for (std::size_t i = 0; i < shown.cases.size(); ++i) {
        const std::string text = tables ? CaseTables(shown.cases[i], shown.results[i], units)
                                        : CaseSummary(shown.cases[i], shown.results[i], units);
        std::fwrite(text.data(), 1, text.size(), stdout);
    }
    for (const T_SHOWN_STAGE& stage : shown.stages) {
        const T_SHOWN_CASE titled{StageTitle(stage), {}};
        const std::string text = tables && !o.stage.empty()
                                     ? CaseTables(titled, stage.results, units)
                                     : CaseSummary(titled, stage.results, units);
        std::fwrite(text.data(), 1, text.size(), stdout);
    }
    if (!shown.modes.empty()) std::printf("%s", ModeTable(shown.modes).c_str());
}

/// A model file keeps the results; -o writes another file.
EXIT_CODE Store(CDBDoc& doc, const T_ANALYSE_OPTIONS& o)
{
    if (!o.out.empty()) return SaveDocument(doc, o.out);
    if (!IsModelFile(o.file) || o.noStore) return EXIT_CODE::Done;
    T_FILE_ERROR error;
    return doc.SaveModel(error) ? EXIT_CODE::Done : ReportFileError(error);
}

} // namespace

EXIT_CODE Analyse(CDBDoc& doc, const std::vector<int>& cases, int modes, bool noneForEmpty)
{
    T_ANALYSIS_OPTIONS options;
    options.allCases = cases.empty() && !noneForEmpty;
    options.cases = cases;
    options.modes = modes;
    if (isatty(STDERR_FILENO)) options.progress = ShowProgress;
    T_ANALYSIS_ERROR error;
    if (doc.RunAnalysis(options, error)) return EXIT_CODE::Done;
    return Complain(EXIT_CODE::BadInput, doc.Path() + ": " + error.text);
}

EXIT_CODE RunAnalyse(const T_ANALYSE_OPTIONS& o)
{
    if (const EXIT_CODE code = CheckPlotName(o.plot); code != EXIT_CODE::Done) return code;
    if (const EXIT_CODE code = CheckOutputs(o.file,
                                            {{o.json, OUTPUT_KIND::Json},
                                             {o.plot, OUTPUT_KIND::Picture},
                                             {o.out, OUTPUT_KIND::Document}},
                                            o.overwrite);
        code != EXIT_CODE::Done)
        return code;
    CDBDoc doc;
    if (const EXIT_CODE code = OpenInput(doc, o.file); code != EXIT_CODE::Done) return code;
    T_SHOWN shown;
    std::string error;
    std::vector<int> keys;
    const bool stageAlone = o.cases.empty() && !o.stage.empty();
    const bool modesAlone = o.cases.empty() && o.modes > 0 && doc.Data().Model().loadCases.empty();
    if (!FindShownStages(doc, o.stage, o.step, o.load, shown.stages, error))
        return Complain(EXIT_CODE::Usage, o.file + ": " + error);
    if (!modesAlone && !stageAlone && !FindShownCases(doc, o.cases, shown.cases, error))
        return Complain(o.cases.empty() ? EXIT_CODE::BadInput : EXIT_CODE::Usage,
                        o.file + ": " + error);
    if (!LoadCasesOf(doc, shown.cases, keys, error))
        return Complain(EXIT_CODE::BadInput, o.file + ": " + error);
    if (const EXIT_CODE code = Analyse(doc, keys, o.modes, stageAlone); code != EXIT_CODE::Done)
        return code;
    if (const EXIT_CODE code = ReadShown(doc, o, shown); code != EXIT_CODE::Done) return code;
    if (o.json != "-") PrintShown(o, shown, doc.Unit().Units());
    EXIT_CODE code = EXIT_CODE::Done;
    if (!o.json.empty())
        code = WriteOutput(o.json,
                           AnalysisJson(shown.cases, shown.results, shown.modes, shown.stages));
#ifdef QM_UI
    if (code == EXIT_CODE::Done && !o.plot.empty()) code = DrawShape(doc, o, shown);
#endif
    return code == EXIT_CODE::Done ? Store(doc, o) : code;
}
