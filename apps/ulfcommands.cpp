#include "ulfcommands.h"

#include "analysecommands.h"
#include "inputfile.h"
#include "output.h"
#include "qm_base/messagehistory.h"
#include "qm_base/textformat.h"
#include "qm_rps/ulftexts.h"
#include "qm_rps/unknownloadfactorresultdlg.h"
#include "ulfrun.h"

#ifdef QM_UI
#include "modelshape.h"
#include "qm_ui/ulfplot.h"
#endif

#include <cstdio>
#include <ctime>
#include <filesystem>
#include <memory>
#include <unistd.h>

namespace {

/// A document with one of its items, ready to be calculated.
struct T_OPENED {
    CDBDoc doc;
    std::unique_ptr<CUnknownLoadFactorItemDlg> dialog;
};

/// A case file is analysed in memory: the load cases of the item's combination.
EXIT_CODE PrepareResults(T_OPENED& in, const std::string& file)
{
    if (IsModelFile(file) || !in.dialog->Findings().empty()) return EXIT_CODE::Done;
    std::vector<int> keys;
    for (const T_ULF_CASE& c : in.dialog->Cases())
        keys.push_back(c.key);
    return Analyse(in.doc, keys, 0);
}

EXIT_CODE OpenItem(const T_ULF_OPTIONS& o, T_OPENED& in)
{
    if (const EXIT_CODE code = OpenInput(in.doc, o.file); code != EXIT_CODE::Done) return code;
    int key = 0;
    if (!in.doc.Attr().FindUlfi(o.item, key))
        return Complain(EXIT_CODE::Usage,
                        o.file + ": no unknown load factor item named \"" + o.item + "\"");
    in.dialog = std::make_unique<CUnknownLoadFactorItemDlg>(in.doc, key);
    return PrepareResults(in, o.file);
}

/// Opens and solves; a refusal or a missing solution is told on stderr.
EXIT_CODE OpenAndSolve(const T_ULF_OPTIONS& o, T_OPENED& in)
{
    if (const EXIT_CODE code = OpenItem(o, in); code != EXIT_CODE::Done) return code;
    const T_ULF_OUTCOME outcome = SolveUlf(*in.dialog);
    if (outcome.code != EXIT_CODE::Done) Complain(outcome.code, o.file + ": " + outcome.message);
    return in.dialog->Result() ? EXIT_CODE::Done : outcome.code;
}

#ifdef QM_UI
std::string FactorNote(const T_ULF_CASE& c, double factor)
{
    return FormatText("%s = %.6g%s", c.name.c_str(), factor, c.unknown ? "" : " (known)");
}

T_ULF_PICTURE PictureOf(CDBDoc& doc, const T_ULF_RESULT& r)
{
    T_ULF_PICTURE picture;
    picture.title = "Unknown load factors: " + r.item.name;
    picture.subtitle = std::string(r.exact ? "solved as equations" : "optimized") + ", " +
                       doc.Data().Model().styp.title;
    for (const T_ULF_RESULT_ROW& row : UlfResultRows(r))
        picture.bars.push_back({row.name, UlfUnit(doc, row.name), row.value, row.upper, row.lower,
                                row.active, !row.met, UlfScale(r, picture.bars.size())});
    for (std::size_t i = 0; i < r.cases.size(); ++i)
        picture.notes.push_back(FactorNote(r.cases[i], r.factors[i]));
    return picture;
}

/// Displacements of the known cases alone, and of all with the factors found.
EXIT_CODE DrawBeforeAfter(CDBDoc& doc, const T_ULF_RESULT& r, const std::string& path)
{
    T_SHOWN_CASE before{"known load cases alone", {}}, after{"with the factors found", {}};
    for (std::size_t i = 0; i < r.cases.size(); ++i) {
        if (!r.cases[i].unknown)
            before.combination.items.push_back({false, r.cases[i].key, r.factors[i]});
        after.combination.items.push_back({false, r.cases[i].key, r.factors[i]});
    }
    T_SHAPE shape = ShapeOfModel(doc);
    shape.subtitle = "Unknown load factors: " + r.item.name;
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
    EXIT_CODE code = WritePicture(UlfPlot(PictureOf(doc, r)), o.plot);
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
    std::fprintf(stderr, "\rqm-rps: looking for the contradiction, %d of %d%s", tried, members,
                 tried == members ? "\n" : "");
    std::fflush(stderr);
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

EXIT_CODE LastMessage(const zql::frx::MDialog& dialog, EXIT_CODE code, const std::string& file)
{
    const auto& messages = dialog.Messages();
    return Complain(code, messages.empty() ? file + ": refused" : messages.back().text);
}

} // namespace

EXIT_CODE RunUlfList(const T_ULF_OPTIONS& o)
{
    CDBDoc doc;
    if (const EXIT_CODE code = OpenInput(doc, o.file); code != EXIT_CODE::Done) return code;
    const T_MODEL& model = doc.Data().Model();
    for (const auto& entry : model.ulfItems) {
        const CUnknownLoadFactorItemDlg dialog(doc, entry.first);
        const T_LCOM_D* combination = nullptr;
        if (const auto it = model.combinations.find(entry.second.combination);
            it != model.combinations.end())
            combination = &it->second;
        std::printf("%s: combination %s, %zu of %zu load cases unknown, %zu constraints%s\n",
                    entry.second.name.c_str(), combination ? combination->name.c_str() : "-",
                    entry.second.unknowns.size(), dialog.Cases().size(),
                    entry.second.constraints.size(),
                    entry.second.solveByEquations ? ", solved as equations" : "");
    }
    for (const auto& entry : model.ulfConstraints) {
        T_ULFC_D c;
        if (doc.Attr().GetUlfc(entry.first, c))
            std::printf("  %s: %s\n", c.name.c_str(), UlfDescription(c).c_str());
    }
    std::printf("%zu items, %zu constraints\n", model.ulfItems.size(), model.ulfConstraints.size());
    return EXIT_CODE::Done;
}

EXIT_CODE RunUlfCheck(const T_ULF_OPTIONS& o)
{
    CDBDoc doc;
    if (const EXIT_CODE code = OpenInput(doc, o.file); code != EXIT_CODE::Done) return code;
    std::size_t items = 0, findings = 0;
    for (const auto& entry : doc.Data().Model().ulfItems) {
        if (!o.item.empty() && entry.second.name != o.item) continue;
        ++items;
        for (const T_FINDING& f : CUnknownLoadFactorItemDlg(doc, entry.first).Findings()) {
            std::printf("%s: %s: %s\n", entry.second.name.c_str(), f.field.c_str(), f.text.c_str());
            ++findings;
        }
    }
    if (items == 0 && !o.item.empty())
        return Complain(EXIT_CODE::Usage,
                        o.file + ": no unknown load factor item named \"" + o.item + "\"");
    std::printf("%zu items, %zu findings\n", items, findings);
    return findings == 0 ? EXIT_CODE::Done : EXIT_CODE::NotFound;
}

EXIT_CODE RunUlfSolve(const T_ULF_OPTIONS& o)
{
    for (const std::string& path : {o.plot, o.shapePlot}) {
        if (const EXIT_CODE code = CheckPlotName(path); code != EXIT_CODE::Done) return code;
    }
    T_OPENED in;
    if (const EXIT_CODE code = OpenItem(o, in); code != EXIT_CODE::Done) return code;
    const T_ULF_OUTCOME outcome = SolveUlf(*in.dialog);
    const auto& result = in.dialog->Result();
    if (outcome.code != EXIT_CODE::Done) Complain(outcome.code, o.file + ": " + outcome.message);
    if (!o.json.empty()) {
        const EXIT_CODE code = WriteOutput(o.json, UlfJson(outcome, result));
        if (code != EXIT_CODE::Done) return code;
    }
    if (!result) return outcome.code;
    if (o.json != "-") std::printf("%s", UlfTables(*result).c_str());
    const EXIT_CODE drawn = DrawPictures(in.doc, *result, o);
    return drawn == EXIT_CODE::Done ? outcome.code : drawn;
}

EXIT_CODE RunUlfExplain(const T_ULF_OPTIONS& o)
{
    T_OPENED in;
    if (const EXIT_CODE code = OpenItem(o, in); code != EXIT_CODE::Done) return code;
    const T_ULF_OUTCOME outcome = SolveUlf(*in.dialog);
    T_ULF_EXPLAINED explained;
    const auto& run = in.dialog->LastRun();
    const std::function<bool(int, int)> progress =
        isatty(STDERR_FILENO) ? ShowSearch : std::function<bool(int, int)>();
    if (!run || !ExplainUlf(*run, in.doc.Unit().Units(), explained, progress))
        return Complain(outcome.code, o.file + ": " + outcome.message);
    if (!o.json.empty()) {
        const EXIT_CODE code = WriteOutput(o.json, ExplainJson(explained));
        if (code != EXIT_CODE::Done) return code;
    }
    for (const std::string& line : explained.lines)
        if (o.json != "-") std::printf("%s\n", line.c_str());
    return outcome.code;
}

EXIT_CODE RunUlfExport(const T_ULF_OPTIONS& o)
{
    T_ULF_SHEET_SETTINGS settings;
    settings.applicationVersion = o.sheetVersion;
    settings.fileName = std::filesystem::path(o.file).filename().string();
    if (!SetDate(o.date, settings))
        return Complain(EXIT_CODE::Usage, o.date + ": a date is YYYY-MM-DD");
    T_OPENED in;
    if (const EXIT_CODE code = OpenAndSolve(o, in); code != EXIT_CODE::Done) return code;
    CUnknownLoadFactorResultDlg dialog(in.doc, *in.dialog->Result());
    if (!dialog.OnExport(o.out, settings)) {
        const bool fits = UlfSheetFits(dialog.Result().constraints.size(), o.sheetVersion);
        return LastMessage(dialog, fits ? EXIT_CODE::NoAccess : EXIT_CODE::BadInput, o.file);
    }
    std::printf("%s written: %zu constraints, %zu load cases\n", o.out.c_str(),
                dialog.Result().constraints.size(), dialog.Result().cases.size());
    return EXIT_CODE::Done;
}

EXIT_CODE RunUlfCombine(const T_ULF_OPTIONS& o)
{
    if (o.out.empty() && !IsModelFile(o.file))
        return Complain(EXIT_CODE::Usage, o.file + ": a case file is not changed; name another "
                                                   "file with -o");
    T_OPENED in;
    if (const EXIT_CODE code = OpenAndSolve(o, in); code != EXIT_CODE::Done) return code;
    CUnknownLoadFactorResultDlg dialog(in.doc, *in.dialog->Result());
    dialog.m_combinationName = o.name;
    (void)TakeMessageHistory(); // what the calculation has left
    const int made = dialog.OnMakeCombination();
    const std::vector<std::string> history = TakeMessageHistory();
    for (const std::string& line : history)
        std::fprintf(made ? stdout : stderr, "%s%s\n", made ? "" : "qm-rps: ", line.c_str());
    if (!made) return EXIT_CODE::Usage;
    return SaveDocument(in.doc, o.out.empty() ? o.file : o.out);
}
