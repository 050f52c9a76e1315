// The guide in a window of its own.
#pragma once

#include <QMainWindow>

class QAction;
class QLineEdit;
class QListWidget;
class QTextBrowser;

/// Pages on the left, the text with its links and pictures on the right; back and forward, search.
/// State: the page on show. One for each main window.
class CHelpWindow : public QMainWindow {
public:
    explicit CHelpWindow(QWidget* parent);

    /// Shows the section with this anchor; where there is none, the first page. False: no page of
    /// the guide is installed.
    bool ShowTopic(const QString& anchor);
    void Retranslate();
    QTextBrowser& Browser() { return *m_text; }

private:
    void MakeBar();
    void ShowPage(const QString& path, const QString& anchor);
    void GoTo(const QString& anchor);
    void FollowPage();
    void Find();

    QListWidget* m_pages;
    QTextBrowser* m_text;
    QLineEdit* m_search;
    QAction *m_back, *m_forward;
};
