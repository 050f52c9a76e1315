#include "qm_ui/evaluate/evaluationdeskview.h"

#include "qm_base/msgfunction.h"
#include "qm_db/filectrl.h"
#include "qm_rps/pushover/overview/factcells.h"
#include "qm_rps/pushover/report/pushovercells.h"
#include "qm_rps/section/sectionexport.h"
#include "qm_ui/evaluate/deskfields.h"
#include "qm_ui/evaluate/overlayplot.h"
#include "qm_ui/form/gridview.h"
#include "qm_ui/pushover/evaluationplot.h"
#include "qm_ui/pushover/pushoverfields.h"

#include <QClipboard>
#include <QGuiApplication>
#include <QTabWidget>

namespace {

using zql::lib::MMSGFunction;
using MODEL = CEvaluationDeskDlg;

/// The table that is in front; null: none.
CGridView* TableInFront(QWidget* host)
{
    CGridView* front = nullptr;
    for (QTableView* table : host->findChildren<QTableView*>())
        if (auto* view = dynamic_cast<CGridView*>(table))
            if (view->isVisible() && (!front || view->hasFocus())) front = view;
    return front;
}

/// Heads and cells with tabs, as spreadsheets take them.
void CopyTable(QWidget* host)
{
    CGridView* const view = TableInFront(host);
    if (!view) return;
    const T_TEXT_TABLE table = TableOnShow(view->Model().Binding());
    QStringList heads;
    for (const T_TEXT_COLUMN& column : table.columns)
        heads << QString::fromStdString(column.head);
    QString text = heads.join(u'\t') + u'\n';
    for (int row = 0; row < view->Model().rowCount(); ++row) {
        QStringList cells;
        for (int column = 0; column < view->Model().columnCount(); ++column)
            cells << view->Model().index(row, column).data().toString();
        text += cells.join(u'\t') + u'\n';
    }
    QGuiApplication::clipboard()->setText(text);
}

void SaveTable(QWidget* host, MODEL& m)
{
    CGridView* const view = TableInFront(host);
    const std::string path = view ? m.AskPath("IDS_QM_EVAL_CSV_FILTER") : std::string();
    T_FILE_ERROR error;
    if (!path.empty() &&
        !CFileCtrl::WriteWholeFile(path, TableCsv(TableOnShow(view->Model().Binding())), error))
        m.SayNotWritten(error.text);
}

void BuildEvaluations(CFormView& form, MODEL& m)
{
    form.Custom({}, MakeEvaluationList(m, form.Changed(), form.Host())).name = "list";
    form.Columns();
    form.Button(KeyText("IDS_QM_EVAL_NEW"), [&m] { m.OnFresh(); }).name = "new";
    form.NextColumn();
    form.Button(KeyText("IDS_QM_EVAL_STORE"), [&m] { (void)m.OnStore(); }).name = "store";
    form.NextColumn();
    auto& gone = form.Button(KeyText("IDS_QM_EVAL_DELETE"), [&m] { (void)m.OnDelete(); });
    gone.name = "delete";
    gone.enabled = [&m] { return !m.Opened().empty(); };
    form.EndColumns();
    form.Text(KeyText("IDS_QM_UI_PUSH_NAME"), Ref(m.m_settings.name)).name = "name";
}

/// Every number with what it is, where it is from and how it was worked out.
void BuildFacts(CFormView& form, MODEL& m)
{
    form.Page(KeyText("IDS_QM_EVAL_FACTS"));
    form.Grid(GridOf([&m] { return FactCells(m.Result(), m.Spectrum()); })).name = "facts";
}

void BuildResults(CFormView& form, MODEL& m)
{
    const auto target = [&m] { return m.m_methodPage.IsTarget(); };
    const auto point = [&m] { return !m.m_methodPage.IsTarget(); };
    form.Page(KeyText("IDS_QM_UI_PUSH_PAGE_RESULT"));
    form.Grid(GridOf([&m] { return PushoverResultCells(m.Result()); })).name = "cells";
    form.Page(KeyText("IDS_QM_UI_PUSH_PAGE_STATES"), target);
    form.Grid(GridOf([&m] { return PushoverStateCells(m.Result()); })).name = "states";
    form.Note([&m] { return m.StoredStepsText(); });
    form.Button(KeyText("IDS_QM_UI_PUSH_STORE_STEPS"), [&m] { (void)m.OnStoreSteps(); }).name =
        "storeSteps";
    form.Page(KeyText("IDS_QM_UI_PUSH_TRIALS"), point);
    T_GRID_BINDING trials = GridOf([&m] { return PushoverTrialCells(m.Pictured()); });
    trials.selected = [&m] { return m.Shown().Trial() - 1; };
    trials.select = [&m](int row) { m.Shown().SetTrial(row + 1); };
    form.Grid(std::move(trials)).name = "trials";
    form.Page(KeyText("IDS_QM_UI_PUSH_PAGE_OUTCOME"));
    form.Custom({}, MakeTextPage(
                        [&m] {
                            return OutcomeLines(m.Result()) + "\n" + m.Shown().CaseText() + "\n" +
                                   m.Result().gammaNote;
                        },
                        form.Host()))
        .name = "outcome";
    form.Page(KeyText("IDS_QM_UI_PUSH_PAGE_CURVE"));
    form.Grid(GridOf([&m] { return PushoverCurveCells(m.Pictured()); })).name = "curve";
}

/// The demand alone, over displacements or periods.
void BuildDemand(CFormView& form, MODEL& m)
{
    form.Page(KeyText("IDS_QM_UI_HEAD_SPECTRUM"));
    form.Choice(KeyText("IDS_QM_UI_PUSH_SPECTRUM_OVER"),
                {[&m] { return static_cast<int>(m.m_show.spectrumOver); },
                 [&m](const int& i) { m.m_show.spectrumOver = static_cast<SPECTRUM_SHOW>(i); }},
                KeyTexts({"IDS_QM_UI_PUSH_OVER_SD", "IDS_QM_UI_PUSH_OVER_T"}))
        .name = "spectrumOver";
    AddPicture(form, [&m] { return DemandPlot(m.Result()); }, {680, 260}).name = "demand";
}

void BuildAdditional(CFormView& form, MODEL& m)
{
    const auto list = [&form](T_GRID_BINDING grid, int& row, const char* name) {
        grid.selected = [&row] { return row; };
        grid.select = [&row](int r) { row = r; };
        form.Grid(std::move(grid)).name = name;
    };
    const auto buttons = [&form](const char* add, std::function<void()> onAdd,
                                 std::function<void()> onRemove, const std::string& name) {
        form.Columns();
        form.Button(KeyText(add), std::move(onAdd)).name = "add" + name;
        form.NextColumn();
        form.Button(KeyText("IDS_QM_UI_PUSH_REMOVE"), std::move(onRemove)).name = "remove" + name;
        form.EndColumns();
    };
    form.Page(KeyText("IDS_QM_UI_PUSH_PAGE_STEPS"));
    list(GridOf([&m] { return AdditionalStepCells(m.Result()); }), m.m_stepRow, "steps");
    form.Integer(KeyText("IDS_QM_UI_PUSH_STEP"), Ref(m.m_addStep)).name = "addStepNumber";
    buttons(
        "IDS_QM_UI_PUSH_ADD_STEP", [&m] { m.OnAddStep(); }, [&m] { m.OnRemoveStep(m.m_stepRow); },
        "Step");
    form.Button(KeyText("IDS_QM_UI_PUSH_STEPS_DLG"), [&m] { (void)m.OnSteps(); }).name = "stepsDlg";
    form.Page(KeyText("IDS_QM_UI_PUSH_PAGE_POINTS"), [&m] { return !m.m_methodPage.IsTarget(); });
    list(GridOf([&m] { return AdditionalPointCells(m.Result()); }), m.m_pointRow, "points");
    const auto spectra = [&m] { return m.m_demandPage.Spectra(); };
    form.Choice(KeyText("IDS_QM_UI_HEAD_SPECTRUM"), NameRef(m.m_addSpectrum, spectra), spectra)
        .name = "addPointSpectrum";
    buttons(
        "IDS_QM_UI_PUSH_ADD_POINT", [&m] { m.OnAddPoint(); },
        [&m] { m.OnRemovePoint(m.m_pointRow); }, "Point");
}

struct T_DESK_BUTTON {
    const char* key;
    const char* name;
    std::function<void()> run;
};

/// Side by side, two in a row.
void AddButtons(CFormView& form, std::span<const T_DESK_BUTTON> buttons)
{
    for (std::size_t i = 0; i < buttons.size(); i += 2) {
        form.Columns(1);
        form.Button(KeyText(buttons[i].key), buttons[i].run).name = buttons[i].name;
        if (i + 1 < buttons.size()) {
            form.NextColumn(1);
            form.Button(KeyText(buttons[i + 1].key), buttons[i + 1].run).name = buttons[i + 1].name;
        }
        form.EndColumns();
    }
}

/// What can be done with the chosen evaluation.
void BuildOperations(CFormView& form, MODEL& m)
{
    const T_DESK_BUTTON buttons[] = {
        {"IDS_QM_UI_PUSH_POINTS_HINGES", "hinges", [&m] { (void)m.OnHinges(); }},
        {"IDS_QM_UI_JUDGE", "judge", [&m] { (void)m.OnJudge(); }},
        {"IDS_QM_UI_PUSH_REPORT", "report", [&m] { m.OnPushoverCurveTextout(); }},
        {"IDS_QM_UI_PUSH_CURVE_FILE", "curveFile", [&m] { m.OnCurveText(); }},
        {"IDS_QM_UI_PUSH_COMPARE", "compare", [&m] { m.OnCompare(); }}};
    AddButtons(form, buttons);
}

/// For the table that is in front.
void BuildTableButtons(CFormView& form, MODEL& m)
{
    QWidget* const host = form.Host();
    const T_DESK_BUTTON buttons[] = {
        {"IDS_QM_EVAL_COPY_TABLE", "copyTable", [host] { CopyTable(host); }},
        {"IDS_QM_EVAL_SAVE_TABLE", "saveTable", [host, &m] { SaveTable(host, m); }}};
    AddButtons(form, buttons);
}

/// What was asked for, and what an engineer should know about it.
void BuildInputs(CFormView& form, MODEL& m)
{
    auto& refusal = form.Note([&m] { return m.Shown().Refusal(); });
    refusal.name = "refusal";
    refusal.shown = [&m] { return !m.Shown().Refusal().empty(); };
    auto& inputs = form.Note([&m] { return InputLine(m.Result(), m.Spectrum()); });
    inputs.name = "inputs";
    inputs.shown = [&m] { return !m.Result().capacity.Sd.empty(); };
    auto& remark = form.Note([&m] { return RemarkLine(m.Result()); });
    remark.name = "remark";
    remark.shown = [&m] { return !m.Result().messages.empty(); };
}

/// The tables of the chosen evaluation.
void BuildTables(CFormView& form, MODEL& m)
{
    form.Columns(); // pages within a page
    BuildFacts(form, m);
    BuildResults(form, m);
    BuildDemand(form, m);
    BuildAdditional(form, m);
    form.EndPages();
    form.EndColumns();
}

/// Bars of one figure of the ticked evaluations, and their table.
void BuildComparison(CFormView& form, MODEL& m)
{
    form.Page(KeyText("IDS_QM_EVAL_COMPARISON"));
    form.Choice(KeyText("IDS_QM_EVAL_BARS"), IndexRef(m.m_bars),
                [] { return std::vector<std::string>(kCardNames.begin(), kCardNames.end()); })
        .name = "bars";
    AddPicture(form,
               [&m] {
                   const std::vector<T_EVALUATION_ENTRY> entries = m.Compared();
                   return BarsPlot(entries, m.m_bars);
               },
               {680, 360})
        .name = "barsPlot";
    form.Grid(GridOf([&m] { return OverviewCells(m.Compared()); })).name = "overview";
}

/// The pages around a table, up to the page that holds them: the picture takes what is left.
void LimitHeight(QWidget& table, const QWidget& page)
{
    constexpr int kPages = 230; // px
    bool isAround = false;
    for (QWidget* at = &table; at && at != &page; at = at->parentWidget()) {
        isAround = isAround || qobject_cast<QTabWidget*>(at);
        if (isAround) at->setMaximumHeight(kPages);
    }
}

} // namespace

void BuildEvaluationDesk(CFormView& form, CEvaluationDeskDlg& m)
{
    form.m_onChange = [&m] { m.OnTaken(); };
    form.SetFindings([&m] { return m.AllFindings(); });
    form.Columns();
    BuildEvaluations(form, m);
    BuildEvaluationSettings(form, m);
    BuildOperations(form, m);
    form.NextColumn(1);
    BuildInputs(form, m);
    form.Page(KeyText("IDS_QM_EVAL_EVALUATION"));
    form.Custom({}, std::make_unique<CDeskPane>(m, form.Changed(), form.Host())).name = "plot";
    form.Custom({}, MakeCards(m, form.Host())).name = "cards";
    auto& trial = form.Custom(
        KeyText("IDS_QM_UI_PUSH_TRIAL"),
        MakeStepField(
            {[&m] { return m.Shown().Trial(); }, [&m](const int& k) { m.Shown().SetTrial(k); }},
            [&m] { return m.Shown().TrialCount(); }, form.Changed(), form.Host()));
    trial.name = "trial";
    trial.shown = [&m] { return !m.m_methodPage.IsTarget(); };
    BuildTables(form, m);
    BuildComparison(form, m);
    form.EndPages();
    BuildTableButtons(form, m);
    form.EndColumns();
    LimitHeight(*form.Find("facts")->widget, *form.Find("plot")->widget->parentWidget());
}
