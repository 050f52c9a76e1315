#include "ulftools.h"

#include "mainwindow.h"

#include "qm_rps/loadcombinationdlg.h"
#include "qm_rps/ulfexplanationdlg.h"
#include "qm_rps/ulfiterationdochost.h"
#include "qm_rps/ulfiterationrundlg.h"
#include "qm_rps/ulftuningdlg.h"
#include "qm_rps/unknownloadfactorconstraintdlg.h"
#include "qm_rps/unknownloadfactordlg.h"
#include "qm_rps/unknownloadfactoritemdlg.h"
#include "qm_rps/unknownloadfactoriteranaldlg.h"
#include "qm_rps/unknownloadfactorresultdlg.h"
#include "qm_rps/unknownstageitemdlg.h"
#include "qm_rps/unknowntabletabgrid1.h"
#include "qm_ui/form/dialogwindow.h"

#include <QTabWidget>
#include <QTemporaryDir>

namespace {

using WINDOW = std::unique_ptr<QWidget>;

/// The window of a model, which lives as long as it does.
template <class MODEL>
WINDOW WindowOf(CMainWindow& main, std::unique_ptr<MODEL> model)
{
    T_DESKTOP& desktop = main.Desktop();
    const T_VIEW* view = desktop.factory.Find(*model);
    if (!view) return nullptr;
    auto window = std::make_unique<CDialogWindow>(desktop.factory, *view, *model, nullptr);
    (void)KeepWith(*window, std::move(model));
    return window;
}

template <class MODEL, class... ARGS>
auto WindowMaker(ARGS... args)
{
    return [=](CMainWindow& main) {
        return WindowOf(main, std::make_unique<MODEL>(main.Doc(), args...));
    };
}

WINDOW ResultWindow(CMainWindow& main, int item)
{
    CUnknownLoadFactorItemDlg dialog(main.Doc(), item);
    std::string error;
    if (!dialog.OnAnalyse({}, error) || !dialog.OnCalculate()) return nullptr;
    return WindowOf(main,
                    std::make_unique<CUnknownLoadFactorResultDlg>(main.Doc(), *dialog.Result()));
}

/// Of the calculation of an item.
WINDOW ExplanationWindow(CMainWindow& main, int item)
{
    CUnknownLoadFactorItemDlg dialog(main.Doc(), item);
    std::string error;
    T_ULF_EXPLAINED explained;
    if (!dialog.OnAnalyse({}, error)) return nullptr;
    // Without a solution there is the more to explain.
    const T_ULF_CALCULATION& c = dialog.Calculate();
    if (!c.run || !ExplainUlf(*c.run, main.Doc().Unit().Units(), explained)) return nullptr;
    return WindowOf(main, std::make_unique<CUlfExplanationDlg>(
                              dialog.m_name, c.said ? c.said->text : "", std::move(explained)));
}

WINDOW SettingsWindow(CMainWindow& main)
{
    return WindowOf(main, std::make_unique<CUnknownLoadFactorIterAnalDlg>(
                              *CUnknownLoadFactorIterAnal::Of(main.Doc().DynModules())));
}

/// Wants every iteration.
class CIterates : public zql::frx::IDialogView {
public:
    void ShowMessage(const std::string&, const std::string&) override {}
    bool AskYesNo(const std::string&, const std::string&) override { return true; }
    int RunModal(zql::frx::MDialog& child) override
    {
        auto* dialog = dynamic_cast<CUlfIterationResultDlg*>(&child);
        if (!dialog) return 0;
        dialog->m_iterate = dialog->m_dontAsk = true;
        return 1;
    }
};

/// A run done, on a copy of the model, which is gone with its folder.
WINDOW RunWindow(CMainWindow& main)
{
    QTemporaryDir folder;
    T_FILE_ERROR error;
    if (!main.Doc().SaveAs((folder.path() + "/bridge.qmdb").toStdString(), error)) return nullptr;
    auto run = std::make_unique<CUlfIterationRunDlg>(main.Doc());
    CIterates view;
    run->SetView(&view);
    const int done = run->OnRun();
    run->SetView(nullptr);
    return done ? WindowOf(main, std::move(run)) : nullptr;
}

/// One factor turned up.
WINDOW TuningWindow(CMainWindow& main)
{
    auto tuned = std::make_unique<CUlfTuningDlg>(main.Doc());
    if (!tuned->OnSolve({}) || !tuned->OnFactor(2, 1.1 * tuned->Factor(2))) return nullptr;
    tuned->m_chosen = 2;
    WINDOW window = WindowOf(main, std::move(tuned));
    window->show();
    window->resize(1320, 780);
    return window;
}

WINDOW StepWindow(CMainWindow& main)
{
    T_ULF_ITER_STEP step{0, main.Doc().Path(), {}, 0.0};
    CUnknownStageItemDlg item(main.Doc(), 1);
    CUlfIterationDocHost host(main.Doc(), item.Record());
    std::string error;
    std::optional<T_FINDING> said;
    if (!item.OnAnalyse({}, error) || !host.Solve(step.rows, said)) return nullptr;
    step.tolerance = UlfIterTolerance(step.rows);
    return WindowOf(main, std::make_unique<CUlfIterationResultDlg>(std::move(step)));
}

} // namespace

std::vector<T_WINDOW_EXAMPLE> UlfWindowExamples()
{
    constexpr const char* kBridge = "cable-stayed-bridge";
    constexpr const char* kBeam = "tuned-beam";
    constexpr const char* kHangers = "staged-two-hangers";
    const auto result = [](int item) {
        return [item](CMainWindow& main) { return ResultWindow(main, item); };
    };
    return {{"ulf-items", kBridge, WindowMaker<CUnknownLoadFactorDlg>()},
            {"ulf-item", kBridge, WindowMaker<CUnknownLoadFactorItemDlg>(2)},
            {"ulf-constraints", kBridge, WindowMaker<CUnknownTableTabGrid1>()},
            {"ulf-constraint", kBeam, WindowMaker<CUnknownLoadFactorConstraintDlg>(13)},
            {"ulf-result", kBridge, result(2)},
            {"ulf-result-picture", kBridge,
             [](CMainWindow& main) {
                 WINDOW window = ResultWindow(main, 2);
                 if (window) window->findChild<QTabWidget*>()->setCurrentIndex(1);
                 return window;
             }},
            {"ulf-result-beam", kBeam, result(1)},
            {"ulf-explanation", kBeam, [](CMainWindow& m) { return ExplanationWindow(m, 4); }},
            {"ulf-tuning", kBridge, TuningWindow},
            {"ulf-stage-item", "cable-stayed-bridge-staged", WindowMaker<CUnknownStageItemDlg>(1)},
            {"ulf-iteration-settings", kHangers, SettingsWindow},
            {"ulf-iteration-step", kHangers, StepWindow},
            {"ulf-iteration", kHangers, RunWindow},
            {"ulf-iteration-bridge", "cable-stayed-bridge-staged", RunWindow},
            {"load-combination", kBridge, WindowMaker<CLoadCombinationDlg>(1)}};
}
