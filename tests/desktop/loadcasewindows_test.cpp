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
#include <QComboBox>
#include <QPushButton>
#include <QTimer>

using namespace desktop_test;

namespace {

class LoadCaseWindows : public DesktopTest {
protected:
    const T_MODEL& Model() { return m_main->Doc().Data().Model(); }
    /// The window on top that is no main window: that of a modeless dialog.
    static CDialogWindow* Window(const char* title)
    {
        for (QWidget* widget : QApplication::topLevelWidgets()) {
            auto* window = dynamic_cast<CDialogWindow*>(widget);
            if (window && window->isVisible() && window->windowTitle() == title) return window;
        }
        return nullptr;
    }
    /// Opens the item window of a load case by a double click in the explorer.
    CDialogWindow* OpenItem(int row)
    {
        m_main->Explorer().Choose(EXPLORER_TABLE::Pushovers);
        const QModelIndex cell = m_main->Explorer().Table().Model().index(row, 0);
        m_main->Explorer().Table().setCurrentIndex(cell);
        emit m_main->Explorer().Table().doubleClicked(cell);
        Settle();
        return Window("Pushover load case");
    }
    static QWidget* Field(CDialogWindow& window, const char* name)
    {
        CFormField* field = window.Form().Find(name);
        EXPECT_NE(nullptr, field) << name;
        return field ? field->widget : nullptr;
    }
    /// In front again, after a message: only then do fields get and lose the focus.
    static void Activate(CDialogWindow& window)
    {
        QApplication::setActiveWindow(&window); // at once: no events are handled meanwhile
    }
    static CGridView& Table(CDialogWindow& window, const char* name)
    {
        return dynamic_cast<CGridView&>(*Field(window, name));
    }
};

} // namespace

TEST_F(LoadCaseWindows, AnItemIsFilledStoredAndUndone)
{
    ASSERT_TRUE(Open("hinge-library"));
    CDialogWindow* window = OpenItem(0);
    ASSERT_NE(nullptr, window);
    Type(Field(*window, "control.masterMaxDispl"), "-0.35");
    Type(Field(*window, "name"), "PX2");
    ChooseIndex(Field(*window, "input.kind"), 1);
    ChooseIndex(Field(*window, "input.direction"), 1);
    Type(Field(*window, "input.factor"), "0.5");
    Click(Field(*window, "row.add"));
    EXPECT_EQ("DY", Table(*window, "patterns").Model().index(1, 1).data().toString());
    window->accept();
    Settle();
    EXPECT_EQ(nullptr, Window("Pushover load case"));
    EXPECT_EQ(nullptr, CModelessDlgCtrl::Of(m_main->Doc()).Find(IDD_PO_LOADCASE_ITEM));
    const T_POLC_D& stored = Model().pushovers.at(1);
    EXPECT_EQ("PX2", stored.name);
    EXPECT_EQ(-0.35, stored.control->masterMaxDispl);
    ASSERT_EQ(2U, stored.patterns.size());
    EXPECT_EQ((T_POLC_PATTERN{1, 2, 0.5}), stored.patterns[1]);
    EXPECT_TRUE(m_main->windowTitle().contains('*')); // the main window was told
    Run("IDS_QM_UI_UNDO");
    EXPECT_EQ("PX", Model().pushovers.at(1).name);
    EXPECT_EQ(1U, Model().pushovers.at(1).patterns.size());
}

TEST_F(LoadCaseWindows, BrokenRulesAreMarkedAndRefusedAndCancelChangesNothing)
{
    ASSERT_TRUE(Open("hinge-library"));
    CDialogWindow* window = OpenItem(0);
    ASSERT_NE(nullptr, window);
    struct T_BAD {
        const char* field;
        const char* text;
        const char* good;
        const char* message;
    };
    for (const T_BAD& bad : {T_BAD{"name", "", "PX", "name is empty"},
                             {"controlNode", "999", "3", "no such control node"},
                             {"control.masterMaxDispl", "0", "0.2", "must not be 0"}}) {
        Type(Field(*window, bad.field), bad.text);
        EXPECT_TRUE(window->Form().Find(bad.field)->IsMarked()) << bad.field;
        EXPECT_EQ(1, window->Form().Marks()) << bad.field;
        CAnswers answers({CAnswers::Accept()});
        window->accept();
        EXPECT_TRUE(answers.m_texts.value(0).contains(bad.message)) << bad.field;
        EXPECT_TRUE(window->isVisible());
        Activate(*window);
        Type(Field(*window, bad.field), bad.good);
        EXPECT_EQ(0, window->Form().Marks()) << bad.field;
    }
    Type(Field(*window, "control.masterMaxDispl"), "9");
    window->reject();
    Settle();
    EXPECT_EQ(0.2, Model().pushovers.at(1).control->masterMaxDispl);
    EXPECT_FALSE(m_main->Doc().Data().IsModified());
    EXPECT_EQ(nullptr, Window("Pushover load case"));
}

TEST_F(LoadCaseWindows, BadPatternRowsAreRefusedWithTheirReason)
{
    ASSERT_TRUE(Open("hinge-library"));
    CDialogWindow* window = OpenItem(0);
    ASSERT_NE(nullptr, window);
    const auto add = [&](int kind, const char* factor, const char* message) {
        ChooseIndex(Field(*window, "input.kind"), kind);
        Type(Field(*window, "input.factor"), factor);
        CAnswers answers({CAnswers::Accept()});
        Click(Field(*window, "row.add"));
        EXPECT_TRUE(answers.m_texts.value(0).contains(message)) << message;
        EXPECT_EQ(1, Table(*window, "patterns").Model().rowCount()) << message;
        Activate(*window);
    };
    add(1, "0", "scale factor");
    add(1, "1", "already has a row"); // direction 1 meets load case 1
    add(2, "1", "greater than 0");
    Type(Field(*window, "input.mode"), "2.7");
    add(2, "1", "must be the first");
    Table(*window, "patterns").setCurrentIndex(Table(*window, "patterns").Model().index(0, 0));
    Click(Field(*window, "row.delete"));
    ChooseIndex(Field(*window, "input.kind"), 2);
    Click(Field(*window, "row.add"));
    EXPECT_EQ("Mode 2", Table(*window, "patterns").Model().index(0, 1).data().toString());
    window->reject();
}

TEST_F(LoadCaseWindows, FieldsFollowTheMethod)
{
    ASSERT_TRUE(Open("hinge-library"));
    CDialogWindow* window = OpenItem(0);
    ASSERT_NE(nullptr, window);
    EXPECT_TRUE(Field(*window, "control.masterMaxDispl")->isVisible());
    EXPECT_FALSE(Field(*window, "control.stiffnessRatioLimit")->isVisible());
    ChooseIndex(Field(*window, "method"), 1);
    EXPECT_FALSE(Field(*window, "control.masterMaxDispl")->isVisible());
    EXPECT_TRUE(Field(*window, "control.stiffnessRatioLimit")->isVisible());
    EXPECT_FALSE(Field(*window, "hasControl")->isEnabled()); // there are no results yet
    Type(Field(*window, "control.stiffnessRatioLimit"), "-0.5");
    EXPECT_TRUE(window->Form().Find("control.stiffnessRatioLimit")->IsMarked());
    window->reject();
}

TEST_F(LoadCaseWindows, TheListAddsCopiesAndDeletes)
{
    ASSERT_TRUE(Open("hinge-library"));
    Run("IDS_QM_UI_POLC_LIST");
    CDialogWindow* list = Window("Pushover load cases");
    ASSERT_NE(nullptr, list);
    Run("IDS_QM_UI_POLC_LIST");
    EXPECT_EQ(list, Window("Pushover load cases")); // the same one
    {
        CAnswers answers({CAnswers::Fill([](CDialogWindow& item) {
            Activate(item);
            Type(Field(item, "name"), "PY");
            ChooseIndex(Field(item, "direction"), 1);
            Type(Field(item, "control.masterMaxDispl"), "0.1");
        })});
        Click(Field(*list, "IDS_QM_UI_POLC_ADD"));
    }
    ASSERT_EQ(2U, Model().pushovers.size());
    EXPECT_EQ(2, Model().pushovers.at(2).direction);
    EXPECT_EQ("PY", Table(*list, "rows").Model().index(1, 1).data().toString());
    Click(Field(*list, "IDS_QM_UI_POLC_COPY")); // the new one is chosen
    EXPECT_EQ("Copy of PY", Model().pushovers.at(3).name);
    Click(Field(*list, "IDS_QM_UI_POLC_DELETE"));
    EXPECT_EQ(2U, Model().pushovers.size());
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
                              CGridView& rows = Table(w, "rows");
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
    ASSERT_NE(nullptr, CServiceHeadOffice::Instance()->GetAgency("rps"));
    struct T_FIGURE {
        const char* command;
        const char* title;
        std::size_t curves;
    };
    for (const T_FIGURE& figure :
         {T_FIGURE{"IDS_QM_UI_FIGURE_MENU_0", "Strength loss without cyclic degradation", 2},
          {"IDS_QM_UI_FIGURE_MENU_E", "Strength loss with cyclic degradation", 2},
          {"IDS_QM_UI_FIGURE_MENU_UNLOAD", "Unloading stiffness with degradation", 4}}) {
        CAnswers answers({[&](QWidget& window) {
            EXPECT_EQ(figure.title, window.windowTitle().toStdString());
            auto* plot =
                dynamic_cast<CPlotWidget*>(Field(dynamic_cast<CDialogWindow&>(window), "figure"));
            ASSERT_NE(nullptr, plot);
            EXPECT_EQ(figure.curves, plot->Plot().series.size());
            EXPECT_EQ("Deformation D / Dy (-)", plot->Plot().x.title);
            EXPECT_EQ("Strength F / Fy (-)", plot->Plot().y.title);
            dynamic_cast<QDialog&>(window).reject();
        }});
        Run(figure.command);
    }
}

TEST_F(LoadCaseWindows, TheAxialTableIsEditedThroughTheService)
{
    ASSERT_TRUE(Open("hinge-library"));
    std::vector<T_SKEL_AXIAL> rows(2);
    rows[1].axial = 200.0;
    rows[1].sides.pos.yield = 80.0;
    CServiceAgency* agency = CServiceHeadOffice::Instance()->GetAgency("rps");
    ASSERT_NE(nullptr, agency);
    CAnswers answers(
        {CAnswers::Fill(
             [](CDialogWindow& w) {
                 Activate(w);
                 EXPECT_EQ("Axial force (kN)", Table(w, "rows")
                                                   .Model()
                                                   .headerData(0, Qt::Horizontal, Qt::DisplayRole)
                                                   .toString()
                                                   .toStdString());
                 EXPECT_TRUE(Table(w, "rows").Model().setData(Table(w, "rows").Model().index(0, 0),
                                                              "-50", Qt::EditRole));
                 EXPECT_TRUE(Table(w, "rows").Model().setData(Table(w, "rows").Model().index(1, 2),
                                                              "75.5", Qt::EditRole));
                 Type(Field(w, "new"), "150");
                 Click(Field(w, "add"));
                 EXPECT_EQ(3, Table(w, "rows").Model().rowCount());
                 Type(Field(w, "new"), "200"); // is there
                 QTimer::singleShot(0, [&w] { Click(Field(w, "add")); });
             },
             false),
         CAnswers::Accept(), CAnswers::Accept()});
    EXPECT_EQ(1, agency->Service({.kind = 2, .rows = &rows}));
    EXPECT_TRUE(answers.m_texts.value(0).contains("already exists"));
    ASSERT_EQ(3U, rows.size());
    EXPECT_EQ(-50.0, rows[0].axial);
    EXPECT_EQ(150.0, rows[1].axial);
    EXPECT_EQ(80.0, rows[1].sides.pos.yield); // from the nearest one
    EXPECT_EQ(75.5, rows[2].sides.neg.yield);
}
