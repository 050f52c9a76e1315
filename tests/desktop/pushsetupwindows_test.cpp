// The windows that set a push up, with real events.
#include "desktoptest.h"

#include "qm_rps/modelessdlgctrl.h"
#include "qm_rps/rps_main.h"
#include "qm_ui/plot/plotwidget.h"

#include <QApplication>

using namespace desktop_test;

namespace {

class PushSetupWindows : public DesktopTest {
protected:
    static CDialogWindow* Window(const QString& title)
    {
        for (QWidget* widget : QApplication::topLevelWidgets()) {
            auto* window = dynamic_cast<CDialogWindow*>(widget);
            if (window && window->isVisible() && window->windowTitle() == title) return window;
        }
        return nullptr;
    }
};

TEST_F(PushSetupWindows, TheGlobalControlIsFilledStoredAndUndone)
{
    ASSERT_TRUE(Open("eccentric-building"));
    const T_POGC_D before = Model().pushControl;
    {
        CAnswers answers({CAnswers::Fill([](CDialogWindow& w) {
            ChooseIndex(Field(w, "pDelta"), 2);
            ChooseIndex(Field(w, "flow"), 1);
            Enter(w, "steps", "0");
            EXPECT_TRUE(IsMarked(w, "steps"));
            Enter(w, "steps", "25");
            QAbstractItemModel& loads = Grid(w, "initialLoads").Model();
            EXPECT_TRUE(SetCell(loads, 0, 1, 0.3));
            EXPECT_TRUE(SetCell(loads, 1, 0, "1 : G")); // the empty row: one more
            EXPECT_EQ(3, loads.rowCount());
            EXPECT_TRUE(SetCell(loads, 1, 0, "")); // and off again
            QAbstractItemModel& types = Grid(w, "hingeTypes").Model();
            EXPECT_TRUE(SetCell(types, 1, 1, Qt::Unchecked));
        })});
        Run("IDS_QM_UI_POGC_MENU");
    }
    const T_POGC_D& control = Model().pushControl;
    EXPECT_EQ(PUSH_P_DELTA::Updated, control.pDelta);
    EXPECT_EQ(PUSH_FLOW::Associated, control.flow);
    EXPECT_EQ(25, control.steps);
    EXPECT_EQ((std::vector<T_PUSH_INITIAL_LOAD>{{1, 0.3}}), control.initialLoads);
    EXPECT_EQ((std::vector<int>{1, 3}), control.hingeTypes); // not "pier", the second one
    Run("IDS_QM_UI_UNDO");
    EXPECT_TRUE(before == Model().pushControl);
}

TEST_F(PushSetupWindows, FunctionsAreAddedAndDeletedUnlessFollowed)
{
    ASSERT_TRUE(Open("hinge-library"));
    {
        CAnswers answers({CAnswers::Fill([](CDialogWindow& w) {
            Push(w, "add");
            Enter(w, "name", "quick");
            QAbstractItemModel& rows = Grid(w, "rows").Model();
            EXPECT_TRUE(SetCell(rows, 0, 1, 0.25));
            EXPECT_TRUE(SetCell(rows, 1, 0, 4.0));
            const auto says = [&] { return rows.index(1, 1).data(Qt::ToolTipRole).toString(); };
            EXPECT_TRUE(says().contains("rise")); // its factor is that of the row before
            EXPECT_TRUE(SetCell(rows, 1, 1, 1.0));
            EXPECT_EQ("", says());
        })});
        Run("IDS_QM_UI_POFC_MENU");
    }
    EXPECT_EQ((T_POFC_D{"quick", {1.0, 4.0}, {0.25, 1.0}}), Model().incrementFunctions.at(2));
    CAnswers answers({CAnswers::Fill([](CDialogWindow& w) {
        Grid(w, "functions").setCurrentIndex(Grid(w, "functions").Model().index(1, 0));
        Push(w, "delete");
    })});
    Run("IDS_QM_UI_POFC_MENU");
    EXPECT_EQ(1U, Model().incrementFunctions.size());
}

TEST_F(PushSetupWindows, ALoadCaseGetsLoadsAndStopsOfItsOwn)
{
    ASSERT_TRUE(Open("eccentric-building"));
    int key = 1;
    (void)CreateOrActivateRPSDlg(&m_main->Doc(), IDD_PO_LOADCASE_ITEM, &m_main->Desktop().view,
                                 &key);
    Settle();
    CDialogWindow* window = Window("Pushover load case");
    ASSERT_NE(nullptr, window);
    ChooseIndex(Field(*window, "start"), 1);
    EXPECT_TRUE(SetCell(Grid(*window, "initialLoads").Model(), 0, 1, 0.6));
    ChooseIndex(Field(*window, "pDelta"), 1); // behind "as the global control"
    Enter(*window, "steps", "12.5");
    EXPECT_TRUE(IsMarked(*window, "steps"));
    Enter(*window, "steps", "12");
    Enter(*window, "stops.drift", "0.03");
    ChooseIndex(Field(*window, "stops.state"), 3);
    Enter(*window, "stops.fractionOfPeak", "0.7");
    EXPECT_TRUE(SetCell(Grid(*window, "additionalDisplacements").Model(), 0, 0, 0.15));
    Enter(*window, "eccentricity", "-0.05");
    window->accept();
    Settle();
    const T_POLC_D& stored = Model().pushovers.at(1);
    EXPECT_EQ((std::vector<T_PUSH_INITIAL_LOAD>{{1, 0.6}}), stored.initialLoads);
    EXPECT_EQ(PUSH_P_DELTA::None, stored.pDelta);
    EXPECT_EQ(12, stored.steps);
    EXPECT_EQ((T_PUSH_STOPS_D{0.03, PUSH_STATE_STOP::Failed, 0.7}), stored.stops);
    EXPECT_EQ(std::vector{0.15}, stored.additionalDisplacements);
    EXPECT_EQ(-0.05, stored.eccentricity);
}

TEST_F(PushSetupWindows, TheListMakesEightCases)
{
    ASSERT_TRUE(Open("eccentric-building"));
    Run("IDS_QM_UI_POLC_LIST");
    CDialogWindow* list = Window("Pushover load cases");
    ASSERT_NE(nullptr, list);
    CAnswers answers({CAnswers::Fill([](CDialogWindow& w) {
                          EXPECT_EQ(8, Grid(w, "names").Model().rowCount());
                          EXPECT_FALSE(Field(w, "signs")->isEnabled());
                          Enter(w, "target", "0.25");
                      }),
                      CAnswers::Accept()});
    Click(Field(*list, "IDS_QM_UI_POLC_EIGHT_BUTTON"));
    EXPECT_TRUE(answers.m_texts.value(0).contains("0.25 m"));
    EXPECT_EQ(12U, Model().pushovers.size());
    EXPECT_EQ("PY- mode", Model().pushovers.at(12).name);
    EXPECT_EQ(-0.25, Model().pushovers.at(12).control->masterMaxDispl);
    Run("IDS_QM_UI_UNDO"); // all eight in one
    EXPECT_EQ(4U, Model().pushovers.size());
}

} // namespace
