#include "qm_rps/modesdlg.h"
#include "qm_ui/create/createfields.h"
#include "qm_ui/create/createviews.h"

namespace {

using DLG = CModesDlg;

void Build(CFormView& form, DLG& d)
{
    T_GRID_BINDING grid = GridOf([&d] { return d.Table(); });
    grid.select = [&d](int row) { d.OnChoose(row); };
    grid.selected = [&d] { return d.Chosen(); };
    CFormField& table = form.Grid(std::move(grid));
    table.name = "modes";
    table.widget->setMinimumSize(520, 200);
    form.Note([&d] { return d.NotesText(); }).name = "notes";
    form.Group(KeyText("IDS_QM_MODES_BY_ANALYSIS"));
    form.Integer(KeyText("IDS_QM_NEW_MODE_COUNT"), Ref(d.m_count)).name = "count";
    form.Button(KeyText("IDS_QM_MODES_FIND"), [&d] { (void)d.OnFind(); }).name = "find";
    form.EndGroup();
    form.Group(KeyText("IDS_QM_MODES_TYPED"));
    form.Number(KeyText("IDS_QM_MODES_PERIOD"), Ref(d.m_period)).name = "period";
    form.Choice(KeyText("IDS_QM_MODES_DIRECTION"), Ref(d.m_direction),
                [] {
                    return std::vector<std::string>{"X", "Y"};
                })
        .name = "direction";
    form.Text(KeyText("IDS_QM_MODES_SHAPE"), Ref(d.m_shape)).name = "shape";
    form.Columns();
    form.Button(KeyText("IDS_QM_MODES_ADD"), [&d] { (void)d.OnAdd(); }).name = "add";
    form.NextColumn();
    CFormField& erase = form.Button(KeyText("IDS_QM_MODES_DELETE"), [&d] { (void)d.OnDelete(); });
    erase.name = "delete";
    erase.enabled = [&d] { return d.Chosen() >= 0; };
    form.EndColumns();
    form.EndGroup();
}

} // namespace

void RegisterModesView(CViewFactory& factory)
{
    T_VIEW view;
    view.showsOnly = true;
    view.size = {620, 560};
    factory.Register<DLG>(KeyText("IDS_QM_MODES_TITLE"), Build, view);
}
