// The page that stands in place of the frame while no model is open.
#pragma once

#include <QStringList>
#include <QWidget>

#include <deque>
#include <functional>
#include <vector>

class CCardGrid;
class QAction;
class QLabel;
class QToolButton;
class QVBoxLayout;

/// What the page asks for.
struct T_START_CALLS {
    std::function<void(const QString& path)> open;     // a recent file
    std::function<void(const QString& path)> openCopy; // an example
    std::function<QStringList()> recent;
    std::function<void(const QString& path)> forget; // take it off the recent files
    /// Actions that begin a model, in the order of their buttons; null: there is no such command.
    std::function<std::vector<QAction*>()> begin;
};

class CStartPage : public QWidget {
public:
    CStartPage(T_START_CALLS calls, QWidget* parent);

    /// Recent files again, and the texts.
    void Refresh();
    /// Pictures of examples are still to be made.
    bool IsDrawing() const { return m_isStale || !m_missing.empty(); }
    const CCardGrid& Recent() const { return *m_recent; }
    const CCardGrid& Examples() const { return *m_examples; }

protected:
    void showEvent(QShowEvent* event) override;

private:
    void MakeButtons();
    void ShowCards();
    void ShowRecent();
    void ShowExamples();
    void DrawNext();

    T_START_CALLS m_calls;
    QLabel *m_title, *m_subtitle, *m_drop;
    QVBoxLayout* m_buttons;
    std::vector<QToolButton*> m_made;
    CCardGrid *m_recent, *m_examples;
    struct T_MISSING { // an example without its picture
        std::size_t card;
        QString path;
    };
    std::deque<T_MISSING> m_missing;
    bool m_isStale = true; // cards are to be made when the page is seen
};
