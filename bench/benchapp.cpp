#include "benchapp.h"

#include <QApplication>

#include <memory>

namespace {

std::unique_ptr<QApplication>& App()
{
    static std::unique_ptr<QApplication> app;
    return app;
}

} // namespace

void NeedBenchApp()
{
    static int count = 1;
    static char name[] = "qm_bench";
    static char* arguments[] = {name, nullptr};
    qputenv("QT_QPA_PLATFORM", "offscreen");
    if (!App()) App() = std::make_unique<QApplication>(count, arguments);
}

void EndBenchApp()
{
    App().reset();
}
