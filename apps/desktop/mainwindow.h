// The main window: tree, properties, tables, frame, messages, menus.
#pragma once

#include "browser.h"
#include "command.h"
#include "desktop.h"
#include "framepane.h"

#include <QElapsedTimer>
#include <QMainWindow>

#include <memory>

class CResultsPane;
class CShell;
class QAction;
class QLabel;
class QMenu;
class QPlainTextEdit;

class CMainWindow : public QMainWindow {
public:
    CMainWindow();
    ~CMainWindow() override;

    /// Offers what a session that ended without saving has left, among the recent files.
    int OfferRecovery();
    /// Opens a file as the menu does. 1 opened.
    int Open(const QString& path);
    /// Everything is read again from the document.
    void Refresh();
    /// "en" or "it".
    void SetLanguage(const std::string& code);

    CDBDoc& Doc() { return m_doc; }
    CFramePane& Frame() { return *m_framePane; }
    CExplorerPane& Explorer() { return m_browser->Table(); }
    CBrowser& Browser() { return *m_browser; }
    T_DESKTOP& Desktop() { return m_desktop; }
    CShell& Shell() { return *m_shell; }
    /// The action of a command by its key, or null.
    QAction* Action(const char* key) const;
    QString Messages() const;

protected:
    void closeEvent(QCloseEvent* event) override;

private:
    T_COMMANDS FileCommands();
    T_COMMANDS EditCommands();
    T_COMMANDS ViewCommands();
    T_COMMANDS WindowCommands();
    void MakeMenus();
    void MakePanes();
    void ShowTexts();
    void UpdateActions();
    void AddRecent(const QString& path);
    void ShowRecent();
    void SaveAs();
    void Analyse();
    void ExportPicture();
    QString AskSavePath();
    static std::string UntitledPath();

    CViewFactory m_factory;
    CDBDoc m_doc;
    CMainFrame m_frame{m_doc, UntitledPath()};
    CDialogView m_view{m_factory, this};
    T_DESKTOP m_desktop;
    CFrameScene m_scene{m_doc};
    CSelection m_selection;
    std::unique_ptr<CBrowser> m_browser;

    QElapsedTimer m_clock;
    CFramePane* m_framePane = nullptr;
    CResultsPane* m_results = nullptr;
    QPlainTextEdit* m_messages = nullptr;
    QLabel* m_units = nullptr;
    QMenu* m_recent = nullptr;
    T_COMMANDS m_commands;
    std::vector<std::pair<QAction*, std::size_t>> m_actions; // of m_commands
    std::vector<std::pair<QMenu*, const char*>> m_menus;
    std::unique_ptr<CShell> m_shell; // once the panes are made; it goes before them
};
