#include "tempfolder.h"
#include "ulffixture.h"

#include <QApplication>
#include <QCheckBox>
#include <QFileInfo>
#include <QPushButton>

#include <cmath>

using namespace desktop_test;

namespace {

class UlfIterationWindows : public UlfWindows {};

constexpr const char* kResult = "Result of unknown load factors";
constexpr const char* kRun = "Iterative analysis for pretension";
constexpr const char* kStep = "Load factors between iterations";

/// Ticks "iterate" and goes on, and does something else before that.
ACT WantMore(std::function<void()> also = {})
{
    return [also](CDialogWindow& w) {
        for (QCheckBox* box : w.findChildren<QCheckBox*>())
            Click(box);
        if (also) also();
        w.accept();
    };
}

bool HasEnded(CDialogWindow& w)
{
    return w.findChild<QPushButton*>("IDS_QM_UI_ULF_START")->isEnabled();
}

/// Closes the window of a run that says so.
ACT Ends(const char* text)
{
    return [text](CDialogWindow& w) {
        EXPECT_TRUE(Says(w, text));
        w.reject();
    };
}

} // namespace

TEST_F(UlfIterationWindows, TwoHangersConvergeInTheWindowOfTheRun)
{
    OpenCopy("staged-two-hangers", "hangers.qmdb");
    EXPECT_NEAR(100e3, Tension("T1"), 1e-6);
    const ACT read = [](CDialogWindow& w) {
        EXPECT_TRUE(Says(w, "Converged"));
        EXPECT_EQ("hangers_01.qmdb", Cell(Table(w), 1, 2));
        EXPECT_NEAR(std::sqrt(1.5 * 1.5 + 0.25 * 0.25), Cell(Table(w), 0, 1).toDouble(), 1e-4);
        // 10/8 and 3/8 of q L = 200 kN over the 100 kN at the start, both applied.
        EXPECT_NEAR(2.5, Cell(Table(w, 1), 0, 4).toDouble(), 1e-6);
        EXPECT_NEAR(0.75, Cell(Table(w, 1), 1, 4).toDouble(), 1e-6);
        EXPECT_NEAR(1.0, Cell(Table(w, 1), 0, 2).toDouble(), 1e-6);
        // Hanger 11 in kN: 100 at the start, 250 now, and as a level support it carries that; the
        // node that it holds is level in the analysed structure as well.
        EXPECT_EQ("100", Cell(Table(w, 2), 0, 2));
        EXPECT_NEAR(250.0, Cell(Table(w, 2), 0, 4).toDouble(), 1e-3);
        EXPECT_NEAR(250.0, Cell(Table(w, 2), 0, 5).toDouble(), 1e-3);
        EXPECT_NEAR(0.0, Cell(Table(w, 3), 0, 2).toDouble(), 1e-9);
        ChooseRow(w, 0); // the first solution
        EXPECT_NEAR(2.5, Cell(Table(w, 1), 0, 2).toDouble(), 1e-6);
        EXPECT_EQ(2U, Picture(w).series.at(0).x.size());
        Press("IDS_QM_UI_ULF_SHOW_RESULT")(w);
    };
    CPlay play({{kRun, Press("IDS_QM_UI_ULF_START")},
                {kStep, WantMore()},
                {kRun, read, HasEnded},
                {kResult, Cancel},
                {kRun, Cancel}});
    Run("IDS_QM_UI_ULF_ITERATE");
    EXPECT_NEAR(250e3, Tension("T1"), 1.0);
    EXPECT_NEAR(75e3, Tension("T2"), 1.0);
    EXPECT_TRUE(QFileInfo::exists(File("hangers_01.qmdb")));
    EXPECT_TRUE(play.m_texts.isEmpty());
}

TEST_F(UlfIterationWindows, AStoppedRunLeavesTheLoadsAndStaysOpenUntilItHasEnded)
{
    OpenCopy("staged-two-hangers", "hangers.qmdb");
    const auto loads = Model().loadCases;
    const ACT start = [](CDialogWindow& w) {
        Later(&w, [&w] { Press("IDS_QM_UI_ULF_START")(w); });
    };
    QWidget* run = nullptr;
    bool stayed = false;
    // The question between the iterations is answered; Esc comes while the analysis runs.
    const auto escape = [&] {
        run = QApplication::activeModalWidget()->parentWidget();
        Later(run, [&] {
            Key(run, Qt::Key_Escape);
            stayed = run->isVisible();
        });
    };
    CPlay play({{kRun, start}, {kStep, WantMore(escape)}, {kRun, Ends("Stopped"), HasEnded}});
    Run("IDS_QM_UI_ULF_ITERATE");
    EXPECT_TRUE(stayed);
    EXPECT_EQ(loads, Model().loadCases);
    EXPECT_FALSE(m_main->Doc().IsExcuted());
}

TEST_F(UlfIterationWindows, ARunIsRefusedWithoutAFileAndAsksAboutAnOldReport)
{
    ASSERT_TRUE(Open("staged-two-hangers"));
    const T_MODEL model = Model();
    OpenCopy("staged-two-hangers", "hangers.qmdb");
    const std::string report = File("hangers.ulf").toStdString();
    WriteText(report, "old\n");
    {
        CPlay play({{kRun, Press("IDS_QM_UI_ULF_START")},
                    {kStep, WantMore()},
                    {kRun, Ends("Converged"), HasEnded}});
        play.m_answer = QMessageBox::No; // add to it
        Run("IDS_QM_UI_ULF_ITERATE");
        EXPECT_TRUE(play.m_texts.value(0).contains("hangers.ulf"));
    }
    EXPECT_EQ(0U, ReadText(report).find("old\n"));
    EXPECT_NE(std::string::npos, ReadText(report).find("Iteration = 1"));

    m_main->Doc().NewModel();
    CEditData& edit = m_main->Doc().Edit();
    ASSERT_TRUE(edit.Begin("stages"));
    for (const auto& [key, item] : model.ulfStageItems)
        ASSERT_TRUE(edit.Put(key, item));
    ASSERT_TRUE(edit.Commit());
    m_main->Refresh();
    CPlay play({{kRun, Press("IDS_QM_UI_ULF_START")}, {kRun, Ends("Save the model first")}});
    Run("IDS_QM_UI_ULF_ITERATE");
}
