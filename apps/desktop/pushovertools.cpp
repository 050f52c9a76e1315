#include "pushovertools.h"

#include "mainwindow.h"
#include "pushoverwindow.h"
#include "json/reportjson.h"

#include "qm_base/msgfunction.h"
#include "qm_db/filectrl.h"
#include "qm_rps/irpsinterfaceimpl.h"
#include "qm_rps/pushoveradditionalstepdlg.h"
#include "qm_rps/pushovercomparisondlg.h"
#include "qm_rps/pushovercontroldlg.h"
#include "qm_rps/pushovercurvedampparamuser.h"
#include "qm_rps/pushovertextdlg.h"
#include "qm_rps/rps_main.h"
#include "qm_rps/rpsmanager.h"
#include "qm_ui/evaluate/evaluationdeskview.h"
#include "qm_ui/pushover/pushovercurveview.h"

#include <QTabWidget>

#include <numeric>

namespace {

QString Text(const char* key)
{
    return QString::fromStdString(zql::lib::MMSGFunction::GetValue(key));
}

/// The picture of an open curve window on an evaluation of the example.
T_WINDOW_EXAMPLE CurveExample(const char* name, const char* evaluation, int trial)
{
    return {name, "rc-frame-3-storey", [=](CMainWindow& main) -> std::unique_ptr<QWidget> {
                auto window = CPushOverWindow::Make(main.Desktop(), nullptr);
                if (!window->Model().OnOpen(evaluation)) return nullptr;
                window->Model().Shown().SetTrial(trial);
                window->Form().Refresh();
                window->show();
                window->resize(1320, 900);
                return window;
            }};
}

/// The window with two evaluations overlaid; `page`: the field whose page is in front.
T_WINDOW_EXAMPLE OverlayExample(const char* name, const char* page)
{
    return {name, "rc-frame-3-storey", [=](CMainWindow& main) -> std::unique_ptr<QWidget> {
                auto window = CPushOverWindow::Make(main.Desktop(), nullptr);
                for (const int row : {1, 3, 5, 7})
                    window->Model().OnTick(row, true);
                window->Form().Refresh();
                QWidget* const shown = window->Form().Find(page)->widget;
                for (QWidget* at = shown; at; at = at->parentWidget())
                    if (QWidget* stack = at->parentWidget())
                        if (auto* tabs = qobject_cast<QTabWidget*>(stack->parentWidget()))
                            tabs->setCurrentWidget(at);
                window->show();
                window->resize(1320, 900);
                return window;
            }};
}

/// The window of a dialog model that `make` fills.
template <class MODEL, class MAKE>
T_WINDOW_EXAMPLE DialogExample(const char* name, QSize size, MAKE make)
{
    return {name, "rc-frame-3-storey", [=](CMainWindow& main) -> std::unique_ptr<QWidget> {
                std::unique_ptr<MODEL> model = make(main.Doc());
                const T_VIEW* view = main.Desktop().factory.Find(*model);
                auto window =
                    std::make_unique<CDialogWindow>(main.Desktop().factory, *view, *model, nullptr);
                (void)KeepWith(*window, std::move(model));
                window->show();
                window->resize(size);
                return window;
            }};
}

/// What a seismic report says of the model, as JSON in a file that the person names.
void SaveReportData(T_DESKTOP& desktop)
{
    IRPSInterfaceImpl report;
    if (!report.BuildReport()) {
        desktop.view.ShowMessage("IDS_QM_UI_FILE_REFUSED", report.Error());
        return;
    }
    const std::string path = AskFileName(desktop.window, true, Text("IDS_QM_UI_REPORT_DATA_TITLE"),
                                         Text("IDS_QM_UI_REPORT_DATA_FILTER"))
                                 .toStdString();
    T_FILE_ERROR error;
    if (!path.empty() &&
        !CFileCtrl::WriteWholeFile(path, ReportJson(*CRPSManager::Current()->ReportInfo()), error))
        desktop.view.ShowMessage("IDS_QM_UI_FILE_REFUSED", error.text);
}

T_VIEW ShowsOnly(int width, int height)
{
    T_VIEW view;
    view.showsOnly = true;
    view.size = QSize(width, height);
    return view;
}

} // namespace

void RegisterPushoverViews(CViewFactory& factory)
{
    T_VIEW desk = ShowsOnly(1320, 900);
    desk.closes = [](zql::frx::MDialog& model) {
        return dynamic_cast<CEvaluationDeskDlg&>(model).OnClose() != 0;
    };
    factory.Register<CEvaluationDeskDlg>(KeyText("IDS_QM_UI_PUSH_TITLE"), BuildEvaluationDesk,
                                         desk);
    factory.Register<CPushOverCurveDampParamUser>(KeyText("IDS_QM_UI_PUSH_USER_TITLE"),
                                                  BuildUserDamping);
    factory.Register<CPushOverControlDlg>(KeyText("IDS_QM_UI_PUSH_CONTROL_TITLE"),
                                          BuildPushOverControl);
    factory.Register<CPushOverAdditionalStepDlg>(KeyText("IDS_QM_UI_PUSH_STEPS_TITLE"),
                                                 BuildAdditionalSteps);
    factory.Register<CPushOverTextDlg>(KeyText("IDS_QM_UI_PUSH_TEXT_TITLE"), BuildPushOverText,
                                       ShowsOnly(900, 640));
    factory.Register<CPushOverComparisonDlg>(KeyText("IDS_QM_UI_PUSH_COMPARE_TITLE"),
                                             BuildPushOverComparison, ShowsOnly(1000, 860));
}

T_COMMANDS PushoverCommands(T_DESKTOP& desktop)
{
    constexpr const char* kMenu = "IDS_QM_UI_MENU_PUSHOVER";
    const auto hasCase = [&desktop] { return !desktop.doc.Data().Model().pushovers.empty(); };
    const auto fresh = [&desktop] {
        CPushOverWindow& window = CPushOverWindow::Show(desktop);
        window.Model().OnFresh();
        window.Form().Refresh();
    };
    const auto compare = [&desktop] {
        CPushOverComparisonDlg comparison(desktop.doc);
        comparison.SetView(&desktop.view);
        comparison.m_askPath = [&desktop] {
            return AskFileName(desktop.window, true, Text("IDS_QM_UI_PUSH_COMPARE_TITLE"),
                               Text("IDS_QM_UI_PICTURE_FILTER"))
                .toStdString();
        };
        comparison.Update();
        (void)comparison.DoModal();
    };
    const auto choose = [&desktop] {
        int key = 0; // the one that was chosen last
        RPS_DoModal(kSelectLoadCase, &key);
        T_POLC_D polc;
        if (key == 0 || !desktop.doc.Attr().GetPolc(key, polc)) return;
        CPushOverWindow& window = CPushOverWindow::Show(desktop);
        window.Model().OnFresh(); // stored evaluations stay with their load cases
        if (window.Model().Opened().empty()) {
            window.Model().m_settings.push = polc.name;
            window.Model().OnEdited();
        }
        window.Form().Refresh();
    };
    return {{kMenu, "IDS_QM_UI_PUSH_CURVE", "F7", [&desktop] { CPushOverWindow::Show(desktop); },
             hasCase},
            {kMenu, "IDS_QM_UI_PUSH_NEW_CURVE", "Shift+F7", fresh, hasCase},
            {kMenu, "IDS_QM_UI_PUSH_COMPARE_ALL", "Ctrl+F7", compare, hasCase},
            {kMenu, "IDS_QM_UI_PUSH_CHOOSE_CASE", "", choose, hasCase},
            {kMenu, "IDS_QM_UI_REPORT_DATA", "", [&desktop] { SaveReportData(desktop); }}};
}

bool OpenPushoverRecord(T_DESKTOP& desktop, EXPLORER_TABLE table, int key)
{
    if (table != EXPLORER_TABLE::Evaluations) return false;
    T_EVAL_D evaluation;
    if (!desktop.doc.Attr().GetEval(key, evaluation)) return false;
    CPushOverWindow& window = CPushOverWindow::Show(desktop);
    (void)window.Model().OnOpen(evaluation.name);
    window.Form().Refresh();
    return true;
}

std::vector<T_WINDOW_EXAMPLE> PushoverWindowExamples()
{
    const auto comparison = [](CDBDoc& doc) {
        auto model = std::make_unique<CPushOverComparisonDlg>(doc);
        model->m_spectrum = "ATC strong";
        model->m_behavior = 1;
        model->Update();
        return model;
    };
    const auto damping = [](CDBDoc&) {
        auto model = std::make_unique<CPushOverCurveDampParamUser>();
        model->Data2Dlg({10.0, 0.9, 40.0, 0.4});
        return model;
    };
    const auto control = [](CDBDoc& doc) {
        auto model = std::make_unique<CPushOverControlDlg>(doc);
        T_EVAL_D evaluation;
        if (doc.Attr().GetEval(1, evaluation)) evaluation.monitoredNodes = {31, 21};
        model->Data2Dlg(evaluation);
        return model;
    };
    const auto steps = [](CDBDoc&) {
        auto model = std::make_unique<CPushOverAdditionalStepDlg>();
        std::vector<int> all(51);
        std::iota(all.begin(), all.end(), 0);
        model->SetCurve(all);
        T_FINDING refusal;
        for (const int step : {12, 30})
            (void)model->AddStep(step, refusal);
        return model;
    };
    return {CurveExample("pushover-atc40", "PX_MODE1 ATC-40 A", 2),
            CurveExample("pushover-fema440", "PX_MODE1 FEMA440 C", 0),
            CurveExample("pushover-ec8", "PX_MODE1 EC8", 0),
            CurveExample("pushover-ntc", "PX_MODE1 NTC2018", 0),
            OverlayExample("pushover-overlay", "plot"),
            OverlayExample("pushover-bars", "barsPlot"),
            DialogExample<CPushOverComparisonDlg>("pushover-comparison", {1000, 880}, comparison),
            DialogExample<CPushOverControlDlg>("pushover-control", {560, 420}, control),
            DialogExample<CPushOverAdditionalStepDlg>("pushover-steps", {480, 420}, steps),
            DialogExample<CPushOverCurveDampParamUser>("pushover-damping", {560, 560}, damping)};
}
