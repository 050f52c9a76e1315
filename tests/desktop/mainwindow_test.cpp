#include "desktoptest.h"
#include "explorerpane.h"

#include <QAction>
#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <QLineEdit>
#include <QLocale>
#include <QSlider>

using namespace desktop_test;

namespace {

class MainWindow : public DesktopTest {};

CAnswers::STEP PressSave()
{
    return CAnswers::Press(QMessageBox::Yes);
}

} // namespace

TEST_F(MainWindow, AnEditedCellIsOneUndoableStepAndSavedOnRequest)
{
    ASSERT_TRUE(Open("cable-stayed-bridge"));
    m_main->Explorer().Choose(EXPLORER_TABLE::Nodes);
    CGridView& table = m_main->Explorer().Table();
    const QString before = table.Model().index(1, 1).data().toString();
    EXPECT_EQ("10", before);
    EXPECT_TRUE(table.Model().setData(table.Model().index(1, 1), "10.25", Qt::EditRole));
    EXPECT_EQ(10.25, m_main->Doc().Data().Model().nodes.at(2).xyz[0]);
    EXPECT_TRUE(m_main->windowTitle().contains('*'));
    Run("IDS_QM_UI_UNDO");
    EXPECT_EQ(10.0, m_main->Doc().Data().Model().nodes.at(2).xyz[0]);
    Run("IDS_QM_UI_REDO");
    AnswerFileName(File("bridge.qmdb"));
    Run("IDS_QM_UI_SAVE"); // a case file is saved as a model file
    EXPECT_TRUE(QFileInfo::exists(File("bridge.qmdb")));
    EXPECT_FALSE(m_main->windowTitle().contains('*'));
    EXPECT_TRUE(m_main->Messages().contains("bridge.qmdb"));
}

TEST_F(MainWindow, ClosingWithEditsAsksAndNeverLosesThemSilently)
{
    ASSERT_TRUE(Open("cable-stayed-bridge"));
    CGridView& table = m_main->Explorer().Table();
    ASSERT_TRUE(table.Model().setData(table.Model().index(1, 1), "11", Qt::EditRole));
    {
        CAnswers answers({CAnswers::Press(QMessageBox::Cancel)});
        EXPECT_FALSE(m_main->close());
        EXPECT_TRUE(m_main->isVisible());
    }
    AnswerFileName(File("kept.qmdb"));
    CAnswers answers({PressSave()});
    EXPECT_TRUE(m_main->close());
    EXPECT_TRUE(QFileInfo::exists(File("kept.qmdb")));
}

TEST_F(MainWindow, BadCellsAndUsedRecordsAreRefusedWithTheirReason)
{
    ASSERT_TRUE(Open("cable-stayed-bridge"));
    CGridView& table = m_main->Explorer().Table();
    struct T_BAD {
        int column;
        const char* text;
    };
    for (const T_BAD bad : {T_BAD{1, "1,5"}, {1, ""}, {1, "nan"}, {9, "-1"}}) {
        CAnswers answers({CAnswers::Accept()});
        EXPECT_FALSE(
            table.Model().setData(table.Model().index(1, bad.column), bad.text, Qt::EditRole));
        EXPECT_TRUE(answers.m_texts.value(0).contains("is no value of")) << bad.text;
    }
    table.setCurrentIndex(table.Model().index(0, 0));
    CAnswers answers({CAnswers::Accept()});
    Run("IDS_QM_UI_DELETE_RECORD");
    EXPECT_TRUE(answers.m_texts.value(0).contains("element 1"));
    EXPECT_EQ(20U, m_main->Doc().Data().Model().nodes.size());
    EXPECT_FALSE(m_main->Doc().Data().IsModified());
}

TEST_F(MainWindow, ABlockPastedFromASpreadsheetIsWholeOrNothing)
{
    ASSERT_TRUE(Open("cable-stayed-bridge"));
    CGridView& table = m_main->Explorer().Table();
    table.setCurrentIndex(table.Model().index(1, 1));
    EXPECT_EQ(1, table.PasteText("1.5\t2.5\r\n3.5\t4.5\r\n"));
    const auto& nodes = m_main->Doc().Data().Model().nodes;
    EXPECT_EQ(4.5, nodes.at(3).xyz[1]);
    Run("IDS_QM_UI_UNDO"); // one step
    EXPECT_EQ(10.0, nodes.at(2).xyz[0]);
    for (const char* block : {"1\t2\n3\tx", "1\n\n", "1\t2\n3", ""}) {
        CAnswers answers({CAnswers::Accept()});
        EXPECT_EQ(0, table.PasteText(block)) << block;
        EXPECT_EQ(10.0, nodes.at(2).xyz[0]) << block;
    }
    std::string tall;
    for (int i = 0; i < 30; ++i)
        tall += "1\n";
    CAnswers answers({CAnswers::Accept()});
    EXPECT_EQ(0, table.PasteText(QString::fromStdString(tall)));
}

TEST_F(MainWindow, DamagedForeignNewerAndMissingFilesAreRefusedAndTheModelStays)
{
    ASSERT_TRUE(Open("cable-stayed-bridge"));
    const auto write = [&](const char* name, const QByteArray& bytes) {
        QFile file(File(name));
        ASSERT_TRUE(file.open(QIODevice::WriteOnly));
        file.write(bytes);
    };
    write("empty.qmdb", "");
    write("foreign.qmdb", "not a model");
    write("broken.json", "{\"format\": ");
    for (const char* name : {"empty.qmdb", "foreign.qmdb", "broken.json", "missing.qmdb"}) {
        CAnswers answers({CAnswers::Accept()});
        EXPECT_EQ(0, m_main->Open(File(name))) << name;
        EXPECT_TRUE(answers.m_texts.value(0).contains(name)) << name;
        EXPECT_EQ(20U, m_main->Doc().Data().Model().nodes.size()) << name;
    }
}

TEST_F(MainWindow, TheFrameIsShownUnderEveryStepOfAPushover)
{
    ASSERT_TRUE(Open("rc-frame-3-storey"));
    CFramePane& frame = m_main->Frame();
    const auto& sources = frame.Sources();
    const auto it = std::ranges::find_if(
        sources, [](const auto& s) { return s.kind == T_SHAPE_SOURCE::KIND::Pushover; });
    ASSERT_NE(sources.end(), it);
    ASSERT_TRUE(frame.Show(*it, 1));
    // Displacements at the control node are those of the curve, step by step.
    const auto& push = m_main->Doc().Data().Model().pushovers.at(it->key);
    const auto& nodes = frame.View().Picture().scene->nodes;
    const auto n = static_cast<std::size_t>(
        std::ranges::find(nodes, push.controlNode, &T_SCENE_NODE::id) - nodes.begin());
    for (const int step : {1, it->steps / 2, it->steps}) {
        frame.Slider().setValue(step);
        double u = 0.0;
        ASSERT_TRUE(m_main->Doc().Post().SelectPushover(it->key));
        ASSERT_TRUE(m_main->Doc().Post().SelectStep(step));
        ASSERT_TRUE(m_main->Doc().Post().GetDispNew(push.controlNode, u));
        EXPECT_EQ(u, (*frame.View().Picture().displacement)[n][0]);
        EXPECT_EQ(3U, frame.View().Picture().drifts.size());
    }
}

TEST_F(MainWindow, LanguageChangesAtRunTime)
{
    EXPECT_EQ("&Save", m_main->Action("IDS_QM_UI_SAVE")->text());
    Run("IDS_QM_UI_ITALIAN");
    EXPECT_EQ("&Salva", m_main->Action("IDS_QM_UI_SAVE")->text());
    Run("IDS_QM_UI_ENGLISH");
    EXPECT_EQ("&Save", m_main->Action("IDS_QM_UI_SAVE")->text());
}

TEST_F(MainWindow, PicturesOfTheFrameAreWrittenInEveryFormat)
{
    ASSERT_TRUE(Open("cable-stayed-bridge"));
    for (const char* name : {"a.svg", "a.pdf", "a.png", "a.jpg", "a.bmp"}) {
        AnswerFileName(File(name));
        Run("IDS_QM_UI_EXPORT_PICTURE");
        EXPECT_GT(QFileInfo(File(name)).size(), 1000) << name;
    }
    AnswerFileName(File("a.gif"));
    CAnswers answers({CAnswers::Accept()});
    Run("IDS_QM_UI_EXPORT_PICTURE");
    EXPECT_TRUE(answers.m_texts.value(0).contains("a.gif"));
}

TEST_F(MainWindow, EditsOfASessionThatCrashedAreOfferedAndRecovered)
{
    ASSERT_TRUE(Open("cable-stayed-bridge"));
    AnswerFileName(File("bridge.qmdb"));
    Run("IDS_QM_UI_SAVE_AS");
    CGridView& table = m_main->Explorer().Table();
    ASSERT_TRUE(table.Model().setData(table.Model().index(1, 1), "12.5", Qt::EditRole));
    m_main->Desktop().frame.OnTick(1e6);
    m_main->Desktop().frame.OnTick(2e6);
    ASSERT_TRUE(QFileInfo::exists(File("bridge.qmdb.auto-1")));
    for (const bool wanted : {false, true}) {
        m_main.reset(); // without closing: as a crash leaves it
        m_main = std::make_unique<CMainWindow>();
        CAnswers answers({CAnswers::Press(wanted ? QMessageBox::Yes : QMessageBox::No)});
        ASSERT_TRUE(m_main->Open(File("bridge.qmdb")));
        const double x = m_main->Doc().Data().Model().nodes.at(2).xyz[0];
        EXPECT_EQ(wanted ? 12.5 : 10.0, x);
    }
    EXPECT_TRUE(m_main->windowTitle().contains('*'));
    Run("IDS_QM_UI_SAVE");
    EXPECT_FALSE(QFileInfo::exists(File("bridge.qmdb.auto-1")));
}

TEST_F(MainWindow, AFileThatCanNotBeWrittenIsToldAndTheEditsStay)
{
    ASSERT_TRUE(Open("cable-stayed-bridge"));
    CGridView& table = m_main->Explorer().Table();
    ASSERT_TRUE(table.Model().setData(table.Model().index(1, 1), "12.5", Qt::EditRole));
    QDir().mkpath(File("folder.qmdb"));
    for (const char* name : {"folder.qmdb", "no/such/folder/a.qmdb"}) {
        AnswerFileName(File(name));
        CAnswers answers({CAnswers::Accept()});
        Run("IDS_QM_UI_SAVE_AS");
        EXPECT_TRUE(answers.m_texts.value(0).contains(name)) << name;
        EXPECT_TRUE(m_main->Doc().Data().IsModified()) << name;
    }
}

TEST_F(MainWindow, TablesFollowTheLocaleOfTheDesktop)
{
    ASSERT_TRUE(Open("cable-stayed-bridge"));
    QLocale::setDefault(QLocale(QLocale::Italian, QLocale::Italy));
    CGridView& table = m_main->Explorer().Table();
    ASSERT_TRUE(table.Model().setData(table.Model().index(1, 1), "12,5", Qt::EditRole));
    EXPECT_EQ("12,5", table.Model().index(1, 1).data().toString());
    table.setCurrentIndex(table.Model().index(2, 1));
    EXPECT_EQ(1, table.PasteText("7,25\t1"));
    EXPECT_EQ(7.25, m_main->Doc().Data().Model().nodes.at(3).xyz[0]);
    EXPECT_EQ(1.0, m_main->Doc().Data().Model().nodes.at(3).xyz[1]);
    QLocale::setDefault(QLocale::c());
}
