// The windows of load cases, figures and the axial force table, with real events.
#include "desktoptest.h"
#include "explorerpane.h"

#include "qm_base/serviceheadoffice.h"
#include "qm_rps/modelessdlgctrl.h"
#include "qm_rps/po_loadcasedlg.h"
#include "qm_rps/po_loadcaselistdlg.h"
#include "qm_rps/rps_main.h"
#include "qm_ui/plot/plotwidget.h"

#include <QApplication>
#include <QKeyEvent>
#include <QTimer>

using namespace desktop_test;

namespace {

class LoadCaseWindows : public DesktopTest {
protected:
    LoadCaseWindows() { EXPECT_TRUE(Open("hinge-library")); }
    /// The window on top that is no main window: that of a modeless dialog.
    static CDialogWindow* Window(const char* title)
    {
        for (QWidget* widget : QApplication::topLevelWidgets()) {
            auto* window = dynamic_cast<CDialogWindow*>(widget);
            if (window && window->isVisible() && window->windowTitle() == title) return window;
        }
        return nullptr;
    }
    /// Opens the item window of the first load case by a double click in the explorer.
    CDialogWindow& OpenItem()
    {
        m_main->Explorer().Choose(EXPLORER_TABLE::Pushovers);
        const QModelIndex cell = m_main->Explorer().Table().Model().index(0, 0);
        m_main->Explorer().Table().setCurrentIndex(cell);
        emit m_main->Explorer().Table().doubleClicked(cell);
        Settle();
        return *Window("Pushover load case");
    }
};

} // namespace

TEST_F(LoadCaseWindows, AnItemIsFilledStoredAndUndone)
{
    CDialogWindow& window = OpenItem();
    Enter(window, "control.masterMaxDispl", "-0.35");
    Enter(window, "name", "PX2");
    ChooseIndex(Field(window, "input.kind"), 1);
    ChooseIndex(Field(window, "input.direction"), 1);
    Enter(window, "input.factor", "0.5");
    Click(Field(window, "row.add"));
    EXPECT_EQ("DY", Cell(Grid(window, "patterns").Model(), 1, 1));
    window.accept();
    Settle();
    EXPECT_EQ(nullptr, Window("Pushover load case"));
    EXPECT_EQ(nullptr, CModelessDlgCtrl::Of(m_main->Doc()).Find(IDD_PO_LOADCASE_ITEM));
    const T_POLC_D& stored = Model().pushovers.at(1);
    EXPECT_EQ("PX2", stored.name);
    EXPECT_EQ(-0.35, stored.control->masterMaxDispl);
    EXPECT_EQ((T_POLC_PATTERN{1, 2, 0.5}), stored.patterns.at(1));
    EXPECT_TRUE(m_main->windowTitle().contains('*')); // the main window was told
    Run("IDS_QM_UI_UNDO");
    EXPECT_EQ("PX", Model().pushovers.at(1).name);
    EXPECT_EQ(1U, Model().pushovers.at(1).patterns.size());
}

TEST_F(LoadCaseWindows, BrokenRulesAreMarkedAndRefusedAndCancelChangesNothing)
{
    CDialogWindow& window = OpenItem();
    struct T_BAD {
        const char *field, *text, *good, *message;
    };
    for (const T_BAD& bad : {T_BAD{"name", "", "PX", "name is empty"},
                             {"controlNode", "999", "3", "no such control node"}}) {
        Enter(window, bad.field, bad.text);
        EXPECT_TRUE(IsMarked(window, bad.field)) << bad.field;
        CAnswers answers({CAnswers::Accept()});
        window.accept();
        EXPECT_TRUE(answers.m_texts.value(0).contains(bad.message)) << bad.field;
        EXPECT_TRUE(window.isVisible());
        Enter(window, bad.field, bad.good);
        EXPECT_EQ(0, window.Form().Marks()) << bad.field;
    }
    ChooseIndex(Field(window, "method"), 1); // has fields of its own
    EXPECT_FALSE(Field(window, "control.masterMaxDispl")->isVisible());
    Enter(window, "control.stiffnessRatioLimit", "-0.5");
    EXPECT_TRUE(IsMarked(window, "control.stiffnessRatioLimit"));
    for (const auto answer : {QMessageBox::No, QMessageBox::Yes}) {
        EXPECT_TRUE(window.isVisible());
        CAnswers answers({CAnswers::Press(answer)});
        QKeyEvent escape(QEvent::KeyPress, Qt::Key_Escape, Qt::NoModifier);
        QApplication::sendEvent(&window, &escape);
        EXPECT_TRUE(answers.m_texts.value(0).contains("what was changed"));
    }
    Settle();
    EXPECT_FALSE(m_main->Doc().Data().IsModified());
    EXPECT_EQ(nullptr, Window("Pushover load case"));
}

TEST_F(LoadCaseWindows, TheListAddsCopiesAndDeletes)
{
    Run("IDS_QM_UI_POLC_LIST");
    CDialogWindow* list = Window("Pushover load cases");
    ASSERT_NE(nullptr, list);
    Run("IDS_QM_UI_POLC_LIST");
    EXPECT_EQ(list, Window("Pushover load cases")); // the same one
    {
        CAnswers answers({CAnswers::Fill([](CDialogWindow& item) {
            Enter(item, "name", "PY");
            ChooseIndex(Field(item, "direction"), 1);
            Enter(item, "control.masterMaxDispl", "0.1");
        })});
        Click(Field(*list, "IDS_QM_UI_POLC_ADD"));
    }
    EXPECT_EQ(2, Model().pushovers.at(2).direction);
    EXPECT_EQ("PY", Cell(Grid(*list, "rows").Model(), 1, 1));
    Click(Field(*list, "IDS_QM_UI_POLC_COPY")); // the new one is chosen
    EXPECT_EQ("Copy of PY", Model().pushovers.at(3).name);
    Click(Field(*list, "IDS_QM_UI_POLC_DELETE"));
    {
        CAnswers answers({CAnswers::Reject()});
        Click(Field(*list, "IDS_QM_UI_POLC_ADD"));
    }
    EXPECT_EQ(2U, Model().pushovers.size());
    Run("IDS_QM_UI_UNDO"); // the deletion
    EXPECT_EQ(3U, Model().pushovers.size());
    list->reject();
    Settle();
    EXPECT_EQ(nullptr, CModelessDlgCtrl::Of(m_main->Doc()).Find(IDD_PO_LOADCASE_LIST));
}

TEST_F(LoadCaseWindows, TheSelectionGivesTheChosenCase)
{
    ASSERT_TRUE(Open("rc-frame-3-storey"));
    int key = 0;
    {
        CAnswers answers({CAnswers::Accept(), // none chosen: refused
                          CAnswers::Accept(), // its message
                          CAnswers::Fill([](CDialogWindow& w) {
                              CGridView& rows = Grid(w, "rows");
                              rows.setCurrentIndex(rows.Model().index(1, 0));
                          })});
        RPS_DoModal(1, &key);
    }
    EXPECT_EQ(2, key);
    CAnswers answers({CAnswers::Reject()});
    RPS_DoModal(1, &key);
    EXPECT_EQ(2, key);
}

TEST_F(LoadCaseWindows, TheThreeFiguresAreDrawnThroughTheRegisteredService)
{
    struct T_FIGURE {
        const char *command, *title;
        std::size_t curves;
    };
    for (const T_FIGURE& figure :
         {T_FIGURE{"IDS_QM_UI_FIGURE_MENU_0", "Strength loss without cyclic degradation", 2},
          {"IDS_QM_UI_FIGURE_MENU_E", "Strength loss with cyclic degradation", 2},
          {"IDS_QM_UI_FIGURE_MENU_UNLOAD", "Unloading stiffness with degradation", 4}}) {
        CAnswers answers({[&](QWidget& window) {
            EXPECT_EQ(figure.title, window.windowTitle().toStdString());
            auto& dialog = dynamic_cast<CDialogWindow&>(window);
            const T_PLOT& plot = dynamic_cast<CPlotWidget&>(*Field(dialog, "figure")).Plot();
            EXPECT_EQ(figure.curves, plot.series.size());
            EXPECT_EQ("Deformation D / Dy (-)", plot.x.title);
            dialog.reject();
        }});
        Run(figure.command);
    }
}

TEST_F(LoadCaseWindows, TheAxialTableIsEditedThroughTheService)
{
    std::vector<T_SKEL_AXIAL> rows(2);
    rows[1].axial = 200.0;
    rows[1].sides.pos.yield = 80.0;
    CServiceAgency* agency = CServiceHeadOffice::Instance()->GetAgency("rps");
    ASSERT_NE(nullptr, agency);
    const auto edit = [](CDialogWindow& w) {
        QAbstractItemModel& table = Grid(w, "rows").Model();
        EXPECT_EQ("Axial force (kN)", table.headerData(0, Qt::Horizontal).toString());
        EXPECT_TRUE(SetCell(table, 0, 0, "-50"));
        EXPECT_TRUE(SetCell(table, 1, 2, "75.5"));
        Enter(w, "new", "150");
        Click(Field(w, "add"));
        EXPECT_EQ(3, table.rowCount());
        Enter(w, "new", "200"); // is there
        QTimer::singleShot(0, [&w] { Click(Field(w, "add")); });
    };
    CAnswers answers({CAnswers::Fill(edit, false), CAnswers::Accept(), CAnswers::Accept()});
    EXPECT_EQ(1, agency->Service({.kind = 2, .rows = &rows}));
    EXPECT_TRUE(answers.m_texts.value(0).contains("already exists"));
    ASSERT_EQ(3U, rows.size());
    EXPECT_EQ(-50.0, rows[0].axial);
    EXPECT_EQ(150.0, rows[1].axial);
    EXPECT_EQ(80.0, rows[1].sides.pos.yield); // from the nearest one
    EXPECT_EQ(75.5, rows[2].sides.neg.yield);
}
