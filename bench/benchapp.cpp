#include "benchapp.h"

#include <QApplication>

void NeedBenchApp()
{
    static int count = 1;
    static char name[] = "qm_bench";
    static char* arguments[] = {name, nullptr};
    qputenv("QT_QPA_PLATFORM", "offscreen");
    static QApplication app(count, arguments);
}
