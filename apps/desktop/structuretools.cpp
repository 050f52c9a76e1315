#include "structuretools.h"

#include "mainwindow.h"

#include "qm_rps/materialdlg.h"
#include "qm_rps/sectiondlg.h"
#include "qm_ui/form/dialogwindow.h"
#include "qm_ui/section/structureviews.h"

namespace {

template <class DIALOG>
void Open(T_DESKTOP& desktop, int key)
{
    DIALOG dialog(desktop.doc, key);
    dialog.SetView(&desktop.view);
    (void)dialog.DoModal();
    desktop.changed();
}

template <class DIALOG>
T_WINDOW_EXAMPLE ExampleOf(const char* name)
{
    return {name, "rc-frame-code-hinges", [](CMainWindow& main) -> std::unique_ptr<QWidget> {
                auto dialog = std::make_unique<DIALOG>(main.Doc());
                const CViewFactory& factory = main.Desktop().factory;
                const T_VIEW& view = *factory.Find(*dialog);
                auto window = std::make_unique<CDialogWindow>(factory, view, *dialog, nullptr);
                KeepWith(*window, std::move(dialog));
                window->show();
                if (view.size.height() > 0) window->resize(view.size);
                return window;
            }};
}

} // namespace

void RegisterStructureViews(CViewFactory& factory)
{
    RegisterStructureForms(factory);
}

T_COMMANDS StructureCommands(T_DESKTOP& desktop)
{
    constexpr const char* kMenu = "IDS_QM_UI_MENU_HINGES";
    return {{kMenu, "IDS_QM_UI_SECT_MENU", "", [&desktop] { Open<CSectionDlg>(desktop, 0); }},
            {kMenu, "IDS_QM_UI_MATL_MENU", "", [&desktop] { Open<CMaterialDlg>(desktop, 0); }}};
}

bool OpenStructureRecord(T_DESKTOP& desktop, EXPLORER_TABLE table, int key)
{
    if (table != EXPLORER_TABLE::Materials) return false;
    Open<CMaterialDlg>(desktop, key);
    return true;
}

std::vector<T_WINDOW_EXAMPLE> StructureWindowExamples()
{
    return {ExampleOf<CSectionDlg>("section"), ExampleOf<CMaterialDlg>("material")};
}
