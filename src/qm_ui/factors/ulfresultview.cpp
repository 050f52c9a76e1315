#include "qm_ui/factors/ulfresultview.h"

#include "qm_base/msgfunction.h"
#include "qm_rps/ulfexplanationdlg.h"
#include "qm_rps/ulfiterationresultdlg.h"
#include "qm_rps/unknownloadfactorresultdlg.h"
#include "qm_ui/factors/ulfplot.h"

#include <QDate>

using zql::lib::MMSGFunction;

namespace {

using RESULT = CUnknownLoadFactorResultDlg;

constexpr CELL_KIND kText = CELL_KIND::Text, kNumber = CELL_KIND::Number;

T_GRID_BINDING FactorGrid(const RESULT& result)
{
    T_GRID_BINDING b;
    b.columns = UlfColumns(result.FactorHeads(), {kText, kNumber});
    b.columns.push_back({KeyText("IDS_QM_UI_HEAD_KIND"), kText});
    b.rows = [&result] { return result.Result().cases.size(); };
    b.text = [&result](std::size_t row, std::size_t c) { return result.FactorText(row, c); };
    return b;
}

T_GRID_BINDING ConstraintGrid(const RESULT& result)
{
    T_GRID_BINDING b;
    b.columns =
        UlfColumns(RESULT::kConstraintHeads, {kText, kNumber, kNumber, kNumber, kNumber, kText});
    b.columns.back().head = KeyText("IDS_QM_UI_ULF_STATE");
    b.columns.push_back({KeyText("IDS_QM_UI_ULF_UNIT"), kText});
    b.columns.push_back({KeyText("IDS_QM_UI_ULF_QUANTITY"), kText});
    b.rows = [&result] { return result.Result().constraints.size(); };
    b.text = [&result](std::size_t row, std::size_t c) { return result.ConstraintText(row, c); };
    b.tone = [&result](std::size_t row, std::size_t) {
        const RESULT::STATE state = result.StateOf(row);
        return state == RESULT::STATE::NotMet   ? CELL_TONE::Fault
               : state == RESULT::STATE::Active ? CELL_TONE::Notice
                                                : CELL_TONE::Plain;
    };
    return b;
}

/// Stays with their tensions and forces; empty where no unknown has any.
T_GRID_BINDING StayGrid(const RESULT& result)
{
    const auto stays = std::make_shared<std::vector<T_ULF_STAY>>(result.Stays());
    T_GRID_BINDING b;
    b.columns = UlfColumns(kUlfStayHeads, {kNumber, kText, kNumber, kNumber, kNumber, kNumber});
    b.rows = [stays] { return stays->size(); };
    b.text = [stays](std::size_t row, std::size_t c) { return UlfStayText(stays->at(row), c); };
    return b;
}

void Export(CFormView& form, RESULT& result, const T_ULF_HOOKS& hooks, bool opens)
{
    const QString path = hooks.askSheetName(form.window());
    if (path.isEmpty()) return;
    const QDate today = QDate::currentDate();
    result.m_sheet.year = today.year();
    result.m_sheet.month = today.month();
    result.m_sheet.day = today.day();
    (void)(opens ? result.OnOpenSheet(path.toStdString()) : result.OnExport(path.toStdString()));
}

void AddExport(CFormView& form, RESULT& result, const T_ULF_HOOKS& hooks)
{
    static constexpr std::array<int, 2> kVersions{16, 11}; // by the choice's index
    form.Group(KeyText("IDS_QM_UI_ULF_SHEET"));
    form.Choice(KeyText("IDS_QM_UI_ULF_SHEET_VERSION"),
                {[&result] { return result.m_sheet.applicationVersion == kVersions[0] ? 0 : 1; },
                 [&result](const int& index) {
                     result.m_sheet.applicationVersion = kVersions[static_cast<std::size_t>(index)];
                 }},
                KeyTexts({"IDS_QM_UI_ULF_SHEET_NEW", "IDS_QM_UI_ULF_SHEET_OLD"}));
    AddUlfButtons(form, {{"IDS_QM_UI_ULF_SHEET_WRITE",
                          [&form, &result, hooks] { Export(form, result, hooks, false); }},
                         {"IDS_QM_UI_ULF_SHEET_OPEN",
                          [&form, &result, hooks] { Export(form, result, hooks, true); }}});
    form.EndGroup();
}

void AddCombination(CFormView& form, RESULT& result)
{
    form.Group(KeyText("IDS_QM_UI_ULF_COMBINATION"));
    form.Text(KeyText("IDS_QM_UI_HEAD_NAME"), Ref(result.m_combinationName)).name = "combination";
    AddUlfButtons(form, {{"IDS_QM_UI_ULF_MAKE_COMBINATION",
                          [&result] { (void)result.OnMakeCombination(); }}});
    form.Note([&result] { return result.Outcome(); });
    form.EndGroup();
}

void BuildResult(CFormView& form, RESULT& result, const T_ULF_HOOKS& hooks)
{
    form.Page(KeyText("IDS_QM_UI_ULF_TABLES"));
    form.Columns();
    AddUlfGrid(form, FactorGrid(result), {280, 300});
    form.NextColumn();
    AddUlfGrid(form, ConstraintGrid(result), {760, 300});
    form.EndColumns();
    form.Note([&result] { return result.Notice(); });
    if (!result.Stays().empty()) {
        form.Page(KeyText("IDS_QM_UI_ULF_STAY_PAGE"));
        form.Note([&result] {
            return MMSGFunction::Format("IDS_QM_UI_ULF_STAYS", {result.ForceUnit()});
        });
        AddUlfGrid(form, StayGrid(result), {760, 300});
    }
    form.Page(KeyText("IDS_QM_UI_ULF_PICTURE"));
    AddUlfPicture(form, [&result] { return UlfPlot(UlfPictureOf(result)); });
    form.EndPages();
    form.Columns();
    AddExport(form, result, hooks);
    if (!result.Result().stage) {
        form.NextColumn();
        AddCombination(form, result);
    }
    form.EndColumns();
}

void BuildExplanation(CFormView& form, CUlfExplanationDlg& explanation)
{
    form.Group(PlainLabel(explanation.Item()));
    form.Note([&explanation] { return explanation.Text(); });
    AddUlfFiller(form);
    form.EndGroup();
}

} // namespace

void RegisterUlfResultViews(CViewFactory& factory, const T_ULF_HOOKS& hooks)
{
    T_VIEW shows;
    shows.showsOnly = true;
    shows.size = {1200, 640};
    factory.Register<RESULT>(
        KeyText("IDS_QM_UI_ULF_RESULT_TITLE"),
        [hooks](CFormView& form, RESULT& result) { BuildResult(form, result, hooks); }, shows);
    shows.size = {720, 420};
    factory.Register<CUlfExplanationDlg>(KeyText("IDS_QM_UI_ULF_EXPLANATION_TITLE"),
                                         BuildExplanation, shows);
}
