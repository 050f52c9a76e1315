// The window with the curves of sections.
#include "desktoptest.h"

#include "qm_rps/section/sectionvalues.h"
#include "qm_ui/plot/plotwidget.h"

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
