#include "ulfcommands.h"

#include "inputfile.h"
#include "output.h"
#include "qm_base/messagehistory.h"
#include "qm_base/say.h"
#include "qm_rps/factors/ulfstageplace.h"
#include "qm_rps/factors/ulftexts.h"
#include "qm_rps/unknownloadfactoritemdlg.h"
#include "qm_rps/unknownloadfactorresultdlg.h"
#include "qm_rps/unknownstageitemdlg.h"
#include "ulfrun.h"
#include "json/ulfjson.h"

#ifdef QM_UI
#include "modelshape.h"
#include "qm_ui/factors/ulfplot.h"
#endif

#include <algorithm>
#include <cstdio>
#include <ctime>
#include <filesystem>
#include <unistd.h>

namespace {

/// What messages about the item begin with.
std::string ItemOf(const T_ULF_OPTIONS& o)
{
    return Say("IDS_QM_CLI_FILE_ITEM", o.file, o.item);
}

EXIT_CODE OpenItem(const T_ULF_OPTIONS& o, T_ULF_OPENED& in)
{
    return OpenUlfItem(o.file, o.item, o.sumStageLoads, in);
}

EXIT_CODE OpenAndAnalyse(const T_ULF_OPTIONS& o, T_ULF_OPENED& in)
{
    const EXIT_CODE code = OpenItem(o, in);
    return code == EXIT_CODE::Done ? AnalyseForUlf(o.file, in) : code;
}

/// Solves for factors that are to be written; a refusal, a missing solution and constraints that
/// are not met are told on stderr.
EXIT_CODE SolveOpened(const T_ULF_OPTIONS& o, T_ULF_OPENED& in)
{
    const T_ULF_OUTCOME outcome = SolveUlf(*in.dialog);
    if (outcome.code == EXIT_CODE::Done) return EXIT_CODE::Done;
    const bool isForced = in.dialog->Result() && o.force;
    const bool isKept = in.dialog->Result() && !o.force;
    Complain(outcome.code, ItemOf(o) + ": " + outcome.message +
                               (isKept ? " " + Say("IDS_QM_CLI_ULF_FORCE") : std::string()));
    return isForced ? EXIT_CODE::Done : outcome.code;
}

#ifdef QM_UI
/// Displacements of the known cases alone, and of all with the factors found.
EXIT_CODE DrawBeforeAfter(CDBDoc& doc, const T_ULF_RESULT& r, const std::string& path)
{
    T_SHOWN_CASE before{Say("IDS_QM_CLI_KNOWN_ALONE"), {}},
        after{Say("IDS_QM_CLI_WITH_FACTORS"), {}};
    for (std::size_t i = 0; i < r.cases.size(); ++i) {
        if (!r.cases[i].unknown)
            before.combination.items.push_back({false, r.cases[i].key, r.factors[i]});
        after.combination.items.push_back({false, r.cases[i].key, r.factors[i]});
    }
    T_SHAPE shape = ShapeOfModel(doc);
    shape.subtitle = Say("IDS_QM_PLOT_ULF_TITLE", r.item.name);
    for (const T_SHOWN_CASE& state : {before, after}) {
        T_CASE_RESULTS results;
        std::string error;
        if (!ReadCaseResults(doc, state, results, error))
            return Complain(EXIT_CODE::BadInput, doc.Path() + ": " + error);
        shape.states.push_back(StateOf(state.name, results.displacements));
    }
    return WritePicture(ShapePlot(shape), path);
}
#endif

EXIT_CODE DrawPictures(CDBDoc& doc, const T_ULF_RESULT& r, const T_ULF_OPTIONS& o)
{
#ifdef QM_UI
    EXIT_CODE code = WritePicture(UlfPlot(UlfPictureOf({doc, r})), o.plot);
    if (code == EXIT_CODE::Done && !o.shapePlot.empty())
        code = DrawBeforeAfter(doc, r, o.shapePlot);
    return code;
#else
    (void)doc, (void)r, (void)o;
    return EXIT_CODE::Done;
#endif
}

/// Shows how far a long search is, where somebody looks at it.
bool ShowSearch(int tried, int members)
{
    ShowOnTerminal(Say("IDS_QM_CLI_CONTRADICTION", std::to_string(tried), std::to_string(members)),
                   tried == members);
    return true;
}

/// Today, or YYYY-MM-DD. False: the text is no date.
bool SetDate(const std::string& text, T_ULF_SHEET_SETTINGS& settings)
{
    if (text.empty()) {
        const std::time_t now = std::time(nullptr);
        std::tm local{};
        localtime_r(&now, &local);
        settings.year = local.tm_year + 1900;
        settings.month = local.tm_mon + 1;
        settings.day = local.tm_mday;
        return true;
    }
    char rest = 0;
    return std::sscanf(text.c_str(), "%4d-%2d-%2d%c", &settings.year, &settings.month,
                       &settings.day, &rest) == 3 &&
           settings.month >= 1 && settings.month <= 12 && settings.day >= 1 && settings.day <= 31;
}

void PrintItem(const std::string& text, bool equations)
{
    std::printf("%s%s\n", text.c_str(), equations ? Say("IDS_QM_CLI_AS_EQUATIONS").c_str() : "");
}

void ListItem(CDBDoc& doc, int key, const T_ULFI_D& item)
{
    const auto& combinations = doc.Data().Model().combinations;
    const auto it = combinations.find(item.combination);
    const std::size_t cases = CUnknownLoadFactorItemDlg(doc, key).Cases().size();
    PrintItem(Say("IDS_QM_CLI_ULF_ITEM", item.name,
                  it == combinations.end() ? "-" : it->second.name,
                  std::to_string(item.unknowns.size()), std::to_string(cases),
                  std::to_string(item.constraints.size())),
              item.solveByEquations);
}

void ListStageItem(CDBDoc& doc, int key, const T_ULSI_D& item)
{
    const auto unknown = std::ranges::count_if(item.rows, &T_ULSI_ROW::unknown);
    const auto scaling = std::ranges::count_if(item.rows, &T_ULSI_ROW::pretension);
    PrintItem(Say("IDS_QM_CLI_ULF_STAGE_ITEM", item.name, std::to_string(unknown),
                  std::to_string(item.rows.size()), std::to_string(scaling),
                  std::to_string(item.constraints.size())),
              item.solveByEquations);
    for (const auto& row : CUnknownStageItemDlg(doc, key).Summary())
        std::printf("  %s\n", Say("IDS_QM_UI_ULF_SUMMARY", Say(std::string(row.key).c_str()),
                                  std::to_string(row.unknowns), std::to_string(row.rows))
                                  .c_str());
}

EXIT_CODE LastMessage(const zql::frx::MDialog& dialog, EXIT_CODE code, const std::string& file)
{
    const auto& messages = dialog.Messages();
    return Complain(code, messages.empty() ? file + ": " + Say("IDS_QM_CLI_REFUSED")
                                           : messages.back().text);
}

} // namespace

EXIT_CODE RunUlfList(const T_ULF_OPTIONS& o)
{
    CDBDoc doc;
    if (const EXIT_CODE code = OpenInput(doc, o.file); code != EXIT_CODE::Done) return code;
    const T_MODEL& model = doc.Data().Model();
    for (const auto& [key, item] : model.ulfItems)
        ListItem(doc, key, item);
    for (const auto& [key, item] : model.ulfStageItems)
        ListStageItem(doc, key, item);
    for (const auto& entry : model.ulfConstraints) {
        T_ULFC_D c;
        if (!doc.Attr().GetUlfc(entry.first, c)) continue;
        const std::string place = UlfPlaceText(doc.Data(), c.stage, c.step);
        const bool bounded = c.inequality || c.compareWithValue; // else there is no number
        const std::string unit =
            bounded ? " " + UlfUnitText(c.type, c.component, doc.Unit().Units()) : std::string();
        std::printf("  %s: %s%s\n", UlfNameAt(c.name, place).c_str(), UlfDescription(c).c_str(),
                    unit.c_str());
    }
    const std::size_t items = model.ulfItems.size() + model.ulfStageItems.size();
    std::printf("%s\n", Say("IDS_QM_CLI_ULF_COUNTS", std::to_string(items),
                            std::to_string(model.ulfConstraints.size()))
                            .c_str());
    return EXIT_CODE::Done;
}

EXIT_CODE RunUlfCheck(const T_ULF_OPTIONS& o)
{
    CDBDoc doc;
    if (const EXIT_CODE code = OpenInput(doc, o.file); code != EXIT_CODE::Done) return code;
    std::size_t items = 0, findings = 0, warnings = 0;
    const auto check = [&](const std::string& name, const CUlfItemDialog& dialog) {
        if (!o.item.empty() && name != o.item) return;
        ++items;
        for (const T_FINDING& f : dialog.Findings()) {
            std::printf("%s: %s: %s\n", name.c_str(), f.field.c_str(), f.text.c_str());
            ++findings;
        }
        for (const T_FINDING& f : dialog.Warnings()) {
            std::printf("%s: %s: %s\n", name.c_str(), f.field.c_str(),
                        Say("IDS_QM_CLI_ULF_WARNING", f.text).c_str());
            ++warnings;
        }
    };
    for (const auto& [key, item] : doc.Data().Model().ulfItems)
        check(item.name, CUnknownLoadFactorItemDlg(doc, key));
    for (const auto& [key, item] : doc.Data().Model().ulfStageItems)
        check(item.name, CUnknownStageItemDlg(doc, key));
    if (items == 0 && !o.item.empty())
        return Complain(EXIT_CODE::Usage, o.file + ": " + Say("IDS_QM_CLI_NO_ULF_ITEM", o.item));
    std::printf(
        "%s\n",
        Say("IDS_QM_CLI_ULF_FINDINGS", std::to_string(items), std::to_string(findings)).c_str());
    if (warnings > 0)
        std::printf("%s\n", Say("IDS_QM_CLI_ULF_WARNINGS", std::to_string(warnings)).c_str());
    return findings == 0 ? EXIT_CODE::Done : EXIT_CODE::NotFound;
}

EXIT_CODE RunUlfSolve(const T_ULF_OPTIONS& o)
{
    for (const std::string& path : {o.plot, o.shapePlot}) {
        if (const EXIT_CODE code = CheckPlotName(path); code != EXIT_CODE::Done) return code;
    }
    if (const EXIT_CODE code = CheckOutputs(o.file,
                                            {{o.json, OUTPUT_KIND::Json},
                                             {o.plot, OUTPUT_KIND::Picture},
                                             {o.shapePlot, OUTPUT_KIND::Picture}},
                                            o.overwrite);
        code != EXIT_CODE::Done)
        return code;
    T_ULF_OPENED in;
    if (const EXIT_CODE code = OpenItem(o, in); code != EXIT_CODE::Done) return code;
    if (in.stage && !o.shapePlot.empty())
        return Complain(EXIT_CODE::Usage, Say("IDS_QM_CLI_SHAPE_PLOT_STATIC", o.item));
    if (const EXIT_CODE code = AnalyseForUlf(o.file, in); code != EXIT_CODE::Done) return code;
    in.dialog->m_dump = o.dump;
    const T_ULF_OUTCOME outcome = SolveUlf(*in.dialog);
    const auto& result = in.dialog->Result();
    for (const T_FINDING& f : result ? in.dialog->Warnings() : std::vector<T_FINDING>())
        Complain(EXIT_CODE::Done, ItemOf(o) + ": " + Say("IDS_QM_CLI_ULF_WARNING", f.text));
    if (outcome.code != EXIT_CODE::Done) Complain(outcome.code, ItemOf(o) + ": " + outcome.message);
    if (!o.json.empty()) {
        const EXIT_CODE code = WriteOutput(o.json, UlfJson(outcome, result));
        if (code != EXIT_CODE::Done) return code;
    }
    if (!result) return outcome.code;
    const CUnknownLoadFactorResultDlg dialog(in.doc, *result);
    if (o.json != "-")
        std::printf("%s%s", UlfTables(*result).c_str(),
                    StayTable(dialog.Stays(), in.doc.Data().Units()).c_str());
    const EXIT_CODE drawn = DrawPictures(in.doc, *result, o);
    return drawn == EXIT_CODE::Done ? outcome.code : drawn;
}

EXIT_CODE RunUlfExplain(const T_ULF_OPTIONS& o)
{
    if (const EXIT_CODE code = CheckOutputs(o.file, {{o.json, OUTPUT_KIND::Json}}, o.overwrite);
        code != EXIT_CODE::Done)
        return code;
    T_ULF_OPENED in;
    if (const EXIT_CODE code = OpenAndAnalyse(o, in); code != EXIT_CODE::Done) return code;
    const T_ULF_OUTCOME outcome = SolveUlf(*in.dialog);
    T_ULF_EXPLAINED explained;
    const auto& run = in.dialog->Calculation().run;
    const std::function<bool(int, int)> progress =
        isatty(STDERR_FILENO) ? ShowSearch : std::function<bool(int, int)>();
    if (!run || !ExplainUlf(*run, in.doc.Unit().Units(), explained, progress))
        return Complain(outcome.code, ItemOf(o) + ": " + outcome.message);
    if (!o.json.empty()) {
        const EXIT_CODE code = WriteOutput(o.json, ExplainJson(explained));
        if (code != EXIT_CODE::Done) return code;
    }
    for (const std::string& line : explained.lines)
        if (o.json != "-") std::printf("%s\n", line.c_str());
    if (outcome.code != EXIT_CODE::Done) Complain(outcome.code, ItemOf(o) + ": " + outcome.message);
    return outcome.code;
}

EXIT_CODE RunUlfExport(const T_ULF_OPTIONS& o)
{
    if (const EXIT_CODE code = CheckOutputs(o.file, {{o.out, OUTPUT_KIND::Sheet}}, o.overwrite);
        code != EXIT_CODE::Done)
        return code;
    T_ULF_SHEET_SETTINGS settings;
    settings.applicationVersion = o.sheetVersion;
    settings.fileName = std::filesystem::path(o.file).filename().string();
    if (!SetDate(o.date, settings))
        return Complain(EXIT_CODE::Usage, o.date + ": " + Say("IDS_QM_CLI_DATE"));
    T_ULF_OPENED in;
    if (const EXIT_CODE code = OpenAndAnalyse(o, in); code != EXIT_CODE::Done) return code;
    if (const EXIT_CODE code = SolveOpened(o, in); code != EXIT_CODE::Done) return code;
    CUnknownLoadFactorResultDlg dialog(in.doc, *in.dialog->Result());
    dialog.m_force = o.force;
    if (!dialog.OnExport(o.out, settings)) {
        const bool fits = UlfSheetFits(dialog.Result().constraints.size(), o.sheetVersion);
        return LastMessage(dialog, fits ? EXIT_CODE::NoAccess : EXIT_CODE::BadInput, o.file);
    }
    std::printf("%s\n", Say("IDS_QM_CLI_SHEET_WRITTEN", o.out,
                            std::to_string(dialog.Result().constraints.size()),
                            std::to_string(dialog.Result().cases.size()))
                            .c_str());
    if (o.open && !OpenSheetFile(o.out))
        return Complain(EXIT_CODE::NoAccess, o.out + ": " + Say("IDS_QM_ULF_NO_EXCEL"));
    return EXIT_CODE::Done;
}

EXIT_CODE RunUlfCombine(const T_ULF_OPTIONS& o)
{
    if (const EXIT_CODE code = CheckOutputs(o.file, {{o.out, OUTPUT_KIND::Document}}, o.overwrite);
        code != EXIT_CODE::Done)
        return code;
    T_ULF_OPENED in;
    if (const EXIT_CODE code = OpenItem(o, in); code != EXIT_CODE::Done) return code;
    if (in.stage)
        return Complain(EXIT_CODE::Usage,
                        o.file + ": " + Say("IDS_QM_ULSI_NO_COMBINATION", o.item));
    if (o.out.empty() && !IsModelFile(o.file))
        return Complain(EXIT_CODE::Usage, o.file + ": " + Say("IDS_QM_CLI_CASE_NOT_CHANGED"));
    if (const EXIT_CODE code = AnalyseForUlf(o.file, in); code != EXIT_CODE::Done) return code;
    if (const EXIT_CODE code = SolveOpened(o, in); code != EXIT_CODE::Done) return code;
    CUnknownLoadFactorResultDlg dialog(in.doc, *in.dialog->Result());
    dialog.m_force = o.force;
    dialog.m_combinationName = o.name;
    (void)TakeMessageHistory(); // what the calculation has left
    const auto& combinations = in.doc.Data().Model().combinations;
    const std::size_t before = combinations.size();
    const int made = dialog.OnMakeCombination();
    // Of a set that is split the parts that could be added stand, and are saved with their lines.
    const EXIT_CODE saved = combinations.size() == before
                                ? EXIT_CODE::Usage
                                : SaveDocument(in.doc, o.out.empty() ? o.file : o.out);
    for (const std::string& line : TakeMessageHistory()) {
        if (!made)
            Complain(EXIT_CODE::Usage, line);
        else if (saved == EXIT_CODE::Done)
            std::printf("%s\n", line.c_str());
    }
    return made ? saved : EXIT_CODE::Usage;
}
