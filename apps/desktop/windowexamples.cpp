#include "windowpictures.h"

#include "hingetools.h"
#include "loadcasetools.h"
#include "mainwindow.h"
#include "pushovertools.h"
#include "ulftools.h"

std::vector<T_WINDOW_EXAMPLE> WindowExamples()
{
    const auto pushover = [](CMainWindow& main) -> std::unique_ptr<QWidget> {
        const auto& sources = main.Frame().Sources();
        (void)main.Frame().Show(sources.back(), sources.back().steps);
        return nullptr;
    };
    std::vector<T_WINDOW_EXAMPLE> all{{"main-empty", ""},
                                      {"main-pushover", "rc-frame-3-storey", pushover},
                                      {"main-bridge", "cable-stayed-bridge"},
                                      {"main-space", "space-frame-3d"}};
    for (const auto& part : {PushoverWindowExamples(), LoadCaseWindowExamples(),
                             HingeWindowExamples(), UlfWindowExamples()})
        all.insert(all.end(), part.begin(), part.end());
    return all;
}
