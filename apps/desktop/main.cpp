#include "mainwindow.h"
#include "pushtools.h"
#include "qm_base/say.h"
#include "qm_db/casefile.h"
#include "qm_solver/libraryspace.h"
#include "windowpictures.h"

#include <QApplication>
#include <QCommandLineParser>
#include <QMessageBox>
#include <QTimer>

#include <clocale>
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

} // namespace

int main(int argc, char** argv)
{
    solver::StartLean(argv);
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
    const QCommandLineOption pictures(
        "pictures", "Write pictures of every window into a folder and end.", "folder");
    const QCommandLineOption examples("examples", "Folder of the example models for --pictures.",
                                      "folder", "examples");
    const QCommandLineOption startOnly("start-only", "Show the window and end: for benchmarks.");
    const QCommandLineOption push("push",
                                  "Push the model's load cases at once, and show the hinges.");
    const QCommandLineOption outside("allow-outside",
                                     "Read recorder files outside the case file's folder, too.");
    parser.addOptions({pictures, examples, startOnly, push, outside});
    parser.process(app);
    CCaseFile::SetAllowOutside(parser.isSet(outside));
    if (parser.isSet(pictures))
        return WriteWindowPictures(parser.value(pictures), parser.value(examples)) ? 1 : 0;
    CMainWindow window;
    window.show();
    if (parser.positionalArguments().isEmpty())
        (void)window.OfferRecovery();
    else if (window.Open(parser.positionalArguments().first()) && parser.isSet(push))
        QTimer::singleShot(0, &window, [&window] { PushAtOnce(window.Desktop()); });
    if (parser.isSet(startOnly)) QTimer::singleShot(0, &app, &QApplication::quit);
    return QApplication::exec();
}
