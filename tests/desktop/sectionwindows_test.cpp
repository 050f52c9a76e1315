// The window with the curves of sections.
#include "desktoptest.h"

#include "qm_rps/section/sectionvalues.h"
#include "qm_ui/plot/plotwidget.h"

#include <QCheckBox>
#include <QComboBox>
#include <QFile>

using namespace desktop_test;

TEST_F(DesktopTest, CurvesOfASectionFollowItsOptionsAndAreExported)
{
    ASSERT_TRUE(Open("rc-frame-code-hinges"));
    const QString file = File("points.csv");
    const auto play = [&](CDialogWindow& curves) {
        const auto plot = [&](const char* page) -> const T_PLOT& {
            return dynamic_cast<CPlotWidget*>(Field(curves, page))->Plot();
        };
        const double before = plot("interaction.picture").series.at(0).x.at(20);
        ChooseIndex(Field(curves, "values"), static_cast<int>(SECTION_VALUES::Design));
        EXPECT_LT(plot("interaction.picture").series.at(0).x.at(20), 0.95 * before);
        Enter(curves, "axial", "0 400");
        EXPECT_EQ(4U, plot("curvature.picture").series.size()); // each with its idealisation
        EXPECT_EQ(2U, plot("surface.picture").series.size());
        Enter(curves, "axial", "0 many");
        EXPECT_TRUE(plot("curvature.picture").series.empty());
        EXPECT_FALSE(plot("interaction.picture").series.empty());
        Enter(curves, "axial", "0");
        ChooseIndex(Field(curves, "law"), 1); // design values and the block: refused
        EXPECT_TRUE(plot("capacity.picture").series.empty());
        ChooseIndex(Field(curves, "law"), 0);
        ChooseIndex(Field(curves, "section"), 1);
        EXPECT_FALSE(plot("capacity.picture").series.empty());
        auto* const core = qobject_cast<QComboBox*>(Field(curves, "core"));
        ASSERT_EQ(std::ssize(kSectionCoreNames), core->count());
        std::vector<double> largest; // of NTC 2018 that of EN 1992-1-1, one rule
        for (const SECTION_CORE of :
             {SECTION_CORE::Eurocode, SECTION_CORE::Ntc, SECTION_CORE::En1998}) {
            ChooseIndex(core, static_cast<int>(of));
            EXPECT_TRUE(core->currentText().startsWith("core confined by"));
            const T_PLOT& shown = plot("interaction.picture");
            largest.push_back(shown.series.empty() ? 0.0 : shown.series.at(0).y.at(0));
        }
        EXPECT_EQ(largest[0], largest[1]);
        EXPECT_NE(largest[0], largest[2]);
        ChooseIndex(core, 0);
        AnswerFileName(file);
        Push(curves, "interaction.export");
        curves.reject();
    };
    CAnswers answers({CAnswers::Fill(play, false)});
    Run("IDS_QM_UI_SECC_CMD");
    QFile csv(file);
    ASSERT_TRUE(csv.open(QIODevice::ReadOnly));
    EXPECT_EQ(41, csv.readAll().count('\n')); // a head and 40 points
    EXPECT_FALSE(m_main->Doc().Data().IsModified());
}

// By hand, plates 200 x 15 and 170 x 9 of 275 MPa: NR = 275e3 0.00753 = 2070.75 kN; Mpl = 170.507
// kNm, of which N = 400 kN in the web takes N^2/(4 tw fy) = 16.162: 154.345 kNm.
TEST_F(DesktopTest, GivenForcesAreCheckedTracedAndExported)
{
    ASSERT_TRUE(Open("steel-frame-code-hinges"));
    const QString file = File("check.csv");
    const auto play = [&](CDialogWindow& w) {
        QAbstractItemModel& ways = Grid(w, "check.table").Model();
        EXPECT_EQ(0, ways.rowCount());
        Push(w, "check.export"); // refused: there is nothing
        QAbstractItemModel& sets = Grid(w, "check.sets").Model();
        EXPECT_TRUE(sets.setData(sets.index(0, 1), "400"));
        EXPECT_TRUE(sets.setData(sets.index(0, 2), "100"));
        ASSERT_LT(2, ways.rowCount());
        EXPECT_TRUE(Field(w, "check.cotTheta")->isHidden());
        EXPECT_EQ("section calculator", Cell(ways, 1, 2));
        EXPECT_NEAR(400 / 2070.75, Cell(ways, 0, 3).toDouble(), 5e-5);
        EXPECT_NEAR(100 / 154.345, Cell(ways, 1, 3).toDouble(), 5e-5);
        EXPECT_EQ("kept", Cell(ways, 1, 4));
        Grid(w, "check.table").setCurrentIndex(ways.index(1, 0));
        QAbstractItemModel& trace = Grid(w, "check.trace").Model();
        ASSERT_EQ(3, trace.rowCount()); // M, MR, ratio
        EXPECT_EQ("MR", Cell(trace, 1, 0));
        EXPECT_NEAR(154.345, Cell(trace, 1, 1).toDouble(), 5e-3);
        EXPECT_EQ("kN m", Cell(trace, 1, 2));
        const int ofOne = ways.rowCount();
        Push(w, "IDS_QM_UI_SECK_NEW");
        EXPECT_TRUE(sets.setData(sets.index(1, 0), "more"));
        EXPECT_TRUE(sets.setData(sets.index(1, 1), "400"));
        EXPECT_TRUE(sets.setData(sets.index(1, 2), "160"));
        EXPECT_EQ("EXCEEDED", Cell(ways, ofOne + 1, 4));
        qobject_cast<QCheckBox*>(Field(w, "check.byRatio"))->click();
        EXPECT_EQ("more", Cell(ways, 0, 0)); // the worse set first
        const int all = ways.rowCount();
        ChooseIndex(Field(w, "check.code"), 1); // EN alone
        EXPECT_GT(all, ways.rowCount());
        AnswerFileName(file);
        Push(w, "check.export");
        w.reject();
    };
    CAnswers answers({CAnswers::Fill(play, false), CAnswers::Press(QMessageBox::Ok)});
    Run("IDS_QM_UI_SECC_CMD");
    EXPECT_TRUE(answers.m_texts.join(' ').contains("Enter a force"));
    QFile csv(file);
    ASSERT_TRUE(csv.open(QIODevice::ReadOnly));
    EXPECT_TRUE(csv.readAll().contains(
        "HEB200,S275,more,400,160,0,0,0,0,bending,section calculator,1.037,EXCEEDED\n"));
}
