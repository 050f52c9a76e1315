// Real events for the windows of the desktop, without a screen.
#pragma once

#include "mainwindow.h"

#include "qm_ui/form/dialogwindow.h"
#include "qm_ui/form/gridview.h"

#include <QMessageBox>
#include <QTimer>
#include <gtest/gtest.h>

#include <functional>
#include <string>
#include <vector>

namespace desktop_test {

/// Path of an example's case file.
QString Example(const char* name);

/// Runs the command line program; what it printed.
QByteArray Program(const QStringList& arguments);

/// Lets what has come in be handled.
void Settle();
/// A key to a widget: with a text, or by its code.
void Key(QWidget* widget, int key, const QString& text = {},
         Qt::KeyboardModifiers with = Qt::NoModifier);
/// Types over an edit field and leaves it.
void Type(QWidget* field, const QString& text);
/// Clicks with the left button, in the middle.
void Click(QWidget* widget);
/// Chooses an entry of a list of choices, as by the keyboard.
void ChooseIndex(QWidget* box, int index);

/// The widget of a field, its page in front; the table of one; whether a rule marks it.
QWidget* Field(CDialogWindow& window, const std::string& name);
CGridView& Grid(CDialogWindow& window, const std::string& name);
bool IsMarked(CDialogWindow& window, const std::string& name);
QString TextAt(CDialogWindow& window, const std::string& name);
/// Types over a field that is open; presses a button or turns a check box by the keyboard.
void Enter(CDialogWindow& window, const std::string& name, const QString& text);
void Push(CDialogWindow& window, const std::string& name);
/// What a table shows; takes a value as typed, a flag as its check state.
QString Cell(QAbstractItemModel& table, int row, int column);
bool SetCell(QAbstractItemModel& table, int row, int column, const QVariant& value);

/// Answers the boxes and dialogs that come up while it lives, one step after the other; each step
/// gets the modal window. A window without a step left is closed and fails the test.
class CAnswers : public QObject {
public:
    using STEP = std::function<void(QWidget& window)>;
    explicit CAnswers(std::vector<STEP> steps);
    ~CAnswers() override;
    /// Texts of the message boxes so far.
    QStringList m_texts;
    std::size_t Left() const { return m_steps.size() - m_next; }

    /// Steps: press a button by its text or standard role; run anything on a dialog window.
    static STEP Press(QMessageBox::StandardButton button);
    static STEP Accept();
    static STEP Reject();
    /// Fills a dialog's form, then accepts it (accept) or leaves it open to the next step.
    static STEP Fill(std::function<void(CDialogWindow&)> fill, bool accept = true);

private:
    void Look();
    std::vector<STEP> m_steps;
    std::size_t m_next = 0;
    QWidget* m_at = nullptr; // window whose step is under way
    QTimer* m_timer;
};

/// A main window on a fresh settings folder, with a model open.
class DesktopTest : public testing::Test {
protected:
    DesktopTest();
    ~DesktopTest() override;
    int Open(const char* example) { return m_main->Open(Example(example)); }
    const T_MODEL& Model() { return m_main->Doc().Data().Model(); }
    /// Runs a command by its key, as its menu entry does.
    void Run(const char* key);
    QString File(const char* name) const { return m_folder + "/" + name; }

    QString m_folder; // of this test alone
    std::unique_ptr<CMainWindow> m_main;
};

} // namespace desktop_test
