#include "loadcasetools.h"

#include "mainwindow.h"

#include "qm_base/serviceheadoffice.h"
#include "qm_rps/modelessdlgctrl.h"
#include "qm_rps/po_femastrlossfigure0dlg.h"
#include "qm_rps/po_femastrlossfigureedlg.h"
#include "qm_rps/po_femaunloadstifffigureedlg.h"
#include "qm_rps/po_hingeskcvtabfemaaxialdlg.h"
#include "qm_rps/po_inelastichingedlg.h"
#include "qm_rps/po_loadcasedlg.h"
#include "qm_rps/po_loadcaselistdlg.h"
#include "qm_rps/po_selectloadcasedlg.h"
#include "qm_rps/pushovercasegeneratordlg.h"
#include "qm_rps/pushoverglobalcontroldlg.h"
#include "qm_rps/pushoverincrementfunctiondlg.h"
#include "qm_rps/rps_main.h"
#include "qm_ui/form/dialogwindow.h"
#include "qm_ui/hinge/figureview.h"
#include "qm_ui/hinge/inelastichingeview.h"
#include "qm_ui/loadcase/loadcaseview.h"
#include "qm_ui/push/pushsetupviews.h"

#include <QEvent>
#include <QTabWidget>
#include <QTimer>

namespace {

/// The window of a modeless dialog. When the person closes it, the document's controller ends both.
class CToolWindow : public CDialogWindow, public IRPSWindow {
public:
    CToolWindow(T_DESKTOP& desktop, const T_VIEW& view, CRPSDlgBase& dialog, int id)
        : CDialogWindow(desktop.factory, view, dialog, desktop.window), m_desktop(desktop),
          m_revision(desktop.doc.Data().Revision())
    {
        Form().m_onChange = [this] { Tell(); };
        connect(this, &QDialog::finished, this, [this, id] {
            Tell();
            QTimer::singleShot(0, this, [this, id] {
                if (!isVisible()) CModelessDlgCtrl::Of(m_desktop.doc).Close(id); // and this window
            });
        });
    }

    void Show() override
    {
        show();
        raise();
        activateWindow();
    }
    void Refresh() override { Form().Refresh(); }

protected:
    /// The document may have changed while another window was in front.
    bool event(QEvent* event) override
    {
        if (event->type() == QEvent::WindowActivate) Form().Refresh();
        return CDialogWindow::event(event);
    }

private:
    void Tell()
    {
        if (m_revision == m_desktop.doc.Data().Revision()) return;
        m_revision = m_desktop.doc.Data().Revision();
        m_desktop.changed();
    }

    T_DESKTOP& m_desktop;
    long m_revision;
};

void InstallWindows(T_DESKTOP& desktop)
{
    CModelessDlgCtrl& ctrl = CModelessDlgCtrl::Of(desktop.doc);
    ctrl.SetView(&desktop.view);
    ctrl.SetWindowMaker([&desktop](CRPSDlgBase& dialog, int id,
                                   zql::frx::IDialogView*) -> std::unique_ptr<IRPSWindow> {
        const T_VIEW* view = desktop.factory.Find(dialog);
        if (!view) return nullptr;
        return std::make_unique<CToolWindow>(desktop, *view, dialog, id);
    });
}

/// Runs a dialog on the document.
template <class MODEL>
std::function<void()> Modal(T_DESKTOP& desktop)
{
    return [&desktop] {
        MODEL dialog;
        dialog.SetDoc(&desktop.doc);
        dialog.SetView(&desktop.view);
        (void)dialog.DoModal();
        desktop.changed();
    };
}

/// A figure, asked for as other modules of the host do.
std::function<void()> Figure(int kind)
{
    return [kind] {
        CServiceAgency* agency = CServiceHeadOffice::Instance()->GetAgency("rps");
        if (agency) (void)agency->Service({.kind = kind});
    };
}

} // namespace

void RegisterLoadCaseViews(CViewFactory& factory)
{
    RegisterLoadCaseForms(factory);
    RegisterPushSetupForms(factory);
    RegisterFigureViews(factory);
    RegisterInelasticHingeView(factory);
    (void)RegisterRPSService(); // 0 where another agency has the name: its services are then used
}

T_COMMANDS LoadCaseCommands(T_DESKTOP& desktop)
{
    constexpr const char* kMenu = "IDS_QM_UI_MENU_PUSHOVER";
    InstallWindows(desktop);
    const auto list = [&desktop] {
        (void)CreateOrActivateRPSDlg(&desktop.doc, IDD_PO_LOADCASE_LIST, &desktop.view, nullptr);
    };
    return {{kMenu, "IDS_QM_UI_POLC_LIST", "Ctrl+Shift+P", list},
            {kMenu, "IDS_QM_UI_POGC_MENU", "", Modal<CPushOverGlobalControlDlg>(desktop)},
            {kMenu, "IDS_QM_UI_POFC_MENU", "", Modal<CPushOverIncrementFunctionDlg>(desktop)},
            {kMenu, "IDS_QM_UI_IEHP_MENU", "", Modal<CPO_InelasticHingeDlg>(desktop)},
            {kMenu},
            {kMenu, "IDS_QM_UI_FIGURE_MENU_0", "", Figure(3)},
            {kMenu, "IDS_QM_UI_FIGURE_MENU_E", "", Figure(4)},
            {kMenu, "IDS_QM_UI_FIGURE_MENU_UNLOAD", "", Figure(5)}};
}

bool OpenLoadCaseRecord(T_DESKTOP& desktop, EXPLORER_TABLE table, int key)
{
    return table == EXPLORER_TABLE::Pushovers &&
           CreateOrActivateRPSDlg(&desktop.doc, IDD_PO_LOADCASE_ITEM, &desktop.view, &key);
}

// ---- examples for pictures ----------------------------------------------------------------------

namespace {

template <class MODEL>
T_WINDOW_EXAMPLE ExampleOf(const char* name, const char* model,
                           std::function<void(CMainWindow&, MODEL&)> fill)
{
    return {name, model, [fill](CMainWindow& main) -> std::unique_ptr<QWidget> {
                auto dialog = std::make_unique<MODEL>();
                fill(main, *dialog);
                const CViewFactory& factory = main.Desktop().factory;
                auto window = std::make_unique<CDialogWindow>(factory, *factory.Find(*dialog),
                                                              *dialog, nullptr);
                KeepWith(*window, std::move(dialog));
                return window;
            }};
}

/// The same window with another page in front.
T_WINDOW_EXAMPLE OnPage(T_WINDOW_EXAMPLE example, int page)
{
    example.make = [make = example.make, page](CMainWindow& main) {
        std::unique_ptr<QWidget> window = make(main);
        for (QTabWidget* tabs : window->findChildren<QTabWidget*>())
            tabs->setCurrentIndex(page);
        return window;
    };
    return example;
}

template <class MODEL>
void OnDocument(CMainWindow& main, MODEL& dialog)
{
    dialog.SetDoc(&main.Doc());
}

/// A case with everything of its own.
void FillOwn(CMainWindow& main, CPO_LoadCaseDlg& dialog)
{
    dialog.SetDoc(&main.Doc());
    dialog.SetStart(CPO_LoadCaseDlg::START::Own);
    dialog.m_case.pDelta = PUSH_P_DELTA::Updated;
    dialog.m_case.steps = 50;
    dialog.m_case.stops = {0.03, PUSH_STATE_STOP::CP, 0.8};
    dialog.m_case.additionalDisplacements = {0.05, 0.1};
    dialog.m_case.additionalEvaluations = true;
}

/// A new case with rules that are not kept.
void FillNew(CMainWindow& main, CPO_LoadCaseDlg& dialog)
{
    dialog.SetDoc(&main.Doc());
    (void)dialog.SetKey(0);
    dialog.m_input.kind = 1;
    (void)dialog.OnAddPattern(dialog.m_input);
}

void FillAxial(CMainWindow& main, CPO_HingeSkcvTabFemaAxialDlg& dialog)
{
    dialog.m_units = main.Doc().Unit().Units();
    std::vector<T_SKEL_AXIAL> rows(3);
    for (std::size_t i = 0; i < rows.size(); ++i) {
        rows[i].axial = 250.0 * static_cast<double>(i);
        rows[i].sides.pos.yield = rows[i].sides.neg.yield = 180.0 - 12.5 * static_cast<double>(i);
    }
    (void)dialog.Data2Dlg(rows);
}

} // namespace

std::vector<T_WINDOW_EXAMPLE> LoadCaseWindowExamples()
{
    constexpr const char* kFrame = "rc-frame-3-storey";
    constexpr const char* kHinges = "hinge-library";
    constexpr const char* kBuilding = "eccentric-building";
    return {ExampleOf<CPO_LoadCaseDlg>("loadcase-item", kHinges, OnDocument<CPO_LoadCaseDlg>),
            OnPage(ExampleOf<CPO_LoadCaseDlg>("loadcase-pattern", kFrame, FillNew), 1),
            OnPage(ExampleOf<CPO_LoadCaseDlg>("loadcase-start", kBuilding, FillOwn), 2),
            OnPage(ExampleOf<CPO_LoadCaseDlg>("loadcase-stops", kBuilding, FillOwn), 3),
            ExampleOf<CPushOverCaseGeneratorDlg>("loadcase-eight", kBuilding,
                                                 OnDocument<CPushOverCaseGeneratorDlg>),
            ExampleOf<CPushOverGlobalControlDlg>("push-global-control", kBuilding,
                                                 OnDocument<CPushOverGlobalControlDlg>),
            ExampleOf<CPushOverIncrementFunctionDlg>("push-increment-functions", kHinges,
                                                     OnDocument<CPushOverIncrementFunctionDlg>),
            ExampleOf<CPO_LoadCaseDlg>("loadcase-new", kFrame, FillNew),
            ExampleOf<CPO_LoadCaseListDlg>("loadcase-list", kFrame,
                                           [](CMainWindow& main, CPO_LoadCaseListDlg& dialog) {
                                               dialog.SetDoc(&main.Doc());
                                               dialog.m_selected = 1;
                                           }),
            ExampleOf<CPO_SelectLoadCaseDlg>("loadcase-select", kFrame,
                                             [](CMainWindow& main, CPO_SelectLoadCaseDlg& dialog) {
                                                 dialog.SetDoc(&main.Doc());
                                                 dialog.SetSelected(2);
                                             }),
            ExampleOf<CPO_FEMAStrLossFigure0Dlg>("figure-strength-loss", kHinges,
                                                 [](CMainWindow&, auto&) {}),
            ExampleOf<CPO_FEMAStrLossFigureEDlg>("figure-strength-loss-cyclic", kHinges,
                                                 [](CMainWindow&, auto&) {}),
            ExampleOf<CPO_FEMAUnloadStiffFigureEDlg>("figure-unloading", kHinges,
                                                     [](CMainWindow&, auto&) {}),
            ExampleOf<CPO_InelasticHingeDlg>("inelastic-hinges", kHinges,
                                             [](CMainWindow& main, CPO_InelasticHingeDlg& dialog) {
                                                 dialog.SetDoc(&main.Doc());
                                             }),
            ExampleOf<CPO_HingeSkcvTabFemaAxialDlg>("axial-forces", kHinges, FillAxial)};
}
