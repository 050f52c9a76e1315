#include "ulfrun.h"

#include "analysecommands.h"
#include "inputfile.h"
#include "output.h"
#include "qm_base/msgfunction.h"
#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_rps/unknownloadfactoritemdlg.h"
#include "qm_rps/unknownstageitemdlg.h"

#include <algorithm>

using zql::lib::MMSGFunction;

namespace {

constexpr int kNotCertified = 10;

/// Codes of the solver that say that there is no solution, or that none was proved; others refuse
/// the input.
bool SaysNoSolution(int code)
{
    return (code >= 5 && code <= 8) || code == kNotCertified;
}

std::string OneLine(std::string text)
{
    std::replace(text.begin(), text.end(), '\n', ' ');
    return text;
}

std::string Short(const std::optional<double>& v)
{
    return v ? FormatText("%.7g", *v + 0.0) : "-";
}

template <class ROWS, class F>
int Widest(const ROWS& rows, int least, const F& text)
{
    std::size_t width = static_cast<std::size_t>(least);
    for (const auto& row : rows)
        width = std::max(width, text(row).size());
    return static_cast<int>(width);
}

/// Names of the load cases, each with its factor; ones of the unknowns that are rounding as 0.
std::string FactorTable(const T_ULF_RESULT& r)
{
    const std::string head = Say(r.stage ? "IDS_QM_CLI_STAGE_CASE" : "IDS_QM_CLI_LOAD_CASE");
    const int width = Widest(r.cases, std::max(10, static_cast<int>(head.size())),
                             [](const T_ULF_CASE& c) { return c.name; });
    std::string text =
        FormatText("%-*s %9s %16s\n", width, head.c_str(), "", Say("IDS_QM_CLI_FACTOR").c_str());
    for (std::size_t i = 0; i < r.cases.size(); ++i)
        text +=
            FormatText("%-*s %9s %16.9g\n", width, r.cases[i].name.c_str(),
                       Say(r.cases[i].unknown ? "IDS_QM_CLI_UNKNOWN" : "IDS_QM_CLI_KNOWN").c_str(),
                       UlfShownFactor(r, i));
    return text;
}

/// The constraints in their units. What the values are is said where they are a forecast.
std::string ConstraintTable(const T_ULF_RESULT& r)
{
    const auto rows = UlfResultRows(r);
    const auto nameOf = [](const T_ULF_RESULT_ROW& row) { return UlfNameAt(row.name, row.place); };
    const int width = Widest(rows, 10, nameOf);
    const int unitWidth = Widest(rows, 4, [](const T_ULF_RESULT_ROW& row) { return row.unit; });
    std::string text = FormatText(
        "%-*s %15s %15s %15s %13s %-*s  %s\n", width, Say("IDS_QM_CLI_CONSTRAINT").c_str(),
        Say(r.linearForecast ? "IDS_QM_CLI_FORECAST" : "IDS_QM_CLI_VALUE").c_str(),
        Say("IDS_QM_CLI_LOWER").c_str(), Say("IDS_QM_CLI_UPPER").c_str(),
        Say("IDS_QM_CLI_MISSED_BY").c_str(), unitWidth, Say("IDS_QM_CLI_UNIT").c_str(),
        Say("IDS_QM_CLI_STATE").c_str());
    for (std::size_t i = 0; i < rows.size(); ++i) {
        const T_ULF_RESULT_ROW& row = rows[i];
        const double scale = UlfScale(r, i);
        const std::string state = !row.met     ? Say("IDS_QM_CLI_NOT_MET")
                                  : row.active ? Say("IDS_QM_CLI_ACTIVE")
                                               : "-";
        text += FormatText("%-*s %15.7g %15s %15s %13.3g %-*s  %s\n", width, nameOf(row).c_str(),
                           UlfShown(row.value, scale), Short(row.lower).c_str(),
                           Short(row.upper).c_str(), UlfShown(row.residual, scale), unitWidth,
                           row.unit.c_str(), state.c_str());
    }
    return text;
}

} // namespace

EXIT_CODE OpenUlfItem(const std::string& file, const std::string& item, bool sumStageLoads,
                      T_ULF_OPENED& out)
{
    if (const EXIT_CODE code = OpenInput(out.doc, file); code != EXIT_CODE::Done) return code;
    int key = 0, stageKey = 0;
    const bool isStatic = out.doc.Attr().FindUlfi(item, key) != 0;
    out.stage = out.doc.Attr().FindUlsi(item, stageKey) != 0;
    if (isStatic && out.stage)
        return Complain(EXIT_CODE::BadInput, file + ": " + Say("IDS_QM_CLI_ULF_TWO_ITEMS", item));
    if (out.stage) {
        auto dialog = std::make_unique<CUnknownStageItemDlg>(out.doc, stageKey);
        dialog->m_sumStageLoads |= sumStageLoads;
        out.dialog = std::move(dialog);
    } else if (isStatic) {
        auto dialog = std::make_unique<CUnknownLoadFactorItemDlg>(out.doc, key);
        for (const T_ULF_CASE& loadCase : dialog->Cases())
            out.cases.push_back(loadCase.key);
        out.dialog = std::move(dialog);
    } else {
        return Complain(EXIT_CODE::Usage, file + ": " + Say("IDS_QM_CLI_NO_ULF_ITEM", item));
    }
    return EXIT_CODE::Done;
}

EXIT_CODE AnalyseForUlf(const std::string& file, T_ULF_OPENED& in)
{
    if ((!in.stage && IsModelFile(file)) || !in.dialog->Findings().empty()) return EXIT_CODE::Done;
    return in.stage ? AnalyseStages(in.doc, file) : Analyse(in.doc, in.cases, 0);
}

EXIT_CODE AnalyseStages(CDBDoc& doc, const std::string& file)
{
    if (doc.Post().CheckStagedResult()) return EXIT_CODE::Done;
    T_ANALYSIS_OPTIONS options;
    options.allCases = false;
    T_ANALYSIS_ERROR error;
    if (doc.RunAnalysis(options, error)) return EXIT_CODE::Done;
    return Complain(ExitCodeOf(error), file + ": " + error.text);
}

T_ULF_OUTCOME SolveUlf(CUlfItemDialog& dialog)
{
    T_ULF_OUTCOME out;
    const T_ULF_CALCULATION& calculation = dialog.Calculate();
    const auto& run = calculation.run;
    if (run) out.solverCode = run->answer.code;
    out.exact = dialog.m_solveByEquations || (run && run->answer.exact);
    if (calculation.said) out.message = OneLine(calculation.said->text);
    if (calculation.result) {
        out.exact = calculation.result->exact;
        const auto rows = UlfResultRows(*calculation.result);
        const bool met = std::ranges::all_of(rows, &T_ULF_RESULT_ROW::met);
        out.status = met ? "found" : "not met";
        out.code = met ? EXIT_CODE::Done : EXIT_CODE::NotFound;
        if (out.message.empty())
            out.message = MMSGFunction::GetValue("IDS_RPS_Unknown_CAN_FIND_OPTIMIZED_SOLUTION");
        return out;
    }
    // A numbered constraint or factor: the restriction of the signs leaves nothing.
    const bool none = run && (SaysNoSolution(out.solverCode) || run->answer.constraint > 0 ||
                              run->answer.factor > 0);
    out.status = none ? "not found" : "refused";
    if (none && out.solverCode == kNotCertified) out.status = "not proved";
    out.code = none ? EXIT_CODE::NotFound : EXIT_CODE::BadInput;
    return out;
}

std::string UlfTables(const T_ULF_RESULT& r)
{
    std::string text = FactorTable(r) + "\n" + ConstraintTable(r) + "\n" +
                       Say("IDS_QM_CLI_OBJECTIVE", FormatText("%.9g", UlfObjective(r))) + "\n";
    if (r.linearForecast) text += Say("IDS_QM_ULF_LINEAR_FORECAST") + "\n";
    return text;
}

std::string StayTable(const std::vector<T_ULF_STAY>& stays, const T_UNITS& units)
{
    if (stays.empty()) return {};
    const std::string unit(NameOf(units.force));
    const auto in = [&](const char* key) { return Say(key) + " " + unit; };
    std::string text =
        FormatText("\n%8s  %-16s %16s %12s %16s %16s\n", Say("IDS_QM_CLI_ELEMENT").c_str(),
                   Say("IDS_QM_CLI_LOAD_CASE").c_str(), in("IDS_QM_CLI_STAY_START").c_str(),
                   Say("IDS_QM_CLI_FACTOR").c_str(), in("IDS_QM_CLI_STAY_NOW").c_str(),
                   in("IDS_QM_CLI_STAY_FORCE").c_str());
    for (const T_ULF_STAY& s : stays)
        text += FormatText("%8d  %-16s %16s %12s %16s %16s\n", s.element, s.load.c_str(),
                           Short(s.start).c_str(), Short(s.Factor()).c_str(), Short(s.now).c_str(),
                           Short(s.force).c_str());
    return text;
}
