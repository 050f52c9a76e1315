#include "qm_ui/loadcase/loadcombinationview.h"

#include "qm_rps/loadcombinationdlg.h"
#include "qm_ui/factors/ulfviewparts.h"

#include <algorithm>

namespace {

using DLG = CLoadCombinationDlg;

T_GRID_BINDING PartGrid(DLG& dialog, const std::shared_ptr<int>& chosen)
{
    T_GRID_BINDING b;
    b.columns = UlfColumns(DLG::kHeads, {CELL_KIND::Choice, CELL_KIND::Number});
    b.columns[DLG::Part].choices = [&dialog] { return dialog.PartTexts(); };
    for (T_GRID_COLUMN& column : b.columns)
        column.edit = true;
    b.rows = [&dialog] { return dialog.m_combination.items.size(); };
    b.text = [&dialog](std::size_t row, std::size_t column) {
        return dialog.CellText(row, static_cast<DLG::COLUMN>(column));
    };
    b.set = [&dialog](std::size_t row, std::size_t column, const std::string& text) {
        return dialog.SetCell(row, static_cast<DLG::COLUMN>(column), text);
    };
    b.select = [chosen](int row) { *chosen = row; };
    b.selected = [chosen] { return *chosen; };
    return b;
}

void Build(CFormView& form, DLG& dialog)
{
    const auto chosen = std::make_shared<int>(-1);
    form.Text(KeyText("IDS_QM_UI_HEAD_NAME"), Ref(dialog.m_combination.name)).name = "name";
    AddUlfGrid(form, PartGrid(dialog, chosen), {420, 260}).name = "items";
    AddUlfButtons(form, {{"IDS_QM_UI_ULF_ADD_ROW",
                          [&dialog, chosen] {
                              dialog.OnAddRow();
                              *chosen = static_cast<int>(dialog.m_combination.items.size()) - 1;
                          }},
                         {"IDS_QM_UI_ULF_DELETE_ROW",
                          [&dialog, chosen] {
                              if (!dialog.OnDeleteRow(static_cast<std::size_t>(*chosen))) return;
                              const auto rows = std::ssize(dialog.m_combination.items);
                              *chosen = std::min(*chosen, static_cast<int>(rows) - 1);
                          },
                          [chosen] { return *chosen >= 0; }}});
    form.Group(KeyText("IDS_QM_UI_LCOM_FLAT"));
    form.Note([&dialog] { return dialog.FlatText(); });
    form.EndGroup();
}

} // namespace

void RegisterLoadCombinationView(CViewFactory& factory)
{
    factory.Register<DLG>(KeyText("IDS_QM_UI_LCOM_TITLE"), Build);
}
