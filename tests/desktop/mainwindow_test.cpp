#include "desktoptest.h"
#include "explorerpane.h"
#include "tempfolder.h"

#include <QAction>
#include <QDir>
#include <QDockWidget>
#include <QFileInfo>
#include <QLocale>
#include <QMenu>
#include <QMenuBar>
#include <QSlider>

using namespace desktop_test;

namespace {

class MainWindow : public DesktopTest {
protected:
    MainWindow() { EXPECT_TRUE(Open("cable-stayed-bridge")); }
    CGridView& Nodes() { return m_main->Explorer().Table(); }
    /// Types X of node 2, which is 10.
    void MoveNode2(const char* x) { ASSERT_TRUE(SetCell(Nodes().Model(), 1, 1, x)); }
    double X2() { return Model().nodes.at(2).xyz[0]; }
};

} // namespace

TEST_F(MainWindow, AnEditedCellIsOneUndoableStepAndSavedOnRequest)
{
    m_main->Explorer().Choose(EXPLORER_TABLE::Nodes);
    EXPECT_EQ("10", Cell(Nodes().Model(), 1, 1));
    MoveNode2("10.25");
    EXPECT_EQ(10.25, X2());
    EXPECT_TRUE(m_main->windowTitle().contains('*'));
    Run("IDS_QM_UI_UNDO");
    EXPECT_EQ(10.0, X2());
    EXPECT_FALSE(m_main->windowTitle().contains('*')) << "as it was opened";
    Run("IDS_QM_UI_REDO");
    EXPECT_TRUE(m_main->windowTitle().contains('*'));
    AnswerFileName(File("bridge.qmdb"));
    Run("IDS_QM_UI_SAVE"); // a case file is saved as a model file
    EXPECT_TRUE(QFileInfo::exists(File("bridge.qmdb")));
    EXPECT_FALSE(m_main->windowTitle().contains('*'));
    EXPECT_TRUE(m_main->Messages().contains("bridge.qmdb"));
    Run("IDS_QM_UI_UNDO"); // away from what was saved
    EXPECT_TRUE(m_main->windowTitle().contains('*'));
    Run("IDS_QM_UI_REDO");
    EXPECT_FALSE(m_main->windowTitle().contains('*'));
}

TEST_F(MainWindow, NoTwoCommandsShareAKeyOrALetter)
{
    for (const char* language : {"en", "it"}) {
        m_main->SetLanguage(language);
        QStringList keys;
        for (const QAction* menu : m_main->menuBar()->actions()) {
            const QString title = menu->text();
            keys << "Alt+" + title.mid(title.indexOf('&') + 1, 1).toUpper();
            for (const QAction* action : menu->menu()->actions())
                if (!action->shortcut().isEmpty()) keys << action->shortcut().toString();
        }
        EXPECT_GT(keys.size(), 20);
        EXPECT_EQ(0, keys.removeDuplicates()) << language;
    }
    m_main->SetLanguage("en");
}

TEST_F(MainWindow, AClosedPanelComesBackFromTheMenu)
{
    auto* panel = m_main->findChild<QDockWidget*>("IDS_QM_UI_EXPLORER");
    ASSERT_TRUE(panel);
    panel->close();
    EXPECT_TRUE(panel->isHidden());
    Run("IDS_QM_UI_EXPLORER");
    EXPECT_FALSE(panel->isHidden());
}

TEST_F(MainWindow, ClosingWithEditsAsksAndNeverLosesThemSilently)
{
    MoveNode2("11");
    {
        CAnswers answers({CAnswers::Press(QMessageBox::Cancel)});
        EXPECT_FALSE(m_main->close());
        EXPECT_TRUE(m_main->isVisible());
    }
    AnswerFileName(File("kept.qmdb"));
    CAnswers answers({CAnswers::Press(QMessageBox::Yes)});
    EXPECT_TRUE(m_main->close());
    EXPECT_TRUE(QFileInfo::exists(File("kept.qmdb")));
}

TEST_F(MainWindow, BadCellsAndUsedRecordsAreRefusedWithTheirReason)
{
    for (const char* text : {"1,5", "", "nan"}) {
        CAnswers answers({CAnswers::Accept()});
        EXPECT_FALSE(SetCell(Nodes().Model(), 1, 1, text));
        EXPECT_TRUE(answers.m_texts.value(0).contains("is no value of")) << text;
    }
    Nodes().setCurrentIndex(Nodes().Model().index(0, 0));
    CAnswers answers({CAnswers::Accept()});
    Run("IDS_QM_UI_DELETE_RECORD");
    EXPECT_TRUE(answers.m_texts.value(0).contains("element 1"));
    EXPECT_EQ(20U, Model().nodes.size());
    EXPECT_FALSE(m_main->Doc().Data().IsModified());
}

TEST_F(MainWindow, ABlockPastedFromASpreadsheetIsWholeOrNothing)
{
    Nodes().setCurrentIndex(Nodes().Model().index(1, 1));
    EXPECT_EQ(1, Nodes().PasteText("1.5\t2.5\r\n3.5\t4.5\r\n"));
    EXPECT_EQ(4.5, Model().nodes.at(3).xyz[1]);
    Run("IDS_QM_UI_UNDO"); // one step
    for (const QString& block : {QString("1\t2\n3\tx"), QString("1\n").repeated(30)}) {
        CAnswers answers({CAnswers::Accept()});
        EXPECT_EQ(0, Nodes().PasteText(block)) << block.toStdString();
        EXPECT_EQ(10.0, X2());
    }
    QLocale::setDefault(QLocale::Italian);
    EXPECT_EQ(1, Nodes().PasteText("12,5\t1"));
    EXPECT_EQ(12.5, X2());
    EXPECT_EQ("12,5", Cell(Nodes().Model(), 1, 1));
}

TEST_F(MainWindow, DamagedForeignAndMissingFilesAreRefusedAndTheModelStays)
{
    WriteText(File("foreign.qmdb").toStdString(), "not a model");
    WriteText(File("broken.json").toStdString(), "{\"format\": ");
    for (const char* name : {"foreign.qmdb", "broken.json", "missing.qmdb"}) {
        CAnswers answers({CAnswers::Accept()});
        EXPECT_EQ(0, m_main->Open(File(name))) << name;
        EXPECT_TRUE(answers.m_texts.value(0).contains(name)) << name;
        EXPECT_EQ(20U, Model().nodes.size()) << name;
    }
}

TEST_F(MainWindow, TheFrameIsShownUnderEveryStepOfAPushover)
{
    ASSERT_TRUE(Open("rc-frame-3-storey"));
    CFramePane& frame = m_main->Frame();
    const auto it =
        std::ranges::find(frame.Sources(), T_SHAPE_SOURCE::KIND::Pushover, &T_SHAPE_SOURCE::kind);
    ASSERT_NE(frame.Sources().end(), it);
    ASSERT_TRUE(frame.Show(*it, 1));
    // Displacements at the control node are those of the curve, step by step.
    const int control = Model().pushovers.at(it->key).controlNode;
    const auto& nodes = frame.View().Picture().scene->nodes;
    const auto n = static_cast<std::size_t>(std::ranges::find(nodes, control, &T_SCENE_NODE::id) -
                                            nodes.begin());
    for (const int step : {1, it->steps / 2, it->steps}) {
        frame.Slider().setValue(step);
        double u = 0.0;
        ASSERT_TRUE(m_main->Doc().Post().SelectPushover(it->key));
        ASSERT_TRUE(m_main->Doc().Post().SelectStep(step));
        ASSERT_TRUE(m_main->Doc().Post().GetDispNew(control, u));
        EXPECT_EQ(u, (*frame.View().Picture().displacement)[n][0]);
        EXPECT_EQ(3U, frame.View().Picture().drifts.size());
    }
}

TEST_F(MainWindow, AStageShowsWhatStands)
{
    ASSERT_TRUE(Open("staged-two-hangers"));
    Run("IDS_QM_UI_ANALYSE");
    std::size_t standing = 0;
    for (const auto& [key, stage] : Model().stages) {
        standing += stage.activate.elements.size() - stage.deactivate.elements.size();
        using S = T_SHAPE_SOURCE;
        ASSERT_TRUE(m_main->Frame().Show({S::KIND::Stage, key, stage.name, stage.steps}, 1));
        EXPECT_EQ(standing, m_main->Frame().View().Picture().scene->lines.size()) << stage.name;
    }
}

TEST_F(MainWindow, APictureOfTheFrameIsWritten)
{
    AnswerFileName(File("a.svg"));
    Run("IDS_QM_UI_EXPORT_PICTURE");
    EXPECT_GT(QFileInfo(File("a.svg")).size(), 1000);
    AnswerFileName(File("a.gif"));
    CAnswers answers({CAnswers::Accept()});
    Run("IDS_QM_UI_EXPORT_PICTURE");
    EXPECT_TRUE(answers.m_texts.value(0).contains("a.gif"));
}

TEST_F(MainWindow, EditsOfASessionThatCrashedAreOfferedAndRecovered)
{
    AnswerFileName(File("bridge.qmdb"));
    Run("IDS_QM_UI_SAVE_AS");
    MoveNode2("12.5");
    m_main->Desktop().frame.OnTick(1e6);
    m_main->Desktop().frame.OnTick(2e6);
    const auto copies = [&] {
        return QFileInfo(File("bridge.qmdb")).dir().entryList({"bridge.qmdb.auto-*"}).size();
    };
    ASSERT_EQ(1, copies());
    for (const bool wanted : {false, true}) {
        m_main.reset(); // without closing: as a crash leaves it
        m_main = std::make_unique<CMainWindow>();
        CAnswers answers({CAnswers::Press(wanted ? QMessageBox::Yes : QMessageBox::Cancel)});
        ASSERT_TRUE(m_main->Open(File("bridge.qmdb")));
        EXPECT_EQ(wanted ? 12.5 : 10.0, X2());
    }
    EXPECT_TRUE(m_main->windowTitle().contains('*'));
    Run("IDS_QM_UI_SAVE");
    EXPECT_EQ(0, copies());
}

TEST_F(MainWindow, AFileThatCanNotBeWrittenIsToldAndTheEditsStay)
{
    MoveNode2("12.5");
    QDir().mkpath(File("folder.qmdb"));
    for (const char* name : {"folder.qmdb", "no/such/folder/a.qmdb"}) {
        AnswerFileName(File(name));
        CAnswers answers({CAnswers::Accept()});
        Run("IDS_QM_UI_SAVE_AS");
        EXPECT_TRUE(answers.m_texts.value(0).contains(name)) << name;
        EXPECT_TRUE(m_main->Doc().Data().IsModified()) << name;
    }
}

TEST_F(MainWindow, TheGuideHasEveryMenuOfToolsAndDeniesNone)
{
    const auto page = [](const char* name) {
        return QString::fromStdString(ReadText(QM_PROJECT "/docs/guide/" + std::string(name)));
    };
    const QString guide = page("desktop.md"), limits = page("limits.md");
    ASSERT_GT(limits.size(), 100);
    int tools = 0;
    for (const QAction* menu : m_main->menuBar()->actions()) {
        const QString name = menu->text().remove('&');
        if (QStringList{"File", "Edit", "View", "Language"}.contains(name)) continue;
        ++tools;
        EXPECT_TRUE(guide.contains("\n| " + name + " | ")) << name.toStdString();
        EXPECT_FALSE(limits.contains("no windows for " + name, Qt::CaseInsensitive));
    }
    EXPECT_GE(tools, 4);
}
