#include "qm_base/msgfunction.h"
#include "qm_rps/push/pushquantity.h"
#include "qm_rps/pushoverhingestatedlg.h"
#include "qm_rps/pushoverrundlg.h"
#include "qm_rps/pushoverstoreydlg.h"
#include "qm_ui/push/pushcurveplot.h"
#include "qm_ui/push/pushresultviews.h"
#include "qm_ui/push/stepfield.h"

#include <QTimer>

namespace {

using RUN = CPushOverRunDlg;

constexpr CELL_KIND kText = CELL_KIND::Text, kNumber = CELL_KIND::Number;

T_GRID_BINDING CaseGrid(RUN& run)
{
    T_GRID_BINDING b;
    b.columns = {{KeyText("IDS_QM_UI_PUSH_RUN_CHOSEN"), CELL_KIND::Flag, true},
                 {KeyText(RUN::kCaseHeads[0]), kText},
                 {KeyText(RUN::kCaseHeads[1]), kText}};
    b.rows = [&run] { return run.Cases(); };
    b.text = [&run](std::size_t row, std::size_t column) {
        if (column == 0) return std::string(run.IsChosen(row) ? "1" : "0");
        return run.CaseText(row, column - 1);
    };
    b.set = [&run](std::size_t row, std::size_t, const std::string& text) {
        if (run.IsRunning()) return 0;
        run.OnChoose(row, text == "1");
        return 1;
    };
    return b;
}

T_GRID_BINDING RowGrid(RUN& run)
{
    constexpr CELL_KIND kKinds[] = {kText, kText, kNumber, kNumber, kNumber, kNumber};
    T_GRID_BINDING b;
    for (std::size_t i = 0; i < RUN::kRowHeads.size(); ++i)
        b.columns.push_back({KeyText(RUN::kRowHeads[i]), kKinds[i]});
    b.columns[4].head = [&run] {
        return DisplacementIn(run.Direction(), run.Units()).Head(RUN::kRowHeads[4]);
    };
    b.columns[5].head = [&run] {
        return ReactionIn(run.Direction(), run.Units()).Head(RUN::kRowHeads[5]);
    };
    b.rows = [&run] { return run.Rows().size(); };
    b.text = [&run](std::size_t row, std::size_t column) { return run.RowText(row, column); };
    b.tone = [&run](std::size_t row, std::size_t column) {
        return column == 1 && !run.Rows().at(row).reached ? CELL_TONE::Notice : CELL_TONE::Plain;
    };
    return b;
}

template <class DIALOG>
void ShowResults(RUN& run)
{
    DIALOG dialog(run.Doc());
    dialog.SetView(run.View());
    if (!run.Runs().empty()) (void)dialog.OnOpen(run.Runs().front().name);
    (void)dialog.DoModal();
}

struct T_BUTTON {
    const char* key;
    std::function<void()> pressed;
    std::function<bool()> enabled;
};

void AddButtons(CFormView& form, const std::vector<T_BUTTON>& buttons)
{
    form.Columns();
    for (std::size_t i = 0; i < buttons.size(); ++i) {
        if (i > 0) form.NextColumn();
        CFormField& field = form.Button(KeyText(buttons[i].key), buttons[i].pressed);
        field.enabled = buttons[i].enabled;
        field.name = buttons[i].key;
        field.widget->setObjectName(QLatin1String(buttons[i].key));
    }
    form.EndColumns();
}

void BuildRun(CFormView& form, RUN& run)
{
    run.m_changed = [&form] { form.Refresh(); };
    const auto runs = [&run] { return run.IsRunning(); };
    const auto hasRuns = [&run] { return !run.IsRunning() && !run.Runs().empty(); };
    AddButtons(form, {{"IDS_QM_UI_PUSH_RUN_START", [&run] { (void)run.OnRun(); },
                       [&run] { return run.CanRun(); }},
                      {"IDS_QM_UI_PUSH_RUN_PAUSE", [&run] { run.OnPause(); },
                       [&run] { return run.IsRunning() && !run.IsPaused(); }},
                      {"IDS_QM_UI_PUSH_RUN_GO_ON", [&run] { run.OnPause(); },
                       [&run] { return run.IsPaused(); }},
                      {"IDS_QM_UI_PUSH_RUN_CANCEL", [&run] { run.OnCancelRun(); }, runs},
                      {"IDS_QM_UI_PUSH_RUN_HINGES",
                       [&run] { ShowResults<CPushOverHingeStateDlg>(run); }, hasRuns},
                      {"IDS_QM_UI_PUSH_RUN_STOREYS",
                       [&run] { ShowResults<CPushOverStoreyDlg>(run); }, hasRuns}});
    form.Note([&run] { return run.StatusText(); });
    form.Columns();
    CFormField& cases = form.Grid(CaseGrid(run));
    cases.name = "cases";
    cases.widget->setMinimumSize(330, 300);
    form.NextColumn(1);
    AddPlot(form, [&run] { return GrowingCurvePlot(run); }, {640, 440});
    form.EndColumns();
    CFormField& rows = form.Grid(RowGrid(run));
    rows.name = "rows";
    rows.widget->setMinimumHeight(130);
    rows.widget->setMaximumHeight(220);
    if (!run.m_atOnce) return;
    QTimer::singleShot(0, form.Host(), [&form, &run] {
        (void)run.OnRun();
        form.Refresh();
        if (!run.Runs().empty()) ShowResults<CPushOverHingeStateDlg>(run);
    });
}

} // namespace

void RegisterPushRunView(CViewFactory& factory)
{
    T_VIEW run;
    run.showsOnly = true;
    run.size = {1080, 760};
    run.closes = [](zql::frx::MDialog& model) { return dynamic_cast<RUN&>(model).OnClose(); };
    factory.Register<RUN>(KeyText("IDS_QM_UI_PUSH_RUN_TITLE"), BuildRun, run);
}
