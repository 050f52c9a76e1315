// The windows that make models, with real events.
#include "windowplay.h"

#include "pushoverwindow.h"
#include "tempfolder.h"

#include "qm_rps/create/spectrumedit.h"

#include <QApplication>
#include <QClipboard>
#include <QPlainTextEdit>

using namespace desktop_test;

namespace {

class NewWindows : public DesktopTest {
protected:
    CPushOverWindow& Curve() { return CPushOverWindow::Show(m_main->Desktop()); }
};

/// As Ctrl+V does.
void Paste(CDialogWindow& w, const char* field, const QString& text)
{
    QApplication::clipboard()->setText(text);
    QWidget* edit = Field(w, field);
    edit->setFocus();
    qobject_cast<QPlainTextEdit*>(edit)->selectAll();
    Key(edit, Qt::Key_V, {}, Qt::ControlModifier);
    Settle();
}

} // namespace

TEST_F(NewWindows, APastedCurveIsEvaluatedAndIsTheCommandsCase)
{
    QString command;
    const auto fill = [&](CDialogWindow& w) {
        Paste(w, "text", "d\tV\n0\t0\n12\t240\n40\t610\n30\t700\n");
        EXPECT_TRUE(IsMarked(w, "text")); // 30 after 40
        EXPECT_TRUE(Says(w, "line 5"));
        Paste(w, "text", "d\tV\n0\t0\n12\t240\n40\t610\n130\t742\n");
        EXPECT_FALSE(IsMarked(w, "text"));
        EXPECT_TRUE(IsMarked(w, "heights"));
        ChooseIndex(Field(w, "length"), static_cast<int>(LENGTH_UNIT::mm));
        Enter(w, "heights", "3x3000");
        Enter(w, "masses", "3x100");
        EXPECT_TRUE(Says(w, "300 t"));
        Enter(w, "ag", "0");
        EXPECT_TRUE(IsMarked(w, "ag"));
        Enter(w, "ag", "0.3");
        EXPECT_EQ(0, w.Form().Marks());
        Key(Field(w, "text"), Qt::Key_Return); // a new line, not the button
        EXPECT_TRUE(w.isVisible());
        EXPECT_EQ(4, Grid(w, "points").Model().rowCount());
        command = TextAt(w, "command");
    };
    CAnswers answers({CAnswers::Fill(fill)});
    Run("IDS_QM_NEW_CURVE_MENU");
    ASSERT_EQ(1U, Model().evaluations.size());
    EXPECT_EQ("PX EC8/OPCM", Curve().Model().m_settings.name);
    EXPECT_EQ(3U, Curve().Model().Shown().Result().limitStates.size()); // it was evaluated
    const QString window = File("window.json"), typed = File("curve.txt");
    T_FILE_ERROR error;
    ASSERT_TRUE(m_main->Doc().ExportCase(window.toStdString(), error)) << error.text;
    WriteText(typed.toStdString(), "d\tV\n0\t0\n12\t240\n40\t610\n130\t742\n");
    QStringList words = command.split(' ').mid(1);
    words[words.indexOf("curve.txt")] = typed;
    words.last() = File("command.json");
    (void)Program(words);
    EXPECT_EQ(ReadText(window.toStdString()), ReadText(words.last().toStdString()));
}

TEST_F(NewWindows, AFrameIsMadeAndAnalysed)
{
    const auto fill = [](CDialogWindow& w) {
        Enter(w, "baysX", "2x5");
        Enter(w, "baysY", "4");
        Enter(w, "columns", "HEB 20");
        EXPECT_TRUE(IsMarked(w, "columns"));
        EXPECT_FALSE(IsMarked(w, "grade.columns"));
        Enter(w, "columns", "0.4x0.4");
        EXPECT_EQ("Dead, floors (kN/m)", w.Form().Find("dead")->caption());
        EXPECT_EQ(5, Grid(w, "levels").Model().rowCount()); // ground, three storeys, sum
        EXPECT_TRUE(TextAt(w, "command").startsWith("qm-rps new frame"));
    };
    CAnswers answers({CAnswers::Fill(fill)});
    Run("IDS_QM_NEW_FRAME_MENU");
    EXPECT_EQ(24U, Model().nodes.size());
    EXPECT_EQ(6U, Model().modes.size());
    EXPECT_EQ(8U, Model().pushovers.size());
    Run("IDS_QM_UI_ANALYSE");
    EXPECT_TRUE(m_main->Doc().IsPostMode());
}

TEST_F(NewWindows, ASpectrumIsEditedWithItsTableAndUndone)
{
    ASSERT_TRUE(Open("first-steps"));
    const T_SPFC_D before = Model().spectra.at(1);
    const auto edit = [](CDialogWindow& w) {
        ASSERT_EQ("ATC", TextAt(w, "name"));
        Enter(w, "SXS", "0.5");
        EXPECT_EQ("0.2", TextAt(w, "Ca")); // SXS = 2.5 Ca
        EXPECT_TRUE(Says(w, "TS ="));
        ChooseIndex(Field(w, "kind"), CSpectrumEdit::User);
        QAbstractItemModel& table = Grid(w, "T").Model();
        EXPECT_TRUE(SetCell(table, 1, 0, "3")); // above the next period
        EXPECT_TRUE(IsMarked(w, "T"));
        EXPECT_TRUE(SetCell(table, 1, 0, "0.2"));
        Enter(w, "name", "site");
    };
    CAnswers answers({CAnswers::Fill(edit)});
    Run("IDS_QM_NEW_SPECTRUM_MENU");
    EXPECT_EQ("site", Model().spectra.at(1).name);
    EXPECT_EQ("site", Model().evaluations.at(1).spectrum);
    Run("IDS_QM_UI_UNDO");
    EXPECT_EQ(before, Model().spectra.at(1));
    EXPECT_EQ("ATC", Model().evaluations.at(1).spectrum);
}

TEST_F(NewWindows, StoreysAreMadeFromLevels)
{
    ASSERT_TRUE(Open("space-frame-3d"));
    const T_TABLE<T_STOR_D> before = Model().storeys;
    const auto edit = [](CDialogWindow& w) {
        QAbstractItemModel& table = Grid(w, "names").Model();
        EXPECT_EQ(4, table.rowCount());
        EXPECT_TRUE(SetCell(table, 0, 1, "Roof"));
    };
    CAnswers answers({CAnswers::Fill(edit)});
    Run("IDS_QM_NEW_STOREYS_MENU");
    ASSERT_EQ(3U, Model().storeys.size());
    EXPECT_EQ("Roof", Model().storeys.at(3).name);
    EXPECT_EQ(before.at(3).nodes, Model().storeys.at(3).nodes);
    EXPECT_EQ(before.at(1), Model().storeys.at(1));
}

TEST_F(NewWindows, ModesAreTypedAndFound)
{
    ASSERT_TRUE(Open("space-frame-3d"));
    const auto edit = [this](CDialogWindow& w) {
        Enter(w, "count", "3");
        Push(w, "find");
        EXPECT_EQ(3, Grid(w, "modes").Model().rowCount());
        Enter(w, "period", "0.9");
        Enter(w, "shape", "0.3, 0.7, 1");
        Push(w, "add");
        EXPECT_EQ(4, Grid(w, "modes").Model().rowCount());
        EXPECT_EQ(0.7, Model().modes.at(4).shape.at(205)[0]);
    };
    CAnswers answers({CAnswers::Fill(edit)});
    Run("IDS_QM_MODES_MENU");
    EXPECT_NEAR(0.780, Model().modes.at(1).period, 5e-4); // that of the example's README
    Run("IDS_QM_UI_UNDO");
    EXPECT_EQ(3U, Model().modes.size());
}
