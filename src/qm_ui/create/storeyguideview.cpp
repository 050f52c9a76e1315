#include "qm_rps/storeyguidedlg.h"
#include "qm_ui/create/createviews.h"

namespace {

using DLG = CStoreyGuideDlg;

void Build(CFormView& form, DLG& d)
{
    form.Note(KeyText("IDS_QM_NEW_STOREYS_HOW"));
    form.Number(
            KeyText("IDS_QM_NEW_TOLERANCE"),
            {[&d] { return d.Tolerance(); }, [&d](const double& value) { d.OnTolerance(value); }},
            [&d] { return d.UnitText(); })
        .name = "tolerance";
    T_GRID_BINDING grid;
    for (int i = 0; i < DLG::Columns; ++i) {
        const auto column = static_cast<DLG::COLUMN>(i);
        const bool isText = column == DLG::Name || column == DLG::Nodes;
        grid.columns.push_back({[&d, column] { return d.ColumnHead(column); },
                                column == DLG::Taken ? CELL_KIND::Flag
                                : isText             ? CELL_KIND::Text
                                                     : CELL_KIND::Number,
                                column <= DLG::Name});
    }
    grid.rows = [&d] { return d.Rows(); };
    grid.text = [&d](std::size_t row, std::size_t column) {
        return d.CellText(row, static_cast<DLG::COLUMN>(column));
    };
    grid.set = [&d](std::size_t row, std::size_t column, const std::string& text) {
        return d.SetCell(row, static_cast<DLG::COLUMN>(column), text);
    };
    CFormField& table = form.Grid(std::move(grid));
    table.name = "names";
    table.widget->setMinimumSize(560, 220);
    form.Note([&d] { return d.NotesText(); }).name = "notes";
    form.SetFindings([&d] { return d.Findings(); });
}

} // namespace

void RegisterStoreyGuideView(CViewFactory& factory)
{
    T_VIEW view;
    view.size = {720, 460};
    factory.Register<DLG>(KeyText("IDS_QM_NEW_STOREYS_TITLE"), Build, view);
}
