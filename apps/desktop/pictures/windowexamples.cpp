#include "windowpictures.h"

#include "hingetools.h"
#include "loadcasetools.h"
#include "mainwindow.h"
#include "pushovertools.h"
#include "pushtools.h"
#include "reporttools.h"
#include "structuretools.h"
#include "ulftools.h"

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
    std::vector<T_WINDOW_EXAMPLE> all{{"main-empty", ""},
                                      {"main-pushover", "rc-frame-3-storey", shown(KIND::Pushover)},
                                      {"main-bridge", "cable-stayed-bridge", shown(KIND::Static)},
                                      {"main-space", "space-frame-3d", shown(KIND::Static)}};
    for (auto& part : {PushWindowExamples(), PushoverWindowExamples(), LoadCaseWindowExamples(),
                       StructureWindowExamples(), ReportWindowExamples(), HingeWindowExamples(),
                       UlfWindowExamples()})
        all.insert(all.end(), part.begin(), part.end());
    return all;
}
