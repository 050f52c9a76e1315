// The binder with real events: a small model, typed into, refused, accepted.
#include "qm_base/checkeddialog.h"
#include "qm_ui/form/dialogwindow.h"
#include "qm_ui/form/gridview.h"
#include "qm_ui/form/localnumber.h"
#include "testapp.h"

#include <QApplication>
#include <QCheckBox>
#include <QClipboard>
#include <QComboBox>
#include <QKeyEvent>
#include <QLineEdit>
#include <QLocale>
#include <QMessageBox>
#include <QScreen>
#include <QTimer>
#include <gtest/gtest.h>

namespace {

/// Two numbers in order, a flag that opens the second, a table of three numbers.
class CSpanDlg : public CCheckedDialog {
public:
    double m_low = 1.0 / 3.0, m_high = 2.0;
    bool m_both = true;
    int m_kind = 1;
    std::array<double, 3> m_values{1.5, 2.5, 3.5};

    std::vector<T_FINDING> Findings() const override
    {
        std::vector<T_FINDING> out;
        if (!(m_low < m_high)) {
            T_FINDING f;
            f.field = "high";
            f.text = f.messageKey = "low < high";
            out.push_back(f);
        }
        return out;
    }
};

void Build(CFormView& form, CSpanDlg& d)
{
    form.Number(PlainLabel("low"), Ref(d.m_low), PlainLabel("m")).name = "low";
    CFormField& high = form.Number(PlainLabel("high"), Ref(d.m_high));
    high.name = "high";
    high.enabled = [&d] { return d.m_both; };
    form.Flag(PlainLabel("both"), Ref(d.m_both)).name = "both";
    form.Choice(PlainLabel("kind"), Ref(d.m_kind),
                [] {
                    return std::vector<std::string>{"a", "b"};
                })
        .name = "kind";
    T_GRID_BINDING grid;
    grid.columns = {{PlainLabel("value"), CELL_KIND::Number, true}};
    grid.rows = [&d] { return d.m_values.size(); };
    grid.text = [&d](std::size_t r, std::size_t) { return std::to_string(d.m_values[r]); };
    grid.set = [&d](std::size_t r, std::size_t, const std::string& text) {
        const auto number = ParseLocalNumber(QString::fromStdString(text));
        if (number) d.m_values[r] = *number;
        return number ? 1 : 0;
    };
    form.Grid(grid).name = "grid";
}

void Key(QWidget* widget, int key, const QString& text = {},
         Qt::KeyboardModifiers with = Qt::NoModifier)
{
    QKeyEvent press(QEvent::KeyPress, key, with, text), release(QEvent::KeyRelease, key, with);
    QApplication::sendEvent(widget, &press);
    QApplication::sendEvent(widget, &release);
}

class DialogWindow : public testing::Test {
protected:
    DialogWindow()
    {
        NeedApp();
        QLocale::setDefault(QLocale::c());
        m_factory.Register<CSpanDlg>(PlainLabel("Span"), Build);
        m_window =
            std::make_unique<CDialogWindow>(m_factory, *m_factory.Find(m_model), m_model, nullptr);
        m_window->show();
        m_window->activateWindow();
        QApplication::processEvents();
    }
    ~DialogWindow() override { QLocale::setDefault(QLocale::c()); }
    template <class W>
    W* Widget(const char* name)
    {
        return qobject_cast<W*>(m_window->Form().Find(name)->widget);
    }
    /// Types over a field and leaves it.
    void Type(const char* name, const QString& text)
    {
        auto* edit = Widget<QLineEdit>(name);
        edit->setFocus();
        edit->selectAll();
        Key(edit, 0, text);
        Key(edit, Qt::Key_Tab);
    }

    CSpanDlg m_model;
    CViewFactory m_factory;
    std::unique_ptr<CDialogWindow> m_window;
};

} // namespace

TEST_F(DialogWindow, FieldsShowAllDigitsAndAnUntouchedOneLosesNone)
{
    EXPECT_EQ("0.3333333333333333", Widget<QLineEdit>("low")->text());
    Type("high", "5");
    EXPECT_EQ(5.0, m_model.m_high);
    EXPECT_EQ(1.0 / 3.0, m_model.m_low);
}

TEST_F(DialogWindow, ABrokenRuleMarksItsFieldWhileTyping)
{
    Type("low", "3");
    EXPECT_TRUE(m_window->Form().Find("high")->IsMarked());
    EXPECT_EQ("low < high", Widget<QLineEdit>("high")->toolTip());
    EXPECT_FALSE(m_window->Form().Find("low")->IsMarked());
    Type("low", "1");
    EXPECT_EQ(0, m_window->Form().Marks());
}

TEST_F(DialogWindow, WhatIsNoNumberIsKeptMarkedAndNotTaken)
{
    for (const char* text : {"1,5", "", "nan", "1e999", "2 m"}) {
        Type("high", text);
        EXPECT_EQ(2.0, m_model.m_high) << text;
        EXPECT_TRUE(m_window->Form().Find("high")->IsMarked()) << text;
        m_window->accept();
        EXPECT_TRUE(m_window->isVisible()) << text;
    }
    Type("high", "4");
    m_window->accept();
    EXPECT_EQ(QDialog::Accepted, m_window->result());
    EXPECT_FALSE(m_window->isVisible());
}

TEST_F(DialogWindow, ARefusalShowsItsMessageAndKeepsTheWindowOpen)
{
    Type("low", "9");
    QString shown;
    QTimer::singleShot(0, [&] {
        auto* box = qobject_cast<QMessageBox*>(QApplication::activeModalWidget());
        if (box) shown = box->text();
        if (box) box->accept();
    });
    m_window->accept();
    EXPECT_EQ("low < high", shown);
    EXPECT_TRUE(m_window->isVisible());
    ASSERT_EQ(1U, m_model.Messages().size());
}

TEST_F(DialogWindow, ACommaLocaleShowsAndTakesTheComma)
{
    QLocale::setDefault(QLocale(QLocale::Italian, QLocale::Italy));
    m_window->Form().Refresh();
    EXPECT_EQ("0,3333333333333333", Widget<QLineEdit>("low")->text());
    Type("high", "2,75");
    EXPECT_EQ(2.75, m_model.m_high);
    Type("high", "2.25");
    EXPECT_EQ(2.25, m_model.m_high);
    Type("high", "1.000,5"); // digits in groups
    EXPECT_EQ(2.25, m_model.m_high);
    EXPECT_TRUE(m_window->Form().Find("high")->IsMarked());
}

TEST_F(DialogWindow, FlagsAndChoicesReachTheModelAndOpenFields)
{
    EXPECT_TRUE(Widget<QLineEdit>("high")->isEnabled());
    Key(Widget<QCheckBox>("both"), Qt::Key_Space, " ");
    EXPECT_FALSE(m_model.m_both);
    EXPECT_FALSE(Widget<QLineEdit>("high")->isEnabled());
    Key(Widget<QComboBox>("kind"), Qt::Key_Up);
    EXPECT_EQ(0, m_model.m_kind);
}

TEST_F(DialogWindow, TablesAreEditedCopiedAndPastedWithFullPrecision)
{
    auto* grid = static_cast<CGridView*>(m_window->Form().Find("grid")->widget);
    grid->setCurrentIndex(grid->Model().index(0, 0));
    grid->edit(grid->currentIndex());
    auto* editor = grid->findChild<QLineEdit*>();
    ASSERT_NE(nullptr, editor);
    editor->selectAll();
    Key(editor, 0, "0.1234567890123");
    Key(editor, Qt::Key_Tab);
    EXPECT_EQ(0.1234567890123, m_model.m_values[0]);
    grid->setCurrentIndex(grid->Model().index(1, 0));
    QGuiApplication::clipboard()->setText("7\r\n8\r\n");
    Key(grid, Qt::Key_V, {}, Qt::ControlModifier);
    EXPECT_EQ((std::array<double, 3>{0.1234567890123, 7, 8}), m_model.m_values);
    grid->selectAll();
    Key(grid, Qt::Key_C, {}, Qt::ControlModifier);
    EXPECT_EQ("0.123457\n7.000000\n8.000000", QGuiApplication::clipboard()->text());
}

TEST_F(DialogWindow, AFormLargerThanTheScreenScrolls)
{
    CViewFactory factory;
    factory.Register<CSpanDlg>(PlainLabel("Tall"), [](CFormView& form, CSpanDlg& d) {
        for (int i = 0; i < 200; ++i)
            form.Number(PlainLabel("low"), Ref(d.m_low));
    });
    CDialogWindow window(factory, *factory.Find(m_model), m_model, nullptr);
    window.show();
    QApplication::processEvents();
    EXPECT_LE(window.height(), window.screen()->availableSize().height());
    EXPECT_GT(window.Form().height(), window.height());
}

TEST_F(DialogWindow, PicturesGiveRoomBeforeAFormWithAWrappedTextScrolls)
{
    CViewFactory factory;
    factory.Register<CSpanDlg>(PlainLabel("Pictures"), [](CFormView& form, CSpanDlg&) {
        form.Columns();
        std::string words;
        for (int i = 0; i < 40; ++i)
            words += "some words ";
        form.Note(PlainLabel(words)).name = "words";
        form.NextColumn(1);
        form.Picture([] { return T_PLOT(); });
        form.EndColumns();
        form.Picture([] { return T_PLOT(); });
    });
    CDialogWindow window(factory, *factory.Find(m_model), m_model, nullptr);
    window.show();
    window.resize(1000, 620); // pictures need 240 each, and would like 480
    QApplication::processEvents();
    EXPECT_LT(window.Form().height(), window.height());
    QWidget* const words = window.Form().Find("words")->widget;
    EXPECT_GE(words->height(), words->heightForWidth(words->width()));
}
