#include "mainwindow.h"
#include "pushtools.h"
#include "qm_base/say.h"
#include "qm_db/casefile.h"
#include "qm_solver/libraryspace.h"
#include "shell/settingsstore.h"
#include "shell/theme.h"
#include "shell/windowkeeper.h"
#include "windowpictures.h"

#include <QApplication>
#include <QCommandLineParser>
#include <QMessageBox>
#include <QTimer>

#include <clocale>
#include <cstdio>
#include <new>

namespace {

/// A task that runs out of memory ends with a message, and the program goes on.
class CApplication : public QApplication {
public:
    using QApplication::QApplication;
    bool notify(QObject* receiver, QEvent* event) override
    {
        try {
            return QApplication::notify(receiver, event);
        } catch (const std::bad_alloc&) {
        }
        QMessageBox::critical(nullptr, {}, QString::fromStdString(Say("IDS_QM_NO_MEMORY")));
        return false;
    }
};

/// The options that pictures are made with.
struct T_PICTURE_ARGUMENTS {
    QCommandLineOption folder{"pictures", "Write pictures of every window into a folder and end.",
                              "folder"};
    QCommandLineOption examples{"examples", "Folder of the example models for --pictures.",
                                "folder", "examples"};
    QCommandLineOption scale{"scale", "Scale of the screen for --pictures: 1 or 2.", "factor"};
    QCommandLineOption size{"size", "Size of the screen for --pictures.", "1024x700"};
    QCommandLineOption theme{"theme", "Colours for --pictures: light or dark.", "name", "light"};
    QCommandLineOption language{"language", "Language for --pictures: en or it; both without it.",
                                "code"};
    QCommandLineOption only{"only", "Windows whose names begin so, for --pictures.", "name"};
    QList<QCommandLineOption> All() const
    {
        return {folder, examples, scale, size, theme, language, only};
    }
};

int WrongUsage(const QCommandLineOption& option)
{
    std::fprintf(stderr, "qm-rps-desktop: bad value of --%s\n",
                 option.names().front().toUtf8().constData());
    return 2;
}

int WritePictures(const QCommandLineParser& parser, const T_PICTURE_ARGUMENTS& arguments)
{
    T_PICTURE_OPTIONS options;
    options.folder = parser.value(arguments.folder);
    options.examples = parser.value(arguments.examples);
    options.only = parser.value(arguments.only);
    if (const QString theme = parser.value(arguments.theme); theme == "dark")
        options.theme = THEME::Dark;
    else if (theme != "light")
        return WrongUsage(arguments.theme);
    if (const QString code = parser.value(arguments.language); code == "en" || code == "it")
        options.languages = QStringList{code};
    else if (!code.isEmpty())
        return WrongUsage(arguments.language);
    if (parser.isSet(arguments.size)) {
        const QStringList sides = parser.value(arguments.size).split('x');
        options.size = QSize(sides.value(0).toInt(), sides.value(1).toInt());
        if (sides.size() != 2 || options.size.isEmpty()) return WrongUsage(arguments.size);
    }
    return WriteWindowPictures(options) ? 1 : 0;
}

} // namespace

int main(int argc, char** argv)
{
    solver::StartLean(argv);
    const COffscreenScreen screen(argc, argv);
    CApplication app(argc, argv);
    std::setlocale(LC_NUMERIC, "C"); // models write '.', whatever the locale of the windows is
    QCoreApplication::setOrganizationName("qm-rps");
    QCoreApplication::setApplicationName("qm-rps-desktop");
    QCoreApplication::setApplicationVersion(QM_RPS_VERSION);
    QCommandLineParser parser;
    parser.setApplicationDescription(
        "Pushover evaluation, plastic hinges and unknown load factors");
    parser.addHelpOption();
    parser.addVersionOption();
    parser.addPositionalArgument("model", "Model file (.qmdb) or case file (.json) to open.",
                                 "[model]");
    const T_PICTURE_ARGUMENTS pictures;
    const QCommandLineOption startOnly("start-only", "Show the window and end: for benchmarks.");
    const QCommandLineOption push("push",
                                  "Push the model's load cases at once, and show the hinges.");
    const QCommandLineOption outside("allow-outside",
                                     "Read recorder files outside the case file's folder, too.");
    parser.addOptions({startOnly, push, outside});
    parser.addOptions(pictures.All());
    parser.process(app);
    CCaseFile::SetAllowOutside(parser.isSet(outside));
    if (parser.isSet(pictures.folder)) return WritePictures(parser, pictures);
    ApplyTheme(ReadPreferences(CSettingsStore()).theme); // before there are windows to repaint
    const CWindowKeeper keeper(&app);
    CMainWindow window;
    window.show();
    if (parser.positionalArguments().isEmpty())
        (void)window.OfferRecovery();
    else if (window.Open(parser.positionalArguments().first()) && parser.isSet(push))
        QTimer::singleShot(0, &window, [&window] { PushAtOnce(window.Desktop()); });
    if (parser.isSet(startOnly)) QTimer::singleShot(0, &app, &QApplication::quit);
    return QApplication::exec();
}
