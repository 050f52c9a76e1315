#include "shell/shell.h"

#include "mainwindow.h"
#include "newtools.h"
#include "shell/about.h"
#include "shell/helptopics.h"
#include "shell/helpwindow.h"
#include "shell/icons.h"
#include "shell/settingsstore.h"
#include "shell/startpage.h"
#include "shell/theme.h"
#include "shell/thumbnails.h"
#include "shell/windowkeeper.h"

#include "qm_base/msgfunction.h"
#include "qm_base/say.h"
#include "qm_rps/preferencesdlg.h"
#include "qm_rps/shell/letters.h"
#include "qm_ui/shown/showndecimals.h"

#include <QApplication>
#include <QDockWidget>
#include <QDropEvent>
#include <QFileInfo>
#include <QKeyEvent>
#include <QMenuBar>
#include <QMimeData>
#include <QSettings>
#include <QStackedWidget>
#include <QTimer>
#include <QToolBar>
#include <QUrl>
#include <QWhatsThis>

#include <utility>

namespace {

// Commands that the program may have or not.
const std::string kPrefix = "IDS_QM_", kCurveWizard = kPrefix + "NEW_CURVE_MENU",
                  kFrameGuide = kPrefix + "NEW_FRAME_MENU";
constexpr const char* kRecentKey = "recent"; // as the menu of recent files keeps them

QString Text(const std::string& key)
{
    return QString::fromStdString(Say(key));
}

/// What the tool bar has, in groups.
const std::vector<std::vector<const char*>>& BarGroups()
{
    static const std::vector<std::vector<const char*>> groups{
        {"IDS_QM_UI_NEW", "IDS_QM_UI_OPEN", "IDS_QM_UI_SAVE"},
        {"IDS_QM_UI_UNDO", "IDS_QM_UI_REDO"},
        {"IDS_QM_UI_SECT_MENU", "IDS_QM_UI_HINGE_TYPES", "IDS_QM_UI_POLC_LIST"},
        {"IDS_QM_UI_ANALYSE", "IDS_QM_UI_PUSH_RUN", "IDS_QM_UI_PUSH_STATES", "IDS_QM_UI_PUSH_CURVE",
         "IDS_QM_UI_ULF_ITEMS"},
        {"IDS_QM_UI_VIEW_ISO", "IDS_QM_UI_VIEW_XZ", "IDS_QM_UI_VIEW_YZ", "IDS_QM_UI_VIEW_XY"},
        {"IDS_QM_UI_REPORT_COMMAND"},
        {"IDS_QM_UI_PREFERENCES", "IDS_QM_UI_HELP"}};
    return groups;
}

/// Each entry of a menu a letter of its own.
void GiveLetters(const QList<QAction*>& entries)
{
    std::vector<std::string> texts;
    for (const QAction* entry : entries)
        texts.push_back(entry->text().toStdString());
    texts = WithLetters(texts);
    for (qsizetype i = 0; i < entries.size(); ++i)
        entries[i]->setText(QString::fromStdString(texts[static_cast<std::size_t>(i)]));
}

CShell* ShellOf(const T_DESKTOP& desktop)
{
    return dynamic_cast<CShell*>(desktop.window->findChild<QObject*>("shell"));
}

/// The one file that is being dragged, of a kind that is taken; empty: none.
QString DraggedFile(const QMimeData* data)
{
    if (!data || data->urls().size() != 1 || !data->urls().front().isLocalFile()) return {};
    const QString path = data->urls().front().toLocalFile();
    const QString kind = QFileInfo(path).suffix().toLower();
    return QStringList{"json", "qmdb", "csv", "txt"}.contains(kind) ? path : QString();
}

} // namespace

CShell::CShell(CMainWindow& window) : QObject(&window), m_window(window)
{
    setObjectName("shell");
    window.setWindowIcon(DrawnIcon("app"));
    window.setAcceptDrops(true);
    qApp->installEventFilter(this);
    for (QAction* action : window.findChildren<QAction*>())
        if (const QString icon = IconOf(action->objectName()); !icon.isEmpty())
            action->setIcon(DrawnIcon(icon));
    MakeBar();
    MakeStart();
    Apply(ReadPreferences(CSettingsStore()));
    Retranslate();
    GiveBackPlaces();
    ShowStart();
}

QAction* CShell::Named(const char* key) const
{
    return m_window.Action(key);
}

void CShell::MakeStart()
{
    T_START_CALLS calls;
    calls.open = [this](const QString& path) { (void)m_window.Open(path); };
    calls.openCopy = [this](const QString& path) {
        if (!m_window.Desktop().frame.OnOpenCopy(path.toStdString())) return;
        m_window.Refresh();
        m_window.Frame().ResetCamera();
    };
    calls.recent = [] { return QSettings().value(kRecentKey).toStringList(); };
    calls.forget = [](const QString& path) {
        QStringList list = QSettings().value(kRecentKey).toStringList();
        list.removeAll(path);
        QSettings().setValue(kRecentKey, list);
    };
    calls.begin = [this] {
        return std::vector<QAction*>{m_window.Action(kCurveWizard.c_str()),
                                     m_window.Action(kFrameGuide.c_str()), Named("IDS_QM_UI_NEW"),
                                     Named("IDS_QM_UI_OPEN")};
    };
    m_stack = new QStackedWidget(&m_window);
    m_start = new CStartPage(std::move(calls), m_stack);
    QWidget* canvas = m_window.takeCentralWidget();
    m_stack->addWidget(m_start);
    m_stack->addWidget(canvas);
    m_window.setCentralWidget(m_stack);
}

void CShell::MakeBar()
{
    m_bar = new QToolBar(&m_window);
    m_bar->setObjectName("toolBar");
    m_bar->setIconSize({22, 22});
    for (const auto& group : BarGroups()) {
        if (!m_bar->actions().isEmpty()) m_bar->addSeparator();
        for (const char* key : group)
            if (QAction* action = Named(key)) m_bar->addAction(action);
    }
    m_window.addToolBar(m_bar);
    for (QAction* action : m_bar->actions())
        if (QWidget* button = m_bar->widgetForAction(action)) button->setFocusPolicy(Qt::TabFocus);
}

bool CShell::IsAtStart() const
{
    return m_stack->currentWidget() == m_start;
}

/// Panes of the model would be empty beside the start page.
void CShell::ShowStart()
{
    m_startRevision = m_window.Doc().Data().Revision();
    m_start->Refresh();
    for (QDockWidget* dock : m_window.findChildren<QDockWidget*>()) {
        if (dock->isHidden()) continue;
        m_hidden.push_back(dock);
        dock->hide();
    }
    m_stack->setCurrentWidget(m_start);
}

void CShell::LeaveStart()
{
    m_stack->setCurrentIndex(1);
    ShowPanes();
}

void CShell::ShowPanes()
{
    for (QDockWidget* dock : std::exchange(m_hidden, {}))
        dock->show();
}

void CShell::Refresh()
{
    const CDBDoc& doc = m_window.Doc();
    if (IsAtStart() && doc.Data().Revision() != m_startRevision) LeaveStart();
    constexpr int kLaterMs = 200; // what has changed is shown first
    if (!doc.Path().empty() && !doc.Data().IsModified())
        QTimer::singleShot(kLaterMs, this, [this] { KeepPicture(); });
}

/// Of the file as it was opened or saved.
void CShell::KeepPicture()
{
    CDBDoc& doc = m_window.Doc();
    const QString path = QString::fromStdString(doc.Path());
    const QString what = path + QString::number(doc.Data().Revision());
    if (path.isEmpty() || doc.Data().IsModified() || what == m_pictured) return;
    m_pictured = what;
    KeepThumbnail(path, DrawThumbnail(doc));
}

void CShell::SetTips()
{
    for (QAction* action : m_window.findChildren<QAction*>()) {
        const std::string key = action->objectName().toStdString();
        if (!key.starts_with("IDS_")) continue;
        const QString plain = action->text().remove('&').remove("...");
        const QString keys = action->shortcut().toString(QKeySequence::NativeText);
        const std::string tip = key + "_TIP";
        action->setStatusTip(Say(tip) == tip ? QString() : Text(tip));
        action->setWhatsThis(action->statusTip());
        action->setToolTip(keys.isEmpty() ? plain : plain + " (" + keys + ")");
        action->setIconText(plain);
    }
}

void CShell::Retranslate()
{
    GiveLetters(m_window.menuBar()->actions());
    for (const QAction* menu : m_window.menuBar()->actions())
        if (menu->menu()) GiveLetters(menu->menu()->actions());
    SetTips();
    m_bar->setWindowTitle(Text("IDS_QM_UI_TOOL_BAR"));
    m_start->Refresh();
    if (m_help) m_help->Retranslate();
}

// ---- preferences, help --------------------------------------------------------------------------

void CShell::Apply(const T_PREFERENCES& preferences)
{
    ApplyTheme(preferences.theme);
    SetShownDecimals(preferences.decimals);
    CMainFrame& frame = m_window.Desktop().frame;
    frame.m_newUnits = preferences.newUnits;
    frame.SetAutosaveInterval(preferences.autosaveS);
}

void CShell::ShowPreferences()
{
    CSettingsStore store;
    CPreferencesDlg dialog(store);
    dialog.SetView(&m_window.Desktop().view);
    const T_PREFERENCES before = dialog.m_now;
    dialog.m_apply = [this](const T_PREFERENCES& now) { Apply(now); };
    if (!dialog.DoModal()) return;
    if (dialog.m_now.language != before.language)
        m_window.SetLanguage(dialog.m_now.language);
    else if (dialog.m_now.decimals != before.decimals)
        m_window.Refresh();
    for (QWidget* window : QApplication::topLevelWidgets())
        window->update();
}

void CShell::ShowHelp(const QString& anchor)
{
    const QString topic = anchor.isEmpty() ? TopicOf(QApplication::activeWindow()) : anchor;
    // Over a window that keeps the others from the keyboard help belongs to that one.
    QWidget* const modal = QApplication::activeModalWidget();
    QWidget* const parent = modal ? modal : &m_window;
    if (m_help && m_help->parentWidget() != parent) m_help->setParent(parent, Qt::Window);
    if (!m_help) {
        m_help = new CHelpWindow(parent);
        connect(m_help, &QObject::destroyed, this, [this] { m_help = nullptr; });
    }
    (void)m_help->ShowTopic(topic);
    m_help->show();
    m_help->raise();
    m_help->activateWindow();
}

// ---- files that are dropped, places -------------------------------------------------------------

void CShell::TakeFile(const QString& path)
{
    const QString kind = QFileInfo(path).suffix().toLower();
    if (kind == "json" || kind == "qmdb") {
        (void)m_window.Open(path);
        return;
    }
    if (QAction* wizard = m_window.Action(kCurveWizard.c_str())) {
        m_window.setProperty(kDroppedCurve, path); // the wizard begins with it
        wizard->trigger();
        m_window.setProperty(kDroppedCurve, QVariant());
        return;
    }
    m_window.Desktop().view.ShowMessage(
        "IDS_QM_START_CSV", Say("IDS_QM_START_CSV", QFileInfo(path).fileName().toStdString()));
}

/// F1 in a window over the main one, whose commands do not reach there.
bool CShell::IsHelpKey(const QObject* object, QEvent* event)
{
    if (event->type() != QEvent::KeyPress || !object->isWidgetType()) return false;
    const auto* key = static_cast<QKeyEvent*>(event);
    return key->key() == Qt::Key_F1 && key->modifiers() == Qt::NoModifier;
}

bool CShell::eventFilter(QObject* object, QEvent* event)
{
    if (IsHelpKey(object, event)) {
        ShowHelp();
        return true;
    }
    if (object != &m_window) return false;
    switch (event->type()) {
    case QEvent::DragEnter: {
        auto* drag = static_cast<QDragEnterEvent*>(event);
        if (DraggedFile(drag->mimeData()).isEmpty()) return false;
        drag->acceptProposedAction();
        return true;
    }
    case QEvent::Drop: {
        auto* drop = static_cast<QDropEvent*>(event);
        const QString path = DraggedFile(drop->mimeData());
        if (path.isEmpty()) return false;
        drop->acceptProposedAction();
        // The program that the file comes from waits until this is done.
        QTimer::singleShot(0, this, [this, path] { TakeFile(path); });
        return true;
    }
    case QEvent::Hide:
        if (!event->spontaneous()) KeepPlaces();
        return false;
    default:
        return false;
    }
}

void CShell::KeepPlaces()
{
    QSettings settings;
    settings.setValue("main/geometry", m_window.saveGeometry());
    ShowPanes(); // they are to be there the next time, too
    settings.setValue("main/docks", m_window.saveState());
}

void CShell::GiveBackPlaces()
{
    const QSettings settings;
    (void)m_window.restoreState(settings.value("main/docks").toByteArray());
    if (!m_window.restoreGeometry(settings.value("main/geometry").toByteArray())) return;
    if (!m_window.isMaximized() && !m_window.isFullScreen())
        m_window.setGeometry(OntoScreens(m_window.geometry(), ScreensNow()));
}

T_COMMANDS ShellCommands(T_DESKTOP& desktop)
{
    constexpr const char *kEdit = "IDS_QM_UI_MENU_EDIT", *kWindow = "IDS_QM_UI_MENU_WINDOW",
                         *kHelp = "IDS_QM_UI_MENU_HELP";
    const auto call = [&desktop](void (CShell::*what)()) {
        return [&desktop, what] {
            if (CShell* shell = ShellOf(desktop)) (shell->*what)();
        };
    };
    const auto help = [&desktop](const char* anchor) {
        return [&desktop, anchor] {
            if (CShell* shell = ShellOf(desktop)) shell->ShowHelp(anchor);
        };
    };
    return {{kEdit, "IDS_QM_UI_PREFERENCES", "Ctrl+,", call(&CShell::ShowPreferences)},
            {kWindow, "IDS_QM_UI_START_PAGE", "Ctrl+Home", call(&CShell::ShowStart)},
            {kHelp, "IDS_QM_UI_HELP", "F1", help("")},
            {kHelp, "IDS_QM_UI_WHATS_THIS", "Shift+F1", [] { QWhatsThis::enterWhatsThisMode(); }},
            {kHelp, "IDS_QM_UI_EXAMPLES", "", call(&CShell::ShowStart)},
            {kHelp, "IDS_QM_UI_ABOUT", "", [&desktop] { ShowAbout(desktop.window); }}};
}
