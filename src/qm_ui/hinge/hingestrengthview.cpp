#include "qm_rps/yieldstrengthcalcoptdlg.h"
#include "qm_rps/yieldstrengthcalcopteffdescdlg.h"
#include "qm_rps/yieldstrengthcalcoptmatdescdlg.h"
#include "qm_ui/hinge/hingefieldsview.h"
#include "qm_ui/hinge/hingeviews.h"

namespace {

void BuildOptions(CFormView& form, CYieldStrengthCalcOptDlg& dlg)
{
    form.Note([&dlg] { return dlg.ModeText(); }).name = "mode";
    form.Flag(KeyText("IDS_QM_UI_HINGE_ONLY_THESE"),
              {[&dlg] { return dlg.Data().selectedOnly; },
               [&dlg](const bool& on) { (void)dlg.OnSelectElemChk(on, {}); }})
        .name = "only";
    Set(form.Text(KeyText("IDS_QM_UI_HINGE_ELEMENTS"),
                  {[&dlg] { return dlg.SelectionText(); },
                   [&dlg](const std::string& text) { (void)dlg.OnSelectionText(text); }}),
        "elements", [&dlg] { return dlg.Data().selectedOnly; });
    form.Note(KeyText("IDS_QM_UI_HINGE_ELEMENTS_NOTE"));
    form.Columns();
    form.Button(KeyText("IDS_QM_UI_HINGE_SHOW_MATERIALS"), [&dlg] { (void)dlg.OnMatlDescBtn(); })
        .name = "materials";
    form.NextColumn();
    form.Button(KeyText("IDS_QM_UI_HINGE_SHOW_SECTIONS"), [&dlg] { (void)dlg.OnEffeDescBtn(); })
        .name = "sections";
    form.EndColumns();
}

/// The note and the table of a description.
template <class DLG>
void BuildDescription(CFormView& form, DLG& dlg)
{
    form.Note(KeyText(DLG::kNoteKey));
    T_GRID_BINDING b;
    constexpr std::size_t kTexts = 2; // element and name, then numbers
    for (std::size_t c = 0; c < dlg.Heads().size(); ++c)
        b.columns.push_back({[&dlg, c] { return dlg.Heads()[c]; },
                             c < kTexts ? CELL_KIND::Text : CELL_KIND::Number});
    b.rows = [&dlg] { return dlg.Rows().size(); };
    b.text = [&dlg](std::size_t row, std::size_t c) { return dlg.Cells(row)[c]; };
    form.Grid(std::move(b)).name = "rows";
}

} // namespace

void RegisterHingeStrengthViews(CViewFactory& factory)
{
    factory.Register<CYieldStrengthCalcOptDlg>(KeyText(CYieldStrengthCalcOptDlg::kTitleKey),
                                               BuildOptions, {.size = {460, 0}});
    factory.Register<CYieldStrengthCalcOptMatDescDlg>(
        KeyText("IDS_QM_UI_HINGE_MATERIALS_TITLE"),
        BuildDescription<CYieldStrengthCalcOptMatDescDlg>, {.showsOnly = true, .size = {760, 420}});
    factory.Register<CYieldStrengthCalcOptEffDescDlg>(
        KeyText("IDS_QM_UI_HINGE_SECTIONS_TITLE"),
        BuildDescription<CYieldStrengthCalcOptEffDescDlg>,
        {.showsOnly = true, .size = {1000, 420}});
}
