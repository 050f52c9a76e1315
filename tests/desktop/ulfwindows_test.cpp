#include "desktoptest.h"

#include "explorerpane.h"
#include "ulftools.h"

#include "qm_rps/unknownloadfactoriteranal.h"
#include "qm_ui/plotwidget.h"

#include <QApplication>
#include <QCheckBox>
#include <QComboBox>
#include <QElapsedTimer>
#include <QFile>
#include <QFileInfo>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>

#include <algorithm>
#include <cmath>

using namespace desktop_test;

namespace {

using ACT = std::function<void(CDialogWindow&)>;

/// A window that is expected, what makes it ready, and what is done on it.
struct T_SCENE {
    QString title;
    ACT act;
    std::function<bool(CDialogWindow&)> ready{};
};

void Later(QWidget* widget, std::function<void()> act)
{
    QMetaObject::invokeMethod(widget, std::move(act), Qt::QueuedConnection);
}

/// Plays the scenes one after the other, each when its window is the active one; answers message
/// boxes meanwhile. Unlike one with fixed steps it waits while an analysis is shown.
class CPlay : public QObject {
public:
    explicit CPlay(std::vector<T_SCENE> scenes) : m_scenes(std::move(scenes))
    {
        connect(&m_timer, &QTimer::timeout, this, [this] { Look(); });
        m_timer.start(1);
        m_clock.start();
    }
    ~CPlay() override { EXPECT_EQ(m_scenes.size(), m_next) << "scenes that were not played"; }
    QStringList m_texts; // of the message boxes
    QMessageBox::StandardButton m_answer = QMessageBox::Yes;

private:
    void Look()
    {
        QWidget* window = QApplication::activeModalWidget();
        if (m_pending || !window || !window->isVisible()) return;
        if (auto* box = qobject_cast<QMessageBox*>(window)) return Answer(*box);
        auto* dialog = dynamic_cast<CDialogWindow*>(window);
        constexpr int kMostMs = 60000;
        if (m_next >= m_scenes.size() || m_clock.elapsed() > kMostMs) {
            ADD_FAILURE() << "unexpected: " << window->windowTitle().toStdString();
            if (auto* any = qobject_cast<QDialog*>(window)) Later(any, [any] { any->reject(); });
            return;
        }
        const T_SCENE& scene = m_scenes[m_next];
        if (!dialog || dialog->windowTitle() != scene.title) return;
        if (scene.ready && !scene.ready(*dialog)) return;
        if (!dialog->isActiveWindow()) return dialog->activateWindow(); // after a box
        ++m_next;
        m_pending = true; // windows that the act opens have their own loop
        Later(dialog, [this, dialog, act = scene.act] {
            m_pending = false;
            act(*dialog);
        });
    }
    void Answer(QMessageBox& box)
    {
        m_texts << box.text();
        QAbstractButton* button = box.button(m_answer);
        Click(button ? button : box.button(QMessageBox::Ok));
    }

    std::vector<T_SCENE> m_scenes;
    std::size_t m_next = 0;
    bool m_pending = false;
    QTimer m_timer;
    QElapsedTimer m_clock;
};

constexpr const char* kItems = "Unknown load factors";
constexpr const char* kItem = "Unknown load factor item";
constexpr const char* kStageItem = "Unknown load factor item of construction stages";
constexpr const char* kResult = "Result of unknown load factors";
constexpr const char* kConstraint = "Constraint of unknown load factors";
constexpr const char* kRun = "Iterative analysis for pretension";
constexpr const char* kStep = "Load factors between iterations";
constexpr const char* kSettings = "Settings of the iterative analysis";

ACT Press(const char* key)
{
    return [key](CDialogWindow& w) {
        auto* button = w.findChild<QPushButton*>(QLatin1String(key));
        ASSERT_NE(nullptr, button) << key;
        ASSERT_TRUE(button->isEnabled()) << key;
        Click(button);
    };
}

void Cancel(CDialogWindow& w)
{
    w.reject();
}

template <class T = QWidget>
T& Widget(CDialogWindow& w, const char* field)
{
    return dynamic_cast<T&>(*w.Form().Find(field)->widget);
}

QAbstractItemModel& Table(CDialogWindow& w, int index = 0)
{
    return w.findChildren<CGridView*>().at(index)->Model();
}

QString Cell(QAbstractItemModel& table, int row, int column)
{
    return table.index(row, column).data().toString();
}

bool SetCell(QAbstractItemModel& table, int row, int column, const QVariant& value)
{
    const bool flag = table.index(row, column).data(Qt::CheckStateRole).isValid();
    return table.setData(table.index(row, column), value, flag ? Qt::CheckStateRole : Qt::EditRole);
}

/// The plot that the window shows (the class has no meta object of its own to be found by).
const T_PLOT& Picture(CDialogWindow& w)
{
    static const T_PLOT none;
    for (QWidget* widget : w.findChildren<QWidget*>())
        if (auto* plot = dynamic_cast<CPlotWidget*>(widget)) return plot->Plot();
    return none;
}

/// A notes field has such a text.
bool Says(CDialogWindow& w, const QString& text)
{
    return std::ranges::any_of(w.findChildren<QLabel*>(),
                               [&](const QLabel* label) { return label->text().contains(text); });
}

void ChooseRow(CDialogWindow& w, int row)
{
    auto* view = w.findChildren<CGridView*>().at(0);
    view->setCurrentIndex(view->Model().index(row, 0));
}

class UlfWindows : public DesktopTest {
protected:
    const T_MODEL& Model() { return m_main->Doc().Data().Model(); }
    void OpenRecord(EXPLORER_TABLE table, int key)
    {
        EXPECT_TRUE(OpenUlfRecord(m_main->Desktop(), table, key));
    }
    /// A copy of the example that may be written beside.
    void OpenCopy(const char* example, const char* name)
    {
        ASSERT_TRUE(Open(example));
        T_FILE_ERROR error;
        ASSERT_TRUE(m_main->Doc().SaveModelAs(File(name).toStdString(), error)) << error.text;
    }
    /// N
    double Tension(const char* loadCase)
    {
        for (const auto& entry : Model().loadCases)
            if (entry.second.name == loadCase) return entry.second.pretension.at(0).force;
        return 0.0;
    }
};

} // namespace

// ---- calculation --------------------------------------------------------------------------------

TEST_F(UlfWindows, ATunedBeamIsSolvedExportedAndCombined)
{
    ASSERT_TRUE(Open("tuned-beam"));
    const std::size_t before = Model().combinations.size();
    const ACT readResult = [&](CDialogWindow& w) {
        // Three-moment equation of five equal spans: 43/38 and 37/38.
        const double byHand[] = {1.0, 43 / 38.0, 37 / 38.0, 37 / 38.0, 43 / 38.0};
        for (int row = 0; row < 5; ++row)
            EXPECT_NEAR(byHand[row], Cell(Table(w), row, 1).toDouble(), 1e-8) << row;
        EXPECT_EQ("D2", Cell(Table(w, 1), 0, 0));
        EXPECT_EQ("at its bound", Cell(Table(w, 1), 0, 5));
        EXPECT_TRUE(Table(w, 1).index(0, 0).data(Qt::BackgroundRole).isValid());
        EXPECT_EQ("m", Cell(Table(w, 1), 0, 6));
        EXPECT_FALSE(Picture(w).series.empty());
        AnswerFileName(File("props.xlsx"));
        Press("IDS_QM_UI_ULF_SHEET_WRITE")(w);
        EXPECT_GT(QFileInfo(File("props.xlsx")).size(), 3000);
        Press("IDS_QM_UI_ULF_MAKE_COMBINATION")(w); // without a name
        EXPECT_TRUE(Says(w, "no name"));
        Type(&Widget(w, "combination"), "ALL"); // taken
        Press("IDS_QM_UI_ULF_MAKE_COMBINATION")(w);
        EXPECT_TRUE(Says(w, "exists already"));
        EXPECT_EQ(before, Model().combinations.size());
        Type(&Widget(w, "combination"), "LEVEL");
        Press("IDS_QM_UI_ULF_MAKE_COMBINATION")(w);
        EXPECT_TRUE(Says(w, "was added"));
        w.reject();
    };
    CPlay play({{kItems,
                 [](CDialogWindow& w) {
                     EXPECT_EQ("PROPS", Cell(Table(w), 0, 0));
                     ChooseRow(w, 0);
                     Press("IDS_QM_UI_ULF_SOLVE")(w);
                 }},
                {kResult, readResult},
                {kItems, Cancel}});
    Run("IDS_QM_UI_ULF_ITEMS");
    ASSERT_EQ(before + 1, Model().combinations.size());
    const T_LCOM_D& made = Model().combinations.rbegin()->second;
    EXPECT_EQ("LEVEL", made.name);
    EXPECT_NEAR(43 / 38.0, made.items.at(1).factor, 1e-9);
    Run("IDS_QM_UI_UNDO");
    EXPECT_EQ(before, Model().combinations.size());
}

TEST_F(UlfWindows, ASheetThatCantBeWrittenSaysSo)
{
    ASSERT_TRUE(Open("tuned-beam"));
    CPlay play({{kItem, Press("IDS_QM_UI_ULF_SOLVE")},
                {kResult,
                 [&](CDialogWindow& w) {
                     AnswerFileName(File("no-such-folder/props.xlsx"));
                     Press("IDS_QM_UI_ULF_SHEET_WRITE")(w);
                     w.reject();
                 }},
                {kItem, Cancel}});
    OpenRecord(EXPLORER_TABLE::UlfItems, 1);
    ASSERT_EQ(1, play.m_texts.size());
    EXPECT_TRUE(play.m_texts[0].contains("no-such-folder"));
}

TEST_F(UlfWindows, AnItemWithoutASolutionIsExplained)
{
    ASSERT_TRUE(Open("tuned-beam"));
    CPlay play({{kItem, Press("IDS_QM_UI_ULF_SOLVE")}, // refused with a message
                {kItem, Press("IDS_QM_UI_ULF_EXPLAIN")},
                {"Explanation of load factors",
                 [](CDialogWindow& w) {
                     EXPECT_TRUE(Says(w, "D2 (= 0 m), D3 (= 0 m), D4 (= 0 m), D5 (= 0 m), M3"));
                     w.reject();
                 }},
                {kItem, Cancel}});
    OpenRecord(EXPLORER_TABLE::UlfItems, 4);
    ASSERT_EQ(1, play.m_texts.size());
    EXPECT_TRUE(play.m_texts[0].contains("IMPOSSIBLE"));
    EXPECT_FALSE(m_main->Doc().Undo().CanUndo());
}

// ---- editing ------------------------------------------------------------------------------------

TEST_F(UlfWindows, AnItemIsRefusedWithItsFieldMarkedThenStoredAsOneStep)
{
    ASSERT_TRUE(Open("tuned-beam"));
    const T_ULFI_D before = Model().ulfItems.at(1);
    const ACT spoil = [](CDialogWindow& w) {
        for (int row = 1; row <= 4; ++row)
            EXPECT_TRUE(SetCell(Table(w), row, 1, Qt::Unchecked));
        EXPECT_FALSE(SetCell(Table(w), 1, 4, "heavy"));
        w.accept();
        EXPECT_TRUE(w.isVisible());
        EXPECT_TRUE(w.Form().Find("unknowns")->IsMarked());
    };
    const ACT repair = [](CDialogWindow& w) {
        EXPECT_TRUE(SetCell(Table(w), 2, 1, Qt::Checked));
        EXPECT_TRUE(SetCell(Table(w), 2, 4, "2.5"));
        EXPECT_TRUE(SetCell(Table(w, 1), 1, 0, Qt::Unchecked)); // D3
        Type(&Widget(w, "name"), "ONE PROP");
        ChooseIndex(&Widget(w, "objective"), 2);
        w.accept();
    };
    {
        CPlay play({{kItem, spoil}, {kItem, Cancel}});
        OpenRecord(EXPLORER_TABLE::UlfItems, 1);
        EXPECT_TRUE(play.m_texts.value(0).contains("No load case is marked unknown"));
        EXPECT_EQ(before, Model().ulfItems.at(1));
        EXPECT_FALSE(m_main->Doc().Data().IsModified());
    }
    CPlay play({{kItem, spoil}, {kItem, repair}});
    OpenRecord(EXPLORER_TABLE::UlfItems, 1);
    const T_ULFI_D& stored = Model().ulfItems.at(1);
    EXPECT_EQ("ONE PROP", stored.name);
    ASSERT_EQ(1U, stored.unknowns.size());
    EXPECT_EQ(2.5, stored.unknowns[0].weight);
    EXPECT_EQ(2, stored.objective);
    EXPECT_EQ((std::vector<std::string>{"D2", "D4", "D5"}), stored.constraints);
    Run("IDS_QM_UI_UNDO");
    EXPECT_EQ(before, Model().ulfItems.at(1));
}

TEST_F(UlfWindows, ConstraintsAreAddedChangedAndDeletedFromTheirList)
{
    ASSERT_TRUE(Open("tuned-beam"));
    const ACT fill = [](CDialogWindow& w) {
        Type(&Widget(w, "name"), "D2"); // taken
        ChooseIndex(&Widget(w, "type"), 3);
        Type(&Widget(w, "id"), "99"); // no such beam
        ChooseIndex(&Widget(w, "component"), 4);
        ChooseIndex(&Widget(w, "position"), 2);
        w.accept();
        EXPECT_TRUE(w.isVisible());
        EXPECT_EQ(2, w.Form().Marks());
    };
    const ACT repair = [](CDialogWindow& w) {
        Type(&Widget(w, "id"), "2.5");
        w.accept(); // what can't be read has the focus
        EXPECT_EQ(w.focusWidget(), &Widget(w, "id"));
        Type(&Widget(w, "id"), "2");
        Type(&Widget(w, "name"), "M2 half");
        EXPECT_EQ(0, w.Form().Marks());
        ASSERT_TRUE(Widget(w, "value").isEnabled());
        Type(&Widget(w, "value"), "12.5");
        w.accept();
    };
    CPlay play({{"Load factor constraints", Press("IDS_QM_UI_ULF_ADD")},
                {kConstraint, fill},
                {kConstraint, repair},
                {"Load factor constraints",
                 [](CDialogWindow& w) {
                     EXPECT_TRUE(Cell(Table(w), 13, 1).contains("Moment y of beam 2"));
                     ChooseRow(w, 0); // used by items
                     Press("IDS_QM_UI_ULF_DELETE")(w);
                     ChooseRow(w, 13);
                     Press("IDS_QM_UI_ULF_MODIFY")(w);
                 }},
                {kConstraint, Cancel},
                {"Load factor constraints", [](CDialogWindow& w) {
                     Press("IDS_QM_UI_ULF_DELETE")(w);
                     EXPECT_EQ(13, Table(w).rowCount());
                     w.reject();
                 }}});
    Run("IDS_QM_UI_ULF_CONSTRAINTS");
    EXPECT_TRUE(play.m_texts.value(0).contains("another constraint has this name"));
    EXPECT_TRUE(play.m_texts.value(1).contains("PROPS")); // those that use D2
    Run("IDS_QM_UI_UNDO");
    const T_ULFC_D& made = Model().ulfConstraints.rbegin()->second;
    EXPECT_EQ("M2 half", made.name);
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
        EXPECT_FALSE(SetCell(rows, 3, 0, "piece 9/First Step"));
        EXPECT_TRUE(SetCell(rows, 3, 1, "T1")); // stands there already
        w.accept();
        EXPECT_TRUE(w.isVisible());
        EXPECT_TRUE(rows.index(3, 1).data(Qt::ToolTipRole).toString().contains("row 4"));
        EXPECT_TRUE(SetCell(rows, 3, 1, "G1"));
        EXPECT_TRUE(SetCell(rows, 3, 4, "0.25"));
        EXPECT_TRUE(SetCell(rows, 3, 7, "Dead load"));
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
        EXPECT_FALSE(SetCell(Table(w), 0, 1, "1,35"));
        Press("IDS_QM_UI_ULF_ADD_ROW")(w);
        EXPECT_TRUE(SetCell(Table(w), 5, 0, "OUTER (combination)")); // which contains this one
        w.accept();
        EXPECT_TRUE(w.isVisible());
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
        EXPECT_TRUE(w.isVisible());
        Type(tolerance, "0.02");
        w.accept();
    };
    CPlay play({{kSettings, edit}});
    Run("IDS_QM_UI_ULF_ITER_SETTINGS");
    EXPECT_TRUE(play.m_texts.value(0).contains("0 to 99"));
    const auto settings = CUnknownLoadFactorIterAnal::Of(m_main->Doc().DynModules())->Settings();
    EXPECT_EQ((T_ULF_ITER_SETTINGS{6, 0.02}), settings);
}

// ---- iteration ----------------------------------------------------------------------------------

namespace {

/// Ticks "iterate" and goes on, and does something else before that.
ACT WantMore(std::function<void()> also = {})
{
    return [also](CDialogWindow& w) {
        for (QCheckBox* box : w.findChildren<QCheckBox*>()) {
            ASSERT_TRUE(box->isEnabled());
            Click(box);
        }
        if (also) also();
        w.accept();
    };
}

bool HasEnded(CDialogWindow& w)
{
    return w.findChild<QPushButton*>("IDS_QM_UI_ULF_START")->isEnabled();
}

} // namespace

TEST_F(UlfWindows, TwoHangersConvergeInTheWindowOfTheRun)
{
    OpenCopy("staged-two-hangers", "hangers.qmdb");
    EXPECT_NEAR(100e3, Tension("T1"), 1e-6);
    const ACT read = [](CDialogWindow& w) {
        EXPECT_TRUE(Says(w, "Converged"));
        QAbstractItemModel& steps = Table(w);
        ASSERT_EQ(2, steps.rowCount());
        EXPECT_EQ("hangers_01.qmdb", Cell(steps, 1, 2));
        EXPECT_NEAR(std::sqrt(1.5 * 1.5 + 0.25 * 0.25), Cell(steps, 0, 1).toDouble(), 1e-4);
        // 10/8 and 3/8 of q L = 200 kN over the 100 kN at the start, both applied.
        EXPECT_NEAR(2.5, Cell(Table(w, 1), 0, 4).toDouble(), 1e-6);
        EXPECT_NEAR(0.75, Cell(Table(w, 1), 1, 4).toDouble(), 1e-6);
        EXPECT_NEAR(1.0, Cell(Table(w, 1), 0, 2).toDouble(), 1e-6);
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
    EXPECT_TRUE(QFileInfo::exists(File("hangers.ulf")));
    EXPECT_TRUE(play.m_texts.isEmpty());
}

TEST_F(UlfWindows, AStoppedRunLeavesTheLoadsAndStaysOpenUntilItHasEnded)
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
    CPlay play({{kRun, start},
                {kStep, WantMore(escape)},
                {kRun,
                 [](CDialogWindow& w) {
                     EXPECT_TRUE(Says(w, "Stopped"));
                     EXPECT_EQ(1, Table(w).rowCount());
                     w.reject();
                 },
                 HasEnded}});
    Run("IDS_QM_UI_ULF_ITERATE");
    EXPECT_TRUE(stayed);
    EXPECT_EQ(loads, Model().loadCases);
    EXPECT_FALSE(m_main->Doc().IsExcuted());
}

TEST_F(UlfWindows, ARunIsRefusedWithoutAFileAndAsksAboutAnOldReport)
{
    ASSERT_TRUE(Open("staged-two-hangers"));
    const T_MODEL model = Model();
    OpenCopy("staged-two-hangers", "hangers.qmdb");
    QFile report(File("hangers.ulf"));
    ASSERT_TRUE(report.open(QIODevice::WriteOnly));
    report.write("old\n");
    report.close();
    {
        CPlay play({{kRun, Press("IDS_QM_UI_ULF_START")},
                    {kStep, WantMore()},
                    {kRun,
                     [](CDialogWindow& w) {
                         EXPECT_TRUE(Says(w, "Converged"));
                         w.reject();
                     },
                     HasEnded}});
        play.m_answer = QMessageBox::No; // add to it
        Run("IDS_QM_UI_ULF_ITERATE");
        EXPECT_TRUE(play.m_texts.value(0).contains("hangers.ulf"));
    }
    ASSERT_TRUE(report.open(QIODevice::ReadOnly));
    const QByteArray text = report.readAll();
    EXPECT_TRUE(text.startsWith("old\n"));
    EXPECT_TRUE(text.contains("Iteration = 1"));

    m_main->Doc().NewModel();
    CEditData& edit = m_main->Doc().Edit();
    ASSERT_TRUE(edit.Begin("stages"));
    for (const auto& [key, item] : model.ulfStageItems)
        ASSERT_TRUE(edit.Put(key, item));
    ASSERT_TRUE(edit.Commit());
    m_main->Refresh();
    CPlay play({{kRun, Press("IDS_QM_UI_ULF_START")}, {kRun, [](CDialogWindow& w) {
                                                           EXPECT_TRUE(
                                                               Says(w, "Save the model first"));
                                                           w.reject();
                                                       }}});
    Run("IDS_QM_UI_ULF_ITERATE");
}
