#include "desktoptest.h"

#include "hingetools.h"
#include "qm_ui/plot/plotwidget.h"

#include <QAction>
#include <QApplication>
#include <QComboBox>
#include <QDialog>
#include <QLineEdit>
#include <QPushButton>
#include <QTabWidget>

using namespace desktop_test;

namespace {

using STEP = CAnswers::STEP;

/// The widget of a field, on its page.
QWidget* At(CDialogWindow& window, const std::string& name)
{
    CFormField* field = window.Form().Find(name);
    if (!field) {
        ADD_FAILURE() << "no field " << name;
        return nullptr;
    }
    for (QWidget* page = field->widget; page; page = page->parentWidget())
        if (QWidget* stack = page->parentWidget())
            if (auto* tabs = qobject_cast<QTabWidget*>(stack->parentWidget()))
                tabs->setCurrentWidget(page);
    return field->widget;
}

bool IsMarked(CDialogWindow& window, const std::string& name)
{
    const CFormField* field = window.Form().Find(name);
    return field && field->IsMarked();
}

void Enter(CDialogWindow& window, const std::string& name, const QString& text)
{
    QWidget* field = At(window, name);
    ASSERT_NE(nullptr, field);
    ASSERT_TRUE(field->isEnabled()) << name;
    QApplication::setActiveWindow(&window); // also after a message
    Type(field, text);
}

QString TextAt(CDialogWindow& window, const std::string& name)
{
    auto* edit = qobject_cast<QLineEdit*>(At(window, name));
    return edit ? edit->text() : QString();
}

/// Presses a button or turns a check box, by the keyboard.
void Push(CDialogWindow& window, const std::string& name)
{
    QWidget* button = At(window, name);
    ASSERT_NE(nullptr, button);
    ASSERT_TRUE(button->isEnabled()) << name;
    Key(button, Qt::Key_Space);
}

CGridView* GridAt(CDialogWindow& window, const std::string& name)
{
    return dynamic_cast<CGridView*>(At(window, name));
}

/// Closes a window that only shows.
STEP Visit(std::function<void(CDialogWindow&)> look)
{
    return CAnswers::Fill(
        [look = std::move(look)](CDialogWindow& window) {
            look(window);
            window.reject();
        },
        false);
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
    std::size_t Types() { return m_main->Doc().Data().Model().hingeTypes.size(); }
    bool Modified() { return m_main->Doc().Data().IsModified(); }
};

/// Rows and columns of one number as a spreadsheet copies them.
QString Block(int rows, const QString& line)
{
    QString text;
    for (int i = 0; i < rows; ++i)
        text += line + "\r\n";
    return text;
}

} // namespace

TEST_F(HingeWindows, TypesAreAddedCopiedAndDeletedEachAsOneStepAndUsersAreNamed)
{
    CAnswers answers({
        Visit([&](CDialogWindow& list) {
            EXPECT_EQ(6, GridAt(list, "types")->Model().rowCount());
            Push(list, "IDS_QM_UI_HINGE_DELETE"); // none is chosen
            Push(list, "IDS_QM_UI_HINGE_ADD");
            EXPECT_EQ(7U, Types());
            Push(list, "IDS_QM_UI_HINGE_COPY"); // of the new one, which is chosen
            EXPECT_EQ("girder (2)", Type(8).name);
            Push(list, "IDS_QM_UI_HINGE_DELETE");
            EXPECT_EQ(7U, Types());
            CGridView* types = GridAt(list, "types");
            types->setCurrentIndex(types->Model().index(0, 0));
            Push(list, "IDS_QM_UI_HINGE_DELETE"); // used
            EXPECT_EQ(7U, Types());
        }),
        CAnswers::Accept(),
        CAnswers::Fill([](CDialogWindow& editor) {
            EXPECT_TRUE(IsMarked(editor, "name"));
            Enter(editor, "name", "steel beam");
            EXPECT_TRUE(IsMarked(editor, "name")); // taken by another type
            Enter(editor, "name", "girder");
            EXPECT_EQ(0, editor.Form().Marks());
        }),
        CAnswers::Accept(),
    });
    Run("IDS_QM_UI_HINGE_TYPES");
    EXPECT_TRUE(answers.m_texts.value(1).contains("used by elements: 2"))
        << answers.m_texts.value(1).toStdString();
    for (const std::size_t left : {8U, 7U, 6U}) { // before the delete, the copy, the new one
        Run("IDS_QM_UI_UNDO");
        EXPECT_EQ(left, Types());
    }
}

namespace {

/// A curve editor behind a button of the type editor: a value that breaks a rule, one that keeps
/// all, and where it is stored.
struct T_CURVE_CASE {
    const char* what;
    int type;
    const char *button, *field, *bad, *good;
    double (*stored)(const T_PHGT_D&);
    double expected;
};
template <class CURVE>
const CURVE& CurveOf(const T_PHGT_D& t, std::size_t component)
{
    return std::get<CURVE>(t.components[component].curves.I);
}
// clang-format off
const T_CURVE_CASE kCurves[] = {
    {"FEMA point",        kBeam,     "My.curve", "sides.pos.C.deform",  "0.5",    "9.5",   [](const T_PHGT_D& t) { return CurveOf<T_SKEL_FEMA>(t, 4).sides.pos.C.deform; }, 9.5},
    {"FEMA criterion",    kBeam,     "My.curve", "sides.pos.LS",        "1",      "6.5",   [](const T_PHGT_D& t) { return CurveOf<T_SKEL_FEMA>(t, 4).sides.neg.LS; }, -6.5},
    {"FEMA unloading",    kBeam,     "My.curve", "unloadExponent",      "-1",     "0.5",   [](const T_PHGT_D& t) { return CurveOf<T_SKEL_FEMA>(t, 4).unloadExponent; }, 0.5},
    {"gap",               kBrace,    "Fx.curve", "sides.pos.gap",       "-0.001", "0.003", [](const T_PHGT_D& t) { return CurveOf<T_SKEL_MULTI>(t, 0).sides.pos.gap; }, 0.003},
    {"yield force",       kBrace,    "Fx.curve", "sides.pos.P1",        "0",      "612.5", [](const T_PHGT_D& t) { return CurveOf<T_SKEL_MULTI>(t, 0).sides.pos.P1; }, 612.5},
    {"Eurocode LS",       kConcrete, "My.curve", "sides.pos.LS",        "0.001",  "2.25",  [](const T_PHGT_D& t) { return CurveOf<T_SKEL_EC8>(t, 4).sides.pos.LS; }, 2.25},
};
// clang-format on

} // namespace

TEST_F(HingeWindows, ACurveEditorMarksBrokenRulesWhileTypingRefusesThemAndTakesTheRest)
{
    for (const T_CURVE_CASE& c : kCurves) {
        SCOPED_TRACE(c.what);
        const T_PHGT_D given = Type(c.type);
        CAnswers answers({
            CAnswers::Fill([&](CDialogWindow& type) { Push(type, c.button); }),
            CAnswers::Fill([&](CDialogWindow& editor) {
                Enter(editor, c.field, c.good);
                const int before = editor.Form().Marks();
                EXPECT_FALSE(IsMarked(editor, c.field));
                Enter(editor, c.field, c.bad);
                EXPECT_TRUE(IsMarked(editor, c.field));
                EXPECT_GT(editor.Form().Marks(), before);
                editor.accept(); // a message, and the window stays
                EXPECT_TRUE(editor.isVisible());
                Enter(editor, c.field, "1 000");
                EXPECT_TRUE(IsMarked(editor, c.field)); // no number
                Enter(editor, c.field, c.good);
            }),
            CAnswers::Accept(),
        });
        OpenType(c.type);
        EXPECT_EQ(1, answers.m_texts.size());
        EXPECT_DOUBLE_EQ(c.expected, c.stored(Type(c.type)));
        Run("IDS_QM_UI_UNDO"); // the whole type is one step
        EXPECT_EQ(given, Type(c.type));
    }
}

TEST_F(HingeWindows, CancelLeavesTheDocumentUntouched)
{
    for (const T_CURVE_CASE& c : kCurves) {
        SCOPED_TRACE(c.what);
        const T_PHGT_D before = Type(c.type);
        CAnswers answers({
            Visit([&](CDialogWindow& type) {
                Push(type, c.button);
                Enter(type, "name", "other");
            }),
            Visit([&](CDialogWindow& editor) { Enter(editor, c.field, c.good); }),
        });
        OpenType(c.type);
        EXPECT_EQ(before, Type(c.type));
        EXPECT_FALSE(Modified());
    }
}

TEST_F(HingeWindows, ThePreviewFollowsEachChangeAndTheMeasureComesBackDigitByDigit)
{
    CAnswers answers({
        Visit([](CDialogWindow& type) { Push(type, "My.curve"); }),
        Visit([](CDialogWindow& editor) {
            auto* plot = dynamic_cast<CPlotWidget*>(At(editor, "picture"));
            ASSERT_NE(nullptr, plot);
            // -E -D -C -B A B C D E
            ASSERT_EQ(9U, plot->Plot().series.at(0).x.size());
            EXPECT_EQ(10.0, plot->Plot().series[0].x[6]);
            Enter(editor, "sides.pos.C.deform", "9.5");
            EXPECT_EQ(9.5, plot->Plot().series[0].x[6]);
            EXPECT_EQ(-9.5, plot->Plot().series[0].x[2]); // symmetric
            Enter(editor, "sides.pos.C.deform", "10");
            ChooseIndex(At(editor, "measure"), 1);
            // (10 - 1) * 0.00741258651
            EXPECT_DOUBLE_EQ(0.06671327859, TextAt(editor, "sides.pos.C.deform").toDouble());
            ChooseIndex(At(editor, "measure"), 0);
            EXPECT_EQ("10", TextAt(editor, "sides.pos.C.deform"));
        }),
    });
    OpenType(kBeam);
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
        CAnswers::Fill([](CDialogWindow& type) { Push(type, "My.curve"); }),
        CAnswers::Fill([](CDialogWindow& editor) {
            QWidget* forces = At(editor, "curves");
            const int before = qobject_cast<QComboBox*>(forces)->count();
            Push(editor, "axialList");
            EXPECT_EQ(before + 1, qobject_cast<QComboBox*>(forces)->count());
            // A broken rule of a force that is not on show marks the choice.
            ChooseIndex(forces, before);
            Enter(editor, "sides.pos.CP", "0.01");
            EXPECT_TRUE(IsMarked(editor, "sides.pos.CP"));
            ChooseIndex(At(editor, "curves"), 0);
            EXPECT_FALSE(IsMarked(editor, "sides.pos.CP"));
            EXPECT_TRUE(IsMarked(editor, "curves"));
            ChooseIndex(At(editor, "curves"), before);
            Enter(editor, "sides.pos.CP", "4.5");
        }),
        CAnswers::Fill([](CDialogWindow& list) {
            Enter(list, "entry", "500");
            Push(list, "add"); // exists: a message
            CGridView* forces = GridAt(list, "axial");
            const int before = forces->Model().rowCount();
            Enter(list, "entry", "1250.5");
            Push(list, "add");
            EXPECT_EQ(before + 1, forces->Model().rowCount());
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
    // Ten points, compression first; (-) mirrors (+).
    QString block;
    for (int i = 0; i < 10; ++i) {
        const QString p = QString::number(1.0 - 0.2 * i), m = QString::number(0.9 - 0.05 * i);
        block += p + "\t" + m + "\t" + p + "\t-" + m + "\r\n";
    }
    CAnswers answers({
        CAnswers::Fill([](CDialogWindow& type) { Push(type, "yieldSurface"); }),
        CAnswers::Fill([&](CDialogWindow& surface) {
            Push(surface, "useZ"); // not used, not checked
            for (const char* name : {"yield.tension", "yield.compression", "yield.y.moment.pos",
                                     "yield.y.moment.neg", "yield.y.momentMax.pos"})
                Enter(surface, name, "200");
            surface.accept(); // MUy,max(-) is 0
            EXPECT_TRUE(IsMarked(surface, "yield.y.momentMax.neg"));
            Enter(surface, "yield.y.momentMax.neg", "210");
            CGridView* grid = GridAt(surface, "yield.y.curves");
            EXPECT_TRUE(IsMarked(surface, "yield.y.curves")); // all points are 0
            grid->setCurrentIndex(grid->Model().index(0, 0));
            EXPECT_EQ(0, grid->PasteText(block + "1\t1\t1\t1\r\n")); // a row too many
            EXPECT_EQ(1, grid->PasteText(block));
            EXPECT_FALSE(IsMarked(surface, "yield.y.curves"));
            const QModelIndex ratio = grid->Model().index(3, 1);
            EXPECT_TRUE(grid->Model().setData(ratio, "1", Qt::EditRole));
            EXPECT_TRUE(ratio.data(Qt::ToolTipRole).toString().contains("M/MY,max(+)"));
            EXPECT_TRUE(grid->Model().setData(ratio, "0.75", Qt::EditRole));
        }),
        CAnswers::Accept(),
        CAnswers::Accept(),
    });
    OpenType(kColumn);
    const auto surface = Type(kColumn).yieldSurface;
    ASSERT_TRUE(surface);
    EXPECT_EQ(0.75, surface->yield.y.curves.pos[3].m);
    EXPECT_NEAR(-0.45, surface->yield.y.curves.neg[9].m, 1e-12);
    EXPECT_EQ(210.0, surface->yield.y.momentMax.neg);
    EXPECT_FALSE(surface->yield.z.used);
}

TEST_F(HingeWindows, UserInteractionIsPastedWholeOrNotAtAllAndMayNotRise)
{
    CAnswers answers({
        CAnswers::Fill([](CDialogWindow& type) {
            ChooseIndex(At(type, "interaction"), 3);
            Push(type, "pmm");
        }),
        CAnswers::Fill([&](CDialogWindow& table) {
            Enter(table, "Pmax", "-1");
            EXPECT_TRUE(IsMarked(table, "Pmax"));
            Enter(table, "Pmax", "4500");
            CGridView* grid = GridAt(table, "curves");
            grid->setCurrentIndex(grid->Model().index(0, 0));
            for (const QString& bad : {Block(12, "1\t1"), Block(2, "1\t2\t3"), QString("1\tx\r\n"),
                                       QString("1\t1\r\n1\r\n"), QString()})
                EXPECT_EQ(0, grid->PasteText(bad)) << bad.toStdString();
            EXPECT_EQ("0", grid->Model().index(0, 0).data().toString());
            EXPECT_EQ(1, grid->PasteText(Block(11, "1\t0.5")));
            EXPECT_FALSE(IsMarked(table, "curves")); // equal values pass
            EXPECT_TRUE(grid->Model().setData(grid->Model().index(6, 1), "0.75", Qt::EditRole));
            EXPECT_TRUE(IsMarked(table, "curves"));
            table.accept();
            EXPECT_TRUE(table.isVisible());
            EXPECT_TRUE(grid->Model().setData(grid->Model().index(6, 1), "0.5", Qt::EditRole));
        }),
        CAnswers::Accept(),
        CAnswers::Accept(),
        CAnswers::Accept(),
        CAnswers::Accept(),
        CAnswers::Accept(),
        CAnswers::Accept(),
    });
    OpenType(kColumn);
    const auto table = Type(kColumn).pmm;
    ASSERT_TRUE(table);
    EXPECT_EQ(4500.0, table->Pmax);
    EXPECT_EQ((T_PM_POINT{1.0, 0.5}), table->curves[0][10]);
    EXPECT_EQ(HINGE_INTERACTION::User, Type(kColumn).interaction);
}

TEST_F(HingeWindows, LengthsSpanAndIntegrationPointsAreTakenFromTheirWindows)
{
    CAnswers answers({
        CAnswers::Fill([](CDialogWindow& type) {
            Push(type, "length");
            Push(type, "span");
            ChooseIndex(At(type, "definition"), 1);
            ChooseIndex(At(type, "My.type"), 5); // Eurocode 8 has a length there too
            Push(type, "length");
            ChooseIndex(At(type, "definition"), 2);
            Push(type, "integrationPoints");
            ChooseIndex(At(type, "definition"), 0);
            for (const char* curve : {"My", "Fz"})
                if (IsMarked(type, std::string(curve) + ".curve"))
                    Push(type, std::string(curve) + ".active");
        }),
        CAnswers::Fill([](CDialogWindow& lengths) {
            Enter(lengths, "My.I", "0.35");
            Push(lengths, "relative");
            EXPECT_FALSE(At(lengths, "My.I")->isVisible());
            EXPECT_TRUE(At(lengths, "My.relative.J")->isVisible());
            Enter(lengths, "My.relative.J", "0.1");
        }),
        CAnswers::Fill([](CDialogWindow& span) {
            QWidget* field = At(span, "span");
            const bool automatic = !field->isEnabled();
            if (automatic) Push(span, "auto");
            Enter(span, "span", "5.25");
        }),
        CAnswers::Fill([](CDialogWindow& lengths) {
            Enter(lengths, "My.J", "0.4");
            EXPECT_EQ("0.4", TextAt(lengths, "Fx.J")); // My is that of all
            Enter(lengths, "Fx.J", "0.2");
        }),
        CAnswers::Fill(
            [](CDialogWindow& points) { ChooseIndex(At(points, "integrationPoints"), 4); }),
    });
    OpenType(kConcrete);
    const T_HINGE_LENGTH length = Type(kConcrete).length;
    EXPECT_EQ(0.35, length.My.I);
    EXPECT_EQ(0.1, length.My.J);
    EXPECT_TRUE(length.relative);
    EXPECT_EQ(5.25, length.span);
    EXPECT_FALSE(length.autoSpan);
    EXPECT_EQ(0.4, length.components.J[4]);
    EXPECT_EQ(0.2, length.components.J[0]);
    EXPECT_EQ(7, length.integrationPoints);
}

TEST_F(HingeWindows, MasonryRefusesACoefficientOfZeroAndTakesOne)
{
    CAnswers answers({
        CAnswers::Fill([](CDialogWindow& type) { Push(type, "masonry."); }),
        CAnswers::Fill([](CDialogWindow& masonry) {
            ChooseIndex(At(masonry, "form"), 1);
            Enter(masonry, "distribution", "0");
            EXPECT_TRUE(IsMarked(masonry, "distribution"));
            masonry.accept();
            EXPECT_TRUE(masonry.isVisible());
            Enter(masonry, "distribution", "1");
            EXPECT_EQ(0, masonry.Form().Marks());
        }),
        CAnswers::Accept(),
    });
    OpenType(kPier);
    ASSERT_TRUE(Type(kPier).masonry);
    EXPECT_EQ(2, Type(kPier).masonry->form);
    EXPECT_EQ(1.0, Type(kPier).masonry->distribution);
}

TEST_F(HingeWindows, TheTypeEditorListsEveryBrokenRuleAndStoresNoneOfThem)
{
    CAnswers answers({
        CAnswers::Fill(
            [](CDialogWindow& type) {
                EXPECT_TRUE(IsMarked(type, "My.curve"));
                EXPECT_GE(GridAt(type, "findings")->Model().rowCount(), 2);
                type.accept();
                EXPECT_TRUE(type.isVisible());
                ChooseIndex(At(type, "element"), 2); // a truss has Fx alone
                EXPECT_FALSE(At(type, "Mz.active")->isEnabled());
                EXPECT_FALSE(At(type, "yieldSurface")->isVisible());
                type.reject();
            },
            false),
        CAnswers::Accept(),
    });
    OpenType(kMistake);
    EXPECT_FALSE(Modified());
}

TEST_F(HingeWindows, HingesAreGeneratedForAListOfElementsAndDeleted)
{
    const auto hinges = [&] { return m_main->Doc().Data().Model().hinges.size(); };
    CAnswers answers({
        Visit([&](CDialogWindow& list) {
            EXPECT_EQ(3, GridAt(list, "hinges")->Model().rowCount());
            Push(list, "generate"); // no type is chosen
            ChooseIndex(At(list, "type"), 0);
            Push(list, "options");
            Push(list, "generate");
            EXPECT_EQ(1, m_main->Doc().Data().Model().hinges.at(2).hingeType);
            Push(list, "delete");
            CGridView* grid = GridAt(list, "hinges");
            grid->setCurrentIndex(grid->Model().index(0, 0));
            Push(list, "delete");
            EXPECT_EQ(2U, hinges());
        }),
        CAnswers::Accept(),
        CAnswers::Fill([](CDialogWindow& options) {
            Push(options, "only");
            for (const char* bad : {"2-", "x", "99"})
                Enter(options, "elements", bad);
            EXPECT_EQ("", TextAt(options, "elements"));
            Enter(options, "elements", "3, 2-3");
            EXPECT_EQ("2, 3", TextAt(options, "elements"));
            Push(options, "materials");
            Push(options, "sections");
        }),
        CAnswers::Accept(),
        CAnswers::Accept(),
        CAnswers::Accept(),
        Visit([](CDialogWindow& materials) {
            // S275 in kN/m2, from the case file
            EXPECT_EQ("275000", GridAt(materials, "rows")->Model().index(0, 2).data().toString());
        }),
        Visit([](CDialogWindow& sections) {
            EXPECT_EQ(2, GridAt(sections, "rows")->Model().rowCount());
        }),
        CAnswers::Accept(),
    });
    EXPECT_TRUE(OpenHingeRecord(m_main->Desktop(), EXPLORER_TABLE::Hinges, 0));
    EXPECT_TRUE(answers.m_texts.value(3).contains("99"));
    Run("IDS_QM_UI_UNDO");
    EXPECT_EQ(3U, hinges());
}

TEST_F(HingeWindows, TheOlderTableEditsAFemaCurveAndAsksBeforeEditsAreLost)
{
    CAnswers answers({
        CAnswers::Fill([](CDialogWindow& table) {
            Enter(table, "sides.pos.D.strength", "1.5"); // above C
            EXPECT_TRUE(IsMarked(table, "sides.pos.D.strength"));
            table.accept();
            EXPECT_TRUE(table.isVisible());
            ChooseIndex(At(table, "component"), 5); // asks; no: stays
            EXPECT_EQ(4, qobject_cast<QComboBox*>(At(table, "component"))->currentIndex());
            Enter(table, "sides.pos.D.strength", "0.8");
        }),
        CAnswers::Accept(),
        CAnswers::Press(QMessageBox::No),
    });
    Run("IDS_QM_UI_HINGE_TABLE");
    EXPECT_EQ(0.8, CurveOf<T_SKEL_FEMA>(Type(kBeam), 4).sides.pos.D.strength);
    EXPECT_EQ(-0.8, CurveOf<T_SKEL_FEMA>(Type(kBeam), 4).sides.neg.D.strength);
}

TEST_F(HingeWindows, ACommaIsTheSeparatorWhereTheLocaleHasIt)
{
    QLocale::setDefault(QLocale(QLocale::Italian));
    CAnswers answers({
        CAnswers::Fill([](CDialogWindow& type) { Push(type, "Fx.curve"); }),
        CAnswers::Fill([](CDialogWindow& editor) {
            Enter(editor, "sides.pos.gap", "0,0025");
            EXPECT_EQ("0,0025", TextAt(editor, "sides.pos.gap"));
        }),
    });
    OpenType(kBrace);
    EXPECT_EQ(0.0025, CurveOf<T_SKEL_MULTI>(Type(kBrace), 0).sides.pos.gap);
}
