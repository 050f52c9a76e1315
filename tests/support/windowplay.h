// Plays scenes on the windows that come up, and looks at what they show.
#pragma once

#include <QPointer>

#include "desktoptest.h"

#include "qm_ui/plot/plotdata.h"

#include <QElapsedTimer>

namespace desktop_test {

using ACT = std::function<void(CDialogWindow&)>;

/// A window that is expected, what makes it ready, and what is done on it.
struct T_SCENE {
    QString title;
    ACT act;
    std::function<bool(CDialogWindow&)> ready{};
};

/// Runs something once the events that are there have been handled.
void Later(QWidget* widget, std::function<void()> act);

/// Plays the scenes one after the other, each when its window is the active one; answers message
/// boxes meanwhile. Unlike one with fixed steps it waits while an analysis is shown.
class CPlay : public QObject {
public:
    explicit CPlay(std::vector<T_SCENE> scenes);
    ~CPlay() override;
    QStringList m_texts; // of the message boxes
    QMessageBox::StandardButton m_answer = QMessageBox::Yes;

private:
    void Look();
    void Answer(QMessageBox& box);

    std::vector<T_SCENE> m_scenes;
    std::size_t m_next = 0;
    QPointer<QMessageBox> m_box;       // answered last
    const QWidget* m_acting = nullptr; // whose act runs: work in it may look after events
    bool m_pending = false;
    QTimer m_timer;
    QElapsedTimer m_clock;
};

/// Clicks the button with this object name.
ACT Press(const char* key);
void Cancel(CDialogWindow& w);

/// The index-th table of the window.
QAbstractItemModel& Table(CDialogWindow& w, int index = 0);
/// Chooses a row of the first table.
void ChooseRow(CDialogWindow& w, int row);
/// The plot that the window shows, or an empty one.
const T_PLOT& Picture(CDialogWindow& w);
/// A note of the window has such a text.
bool Says(CDialogWindow& w, const QString& text);

} // namespace desktop_test
