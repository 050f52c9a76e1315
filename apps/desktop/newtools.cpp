#include "newtools.h"

#include "mainwindow.h"
#include "pushoverwindow.h"

#include "qm_base/say.h"
#include "qm_rps/curvewizarddlg.h"
#include "qm_rps/frameguidedlg.h"
#include "qm_rps/modesdlg.h"
#include "qm_rps/spectrumdlg.h"
#include "qm_rps/storeyguidedlg.h"
#include "qm_ui/create/createviews.h"
#include "qm_ui/form/dialogwindow.h"

namespace {

constexpr const char* kMenu = "IDS_QM_UI_MENU_FILE";

QString Text(const char* key)
{
    return QString::fromStdString(Say(key));
}

/// Afterwards the window of the evaluation is open.
void NewFromCurve(T_DESKTOP& desktop)
{
    CCurveWizardDlg dialog(desktop.doc);
    dialog.SetView(&desktop.view);
    dialog.m_mayReplace = [&desktop] { return desktop.frame.OnNew(); };
    const std::string dropped = desktop.window->property(kDroppedCurve).toString().toStdString();
    dialog.m_askFile = [&dropped] { return dropped; };
    if (!dropped.empty()) (void)dialog.OnFile();
    dialog.m_askFile = [&desktop] {
        return AskFileName(desktop.window, false, Text("IDS_QM_NEW_CURVE_TITLE"),
                           Text("IDS_QM_NEW_CURVE_FILTER"))
            .toStdString();
    };
    if (!dialog.DoModal()) return;
    desktop.changed();
    CPushOverWindow& window = CPushOverWindow::Show(desktop);
    (void)window.Model().OnOpen(dialog.Evaluation());
    window.Form().Refresh();
}

/// Modes are found while a window shows how far they are.
template <class DIALOG>
void ShowProgress(T_DESKTOP& desktop, DIALOG& dialog)
{
    dialog.m_withProgress = [&desktop](const std::function<int(typename DIALOG::TELL_FN)>& work) {
        return RunWithProgress(desktop.window, Text("IDS_QM_UI_ANALYSING"), work);
    };
}

void NewFrame(T_DESKTOP& desktop)
{
    CFrameGuideDlg dialog(desktop.doc);
    dialog.SetView(&desktop.view);
    ShowProgress(desktop, dialog);
    dialog.m_mayReplace = [&desktop] { return desktop.frame.OnNew(); };
    (void)dialog.DoModal();
    desktop.changed();
}

template <class DIALOG, class... KEY>
void Edit(T_DESKTOP& desktop, KEY... key)
{
    DIALOG dialog(desktop.doc, key...);
    dialog.SetView(&desktop.view);
    (void)dialog.DoModal();
    desktop.changed();
}

void EditModes(T_DESKTOP& desktop)
{
    CModesDlg dialog(desktop.doc);
    dialog.SetView(&desktop.view);
    ShowProgress(desktop, dialog);
    (void)dialog.DoModal();
    desktop.changed();
}

/// The window of a model that `fill` prepares.
template <class DIALOG>
T_WINDOW_EXAMPLE ExampleOf(const char* name, const char* model, std::function<void(DIALOG&)> fill)
{
    return {name, model, [fill](CMainWindow& main) -> std::unique_ptr<QWidget> {
                auto dialog = std::make_unique<DIALOG>(main.Doc());
                fill(*dialog);
                const CViewFactory& factory = main.Desktop().factory;
                const T_VIEW& view = *factory.Find(*dialog);
                auto window = std::make_unique<CDialogWindow>(factory, view, *dialog, nullptr);
                KeepWith(*window, std::move(dialog));
                window->show();
                if (view.size.height() > 0) window->resize(view.size);
                return window;
            }};
}

void FillCurve(CCurveWizardDlg& dialog)
{
    dialog.m_curve.text = "d (mm)\tV (kN)\n0\t0\n12\t240\n24\t455\n40\t610\n65\t700\n95\t735\n"
                          "130\t742\n170\t715\n";
    dialog.m_units = {FORCE_UNIT::kN, LENGTH_UNIT::mm};
    dialog.m_masses = "2x110, 95";
    dialog.m_heights = "3500, 2x3000";
    dialog.m_title = "Curve of another program";
}

} // namespace

void RegisterNewViews(CViewFactory& factory)
{
    RegisterCurveWizardView(factory);
    RegisterFrameGuideView(factory);
    RegisterSpectrumView(factory);
    RegisterModesView(factory);
    RegisterStoreyGuideView(factory);
}

T_COMMANDS PartCommands(T_DESKTOP& desktop)
{
    const auto hasNodes = [&desktop] { return !desktop.doc.Data().Model().nodes.empty(); };
    return {{"IDS_QM_UI_MENU_PUSHOVER", "IDS_QM_NEW_SPECTRUM_MENU", "",
             [&desktop] { Edit<CSpectrumDlg>(desktop, 0); }},
            {"IDS_QM_UI_MENU_ANALYSIS", "IDS_QM_MODES_MENU", "", [&desktop] { EditModes(desktop); },
             hasNodes},
            {"IDS_QM_UI_MENU_EDIT", "IDS_QM_NEW_STOREYS_MENU", "",
             [&desktop] { Edit<CStoreyGuideDlg>(desktop); }, hasNodes}};
}

bool OpenNewRecord(T_DESKTOP& desktop, EXPLORER_TABLE table, int key)
{
    if (table != EXPLORER_TABLE::Spectra) return false;
    Edit<CSpectrumDlg>(desktop, key);
    return true;
}

T_COMMANDS NewCommands(T_DESKTOP& desktop)
{
    return {{kMenu, "IDS_QM_NEW_CURVE_MENU", "Ctrl+Shift+N", [&desktop] { NewFromCurve(desktop); }},
            {kMenu, "IDS_QM_NEW_FRAME_MENU", "Ctrl+Shift+F", [&desktop] { NewFrame(desktop); }}};
}

std::vector<T_WINDOW_EXAMPLE> NewWindowExamples()
{
    const auto frame = [](CFrameGuideDlg& dialog) { dialog.m_building.title = "Office building"; };
    return {ExampleOf<CCurveWizardDlg>("new-curve", "", FillCurve),
            ExampleOf<CFrameGuideDlg>("new-frame", "", frame),
            ExampleOf<CSpectrumDlg>("spectrum", "first-steps",
                                    [](CSpectrumDlg& dialog) { dialog.OnSelChange(2); }),
            ExampleOf<CModesDlg>("modes", "first-steps", [](CModesDlg&) {}),
            ExampleOf<CStoreyGuideDlg>("storeys", "eccentric-building", [](CStoreyGuideDlg&) {})};
}
