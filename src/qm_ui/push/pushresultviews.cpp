#include "qm_ui/push/pushresultviews.h"

#include "qm_base/msgfunction.h"
#include "qm_ui/push/hingelawplot.h"
#include "qm_ui/push/pushcurveplot.h"
#include "qm_ui/push/stepfield.h"
#include "qm_ui/push/storeyplot.h"

namespace {

using STATES = CPushOverHingeStateDlg;
using STOREYS = CPushOverStoreyDlg;

constexpr QSize kSidePicture{460, 320}, kStoreyPicture{340, 400};
constexpr int kMostTable = 240; // px: pictures take the room that is left

/// Result and step, and what they are.
void AddHead(CFormView& form, CPushOverResultDlg& shown)
{
    form.Columns();
    form.Choice(KeyText("IDS_QM_UI_PUSH_RUN_RESULT"),
                {[&shown] { return shown.ResultIndex(); },
                 [&shown](const int& index) { shown.OnSelChangeResult(index); }},
                [&shown] { return shown.ResultTexts(); })
        .name = "result";
    form.NextColumn(1);
    form.Custom(KeyText("IDS_QM_UI_SHAPE_STEP"), MakeStepField(shown, form.Changed(), form.Host()))
        .name = "step";
    form.EndColumns();
    CFormField& point = form.Choice(KeyText("IDS_QM_UI_PUSH_POINT"),
                                    {[&shown] { return shown.PointIndex(); },
                                     [&shown](const int& index) { shown.OnSelChangePoint(index); }},
                                    [&shown] { return shown.PointTexts(); });
    point.name = "point";
    point.shown = [&shown] { return !shown.PointTexts().empty(); };
    form.Note([&shown] { return shown.StepText(); });
    form.Note([&shown] { return shown.StatusText(); });
}

T_GRID_BINDING HingeGrid(STATES& d)
{
    constexpr CELL_KIND kKinds[] = {CELL_KIND::Number, CELL_KIND::Text,   CELL_KIND::Text,
                                    CELL_KIND::Number, CELL_KIND::Number, CELL_KIND::Text};
    T_GRID_BINDING b;
    for (std::size_t i = 0; i < STATES::kHeads.size(); ++i)
        b.columns.push_back({KeyText(STATES::kHeads[i]), kKinds[i]});
    b.rows = [&d] { return d.Rows(); };
    b.text = [&d](std::size_t row, std::size_t column) { return d.CellText(row, column); };
    b.select = [&d](int row) { d.OnHingeRow(row); };
    b.selected = [&d] { return d.HingeRow(); };
    b.tone = [&d](std::size_t row, std::size_t) {
        const PUSH_STATE state = d.StateAt(row);
        if (state >= PUSH_STATE::CtoD) return CELL_TONE::Fault;
        return state == PUSH_STATE::Elastic ? CELL_TONE::Plain : CELL_TONE::Notice;
    };
    return b;
}

void BuildStates(CFormView& form, STATES& d)
{
    AddHead(form, d);
    form.Columns();
    CFormField& frame = form.Custom({}, MakeStateFrame(d, form.Changed(), form.Host()));
    frame.name = "frame";
    frame.widget->setMinimumSize(480, 360);
    form.Flag(KeyText("IDS_QM_UI_PUSH_HINGE_YIELDED"), {[&d] { return d.m_onlyYielded; },
                                                        [&d](const bool& only) {
                                                            d.m_onlyYielded = only;
                                                            d.OnFilter();
                                                        }})
        .name = "yielded";
    CFormField& grid = form.Grid(HingeGrid(d));
    grid.name = "hinges";
    grid.widget->setMinimumSize(480, 180);
    grid.widget->setMaximumHeight(kMostTable);
    form.Note([&d] { return d.UnitsText(); });
    form.NextColumn(1);
    AddPlot(
        form, [&d] { return StepCurvePlot(d); }, kSidePicture);
    const auto law = [&d] {
        return d.Hinge() < 0 ? T_PLOT()
                             : HingeLawPlot(d.Run(), static_cast<std::size_t>(d.Hinge()), d.Step(),
                                            d.Units());
    };
    AddPlot(form, law, kSidePicture);
    form.EndColumns();
}

void BuildStoreys(CFormView& form, STOREYS& d)
{
    AddHead(form, d);
    form.Flag(KeyText("IDS_QM_PLOT_STOREY_LARGEST"), Ref(d.m_envelope)).name = "envelope";
    CFormField& none = form.Note(KeyText("IDS_QM_UI_STOREY_NONE"));
    none.shown = [&d] { return !d.HasStoreys(); };
    form.Columns();
    for (const auto value :
         {STOREY_VALUE::Displacement, STOREY_VALUE::Drift, STOREY_VALUE::Shear}) {
        if (value != STOREY_VALUE::Displacement) form.NextColumn(1);
        AddPlot(
            form, [&d, value] { return StoreyPlot(d, value); }, kStoreyPicture);
    }
    form.EndColumns();
    CFormField& grid = form.Grid(GridOf([&d] { return d.Table(); }));
    grid.name = "storeys";
    grid.widget->setMinimumHeight(140);
    grid.widget->setMaximumHeight(kMostTable);
}

} // namespace

void RegisterPushResultViews(CViewFactory& factory)
{
    T_VIEW states;
    states.showsOnly = true;
    states.size = {1220, 860};
    factory.Register<STATES>(KeyText("IDS_QM_UI_PUSH_STATES_TITLE"), BuildStates, states);
    T_VIEW storeys;
    storeys.showsOnly = true;
    storeys.size = {1180, 760};
    factory.Register<STOREYS>(KeyText("IDS_QM_UI_STOREY_TITLE"), BuildStoreys, storeys);
}
