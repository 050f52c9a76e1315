#include "ulffixture.h"

#include "qm_rps/unknownloadfactoriteranal.h"

#include <QAbstractSpinBox>
#include <QFileInfo>
#include <QLineEdit>

using namespace desktop_test;

namespace {

constexpr const char* kItems = "Unknown load factors";
constexpr const char* kItem = "Unknown load factor item";
constexpr const char* kStageItem = "Unknown load factor item of construction stages";
constexpr const char* kResult = "Result of unknown load factors";
constexpr const char* kConstraint = "Constraint of unknown load factors";
constexpr const char* kSettings = "Settings of the iterative analysis";

} // namespace

TEST_F(UlfWindows, ATunedBeamIsSolvedExportedAndCombined)
{
    ASSERT_TRUE(Open("tuned-beam"));
    const std::size_t before = Model().combinations.size();
    const ACT readResult = [&](CDialogWindow& w) {
        // Three-moment equation of five equal spans: 43/38 and 37/38.
        const double byHand[] = {1.0, 43 / 38.0, 37 / 38.0, 37 / 38.0, 43 / 38.0};
        for (int row = 0; row < 5; ++row)
            EXPECT_NEAR(byHand[row], Cell(Table(w), row, 1).toDouble(), 1e-8) << row;
        EXPECT_EQ("at its bound", Cell(Table(w, 1), 0, 5));
        EXPECT_TRUE(Table(w, 1).index(0, 0).data(Qt::BackgroundRole).isValid());
        EXPECT_FALSE(Picture(w).series.empty());
        AnswerFileName(File("props.xlsx"));
        Press("IDS_QM_UI_ULF_SHEET_WRITE")(w);
        EXPECT_GT(QFileInfo(File("props.xlsx")).size(), 3000);
        Type(Field(w, "combination"), "ALL"); // taken
        Press("IDS_QM_UI_ULF_MAKE_COMBINATION")(w);
        EXPECT_TRUE(Says(w, "exists already"));
        EXPECT_EQ(before, Model().combinations.size());
        Type(Field(w, "combination"), "LEVEL");
        Press("IDS_QM_UI_ULF_MAKE_COMBINATION")(w);
        EXPECT_TRUE(Says(w, "was added"));
        w.reject();
    };
    const ACT solve = [](CDialogWindow& w) {
        ChooseRow(w, 0);
        Press("IDS_QM_UI_ULF_SOLVE")(w);
    };
    CPlay play({{kItems, solve}, {kResult, readResult}, {kItems, Cancel}});
    Run("IDS_QM_UI_ULF_ITEMS");
    ASSERT_EQ(before + 1, Model().combinations.size());
    const T_LCOM_D& made = Model().combinations.rbegin()->second;
    EXPECT_EQ("LEVEL", made.name);
    EXPECT_NEAR(43 / 38.0, made.items.at(1).factor, 1e-9);
    Run("IDS_QM_UI_UNDO");
    EXPECT_EQ(before, Model().combinations.size());
}

TEST_F(UlfWindows, AnItemWithoutASolutionIsExplained)
{
    ASSERT_TRUE(Open("tuned-beam"));
    const ACT read = [](CDialogWindow& w) {
        EXPECT_TRUE(Says(w, "D2 (= 0 m), D3 (= 0 m), D4 (= 0 m), D5 (= 0 m), M3"));
        w.reject();
    };
    CPlay play({{kItem, Press("IDS_QM_UI_ULF_SOLVE")}, // refused with a message
                {kItem, Press("IDS_QM_UI_ULF_EXPLAIN")},
                {"Explanation of load factors", read},
                {kItem, Cancel}});
    OpenRecord(EXPLORER_TABLE::UlfItems, 4);
    ASSERT_EQ(1, play.m_texts.size()) << play.m_texts.join('|').toStdString();
    EXPECT_TRUE(play.m_texts[0].contains("IMPOSSIBLE"));
    EXPECT_FALSE(m_main->Doc().Undo().CanUndo());
}

TEST_F(UlfWindows, AnItemIsRefusedWithItsFieldMarkedThenStoredAsOneStep)
{
    ASSERT_TRUE(Open("tuned-beam"));
    const T_ULFI_D before = Model().ulfItems.at(1);
    const ACT spoil = [](CDialogWindow& w) {
        for (int row = 1; row <= 4; ++row)
            EXPECT_TRUE(SetCell(Table(w), row, 1, Qt::Unchecked));
        w.accept();
        EXPECT_TRUE(w.isVisible());
        EXPECT_TRUE(IsMarked(w, "unknowns"));
    };
    const ACT repair = [](CDialogWindow& w) {
        EXPECT_TRUE(SetCell(Table(w), 2, 1, Qt::Checked));
        EXPECT_TRUE(SetCell(Table(w), 2, 4, "2.5"));
        EXPECT_TRUE(SetCell(Table(w, 1), 1, 0, Qt::Unchecked)); // D3
        Type(Field(w, "name"), "ONE PROP");
        ChooseIndex(Field(w, "objective"), 2);
        w.accept();
    };
    CPlay play({{kItem, spoil}, {kItem, repair}});
    OpenRecord(EXPLORER_TABLE::UlfItems, 1);
    EXPECT_TRUE(play.m_texts.value(0).contains("No load case is marked unknown"));
    const T_ULFI_D& stored = Model().ulfItems.at(1);
    EXPECT_EQ("ONE PROP", stored.name);
    EXPECT_EQ(1U, stored.unknowns.size());
    EXPECT_EQ(2.5, stored.unknowns.at(0).weight);
    EXPECT_EQ(2, stored.objective);
    EXPECT_EQ((std::vector<std::string>{"D2", "D4", "D5"}), stored.constraints);
    Run("IDS_QM_UI_UNDO");
    EXPECT_EQ(before, Model().ulfItems.at(1));
}

TEST_F(UlfWindows, ConstraintsAreAddedAndDeletedInTheirList)
{
    ASSERT_TRUE(Open("tuned-beam"));
    const ACT fill = [](CDialogWindow& w) {
        Type(Field(w, "name"), "D2"); // taken
        ChooseIndex(Field(w, "type"), 3);
        Type(Field(w, "id"), "99"); // no such beam
        ChooseIndex(Field(w, "component"), 4);
        ChooseIndex(Field(w, "position"), 2);
        w.accept();
        EXPECT_EQ(2, w.Form().Marks());
    };
    const ACT repair = [](CDialogWindow& w) {
        Type(Field(w, "id"), "2");
        Type(Field(w, "name"), "M2 half");
        EXPECT_EQ(0, w.Form().Marks());
        Enter(w, "value", "12.5");
        w.accept();
    };
    const ACT remove = [](CDialogWindow& w) {
        EXPECT_TRUE(Cell(Table(w), 13, 1).contains("Moment y of beam 2"));
        ChooseRow(w, 0); // used by items
        Press("IDS_QM_UI_ULF_DELETE")(w);
        ChooseRow(w, 13);
        Press("IDS_QM_UI_ULF_DELETE")(w);
        EXPECT_EQ(13, Table(w).rowCount());
        w.reject();
    };
    constexpr const char* kList = "Load factor constraints";
    CPlay play({{kList, Press("IDS_QM_UI_ULF_ADD")},
                {kConstraint, fill},
                {kConstraint, repair},
                {kList, remove}});
    Run("IDS_QM_UI_ULF_CONSTRAINTS");
    EXPECT_TRUE(play.m_texts.value(0).contains("another constraint has this name"));
    EXPECT_TRUE(play.m_texts.value(1).contains("PROPS")); // those that use D2
    Run("IDS_QM_UI_UNDO");
    const T_ULFC_D& made = Model().ulfConstraints.rbegin()->second;
    EXPECT_EQ(ULFC_TYPE::Beam, made.type);
    EXPECT_EQ(2, made.position);
    EXPECT_EQ(4, made.component);
    EXPECT_NEAR(12500.0, made.value, 1e-9); // stored in N*m
}

TEST_F(UlfWindows, RowsOfAStageItemAreAddedJudgedAndDeleted)
{
    ASSERT_TRUE(Open("staged-two-hangers"));
    const T_ULSI_D before = Model().ulfStageItems.at(1);
    const ACT edit = [](CDialogWindow& w) {
        QAbstractItemModel& rows = Table(w);
        Press("IDS_QM_UI_ULF_ADD_ROW")(w);
        ASSERT_EQ(4, rows.rowCount());
        EXPECT_TRUE(SetCell(rows, 3, 0, "piece 1/First Step"));
        EXPECT_TRUE(SetCell(rows, 3, 1, "T1")); // stands there already
        w.accept();
        EXPECT_TRUE(rows.index(3, 1).data(Qt::ToolTipRole).toString().contains("row 4"));
        EXPECT_TRUE(SetCell(rows, 3, 1, "G1"));
        EXPECT_TRUE(SetCell(rows, 3, 4, "0.25"));
        EXPECT_TRUE(SetCell(rows, 3, 7, "0: sum of the dead load"));
        ChooseRow(w, 2);
        Press("IDS_QM_UI_ULF_DELETE_ROW")(w);
        w.accept();
    };
    CPlay play({{kStageItem, edit}});
    OpenRecord(EXPLORER_TABLE::UlfStageItems, 1);
    EXPECT_TRUE(play.m_texts.value(0).contains("twice"));
    const T_ULSI_D& stored = Model().ulfStageItems.at(1);
    ASSERT_EQ(3U, stored.rows.size());
    const T_ULSI_ROW& row = stored.rows.back();
    EXPECT_EQ(0.25, row.factor);
    EXPECT_EQ("G1", Model().loadCases.at(row.loadCase).name);
    EXPECT_EQ("piece 1", Model().stages.at(row.stage).name);
    EXPECT_EQ(kLoadGroupDead, row.loadGroup);
    Run("IDS_QM_UI_UNDO");
    EXPECT_EQ(before, Model().ulfStageItems.at(1));
}

TEST_F(UlfWindows, ACombinationTakesCasesAndOthersButNotItself)
{
    ASSERT_TRUE(Open("tuned-beam"));
    {
        CEditData& edit = m_main->Doc().Edit();
        ASSERT_TRUE(edit.Begin("outer"));
        ASSERT_TRUE(edit.Put(2, T_LCOM_D{"OUTER", {{true, 1, 2.0}}}));
        ASSERT_TRUE(edit.Commit());
    }
    const T_LCOM_D before = Model().combinations.at(1);
    const ACT edit = [](CDialogWindow& w) {
        EXPECT_TRUE(SetCell(Table(w), 0, 1, "1.35"));
        Press("IDS_QM_UI_ULF_ADD_ROW")(w);
        EXPECT_TRUE(SetCell(Table(w), 5, 0, "OUTER (combination)")); // which contains this one
        w.accept();
        ChooseRow(w, 5);
        Press("IDS_QM_UI_ULF_DELETE_ROW")(w);
        EXPECT_TRUE(Says(w, "1.35 W"));
        w.accept();
    };
    CPlay play({{"Load combination", edit}});
    OpenRecord(EXPLORER_TABLE::Combinations, 1);
    EXPECT_TRUE(play.m_texts.value(0).contains("contains itself"));
    EXPECT_EQ(1.35, Model().combinations.at(1).items.at(0).factor);
    Run("IDS_QM_UI_UNDO");
    EXPECT_EQ(before, Model().combinations.at(1));
}

TEST_F(UlfWindows, SettingsOfTheIterationAreJudgedAndKept)
{
    ASSERT_TRUE(Open("staged-two-hangers"));
    const ACT edit = [](CDialogWindow& w) {
        auto* spin = w.findChild<QAbstractSpinBox*>();
        auto* tolerance = w.Form().findChildren<QLineEdit*>().back();
        Key(spin, Qt::Key_Up);
        Type(tolerance, "-1");
        w.accept();
        Type(tolerance, "0.02");
        w.accept();
    };
    CPlay play({{kSettings, edit}});
    Run("IDS_QM_UI_ULF_ITER_SETTINGS");
    EXPECT_TRUE(play.m_texts.value(0).contains("0 to 99"));
    const auto settings = CUnknownLoadFactorIterAnal::Of(m_main->Doc().DynModules())->Settings();
    EXPECT_EQ((T_ULF_ITER_SETTINGS{6, 0.02}), settings);
}
