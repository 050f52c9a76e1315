// What stands around the panes of the main window: start page, tool bar, icons and tips, files that
// are dropped, preferences, help, and the memory of where everything stood.
#pragma once

#include "command.h"
#include "qm_rps/shell/preferences.h"

#include <QMainWindow>

#include <vector>

class CHelpWindow;
class CMainWindow;
class CStartPage;
class QAction;
class QDockWidget;
class QStackedWidget;
class QToolBar;
struct T_DESKTOP;

class CShell : public QObject {
public:
    /// The window's menus and its central pane are made; actions and menus have the keys of their
    /// texts as names. The pane goes behind the start page.
    explicit CShell(CMainWindow& window);

    /// The document may have changed: the start page goes where there is a model now.
    void Refresh();
    /// Texts, tips and letters again.
    void Retranslate();

    void ShowStart();
    bool IsAtStart() const;
    void ShowPreferences();
    /// The section of the guide for what has the focus; empty anchor: of that.
    void ShowHelp(const QString& anchor = {});
    CStartPage& Start() { return *m_start; }
    CHelpWindow* Help() const { return m_help; }
    QToolBar& Bar() { return *m_bar; }
    /// Takes a file that was dropped on the window, or says why not.
    void TakeFile(const QString& path);

    bool eventFilter(QObject* object, QEvent* event) override;

private:
    void MakeStart();
    void MakeBar();
    void SetTips();
    void LeaveStart();
    void ShowPanes();
    static bool IsHelpKey(const QObject* object, QEvent* event);
    void Apply(const T_PREFERENCES& preferences);
    void KeepPicture();
    void KeepPlaces();
    void GiveBackPlaces();
    QAction* Named(const char* key) const;

    CMainWindow& m_window;
    QStackedWidget* m_stack = nullptr;
    CStartPage* m_start = nullptr;
    CHelpWindow* m_help = nullptr;
    QToolBar* m_bar = nullptr;
    std::vector<QDockWidget*> m_hidden; // panes of the model, while the start page stands
    long m_startRevision = -1;
    QString m_pictured; // file and revision of the latest thumbnail
};

/// Commands of the shell, among those of the tools. The desktop must outlive them.
T_COMMANDS ShellCommands(T_DESKTOP& desktop);
