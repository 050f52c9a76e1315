#include "windowpictures.h"

#include "mainwindow.h"
#include "shell/theme.h"

#include "qm_base/textformat.h"

#include <QApplication>
#include <QDir>
#include <QFileInfo>
#include <QPixmap>
#include <QSettings>
#include <QStandardPaths>
#include <QTemporaryDir>

#include <cstdio>
#include <filesystem>
#include <fstream>
#include <string_view>

#include <unistd.h>

namespace {

constexpr QSize kScreen{1920, 1080}; // where none is asked for

/// Events until the window has got its layout.
void Settle()
{
    for (int i = 0; i < 5; ++i)
        QApplication::processEvents();
}

/// Windows that are larger than the screen have to scroll, as on a real one.
void FitInto(QWidget& window, const QSize& most, bool isMain)
{
    if (most.isEmpty()) return;
    window.resize(isMain ? most : window.size().boundedTo(most));
}

bool WriteOne(const T_WINDOW_EXAMPLE& example, const QString& language,
              const T_PICTURE_OPTIONS& options)
{
    CMainWindow main;
    main.SetLanguage(language.toStdString());
    ApplyTheme(options.theme);
    const QString model =
        options.examples + "/" + QString::fromStdString(example.model) + "/case.json";
    if (!example.model.empty() && !main.Open(model)) return false;
    FitInto(main, options.size, true);
    main.show();
    Settle();
    std::unique_ptr<QWidget> window;
    if (example.make) window = example.make(main);
    QWidget& shown = window ? *window : static_cast<QWidget&>(main);
    shown.show();
    FitInto(shown, options.size, !window);
    Settle();
    const QString file = QStringLiteral("%1/%2-%3.png")
                             .arg(options.folder, QString::fromStdString(example.name), language);
    return shown.grab().save(file);
}

/// The argument that follows an option; empty: it is not there.
QString ArgumentOf(int argc, char** argv, std::string_view option)
{
    for (int i = 1; i < argc; ++i) {
        const std::string_view argument = argv[i];
        if (argument == option && i + 1 < argc) return QString::fromLocal8Bit(argv[i + 1]);
        if (argument.starts_with(option) && argument.size() > option.size() &&
            argument[option.size()] == '=')
            return QString::fromLocal8Bit(argv[i] + option.size() + 1);
    }
    return {};
}

} // namespace

int WriteWindowPictures(const T_PICTURE_OPTIONS& options)
{
    if (!QDir().mkpath(options.folder)) return 1;
    // The person's settings and recent files stay as they are.
    const QTemporaryDir settings;
    QSettings::setDefaultFormat(QSettings::IniFormat);
    QSettings::setPath(QSettings::IniFormat, QSettings::UserScope, settings.path());
    QStandardPaths::setTestModeEnabled(true);
    int failed = 0;
    for (const T_WINDOW_EXAMPLE& example : WindowExamples()) {
        if (!QString::fromStdString(example.name).startsWith(options.only)) continue;
        for (const QString& language : options.languages) {
            if (WriteOne(example, language, options)) continue;
            std::fprintf(stderr, "qm-rps-desktop: no picture of %s, %s\n", example.name.c_str(),
                         language.toUtf8().constData());
            ++failed;
        }
    }
    return failed;
}

COffscreenScreen::COffscreenScreen(int argc, char** argv)
{
    if (ArgumentOf(argc, argv, "--pictures").isEmpty()) return;
    const QStringList sides = ArgumentOf(argc, argv, "--size").split('x');
    const int width = sides.value(0).toInt(), height = sides.value(1).toInt();
    const double scale = ArgumentOf(argc, argv, "--scale").toDouble();
    const std::string text =
        FormatText("{\"screens\": [{\"name\": \"memory\", \"x\": 0, \"y\": 0, \"width\": %d, "
                   "\"height\": %d, \"logicalDpi\": 96, \"logicalBaseDpi\": 96, \"dpr\": %g}]}",
                   width > 0 ? width : kScreen.width(), height > 0 ? height : kScreen.height(),
                   scale > 0.0 ? scale : 1.0);
    m_file = (std::filesystem::temp_directory_path() /
              ("qm-rps-screen-" + std::to_string(getpid()) + ".json"))
                 .string();
    std::ofstream(m_file) << text;
    qputenv("QT_QPA_PLATFORM", QByteArray("offscreen:configfile=") + m_file.c_str());
}

COffscreenScreen::~COffscreenScreen()
{
    std::error_code ignored;
    if (!m_file.empty()) std::filesystem::remove(m_file, ignored);
}
