#include "mainwindow.h"

#include "newtools.h"
#include "pushoverwindow.h"
#include "resultspane.h"
#include "shell/menus.h"
#include "shell/shell.h"
#include "toolcommands.h"
#include "viewtools.h"

#include "qm_base/messagehistory.h"
#include "qm_base/msgfunction.h"

#include <QAction>
#include <QApplication>
#include <QCloseEvent>
#include <QDir>
#include <QDockWidget>
#include <QFileInfo>
#include <QLabel>
#include <QMenuBar>
#include <QPlainTextEdit>
#include <QSettings>
#include <QStandardPaths>
#include <QStatusBar>
#include <QTimer>
#include <QToolBar>

#include <map>

using zql::lib::MMSGFunction;

namespace {

constexpr int kMostRecent = 8;
constexpr const char* kRecentKey = "recent";
constexpr const char* kLanguageKey = "language";

QString Text(const char* key)
{
    return QString::fromStdString(MMSGFunction::GetValue(key));
}

} // namespace

CMainWindow::CMainWindow()
    : m_desktop{m_doc, m_frame, m_factory, m_view, this, m_selection, [this] { Refresh(); }}
{
    RegisterViews(m_factory);
    m_frame.SetView(&m_view);
    m_frame.m_mayLeave = [this] { return CPushOverWindow::MayLeave(*this); };
    m_frame.m_askPath = [this] { return AskSavePath().toStdString(); };
    const QString language = QSettings().value(kLanguageKey, "en").toString();
    (void)MMSGFunction::SetLanguage(language.toStdString());
    MakePanes();
    MakeMenus();
    SetMessageHistorySink([this](std::string_view line) {
        m_messages->appendPlainText(
            QString::fromUtf8(line.data(), static_cast<qsizetype>(line.size())));
    });
    m_browser->m_showResult = [this](const T_SHAPE_SOURCE& source) {
        (void)m_framePane->Show(source, source.steps);
    };
    ShowTexts();
    Refresh();
    resize(1280, 800);
    m_shell = std::make_unique<CShell>(*this);
    m_clock.start();
    constexpr int kTickMs = 1000;
    auto* timer = new QTimer(this);
    connect(timer, &QTimer::timeout, this,
            [this] { m_frame.OnTick(static_cast<double>(m_clock.elapsed()) / kTickMs); });
    timer->start(kTickMs);
}

CMainWindow::~CMainWindow()
{
    SetMessageHistorySink({});
    m_shell.reset();
    // These watch the selection, which ends before the widgets of the window do.
    m_browser.reset();
    delete m_results;
    delete takeCentralWidget();
}

// ---- panes and menus ----------------------------------------------------------------------------

void CMainWindow::MakePanes()
{
    m_framePane = new CFramePane(m_doc, m_scene, m_selection, this);
    setCentralWidget(m_framePane);
    m_browser = std::make_unique<CBrowser>(m_desktop, m_scene);
    m_messages = new QPlainTextEdit(this);
    m_messages->setReadOnly(true);
    m_messages->setMaximumBlockCount(1000);
    const auto dock = [this](QWidget* pane, const char* name, Qt::DockWidgetArea area) {
        auto* widget = new QDockWidget(this);
        widget->setObjectName(QLatin1String(name));
        widget->setWidget(pane);
        addDockWidget(area, widget);
        return widget;
    };
    QDockWidget* left = dock(&m_browser->Tree(), "IDS_QM_UI_EXPLORER", Qt::LeftDockWidgetArea);
    QDockWidget* right =
        dock(&m_browser->Properties(), "IDS_QM_UI_PROPERTIES", Qt::RightDockWidgetArea);
    QDockWidget* below = dock(&m_browser->Table(), "IDS_QM_UI_TABLES", Qt::BottomDockWidgetArea);
    QDockWidget* told = dock(m_messages, "IDS_QM_UI_MESSAGES", Qt::BottomDockWidgetArea);
    m_results = new CResultsPane(*m_framePane, this);
    QDockWidget* results = dock(m_results, "IDS_QM_VIEW_RESULTS", Qt::BottomDockWidgetArea);
    tabifyDockWidget(below, results);
    tabifyDockWidget(results, told);
    results->hide();
    below->raise();
    setCorner(Qt::BottomLeftCorner, Qt::LeftDockWidgetArea);
    setCorner(Qt::BottomRightCorner, Qt::RightDockWidgetArea);
    resizeDocks({left, right}, {250, 330}, Qt::Horizontal);
    resizeDocks({below}, {230}, Qt::Vertical);
    m_units = new QLabel(this);
    statusBar()->addPermanentWidget(m_units);
}

void CMainWindow::MakeMenus()
{
    for (const T_COMMANDS& part : {FileCommands(), EditCommands(), ViewCommands(),
                                   ViewPartCommands(*m_framePane, "IDS_QM_UI_MENU_VIEW"),
                                   ToolCommands(m_desktop), WindowCommands()})
        m_commands.insert(m_commands.end(), part.begin(), part.end());
    const T_COMMANDS fresh = NewCommands(m_desktop); // below the first of the menu File, New
    m_commands.insert(m_commands.begin() + 1, fresh.begin(), fresh.end());
    ArrangeMenus(m_commands);
    std::map<std::string, QMenu*> menus;
    for (std::size_t i = 0; i < m_commands.size(); ++i) {
        const T_COMMAND& command = m_commands[i];
        QMenu*& menu = menus[command.menu];
        if (!menu) {
            menu = menuBar()->addMenu(QString());
            m_menus.emplace_back(menu, command.menu);
            connect(menu, &QMenu::aboutToShow, this, [this] { UpdateActions(); });
        }
        if (!*command.key) {
            menu->addSeparator();
            continue;
        }
        QAction* action = menu->addAction(QString());
        action->setObjectName(command.key);
        action->setShortcut(QKeySequence(QLatin1String(command.keys)));
        action->setCheckable(command.checked != nullptr);
        connect(action, &QAction::triggered, this, [this, i] {
            m_commands[i].run();
            UpdateActions();
        });
        m_actions.emplace_back(action, i);
        if (std::string_view(command.key) == "IDS_QM_UI_OPEN") {
            m_recent = menu->addMenu(QString());
            m_recent->menuAction()->setObjectName("IDS_QM_UI_RECENT");
            connect(m_recent, &QMenu::aboutToShow, this, [this] { ShowRecent(); });
        }
    }
    ShowRecent();
}

QAction* CMainWindow::Action(const char* key) const
{
    for (const auto& [action, i] : m_actions)
        if (std::string_view(m_commands[i].key) == key) return action;
    return nullptr;
}

QString CMainWindow::Messages() const
{
    return m_messages->toPlainText();
}

void CMainWindow::ShowTexts()
{
    for (const auto& [menu, key] : m_menus)
        menu->setTitle(Text(key));
    for (const auto& [action, i] : m_actions)
        action->setText(Text(m_commands[i].key));
    if (m_recent) m_recent->setTitle(Text("IDS_QM_UI_RECENT"));
    for (QDockWidget* dock : findChildren<QDockWidget*>())
        dock->setWindowTitle(Text(dock->objectName().toLatin1().constData()));
    m_browser->Retranslate();
    m_framePane->Retranslate();
    if (m_shell) m_shell->Retranslate();
    m_results->Retranslate();
}

void CMainWindow::UpdateActions()
{
    for (const auto& [action, i] : m_actions) {
        const T_COMMAND& command = m_commands[i];
        action->setEnabled(!command.enabled || command.enabled());
        if (command.checked) action->setChecked(command.checked());
    }
}

void CMainWindow::Refresh()
{
    m_selection.KeepExisting(m_doc);
    m_browser->Refresh();
    m_framePane->Refresh();
    const T_UNITS units = m_doc.Unit().Units();
    const auto force = QString::fromStdString(std::string(NameOf(units.force)));
    const auto length = QString::fromStdString(std::string(NameOf(units.length)));
    m_units->setText(QStringLiteral("%1, %2, s").arg(force, length));
    setWindowTitle(QString::fromStdString(m_frame.Title()) + " - " + Text("IDS_QM_PRODUCT"));
    UpdateActions();
    if (m_shell) m_shell->Refresh();
}

void CMainWindow::SetLanguage(const std::string& code)
{
    if (!MMSGFunction::SetLanguage(code)) return;
    QSettings().setValue(kLanguageKey, QString::fromStdString(code));
    ShowTexts();
    for (QWidget* widget : QApplication::allWidgets()) {
        QEvent event(QEvent::LanguageChange);
        QApplication::sendEvent(widget, &event);
    }
    Refresh();
}

// ---- files
// ---------------------------------------------------------------------------------------

/// In the person's folder for application data.
std::string CMainWindow::UntitledPath()
{
    const QString folder = QStandardPaths::writableLocation(QStandardPaths::AppDataLocation);
    if (folder.isEmpty() || !QDir().mkpath(folder)) return {};
    return (folder + "/untitled.qmdb").toStdString();
}

int CMainWindow::OfferRecovery()
{
    std::vector<std::string> files;
    for (const QString& path : QSettings().value(kRecentKey).toStringList())
        files.push_back(path.toStdString());
    const int done = m_frame.OnStart(files);
    Refresh();
    if (done) m_framePane->ResetCamera();
    return done;
}

int CMainWindow::Open(const QString& path)
{
    const int done = m_frame.OnOpen(path.toStdString());
    if (done) AddRecent(QFileInfo(path).absoluteFilePath());
    Refresh();
    if (done) m_framePane->ResetCamera();
    return done;
}

QString CMainWindow::AskSavePath()
{
    return AskFileName(this, true, Text("IDS_QM_UI_SAVE_TITLE"), Text("IDS_QM_UI_SAVE_FILTER"));
}

void CMainWindow::SaveAs()
{
    const QString path = AskSavePath();
    if (!path.isEmpty() && m_frame.OnSaveAs(path.toStdString()))
        AddRecent(QFileInfo(QString::fromStdString(m_doc.Path())).absoluteFilePath());
    Refresh();
}

void CMainWindow::Analyse()
{
    (void)RunWithProgress(this, Text("IDS_QM_UI_ANALYSING"),
                          [this](auto progress) { return m_frame.OnAnalyse(0, progress); });
    Refresh();
}

void CMainWindow::ExportPicture()
{
    const QString path = AskFileName(this, true, Text("IDS_QM_UI_EXPORT_PICTURE_TITLE"),
                                     Text("IDS_QM_UI_PICTURE_FILTER"));
    std::string error;
    if (path.isEmpty() || WritePictureFile(m_framePane->Drawing(), path.toStdString(), error))
        return;
    m_view.ShowMessage("IDS_QM_UI_FILE_REFUSED", error);
}

void CMainWindow::AddRecent(const QString& path)
{
    QStringList list = QSettings().value(kRecentKey).toStringList();
    list.removeAll(path);
    list.prepend(path);
    QSettings().setValue(kRecentKey, list.mid(0, kMostRecent));
    ShowRecent();
}

void CMainWindow::ShowRecent()
{
    m_recent->clear();
    for (const QString& path : QSettings().value(kRecentKey).toStringList())
        connect(m_recent->addAction(path), &QAction::triggered, this,
                [this, path] { (void)Open(path); });
    m_recent->setEnabled(!m_recent->isEmpty());
}

void CMainWindow::closeEvent(QCloseEvent* event)
{
    event->setAccepted(m_frame.OnClose() != 0);
}
