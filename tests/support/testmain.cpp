#include "testapp.h"

#include <QApplication>
#include <gtest/gtest.h>

#include <memory>

namespace {

int g_argc = 1;
char** g_argv = nullptr;
std::unique_ptr<QApplication> g_app;

} // namespace

void NeedApp()
{
    if (!g_app) g_app = std::make_unique<QApplication>(g_argc, g_argv);
}

int main(int argc, char** argv)
{
    qputenv("QT_QPA_PLATFORM", "offscreen");
    testing::InitGoogleTest(&argc, argv);
    g_argv = argv;
    const int result = RUN_ALL_TESTS();
    g_app.reset();
    return result;
}
