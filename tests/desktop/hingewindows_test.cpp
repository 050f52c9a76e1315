#include "desktoptest.h"

#include "hingetools.h"
#include "qm_ui/plot/plotwidget.h"

#include <QComboBox>

using namespace desktop_test;

namespace {

using STEP = CAnswers::STEP;

/// Opens what stands behind a button.
STEP PushOn(const char* name)
{
    return CAnswers::Fill([name](CDialogWindow& window) { Push(window, name); });
}

/// Closes a window that only shows.
STEP Visit(std::function<void(CDialogWindow&)> look)
{
    const auto visit = [look = std::move(look)](CDialogWindow& window) {
        look(window);
        window.reject();
    };
    return CAnswers::Fill(visit, false);
}

constexpr int kBeam = 1, kColumn = 2, kConcrete = 3, kBrace = 4, kPier = 5, kMistake = 6;

class HingeWindows : public DesktopTest {
protected:
    HingeWindows() { EXPECT_TRUE(Open("hinge-library")); }
    void OpenType(int key)
    {
        EXPECT_TRUE(OpenHingeRecord(m_main->Desktop(), EXPLORER_TABLE::HingeTypes, key));
        Settle();
    }
    T_PHGT_D Type(int key)
    {
        T_PHGT_D type;
        EXPECT_TRUE(m_main->Doc().Attr().GetPhgt(key, type)) << key;
        return type;
    }
    bool Modified() { return m_main->Doc().Data().IsModified(); }
};

template <class CURVE>
const CURVE& CurveOf(const T_PHGT_D& t, std::size_t component)
{
    return std::get<CURVE>(t.components[component].curves.I);
}

} // namespace

TEST_F(HingeWindows, TypesAreAddedCopiedAndDeletedEachAsOneStepAndUsersAreNamed)
{
    const auto& types = Model().hingeTypes;
    CAnswers answers({
        Visit([&](CDialogWindow& list) {
            Push(list, "IDS_QM_UI_HINGE_DELETE"); // none is chosen
            Push(list, "IDS_QM_UI_HINGE_ADD");
            Push(list, "IDS_QM_UI_HINGE_COPY"); // of the new one, which is chosen
            EXPECT_EQ("girder (2)", Type(8).name);
            Push(list, "IDS_QM_UI_HINGE_DELETE");
            EXPECT_EQ(7U, types.size());
            CGridView& rows = Grid(list, "types");
            rows.setCurrentIndex(rows.Model().index(0, 0));
            Push(list, "IDS_QM_UI_HINGE_DELETE"); // used
            EXPECT_EQ(7U, types.size());
        }),
        CAnswers::Accept(),
        CAnswers::Fill([](CDialogWindow& editor) {
            Enter(editor, "name", "steel beam");
            EXPECT_TRUE(IsMarked(editor, "name")); // taken by another type
            Enter(editor, "name", "girder");
            EXPECT_EQ(0, editor.Form().Marks());
        }),
        CAnswers::Accept(),
    });
    Run("IDS_QM_UI_HINGE_TYPES");
    EXPECT_TRUE(answers.m_texts.value(1).contains("used by elements: 2"));
    for (const std::size_t left : {8U, 7U, 6U}) { // before the delete, the copy, the new one
        Run("IDS_QM_UI_UNDO");
        EXPECT_EQ(left, types.size());
    }
}

TEST_F(HingeWindows, AnEditorMarksBrokenRulesWhileTypingRefusesThemAndTakesTheRest)
{
    using T = const T_PHGT_D&;
    const struct {
        int type;
        const char *button, *field, *bad, *good;
        double (*stored)(T);
    } kEditors[] = {
        {kBeam, "My.curve", "sides.pos.LS", "1", "6.5",
         [](T t) { return -CurveOf<T_SKEL_FEMA>(t, 4).sides.neg.LS; }},
        {kBrace, "Fx.curve", "sides.pos.gap", "-0.001", "0.003",
         [](T t) { return CurveOf<T_SKEL_MULTI>(t, 0).sides.pos.gap; }},
        {kConcrete, "My.curve", "sides.pos.LS", "0.001", "2.25",
         [](T t) { return CurveOf<T_SKEL_EC8>(t, 4).sides.pos.LS; }},
        {kPier, "masonry.", "compStrength", "0", "4500",
         [](T t) { return t.masonry->compStrength; }},
    };
    for (const auto& c : kEditors) {
        SCOPED_TRACE(c.type);
        const T_PHGT_D given = Type(c.type);
        CAnswers answers({
            PushOn(c.button),
            CAnswers::Fill([&](CDialogWindow& editor) {
                Enter(editor, c.field, c.good);
                EXPECT_FALSE(IsMarked(editor, c.field));
                Enter(editor, c.field, c.bad);
                EXPECT_TRUE(IsMarked(editor, c.field));
                editor.accept(); // a message, and the window stays
                EXPECT_TRUE(editor.isVisible());
                Enter(editor, c.field, c.good);
            }),
            CAnswers::Accept(),
        });
        OpenType(c.type);
        EXPECT_EQ(1, answers.m_texts.size());
        EXPECT_DOUBLE_EQ(QString(c.good).toDouble(), c.stored(Type(c.type)));
        Run("IDS_QM_UI_UNDO"); // the whole type is one step
        EXPECT_EQ(given, Type(c.type));
    }
}

TEST_F(HingeWindows, ThePreviewFollowsEachChangeAndCancelLeavesTheDocumentUntouched)
{
    const T_PHGT_D before = Type(kBeam);
    CAnswers answers({
        Visit([](CDialogWindow& type) {
            Push(type, "My.curve");
            Enter(type, "name", "other");
        }),
        Visit([](CDialogWindow& editor) {
            auto* plot = dynamic_cast<CPlotWidget*>(Field(editor, "picture"));
            ASSERT_NE(nullptr, plot);
            Enter(editor, "sides.pos.C.deform", "9.5");
            EXPECT_EQ(9.5, plot->Plot().series.at(0).x.at(6)); // -E -D -C -B A B C D E
            EXPECT_EQ(-9.5, plot->Plot().series[0].x[2]);      // symmetric
            Enter(editor, "sides.pos.C.deform", "10");
            ChooseIndex(Field(editor, "measure"), 1);
            // (10 - 1) * 0.00741258651
            EXPECT_DOUBLE_EQ(0.06671327859, TextAt(editor, "sides.pos.C.deform").toDouble());
            ChooseIndex(Field(editor, "measure"), 0);
            EXPECT_EQ("10", TextAt(editor, "sides.pos.C.deform"));
            Enter(editor, "sides.pos.C.deform", "9");
        }),
    });
    OpenType(kBeam);
    EXPECT_EQ(before, Type(kBeam));
    EXPECT_FALSE(Modified());
}

TEST_F(HingeWindows, EndsOfTheirOwnHavePagesOfTheirOwn)
{
    CAnswers answers({
        CAnswers::Fill([](CDialogWindow& type) {
            Push(type, "My.sameEnds");
            Push(type, "My.curve");
        }),
        CAnswers::Fill([](CDialogWindow& editor) {
            Enter(editor, "J.sides.pos.E.deform", "9");
            EXPECT_TRUE(IsMarked(editor, "J.sides.pos.E.deform"));
            EXPECT_FALSE(IsMarked(editor, "sides.pos.E.deform"));
            Enter(editor, "J.sides.pos.E.deform", "13");
            EXPECT_EQ(0, editor.Form().Marks());
        }),
    });
    OpenType(kBeam);
    const T_HINGE_COMPONENT my = Type(kBeam).components[4];
    EXPECT_EQ(12.0, std::get<T_SKEL_FEMA>(my.curves.I).sides.pos.E.deform);
    EXPECT_EQ(13.0, std::get<T_SKEL_FEMA>(my.curves.J).sides.pos.E.deform);
}

TEST_F(HingeWindows, TheListOfAxialForcesRefusesAForceTwiceAndNewOnesGetTheCurve)
{
    CAnswers answers({
        PushOn("My.curve"),
        CAnswers::Fill([](CDialogWindow& editor) {
            auto* forces = qobject_cast<QComboBox*>(Field(editor, "curves"));
            const int before = forces->count();
            Push(editor, "axialList");
            EXPECT_EQ(before + 1, forces->count());
            // A broken rule of a force that is not on show marks the choice.
            ChooseIndex(forces, before);
            Enter(editor, "sides.pos.CP", "0.01");
            EXPECT_TRUE(IsMarked(editor, "sides.pos.CP"));
            ChooseIndex(Field(editor, "curves"), 0);
            EXPECT_TRUE(IsMarked(editor, "curves"));
            ChooseIndex(Field(editor, "curves"), before);
            Enter(editor, "sides.pos.CP", "4.5");
        }),
        CAnswers::Fill([](CDialogWindow& list) {
            Enter(list, "entry", "500");
            Push(list, "add"); // exists: a message
            Enter(list, "entry", "1250.5");
            Push(list, "add");
        }),
        CAnswers::Accept(),
    });
    OpenType(kColumn);
    EXPECT_TRUE(answers.m_texts.value(0).contains("500"));
    const auto curves = CurveOf<T_SKEL_FEMA>(Type(kColumn), 4).curves;
    EXPECT_EQ(1250.5, curves.back().axial);
    EXPECT_EQ(4.5, curves.back().sides.pos.CP);
}

TEST_F(HingeWindows, AYieldSurfaceIsPastedAndRefusedWhereARatioReachesOne)
{
    QString block; // ten points, compression first; (-) mirrors (+)
    for (int i = 0; i < 10; ++i)
        block += QString("%1\t%2\t%1\t-%2\r\n").arg(1.0 - 0.2 * i).arg(0.9 - 0.05 * i);
    CAnswers answers({
        PushOn("yieldSurface"),
        CAnswers::Fill([&](CDialogWindow& surface) {
            EXPECT_NEAR(2218.645, TextAt(surface, "yield.tension").toDouble(), 1e-3); // A fy
            EXPECT_FALSE(IsMarked(surface, "yield.y.curves")); // those of the section
            Push(surface, "useZ");                             // not used, not checked
            for (const char* name : {"yield.tension", "yield.compression", "yield.y.moment.pos",
                                     "yield.y.moment.neg", "yield.y.momentMax.pos"})
                Enter(surface, name, "200");
            Enter(surface, "yield.y.momentMax.neg", "0");
            surface.accept();
            EXPECT_TRUE(IsMarked(surface, "yield.y.momentMax.neg"));
            Enter(surface, "yield.y.momentMax.neg", "210");
            CGridView& grid = Grid(surface, "yield.y.curves");
            grid.setCurrentIndex(grid.Model().index(0, 0));
            EXPECT_EQ(1, grid.PasteText(block));
            EXPECT_FALSE(IsMarked(surface, "yield.y.curves"));
            EXPECT_TRUE(SetCell(grid.Model(), 3, 1, "1"));
            EXPECT_TRUE(IsMarked(surface, "yield.y.curves"));
            EXPECT_TRUE(SetCell(grid.Model(), 3, 1, "0.75"));
        }),
        CAnswers::Accept(),
    });
    OpenType(kColumn);
    const auto surface = Type(kColumn).yieldSurface;
    ASSERT_TRUE(surface);
    EXPECT_EQ(0.75, surface->yield.y.curves.pos[3].m);
    EXPECT_NEAR(-0.45, surface->yield.y.curves.neg[9].m, 1e-12);
    EXPECT_EQ(210.0, surface->yield.y.momentMax.neg);
}

TEST_F(HingeWindows, UserInteractionIsPastedAndMayNotRise)
{
    CAnswers answers({
        CAnswers::Fill([](CDialogWindow& type) {
            ChooseIndex(Field(type, "interaction"), 3);
            Push(type, "pmm");
        }),
        CAnswers::Fill([&](CDialogWindow& table) {
            Enter(table, "Pmax", "4500");
            CGridView& grid = Grid(table, "curves");
            grid.setCurrentIndex(grid.Model().index(0, 0));
            EXPECT_TRUE(grid.PasteText(QString("1\t0.5\r\n").repeated(11)));
            EXPECT_FALSE(IsMarked(table, "curves")); // equal values pass
            EXPECT_TRUE(SetCell(grid.Model(), 6, 1, "0.75"));
            EXPECT_TRUE(IsMarked(table, "curves"));
            EXPECT_TRUE(SetCell(grid.Model(), 6, 1, "0.5"));
        }),
    });
    OpenType(kColumn);
    EXPECT_EQ(HINGE_INTERACTION::User, Type(kColumn).interaction);
    EXPECT_EQ(4500.0, Type(kColumn).pmm.value().Pmax);
    EXPECT_EQ((T_PM_POINT{1.0, 0.5}), Type(kColumn).pmm.value().curves[0][10]);
}

TEST_F(HingeWindows, LengthsSpanAndIntegrationPointsAreTakenFromTheirWindows)
{
    CAnswers answers({
        CAnswers::Fill([](CDialogWindow& type) {
            Push(type, "length");
            Push(type, "span");
            ChooseIndex(Field(type, "definition"), 1);
            ChooseIndex(Field(type, "My.type"), 5); // Eurocode 8 has a length there too
            Push(type, "length");
            ChooseIndex(Field(type, "definition"), 2);
            Push(type, "integrationPoints");
            ChooseIndex(Field(type, "definition"), 0);
            for (const char* curve : {"My", "Fz"})
                if (IsMarked(type, std::string(curve) + ".curve"))
                    Push(type, std::string(curve) + ".active");
        }),
        CAnswers::Fill([](CDialogWindow& lengths) {
            Enter(lengths, "My.I", "0.35");
            Push(lengths, "relative");
            EXPECT_FALSE(Field(lengths, "My.I")->isVisible());
            Enter(lengths, "My.relative.J", "0.1");
        }),
        CAnswers::Fill([](CDialogWindow& span) {
            Push(span, "auto");
            Enter(span, "span", "5.25");
        }),
        CAnswers::Fill([](CDialogWindow& lengths) {
            Enter(lengths, "My.J", "0.4");
            EXPECT_EQ("0.4", TextAt(lengths, "Fx.J")); // My is that of all
            Enter(lengths, "Fx.J", "0.2");
        }),
        CAnswers::Fill([](CDialogWindow& w) { ChooseIndex(Field(w, "integrationPoints"), 4); }),
    });
    OpenType(kConcrete);
    const T_HINGE_LENGTH length = Type(kConcrete).length;
    EXPECT_EQ((T_ENDS<double>{0.35, 0.1}), length.My);
    EXPECT_TRUE(length.relative);
    EXPECT_EQ(5.25, length.span);
    EXPECT_FALSE(length.autoSpan);
    EXPECT_EQ(0.4, length.components.J[4]);
    EXPECT_EQ(0.2, length.components.J[0]);
    EXPECT_EQ(7, length.integrationPoints);
}

TEST_F(HingeWindows, TheTypeEditorListsEveryBrokenRuleAndStoresNoneOfThem)
{
    CAnswers answers({
        Visit([](CDialogWindow& type) {
            EXPECT_TRUE(IsMarked(type, "My.curve"));
            EXPECT_GE(Grid(type, "findings").Model().rowCount(), 2);
            type.accept();
            EXPECT_TRUE(type.isVisible());
            ChooseIndex(Field(type, "element"), 2); // a truss has Fx alone
            EXPECT_FALSE(Field(type, "Mz.active")->isEnabled());
            EXPECT_FALSE(Field(type, "yieldSurface")->isVisible());
        }),
        CAnswers::Accept(),
    });
    OpenType(kMistake);
    EXPECT_FALSE(Modified());
}

TEST_F(HingeWindows, HingesAreGeneratedForAListOfElementsAndDeleted)
{
    const auto& hinges = Model().hinges;
    CAnswers answers({
        Visit([&](CDialogWindow& list) {
            Push(list, "generate"); // no type is chosen
            ChooseIndex(Field(list, "type"), 0);
            Push(list, "options");
            Push(list, "generate");
            EXPECT_EQ(1, hinges.at(2).hingeType);
            Push(list, "delete");
            CGridView& grid = Grid(list, "hinges");
            grid.setCurrentIndex(grid.Model().index(0, 0));
            Push(list, "delete");
            EXPECT_EQ(2U, hinges.size());
        }),
        CAnswers::Accept(),
        CAnswers::Fill([](CDialogWindow& options) {
            Push(options, "only");
            Enter(options, "elements", "99");
            Enter(options, "elements", "3, 2-3");
            EXPECT_EQ("2, 3", TextAt(options, "elements"));
            Push(options, "materials");
            Push(options, "sections");
        }),
        CAnswers::Accept(),
        Visit([](CDialogWindow& materials) { // S275 in kN/m2, from the case file
            EXPECT_EQ("275000", Cell(Grid(materials, "rows").Model(), 0, 2));
        }),
        Visit([](CDialogWindow& w) { EXPECT_EQ(2, Grid(w, "rows").Model().rowCount()); }),
        CAnswers::Accept(),
    });
    EXPECT_TRUE(OpenHingeRecord(m_main->Desktop(), EXPLORER_TABLE::Hinges, 0));
    EXPECT_TRUE(answers.m_texts.value(1).contains("99"));
    Run("IDS_QM_UI_UNDO");
    EXPECT_EQ(3U, hinges.size());
}

TEST_F(HingeWindows, TheOlderTableEditsAFemaCurveAndAsksBeforeEditsAreLost)
{
    CAnswers answers({
        CAnswers::Fill([](CDialogWindow& table) {
            Enter(table, "sides.pos.D.strength", "1.5"); // above C
            EXPECT_TRUE(IsMarked(table, "sides.pos.D.strength"));
            table.accept();
            EXPECT_TRUE(table.isVisible());
            ChooseIndex(Field(table, "component"), 5); // asks; no: stays
            EXPECT_EQ(4, qobject_cast<QComboBox*>(Field(table, "component"))->currentIndex());
            Enter(table, "sides.pos.D.strength", "0.8");
        }),
        CAnswers::Accept(),
        CAnswers::Press(QMessageBox::No),
    });
    Run("IDS_QM_UI_HINGE_TABLE");
    EXPECT_EQ(-0.8, CurveOf<T_SKEL_FEMA>(Type(kBeam), 4).sides.neg.D.strength);
}
