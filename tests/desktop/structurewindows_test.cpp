// The windows of sections and materials, with real events.
#include "windowplay.h"

#include "explorerpane.h"
#include "qm_rps/section/barlayout.h"

#include <QComboBox>

#include <numbers>

using namespace desktop_test;

namespace {

class StructureWindows : public DesktopTest {
protected:
    StructureWindows() { EXPECT_TRUE(Open("rc-frame-code-hinges")); }
};

constexpr double kBar = std::numbers::pi / 4.0 * 0.016 * 0.016; // m2

} // namespace

TEST_F(StructureWindows, BarsAreLaidByButtonsAndStoredAsOneEdit)
{
    const T_SECT_D before = Model().sections.at(1);
    const auto lay = [](CDialogWindow& w) {
        ASSERT_EQ("column 40x40", TextAt(w, "name"));
        EXPECT_EQ(8, Grid(w, "bars").Model().rowCount());
        EXPECT_TRUE(Says(w, "8 bars"));
        Push(w, "IDS_QM_UI_SECT_CLEAR");
        EXPECT_EQ(0, Grid(w, "bars").Model().rowCount());
        Enter(w, "diameter", "0.016");
        Push(w, "IDS_QM_UI_SECT_ADD"); // corners
        ChooseIndex(Field(w, "place"), static_cast<int>(BAR_PLACE::Top));
        Enter(w, "count", "2");
        Push(w, "IDS_QM_UI_SECT_ADD");
        QAbstractItemModel& bars = Grid(w, "bars").Model();
        ASSERT_EQ(6, bars.rowCount());
        // 200 - 30 - 8 - 8 mm from the middle; a third of that on either side.
        EXPECT_NEAR(0.154 / 3.0, Cell(bars, 5, 0).toDouble(), 1e-9);
        EXPECT_NEAR(0.154, Cell(bars, 5, 1).toDouble(), 1e-9);
        EXPECT_EQ("6 bars, stirrup 0.008 every 0.15 m", Picture(w).subtitle);
        EXPECT_FALSE(IsMarked(w, "detailing.cover"));
        Enter(w, "detailing.cover", "0.25"); // no core is left
        EXPECT_TRUE(IsMarked(w, "detailing"));
        Enter(w, "detailing.cover", "0.03");
        Enter(w, "detailing.stirrup_spacing", "0.1");
        EXPECT_TRUE(SetCell(bars, 4, 2, "0.02"));
        EXPECT_FALSE(SetCell(bars, 4, 2, "thick"));
    };
    CAnswers answers({CAnswers::Fill(lay)});
    Run("IDS_QM_UI_SECT_MENU");
    const T_SECT_D after = Model().sections.at(1);
    ASSERT_EQ(6U, after.bars.size());
    EXPECT_NEAR(kBar, after.bars[0].area, 1e-12);
    EXPECT_NEAR(std::numbers::pi * 1e-4, after.bars[4].area, 1e-12);
    EXPECT_EQ(0.1, after.detailing->stirrupSpacing);
    Run("IDS_QM_UI_UNDO");
    EXPECT_EQ(before, Model().sections.at(1));
}

TEST_F(StructureWindows, BarsThatCannotStandAreRefusedWithWords)
{
    const auto tooMany = [](CDialogWindow& w) { Push(w, "IDS_QM_UI_SECT_ADD"); };
    CAnswers answers({CAnswers::Fill(tooMany, false), CAnswers::Accept(), CAnswers::Reject()});
    Run("IDS_QM_UI_SECT_MENU");
    EXPECT_TRUE(answers.m_texts.value(0).contains("another bar"))
        << answers.m_texts.join(" ").toStdString();
    EXPECT_EQ(8U, Model().sections.at(1).bars.size());
}

TEST_F(StructureWindows, AMaterialTellsWhatIsKnownOfIt)
{
    m_main->Explorer().Choose(EXPLORER_TABLE::Materials);
    const auto fill = [](CDialogWindow& w) {
        ASSERT_EQ("concrete of beams", TextAt(w, "name"));
        EXPECT_TRUE(Says(w, "Confidence factor: 1.2."));
        Enter(w, "confidence_factor", "0.9");
        EXPECT_TRUE(IsMarked(w, "confidence_factor"));
        Enter(w, "confidence_factor", "");
        ChooseIndex(Field(w, "knowledge"), 1);
        EXPECT_TRUE(Says(w, "Confidence factor: 1.35."));
        Enter(w, "mean.fyw", "410000");
    };
    CAnswers answers({CAnswers::Fill(fill)});
    m_main->Explorer().m_open(EXPLORER_TABLE::Materials, 2);
    const T_MATL_D& material = Model().materials.at(2);
    EXPECT_EQ(MATL_KNOWLEDGE::KL1, material.knowledge);
    EXPECT_NEAR(410e6, material.mean->fyw, 1.0);
    EXPECT_FALSE(material.confidence);
}
