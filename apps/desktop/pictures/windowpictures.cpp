#include "windowpictures.h"

#include "mainwindow.h"

#include "qm_base/msgfunction.h"

#include <QApplication>
#include <QDir>
#include <QPixmap>
#include <QSettings>
#include <QStandardPaths>
#include <QTemporaryDir>

#include <cstdio>

namespace {

/// Events until the window has got its layout.
void Settle()
{
    for (int i = 0; i < 5; ++i)
        QApplication::processEvents();
}

bool WriteOne(const T_WINDOW_EXAMPLE& example, const QString& file, const QString& examples)
{
    CMainWindow main;
    main.SetLanguage(QFileInfo(file).completeBaseName().endsWith("-it") ? "it" : "en");
    const QString model = examples + "/" + QString::fromStdString(example.model) + "/case.json";
    if (!example.model.empty() && !main.Open(model)) return false;
    main.show();
    Settle();
    std::unique_ptr<QWidget> window;
    if (example.make) window = example.make(main);
    QWidget& shown = window ? *window : static_cast<QWidget&>(main);
    shown.show();
    Settle();
    return shown.grab().save(file);
}

} // namespace

int WriteWindowPictures(const QString& folder, const QString& examples)
{
    if (!QDir().mkpath(folder)) return 1;
    // The person's settings and recent files stay as they are.
    const QTemporaryDir settings;
    QSettings::setDefaultFormat(QSettings::IniFormat);
    QSettings::setPath(QSettings::IniFormat, QSettings::UserScope, settings.path());
    QStandardPaths::setTestModeEnabled(true);
    int failed = 0;
    for (const T_WINDOW_EXAMPLE& example : WindowExamples())
        for (const char* language : {"en", "it"}) {
            const QString file = QStringLiteral("%1/%2-%3.png")
                                     .arg(folder, QString::fromStdString(example.name), language);
            if (WriteOne(example, file, examples)) continue;
            std::fprintf(stderr, "qm-rps-desktop: no picture %s\n", file.toUtf8().constData());
            ++failed;
        }
    return failed;
}
