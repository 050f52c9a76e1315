#include "desktoptest.h"

#include "qm_rps/ulftuningdlg.h"
#include "qm_ui/plot/plotwidget.h"

#include <QSlider>

using namespace desktop_test;

namespace {

class UlfTuning : public DesktopTest {};

/// Moment at a place of the tuned beam, whose five elements have five places each.
double MomentAt(const CUlfTuningDlg& tuned, std::size_t element, std::size_t place)
{
    return tuned.Values().moments.at(5 * element + place);
}

std::size_t NumberOf(const CUlfTuningDlg& tuned, const char* name)
{
    for (std::size_t u = 0; u < tuned.Unknowns(); ++u)
        if (tuned.NameOf(u) == name) return u;
    ADD_FAILURE() << name;
    return 0;
}

} // namespace

// Five spans of 10 m under 10 kN/m, level over four props: 2/19 and 3/38 w L2 over them
// (three-moment equation). 100 kN more at the first prop of the beam of 50 m add 100 a (50 - x) /
// 50 with a = 10.
TEST_F(UlfTuning, MomentsFollowAFactorBySuperposition)
{
    ASSERT_TRUE(Open("tuned-beam"));
    CUlfTuningDlg tuned(m_main->Doc());
    EXPECT_FALSE(tuned.IsSolved()); // there are no results yet
    EXPECT_NE("", tuned.StatusText());
    ASSERT_EQ(1, tuned.OnSolve({})) << tuned.StatusText();
    const double outer = 1000.0 * 2.0 / 19.0, inner = 1000.0 * 3.0 / 38.0;
    const double middle = (outer + inner) / 2.0 - 125.0; // of the second span
    EXPECT_NEAR(outer, MomentAt(tuned, 1, 0), 1e-6);
    EXPECT_NEAR(middle, MomentAt(tuned, 1, 2), 1e-6);
    EXPECT_TRUE(tuned.IsMet());
    const std::size_t p2 = NumberOf(tuned, "P2");
    const double found = tuned.Factor(p2);
    EXPECT_NEAR(43.0 / 38.0, found, 1e-9);
    EXPECT_EQ(0, tuned.OnFactor(p2, std::nan("")));
    ASSERT_EQ(1, tuned.OnFactor(p2, found + 0.25));
    EXPECT_NEAR(outer + 0.25 * 800.0, MomentAt(tuned, 1, 0), 1e-6);
    EXPECT_NEAR(middle + 0.25 * 700.0, MomentAt(tuned, 1, 2), 1e-6);
    EXPECT_NEAR(inner + 0.25 * 600.0, MomentAt(tuned, 2, 0), 1e-6);
    EXPECT_NEAR(outer, tuned.ValuesBefore().moments.at(5), 1e-6);
    EXPECT_FALSE(tuned.IsMet()); // no longer level
    tuned.OnReset();
    EXPECT_NEAR(outer, MomentAt(tuned, 1, 0), 1e-6);
}

// What superposition says of other pretension is what the analysis of it gives.
TEST_F(UlfTuning, StagedForcesAreThoseOfTheAnalysisWithTheScaledPretension)
{
    ASSERT_TRUE(Open("staged-two-hangers"));
    CDBDoc& doc = m_main->Doc();
    CUlfTuningDlg tuned(doc);
    ASSERT_EQ(1, tuned.OnSolve({})) << tuned.StatusText();
    const T_TEXT_TABLE stays = tuned.StayCells();
    ASSERT_FALSE(stays.rows.empty());
    for (std::size_t u = 0; u < tuned.Unknowns(); ++u)
        ASSERT_EQ(1, tuned.OnFactor(u, 1.0));
    EXPECT_NE(std::string::npos, tuned.StatusText().find("analysed structure"));
    ASSERT_EQ(1, tuned.OnFactor(0, 1.001));
    const CUlfDeckValues::T_VALUES superposed = tuned.Values();
    const CUlfDeckValues::T_VALUES before = tuned.ValuesBefore();
    int load = 0;
    ASSERT_TRUE(doc.Attr().FindStld(stays.rows[0][1], load));
    T_PTNS_D tension;
    ASSERT_TRUE(doc.Attr().GetPtns(load, std::stoi(stays.rows[0][0]), tension));
    tension.force *= 1.001;
    ASSERT_TRUE(doc.Edit().Begin("scale") && doc.Edit().AddPtns(load, tension) &&
                doc.Edit().Commit());
    CUlfTuningDlg again(doc);
    ASSERT_EQ(1, again.OnSolve({})) << again.StatusText();
    const CUlfDeckValues::T_VALUES analysed = again.ValuesBefore();
    ASSERT_EQ(analysed.stays.size(), superposed.stays.size());
    const double change = analysed.stays.at(0) - before.stays.at(0);
    EXPECT_GT(std::fabs(change), 0.0);
    for (std::size_t i = 0; i < analysed.stays.size(); ++i)
        EXPECT_NEAR(analysed.stays[i], superposed.stays[i], 0.01 * std::fabs(change)) << i;
}

TEST_F(UlfTuning, SliderAndNumberMoveTheDeckInTheWindow)
{
    ASSERT_TRUE(Open("cable-stayed-bridge"));
    const auto play = [](CDialogWindow& w) {
        Click(w.findChild<QWidget*>("IDS_QM_TUNE_SOLVE"));
        Settle();
        CGridView& stays = Grid(w, "stays");
        ASSERT_EQ(8, stays.Model().rowCount());
        EXPECT_EQ("101", Cell(stays.Model(), 0, 0));
        auto* deck = dynamic_cast<CPlotWidget*>(Field(w, "deck"));
        ASSERT_EQ(2U, deck->Plot().series.size());
        EXPECT_EQ(deck->Plot().series[0].y, deck->Plot().series[1].y);
        stays.selectRow(1);
        auto* slider = qobject_cast<QSlider*>(Field(w, "slider"));
        const double before = TextAt(w, "factor").toDouble();
        Key(slider, Qt::Key_Right);
        EXPECT_GT(TextAt(w, "factor").toDouble(), before);
        EXPECT_NE(deck->Plot().series[0].y, deck->Plot().series[1].y);
        const double start = Cell(stays.Model(), 1, 2).toDouble();
        Enter(w, "factor", "2");
        EXPECT_NEAR(2.0 * start, Cell(stays.Model(), 1, 4).toDouble(), 1e-6 * std::fabs(start));
        w.reject();
    };
    CAnswers answers({CAnswers::Fill(play, false)});
    Run("IDS_QM_TUNE_COMMAND");
}
