#include "mainwindow.h"
#include "windowpictures.h"

#include <QApplication>
#include <QCommandLineParser>
#include <QTimer>

#include <clocale>

int main(int argc, char** argv)
{
    QApplication app(argc, argv);
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
    parser.addOptions({pictures, examples, startOnly});
    parser.process(app);
    if (parser.isSet(pictures))
        return WriteWindowPictures(parser.value(pictures), parser.value(examples)) ? 1 : 0;
    CMainWindow window;
    window.show();
    if (parser.positionalArguments().isEmpty())
        (void)window.OfferRecovery();
    else
        (void)window.Open(parser.positionalArguments().first());
    if (parser.isSet(startOnly)) QTimer::singleShot(0, &app, &QApplication::quit);
    return QApplication::exec();
}
