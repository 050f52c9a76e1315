#include "windowpictures.h"

#include "hingetools.h"
#include "loadcasetools.h"
#include "mainwindow.h"
#include "newtools.h"
#include "pushovertools.h"
#include "pushtools.h"
#include "reporttools.h"
#include "shell/helpwindow.h"
#include "shell/settingsstore.h"
#include "shell/shell.h"
#include "shell/startpage.h"
#include "structuretools.h"
#include "ulftools.h"
#include "viewtools.h"

#include "qm_rps/preferencesdlg.h"
#include "qm_ui/form/dialogwindow.h"

#include <QApplication>
#include <QElapsedTimer>

std::vector<T_WINDOW_EXAMPLE> WindowExamples()
{
    using KIND = T_SHAPE_SOURCE::KIND;
    const auto shown = [](KIND kind) {
        return [kind](CMainWindow& main) -> std::unique_ptr<QWidget> {
            if (kind == KIND::Static) (void)main.Desktop().frame.OnAnalyse(0, {});
            main.Refresh();
            for (const T_SHAPE_SOURCE& source : main.Frame().Sources()) {
                if (source.kind != kind) continue;
                (void)main.Frame().Show(source, source.steps);
                break;
            }
            return nullptr;
        };
    };
    const auto started = [](CMainWindow& main) -> std::unique_ptr<QWidget> {
        QElapsedTimer clock;
        constexpr int kMostMs = 10000;
        for (clock.start(); clock.elapsed() < kMostMs && main.Shell().Start().IsDrawing();)
            QApplication::processEvents();
        return nullptr;
    };
    const auto preferences = [](CMainWindow& main) -> std::unique_ptr<QWidget> {
        auto store = std::make_unique<CSettingsStore>();
        auto dialog = std::make_unique<CPreferencesDlg>(*store);
        const CViewFactory& factory = main.Desktop().factory;
        auto window =
            std::make_unique<CDialogWindow>(factory, *factory.Find(*dialog), *dialog, nullptr);
        KeepWith(*window, std::move(store));
        KeepWith(*window, std::move(dialog));
        return window;
    };
    const auto help = [](CMainWindow&) -> std::unique_ptr<QWidget> {
        auto window = std::make_unique<CHelpWindow>(nullptr);
        (void)window->ShowTopic("methods");
        return window;
    };
    std::vector<T_WINDOW_EXAMPLE> all{{"main-empty", "", started},
                                      {"main-pushover", "rc-frame-3-storey", shown(KIND::Pushover)},
                                      {"main-bridge", "cable-stayed-bridge", shown(KIND::Static)},
                                      {"main-space", "space-frame-3d", shown(KIND::Static)},
                                      {"preferences", "", preferences},
                                      {"help", "", help}};
    for (auto& part : {ViewWindowExamples(), PushWindowExamples(), PushoverWindowExamples(),
                       LoadCaseWindowExamples(), StructureWindowExamples(), ReportWindowExamples(),
                       HingeWindowExamples(), UlfWindowExamples(), NewWindowExamples()})
        all.insert(all.end(), part.begin(), part.end());
    return all;
}
