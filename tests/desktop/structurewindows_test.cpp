// The windows of sections and materials, with real events.
#include "windowplay.h"

#include "explorerpane.h"
#include "qm_db/editscope.h"
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

namespace {

void ToNewtonAndMillimetre(CDBDoc& doc)
{
    T_STYP_D styp = doc.Data().Model().styp;
    styp.units = {FORCE_UNIT::N, LENGTH_UNIT::mm};
    CEditScope edit(doc, "Units");
    ASSERT_TRUE(edit.PutStyp(styp) && edit.Commit());
}

/// A field, what is typed in N and mm, what the record has then in N and m.
template <class R>
struct T_TYPED {
    const char* field;
    const char* typed;
    double si;
    std::function<double(const R&)> of;
};

template <class R>
void TypeAll(CDialogWindow& w, const std::vector<T_TYPED<R>>& rows)
{
    for (const T_TYPED<R>& row : rows)
        Enter(w, row.field, row.typed);
}

template <class R>
void ExpectAll(const R& record, const std::vector<T_TYPED<R>>& rows)
{
    for (const T_TYPED<R>& row : rows)
        EXPECT_NEAR(row.si, row.of(record), 1e-12 * row.si) << row.field;
}

} // namespace

TEST_F(StructureWindows, ASteelShapeBringsItsDimensionsAndIsUndone)
{
    ASSERT_TRUE(Open("steel-frame-code-hinges"));
    ToNewtonAndMillimetre(m_main->Doc());
    const T_SECT_D before = Model().sections.at(1);
    const auto take = [](CDialogWindow& w) {
        ASSERT_EQ("HEB200", TextAt(w, "name"));
        EXPECT_EQ("200", TextAt(w, "size0"));
        EXPECT_EQ("", TextAt(w, "stockName")); // it has no fillet
        Enter(w, "stockName", "IPE 300");
        // EN 10365: 300 x 150 x 7.1 x 10.7, r = 15; A = 53.8 cm2.
        EXPECT_EQ("15", TextAt(w, "fillet"));
        EXPECT_EQ("IPE 300", qobject_cast<QComboBox*>(Field(w, "stock"))->currentText());
        EXPECT_NEAR(5380.0, TextAt(w, "A").toDouble(), 5.0);
        EXPECT_FALSE(Field(w, "A")->isEnabled());
        ChooseIndex(Field(w, "shape"), static_cast<int>(SECT_SHAPE::Rectangle));
        EXPECT_TRUE(Field(w, "fillet")->isHidden());
        ChooseIndex(Field(w, "shape"), static_cast<int>(SECT_SHAPE::IShape));
        EXPECT_EQ("15", TextAt(w, "fillet"));
        Enter(w, "fillet", "200"); // no room
        EXPECT_TRUE(IsMarked(w, "fillet"));
        Enter(w, "stockName", "IPE300");
        EXPECT_FALSE(IsMarked(w, "fillet"));
    };
    CAnswers answers({CAnswers::Fill(take)});
    Run("IDS_QM_UI_SECT_MENU");
    const T_SECT_D& after = Model().sections.at(1);
    const std::array<double, 5> sizes{after.size[0], after.size[1], after.size[2], after.size[3],
                                      after.fillet};
    constexpr std::array<double, 5> kSizes{0.3, 0.15, 0.0071, 0.0107, 0.015};
    for (std::size_t i = 0; i < sizes.size(); ++i)
        EXPECT_NEAR(kSizes[i], sizes[i], 1e-12);
    Run("IDS_QM_UI_UNDO");
    EXPECT_EQ(before, Model().sections.at(1));
    Run("IDS_QM_UI_REDO");
    EXPECT_NEAR(0.015, Model().sections.at(1).fillet, 1e-12);
}

TEST_F(StructureWindows, AChannelIsChosenByItsFamily)
{
    ASSERT_TRUE(Open("steel-frame-code-hinges"));
    ToNewtonAndMillimetre(m_main->Doc());
    const auto take = [](CDialogWindow& w) {
        EXPECT_TRUE(Field(w, "taper")->isHidden());
        const auto choose = [&w](const char* field, const char* text) {
            ChooseIndex(Field(w, field), qobject_cast<QComboBox*>(Field(w, field))->findText(text));
        };
        choose("family", "UPN");
        EXPECT_EQ("200", TextAt(w, "size1")); // still HEB 200
        choose("stock", "UPN 200");
        // DIN 1026-1: 75 x 8.5 x 11.5 with 8 %; 8.5 / 2 nearer to the tip it is 11.16 thick.
        EXPECT_EQ("75", TextAt(w, "size1"));
        EXPECT_EQ("11.16", TextAt(w, "size3"));
        EXPECT_EQ("0.08", TextAt(w, "taper"));
        EXPECT_NEAR(3220.0, TextAt(w, "A").toDouble(), 5.0);
        EXPECT_EQ("UPN 200", TextAt(w, "stockName"));
    };
    CAnswers answers({CAnswers::Fill(take)});
    Run("IDS_QM_UI_SECT_MENU");
    EXPECT_EQ(SECT_SHAPE::Channel, Model().sections.at(1).shape);
    EXPECT_EQ(0.08, Model().sections.at(1).taper);
}

TEST_F(StructureWindows, AnUnknownShapeIsRefusedAndChangesNothing)
{
    ASSERT_TRUE(Open("steel-frame-code-hinges"));
    const T_SECT_D before = Model().sections.at(1);
    CAnswers answers(
        {CAnswers::Fill([](CDialogWindow& w) { Enter(w, "stockName", "IPE 301"); }, false),
         CAnswers::Accept(), CAnswers::Accept()});
    Run("IDS_QM_UI_SECT_MENU");
    EXPECT_TRUE(answers.m_texts.value(0).contains("IPE 301"));
    EXPECT_EQ(before, Model().sections.at(1));
}

TEST_F(StructureWindows, EveryValueOfASectionIsTypedInTheUnitsOfTheDocument)
{
    ASSERT_TRUE(Open("masonry-wall"));
    ToNewtonAndMillimetre(m_main->Doc());
    using R = T_SECT_D;
    const std::vector<T_TYPED<R>> rows{
        {"A", "610000", 0.61, [](const R& r) { return r.area; }},
        {"Asy", "510000", 0.51, [](const R& r) { return r.Asy; }},
        {"Asz", "520000", 0.52, [](const R& r) { return r.Asz; }},
        {"J", "5.1e10", 0.051, [](const R& r) { return r.J; }},
        {"Iy", "7.2e10", 0.072, [](const R& r) { return r.Iyy; }},
        {"Iz", "1.25e10", 0.0125, [](const R& r) { return r.Izz; }},
        {"Zy", "1.8e8", 0.18, [](const R& r) { return r.Zy; }},
        {"Zz", "7.5e7", 0.075, [](const R& r) { return r.Zz; }},
        {"factors_I.area", "0.91", 0.91, [](const R& r) { return r.factorsI.area; }},
        {"factors_I.Asy", "0.92", 0.92, [](const R& r) { return r.factorsI.Asy; }},
        {"factors_I.Asz", "0.93", 0.93, [](const R& r) { return r.factorsI.Asz; }},
        {"factors_I.J", "0.94", 0.94, [](const R& r) { return r.factorsI.J; }},
        {"factors_I.Iyy", "0.95", 0.95, [](const R& r) { return r.factorsI.Iyy; }},
        {"factors_I.Izz", "0.96", 0.96, [](const R& r) { return r.factorsI.Izz; }},
        {"factors_J.Iyy", "0.35", 0.35, [](const R& r) { return r.factorsJ.Iyy; }},
        {"factors_J.Izz", "0.36", 0.36, [](const R& r) { return r.factorsJ.Izz; }}};
    CAnswers answers({CAnswers::Fill([&](CDialogWindow& w) { TypeAll(w, rows); })});
    Run("IDS_QM_UI_SECT_MENU");
    ExpectAll(Model().sections.at(1), rows);
}

TEST_F(StructureWindows, EveryValueOfAMaterialIsTypedInTheUnitsOfTheDocument)
{
    ASSERT_TRUE(Open("masonry-wall"));
    ToNewtonAndMillimetre(m_main->Doc());
    using R = T_MATL_D;
    const std::vector<T_TYPED<R>> rows{
        {"E", "1500", 1.5e9, [](const R& r) { return r.E; }},
        {"nu", "0.25", 0.25, [](const R& r) { return r.nu; }},
        {"G", "500", 5e8, [](const R& r) { return r.G.value_or(0.0); }},
        {"density", "1.8e-9", 1800.0, [](const R& r) { return r.density; }},
        {"alpha", "6e-6", 6e-6, [](const R& r) { return r.alpha; }},
        {"fck", "2.4", 2.4e6, [](const R& r) { return r.fck; }},
        {"mean.fc", "3.2", 3.2e6, [](const R& r) { return r.mean->fc; }},
        {"masonry.tau0", "0.065", 6.5e4, [](const R& r) { return r.masonry->tau0; }},
        {"masonry.fv0", "0.14", 1.4e5, [](const R& r) { return r.masonry->fv0; }},
        {"masonry.fb", "10", 1e7, [](const R& r) { return r.masonry->fb; }},
        {"masonry.interlocking", "1.5", 1.5, [](const R& r) { return r.masonry->interlocking; }}};
    const auto fill = [&](CDialogWindow& w) {
        EXPECT_EQ("250", TextAt(w, "G"));
        EXPECT_FALSE(Field(w, "masonry.tau0")->isEnabled());
        Push(w, "hasMean");
        Push(w, "hasMasonry");
        TypeAll(w, rows);
        ChooseIndex(Field(w, "masonry.bond"), static_cast<int>(BOND_KIND::Regular));
        Push(w, "masonry.hollow_blocks");
        Push(w, "hasMasonry"); // switched off and on again it is as it was
        Push(w, "hasMasonry");
    };
    CAnswers answers({CAnswers::Fill(fill)});
    Run("IDS_QM_UI_MATL_MENU");
    const R& material = Model().materials.at(1);
    ExpectAll(material, rows);
    EXPECT_EQ(BOND_KIND::Regular, material.masonry->bond);
    EXPECT_TRUE(material.masonry->hollowBlocks);
}

TEST_F(StructureWindows, AGradeFillsInItsValuesUntilOneIsTyped)
{
    const auto take = [](CDialogWindow& w) {
        auto* const concrete = qobject_cast<QComboBox*>(Field(w, "gradeConcrete"));
        ChooseIndex(concrete, concrete->findText("C25/30"));
        // EN 1992-1-1 Table 3.1: fck = 25 MPa, Ecm = 31 GPa.
        EXPECT_EQ("25000", TextAt(w, "fck"));
        EXPECT_NEAR(31e6, TextAt(w, "E").toDouble(), 0.5e6);
        EXPECT_EQ("400000", TextAt(w, "fyk")); // that of the bars stays
        auto* const bars = qobject_cast<QComboBox*>(Field(w, "gradeBars"));
        ChooseIndex(bars, bars->findText("B450C"));
        EXPECT_EQ("450000", TextAt(w, "fyk"));
        EXPECT_TRUE(Says(w, "NTC 2018"));
        EXPECT_TRUE(Says(w, "recalled"));
        Enter(w, "fyk", "430000");
        EXPECT_EQ(0, bars->currentIndex());
        EXPECT_EQ("C25/30", concrete->currentText());
    };
    CAnswers answers({CAnswers::Fill(take)});
    Run("IDS_QM_UI_MATL_MENU");
    EXPECT_NEAR(25e6, Model().materials.at(1).fck, 1.0);
    EXPECT_NEAR(430e6, Model().materials.at(1).fyk, 1.0);
    EXPECT_NEAR(2500.0, Model().materials.at(1).density, 1e-6);
}

TEST_F(StructureWindows, BarsThatWereLaidOrTypedAreNotDroppedByEsc)
{
    const ACT changes[] = {
        [](CDialogWindow& w) { Push(w, "IDS_QM_UI_SECT_ONE"); },
        [](CDialogWindow& w) { EXPECT_TRUE(SetCell(Grid(w, "bars").Model(), 0, 2, "0.02")); },
    };
    for (const ACT& change : changes) {
        CPlay play({{"Section", [&](CDialogWindow& w) {
                         change(w);
                         Key(&w, Qt::Key_Escape);
                         EXPECT_TRUE(w.isVisible());
                         Cancel(w);
                     }}});
        play.m_answer = QMessageBox::No;
        Run("IDS_QM_UI_SECT_MENU");
        EXPECT_TRUE(play.m_texts.value(0).contains("drop"));
    }
    CPlay play({{"Section", [](CDialogWindow& w) { // to look at another one changes nothing
                     ChooseIndex(Field(w, "record"), 1);
                     Key(&w, Qt::Key_Escape);
                     EXPECT_FALSE(w.isVisible());
                 }}});
    Run("IDS_QM_UI_SECT_MENU");
    EXPECT_EQ(0, play.m_texts.size());
}
