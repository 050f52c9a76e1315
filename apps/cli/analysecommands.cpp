#include "analysecommands.h"

#include "analysis/analysistext.h"
#include "inputfile.h"
#include "output.h"
#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_db/sectionproperties.h"
#include "qm_rps/desk/elementlist.h"
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
    T_RESULT_CHOICE choice;
};

/// Shows how far a long run is, where somebody looks at it.
bool ShowProgress(std::size_t done, std::size_t total)
{
    ShowOnTerminal(Say("IDS_QM_CLI_ANALYSING", std::to_string(done), std::to_string(total)),
                   done == total);
    return true;
}

T_ACCURACY_BY_NAME AccuracyByName(CDBDoc& doc)
{
    T_ACCURACY_BY_NAME out;
    for (const T_LOST_DIGITS& lost : doc.LostDigits()) {
        const auto& cases = doc.Data().Model().loadCases;
        const auto at = cases.find(lost.loadCase);
        out.emplace_back(at == cases.end() ? std::string() : at->second.name, lost);
    }
    return out;
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

/// Rows of all tables that nobody reads on a screen.
constexpr std::size_t kManyRows = 20000;

std::size_t RowsOf(const T_SHOWN& shown)
{
    std::size_t rows = 0;
    const auto add = [&](const T_CASE_RESULTS& r) {
        rows += r.displacements.size() + r.reactions.size() + r.trusses.size() +
                kForcePositions * r.beams.size();
    };
    for (const T_CASE_RESULTS& r : shown.results)
        add(r);
    for (const T_SHOWN_STAGE& stage : shown.stages)
        add(stage.results);
    return rows;
}

void PrintShown(const T_ANALYSE_OPTIONS& o, const T_SHOWN& shown, const T_UNITS& units)
{
    const bool chosen = !shown.choice.IsAll() || o.envelope;
    const std::size_t rows = RowsOf(shown);
    const bool many = rows > kManyRows && !chosen && !o.table;
    const bool tables = (o.table || o.json.empty() || chosen) && !many;
    for (std::size_t i = 0; i < shown.cases.size(); ++i) {
        const std::string text =
            tables && !o.envelope
                ? CaseTables(shown.cases[i], shown.results[i], shown.choice, units)
                : CaseSummary(shown.cases[i], shown.results[i], units);
        std::fwrite(text.data(), 1, text.size(), stdout);
    }
    for (const T_SHOWN_STAGE& stage : shown.stages) {
        const T_SHOWN_CASE titled{StageTitle(stage), {}};
        const std::string text = tables && !o.stage.empty()
                                     ? CaseTables(titled, stage.results, shown.choice, units)
                                     : CaseSummary(titled, stage.results, units);
        std::fwrite(text.data(), 1, text.size(), stdout);
    }
    if (o.envelope)
        std::printf("%s", EnvelopeTables(shown.cases, shown.results, shown.choice, units).c_str());
    if (many && o.json.empty())
        std::printf("%s\n", Say("IDS_QM_CLI_MANY_ROWS", std::to_string(rows)).c_str());
    if (!shown.modes.empty()) std::printf("%s", ModeTable(shown.modes).c_str());
}

/// Ids of a list that must be there; each once.
template <class RECORDS>
EXIT_CODE ReadIds(const T_ANALYSE_OPTIONS& o, const std::string& text, const RECORDS& records,
                  const char* wrong, const char* missing, std::set<int>& out)
{
    if (text.empty()) return EXIT_CODE::Done;
    const std::optional<std::vector<int>> ids = ParseElementList(text);
    if (!ids || ids->empty()) return Complain(EXIT_CODE::Usage, Say(wrong, text));
    for (const int id : *ids) {
        if (!records.contains(id))
            return Complain(EXIT_CODE::Usage, o.file + ": " + Say(missing, std::to_string(id)));
        out.insert(id);
    }
    return EXIT_CODE::Done;
}

EXIT_CODE ReadChoice(CDBDoc& doc, const T_ANALYSE_OPTIONS& o, T_RESULT_CHOICE& choice)
{
    choice.top = static_cast<std::size_t>(o.top);
    const T_MODEL& model = doc.Data().Model();
    if (const EXIT_CODE code = ReadIds(o, o.nodes, model.nodes, "IDS_QM_CLI_PUSH_NODE_LIST",
                                       "IDS_QM_ANALYSIS_NO_NODE", choice.nodes);
        code != EXIT_CODE::Done)
        return code;
    return ReadIds(o, o.elements, model.elements, "IDS_QM_CLI_HINGE_ELEMENT_LIST",
                   "IDS_QM_ANALYSIS_NO_ELEMENT", choice.elements);
}

/// Of what is chosen; all of it in ascending order.
std::vector<T_CASE_RESULTS> ResultsForJson(const T_SHOWN& shown)
{
    T_RESULT_CHOICE choice = shown.choice;
    choice.top = 0;
    std::vector<T_CASE_RESULTS> out;
    for (const T_CASE_RESULTS& results : shown.results)
        out.push_back(Chosen(results, choice));
    return out;
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

EXIT_CODE ExitCodeOf(const T_ANALYSIS_ERROR& error)
{
    return error.fault == ANALYSIS_FAULT::NoMemory ? EXIT_CODE::NoAccess : EXIT_CODE::BadInput;
}

EXIT_CODE Analyse(CDBDoc& doc, const std::vector<int>& cases, int modes, bool noneForEmpty)
{
    T_ANALYSIS_OPTIONS options;
    options.allCases = cases.empty() && !noneForEmpty;
    options.cases = cases;
    options.modes = modes;
    if (isatty(STDERR_FILENO)) options.progress = ShowProgress;
    T_ANALYSIS_ERROR error;
    if (doc.RunAnalysis(options, error)) {
        for (const T_LOST_DIGITS& lost : doc.LostDigits())
            std::fprintf(stderr, "%s: %s\n", doc.Path().c_str(), doc.TextOf(lost).c_str());
        if (const std::string text = StiffnessFactorText(doc.Data().Model()); !text.empty())
            std::fprintf(stderr, "%s: %s\n", doc.Path().c_str(), text.c_str());
        return EXIT_CODE::Done;
    }
    return Complain(ExitCodeOf(error), doc.Path() + ": " + error.text);
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
    if (const EXIT_CODE code = ReadChoice(doc, o, shown.choice); code != EXIT_CODE::Done)
        return code;
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
        code = WriteOutput(o.json, AnalysisJson(shown.cases, ResultsForJson(shown), shown.modes,
                                                shown.stages, AccuracyByName(doc)));
#ifdef QM_UI
    if (code == EXIT_CODE::Done && !o.plot.empty()) code = DrawShape(doc, o, shown);
#endif
    return code == EXIT_CODE::Done ? Store(doc, o) : code;
}
