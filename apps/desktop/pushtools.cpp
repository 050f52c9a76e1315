#include "pushtools.h"

#include "mainwindow.h"

#include "qm_rps/pushoverhingestatedlg.h"
#include "qm_rps/pushoverjudgementdlg.h"
#include "qm_rps/pushoverrundlg.h"
#include "qm_rps/pushoverstoreydlg.h"
#include "qm_ui/form/dialogwindow.h"
#include "qm_ui/push/judgeview.h"
#include "qm_ui/push/pushresultviews.h"

#include <algorithm>

namespace {

/// Runs the dialog of a model class on the document.
template <class DIALOG>
std::function<void()> Open(T_DESKTOP& desktop)
{
    return [&desktop] {
        DIALOG dialog(desktop.doc);
        dialog.SetView(&desktop.view);
        (void)dialog.DoModal();
        desktop.changed();
    };
}

/// The window of a dialog on an example that has been pushed; `fill` makes and fills the dialog.
template <class DIALOG>
T_WINDOW_EXAMPLE Example(const char* name, const char* model,
                         std::function<std::unique_ptr<DIALOG>(CDBDoc&)> fill)
{
    return {name, model, [=](CMainWindow& main) -> std::unique_ptr<QWidget> {
                std::unique_ptr<DIALOG> dialog = fill(main.Doc());
                const T_VIEW* view = main.Desktop().factory.Find(*dialog);
                auto window = std::make_unique<CDialogWindow>(main.Desktop().factory, *view,
                                                              *dialog, nullptr);
                (void)KeepWith(*window, std::move(dialog));
                window->show();
                window->resize(view->size);
                return window;
            }};
}

int Push(CDBDoc& doc)
{
    CPushOverRunDlg run(doc);
    return run.OnRun();
}

template <class DIALOG>
std::unique_ptr<DIALOG> Pushed(CDBDoc& doc, double part)
{
    (void)Push(doc);
    auto dialog = std::make_unique<DIALOG>(doc);
    dialog->OnStep(static_cast<int>(part * dialog->Steps()));
    return dialog;
}

/// The hinges at the demand of an evaluation.
std::unique_ptr<CPushOverHingeStateDlg> AtPoint(CDBDoc& doc)
{
    auto dialog = Pushed<CPushOverHingeStateDlg>(doc, 1.0);
    T_PUSH_EVALUATION evaluation;
    std::string error;
    if (EvaluateStored(doc, "PX EC8", evaluation, error))
        (void)dialog->OnShowPoints(evaluation, {}, error);
    return dialog;
}

int IndexOf(const std::vector<std::string>& texts, const std::string& text)
{
    return static_cast<int>(std::ranges::find(texts, text) - texts.begin());
}

/// The ends of the frame by EN 1998-3, at the demands of its evaluation.
std::unique_ptr<CPushOverJudgementDlg> Judged(CDBDoc& doc)
{
    (void)Push(doc);
    auto dialog = std::make_unique<CPushOverJudgementDlg>(doc);
    T_PUSH_EVALUATION evaluation;
    std::string error;
    if (EvaluateStored(doc, "PX EC8", evaluation, error) && dialog->OnJudge(evaluation, {}, error))
        dialog->OnSelChangeCode(IndexOf(dialog->CodeTexts(), "EN1998-3"));
    return dialog;
}

} // namespace

void RegisterPushViews(CViewFactory& factory)
{
    RegisterPushRunView(factory);
    RegisterPushResultViews(factory);
    RegisterJudgementView(factory);
}

T_COMMANDS PushCommands(T_DESKTOP& desktop)
{
    constexpr const char* kMenu = "IDS_QM_UI_MENU_PUSHOVER";
    const auto hasCase = [&desktop] { return !desktop.doc.Data().Model().pushovers.empty(); };
    const auto hasResult = [&desktop] { return !PushResultsOf(desktop.doc).empty(); };
    return {
        {kMenu, "IDS_QM_UI_PUSH_RUN", "F8", Open<CPushOverRunDlg>(desktop), hasCase},
        {kMenu, "IDS_QM_UI_PUSH_STATES", "Shift+F8", Open<CPushOverHingeStateDlg>(desktop),
         hasResult},
        {kMenu, "IDS_QM_UI_PUSH_STOREYS", "Ctrl+F8", Open<CPushOverStoreyDlg>(desktop), hasResult}};
}

void PushAtOnce(T_DESKTOP& desktop)
{
    CPushOverRunDlg dialog(desktop.doc);
    dialog.m_atOnce = true;
    dialog.SetView(&desktop.view);
    (void)dialog.DoModal();
    desktop.changed();
}

std::vector<T_WINDOW_EXAMPLE> PushWindowExamples()
{
    constexpr const char* kFrame = "rc-frame-2-storey";
    return {Example<CPushOverRunDlg>("push-run", kFrame,
                                     [](CDBDoc& doc) {
                                         auto run = std::make_unique<CPushOverRunDlg>(doc);
                                         (void)run->OnRun();
                                         return run;
                                     }),
            Example<CPushOverHingeStateDlg>(
                "push-states", kFrame,
                [](CDBDoc& doc) { return Pushed<CPushOverHingeStateDlg>(doc, 0.8); }),
            Example<CPushOverHingeStateDlg>(
                "push-states-space", "eccentric-building",
                [](CDBDoc& doc) { return Pushed<CPushOverHingeStateDlg>(doc, 1.0); }),
            Example<CPushOverHingeStateDlg>("push-states-point", "eccentric-building", AtPoint),
            Example<CPushOverJudgementDlg>("push-judgement", "rc-frame-code-hinges", Judged),
            Example<CPushOverStoreyDlg>("push-storeys", "steel-frame-2-storey", [](CDBDoc& doc) {
                return Pushed<CPushOverStoreyDlg>(doc, 0.6);
            })};
}
