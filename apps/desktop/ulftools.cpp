#include "ulftools.h"

#include "qm_rps/loadcombinationdlg.h"
#include "qm_rps/ulfiterationrundlg.h"
#include "qm_rps/ulftuningdlg.h"
#include "qm_rps/unknownloadfactorconstraintdlg.h"
#include "qm_rps/unknownloadfactordlg.h"
#include "qm_rps/unknownloadfactoritemdlg.h"
#include "qm_rps/unknownloadfactoriteranaldlg.h"
#include "qm_rps/unknownstageitemdlg.h"
#include "qm_rps/unknowntabletabgrid1.h"
#include "qm_ui/factors/ulfconstraintview.h"
#include "qm_ui/factors/ulfitemview.h"
#include "qm_ui/factors/ulfiterationview.h"
#include "qm_ui/factors/ulfresultview.h"
#include "qm_ui/factors/ulftuningview.h"
#include "qm_ui/loadcase/loadcombinationview.h"

void RegisterUlfViews(CViewFactory& factory)
{
    const T_ULF_HOOKS hooks{RunWithProgress, [](QWidget* parent) {
                                return AskFileName(parent, true,
                                                   UlfText("IDS_QM_UI_ULF_SHEET_TITLE"),
                                                   UlfText("IDS_QM_UI_ULF_SHEET_FILTER"));
                            }};
    RegisterUlfItemViews(factory, hooks);
    RegisterUlfConstraintViews(factory);
    RegisterUlfResultViews(factory, hooks);
    RegisterUlfIterationViews(factory);
    RegisterUlfTuningView(factory, hooks);
    RegisterLoadCombinationView(factory);
}

namespace {

/// Runs a dialog over the main window.
void Show(T_DESKTOP& desktop, zql::frx::MDialog& dialog)
{
    dialog.SetView(&desktop.view);
    (void)dialog.DoModal();
    desktop.changed();
}

template <class DIALOG, class... ARGS>
void Show(T_DESKTOP& desktop, ARGS&&... args)
{
    DIALOG dialog(desktop.doc, std::forward<ARGS>(args)...);
    Show(desktop, dialog);
}

void ShowSettings(T_DESKTOP& desktop)
{
    auto* settings = CUnknownLoadFactorIterAnal::Of(desktop.doc.DynModules());
    if (!settings) return;
    CUnknownLoadFactorIterAnalDlg dialog(*settings);
    Show(desktop, dialog);
}

} // namespace

T_COMMANDS UlfCommands(T_DESKTOP& d)
{
    constexpr const char* kMenu = "IDS_QM_UI_MENU_ULF";
    const auto hasItems = [&d] { return !d.doc.Data().Model().ulfStageItems.empty(); };
    const auto hasAny = [&d, hasItems] {
        return hasItems() || !d.doc.Data().Model().ulfItems.empty();
    };
    return {{kMenu, "IDS_QM_UI_ULF_ITEMS", "Ctrl+L", [&d] { Show<CUnknownLoadFactorDlg>(d); }},
            {kMenu, "IDS_QM_UI_ULF_CONSTRAINTS", "Ctrl+Shift+L",
             [&d] { Show<CUnknownTableTabGrid1>(d); }},
            {kMenu},
            {kMenu, "IDS_QM_TUNE_COMMAND", "", [&d] { Show<CUlfTuningDlg>(d); }, hasAny},
            {kMenu, "IDS_QM_UI_ULF_ITER_SETTINGS", "", [&d] { ShowSettings(d); }},
            {kMenu, "IDS_QM_UI_ULF_ITERATE", "", [&d] { Show<CUlfIterationRunDlg>(d); }, hasItems}};
}

bool OpenUlfRecord(T_DESKTOP& desktop, EXPLORER_TABLE table, int key)
{
    switch (table) {
    case EXPLORER_TABLE::UlfConstraints:
        Show<CUnknownLoadFactorConstraintDlg>(desktop, key);
        return true;
    case EXPLORER_TABLE::UlfItems:
        Show<CUnknownLoadFactorItemDlg>(desktop, key);
        return true;
    case EXPLORER_TABLE::UlfStageItems:
        Show<CUnknownStageItemDlg>(desktop, key);
        return true;
    case EXPLORER_TABLE::Combinations:
        Show<CLoadCombinationDlg>(desktop, key);
        return true;
    default:
        return false;
    }
}
