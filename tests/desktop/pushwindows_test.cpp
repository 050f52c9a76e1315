// The windows of the push, with real events.
#include "windowplay.h"

#include "qm_db/editscope.h"
#include "qm_rps/push/pushresultlist.h"
#include "qm_ui/frame/frameview.h"

#include <QComboBox>
#include <QMouseEvent>
#include <QPushButton>
#include <QSlider>

#include <cmath>

using namespace desktop_test;

namespace {

constexpr const char* kRun = "Push";
constexpr const char* kStates = "Hinges of a push by step";
constexpr const char* kStoreys = "Storeys of a push";

class PushWindows : public DesktopTest {
protected:
    PushWindows() { EXPECT_TRUE(Open("steel-frame-2-storey")); }
    T_PUSH_RUN Stored(const char* name = "PX_HINGES")
    {
        CDBDoc& doc = m_main->Doc();
        T_PUSH_RUN run;
        std::string error;
        for (const T_PUSH_RESULT_ID& id : PushResultsOf(doc)) {
            if (id.name != name) continue;
            EXPECT_TRUE(CPushRun(doc).Read(id.key, id.turn, run, error)) << error;
        }
        return run;
    }
    void PushIt()
    {
        CPlay play({{kRun, Press("IDS_QM_UI_PUSH_RUN_START")}, {kRun, Cancel, HasEnded}});
        Run("IDS_QM_UI_PUSH_RUN");
    }
    static bool HasEnded(CDialogWindow& w)
    {
        return w.findChild<QPushButton*>("IDS_QM_UI_PUSH_RUN_HINGES")->isEnabled();
    }
};

/// The largest series of the window's first picture: the curve.
std::size_t Points(CDialogWindow& w)
{
    const T_PLOT& plot = Picture(w);
    return plot.series.empty() ? 0 : plot.series.front().x.size();
}

void Slide(CDialogWindow& w, int step)
{
    w.findChild<QSlider*>()->setValue(step);
}

} // namespace

TEST_F(PushWindows, ALoadCaseIsPushedAndItsResultsAreThoseOfTheDocument)
{
    const ACT read = [](CDialogWindow& w) {
        EXPECT_TRUE(Says(w, "came to its target"));
        EXPECT_EQ(109U, Points(w)); // the state before the push, increments to 32.4 in
        const T_PLOT_SERIES& curve = Picture(w).series.front();
        EXPECT_EQ(0.0, curve.x.front());
        EXPECT_EQ(0.0, curve.y.front());
        EXPECT_NEAR(0.3, curve.x[1], 1e-9);
        EXPECT_EQ("reached", Cell(Grid(w, "rows").Model(), 0, 1));
        EXPECT_EQ("108", Cell(Grid(w, "rows").Model(), 0, 2));
        EXPECT_EQ("32.4", Cell(Grid(w, "rows").Model(), 0, 4));
        EXPECT_EQ("up to date", Cell(Grid(w, "cases").Model(), 0, 2));
        Cancel(w);
    };
    CPlay play({{kRun, Press("IDS_QM_UI_PUSH_RUN_START")}, {kRun, read, HasEnded}});
    Run("IDS_QM_UI_PUSH_RUN");
    EXPECT_FALSE(m_main->Doc().Data().IsLocked());
    const T_PUSH_RUN run = Stored();
    ASSERT_EQ(108U, run.displacement.size());
    for (std::size_t i = 0; i < run.displacement.size(); ++i)
        EXPECT_NEAR(0.00762 * static_cast<double>(i + 1), run.displacement[i], 1e-9); // 0.3 in

    // What is read back is what the engine has given.
    std::vector<T_PUSH_RUN> fresh;
    std::string error;
    ASSERT_TRUE(CPushRun(m_main->Doc()).Run(run.key, {}, fresh, error)) << error;
    const T_PUSH_RUN& again = fresh.at(0);
    EXPECT_EQ(again.baseReaction, run.baseReaction);
    EXPECT_EQ(again.data.displacement, run.data.displacement);
    ASSERT_EQ(again.hinges.size(), run.hinges.size());
    for (std::size_t i = 0; i < run.hinges.size(); ++i) {
        EXPECT_EQ(again.hinges[i].state, run.hinges[i].state);
        EXPECT_EQ(again.hinges[i].force, run.hinges[i].force);
    }
    ASSERT_EQ(2U, run.storeys.size());
    EXPECT_EQ(again.storeys[0].shear, run.storeys[0].shear);
    ASSERT_EQ(again.events.size(), run.events.size());
    EXPECT_EQ(again.events.back().displacement, run.events.back().displacement);
    EXPECT_EQ(again.advice, run.advice);
}

TEST_F(PushWindows, ARunWaitsAndIsStoppedWithItsSteps)
{
    std::size_t paused = 0;
    const auto start = [](CDialogWindow& w) {
        Later(&w, [&w] { Press("IDS_QM_UI_PUSH_RUN_START")(w); });
        Later(&w, [&w] { Press("IDS_QM_UI_PUSH_RUN_PAUSE")(w); });
    };
    const auto isPaused = [](CDialogWindow& w) {
        return w.findChild<QPushButton*>("IDS_QM_UI_PUSH_RUN_GO_ON")->isEnabled() && Points(w) > 0;
    };
    const auto stop = [&](CDialogWindow& w) {
        EXPECT_TRUE(Says(w, "waits"));
        EXPECT_TRUE(m_main->Doc().Data().IsLocked());
        paused = Points(w);
        w.reject(); // does not close: it stops the run
        EXPECT_TRUE(w.isVisible());
    };
    CPlay play({{kRun, start}, {kRun, stop, isPaused}, {kRun, Cancel, HasEnded}});
    Run("IDS_QM_UI_PUSH_RUN");
    const T_PUSH_RUN run = Stored();
    EXPECT_TRUE(run.cancelled);
    EXPECT_GE(run.displacement.size(), paused);
    EXPECT_GE(run.displacement.size(), 1U);
    EXPECT_LT(run.displacement.size(), 108U);
    EXPECT_FALSE(m_main->Doc().Data().IsLocked());
}

TEST_F(PushWindows, HingesAreShownByStepAndChosenByAClickOnTheFrame)
{
    PushIt();
    const T_PUSH_RUN run = Stored();
    const ACT look = [&](CDialogWindow& w) {
        auto* frame = dynamic_cast<CFrameView*>(Field(w, "frame"));
        ASSERT_NE(nullptr, frame);
        ASSERT_NE(nullptr, frame->Picture().marks);
        EXPECT_EQ(run.hinges.size(), frame->Picture().marks->hinges.size());
        QAbstractItemModel& table = Grid(w, "hinges").Model();
        EXPECT_EQ(static_cast<int>(run.hinges.size()), table.rowCount());
        Slide(w, 1);
        EXPECT_TRUE(Says(w, "Step 1 of 108"));
        for (const T_HINGE_MARK& mark : frame->Picture().marks->hinges)
            EXPECT_EQ(PUSH_STATE::Elastic, mark.state);
        Key(Field(w, "yielded"), Qt::Key_Space);
        EXPECT_EQ(0, table.rowCount());
        Slide(w, 108);
        int yielded = 0;
        for (const T_PUSH_HINGE_SERIES& h : run.hinges)
            yielded += h.state.back() != PUSH_STATE::Elastic;
        EXPECT_EQ(yielded, table.rowCount());
        // Another hinge than the one that is chosen.
        frame->grab();
        QPointF at;
        long clicked = -1;
        for (int y = frame->height() - 1; y > 0 && clicked < 0; --y)
            for (int x = 0; x < frame->width() && clicked < 0; x += 3) {
                at = {double(x), double(y)};
                const long hinge = frame->HingeAt(at);
                const auto& marks = frame->Picture().marks->hinges;
                if (hinge >= 0 && !marks[static_cast<std::size_t>(hinge)].chosen) clicked = hinge;
            }
        ASSERT_GE(clicked, 0);
        for (const auto type : {QEvent::MouseButtonPress, QEvent::MouseButtonRelease}) {
            QMouseEvent event(type, at, frame->mapToGlobal(at), Qt::LeftButton, Qt::LeftButton,
                              Qt::NoModifier);
            QCoreApplication::sendEvent(frame, &event);
        }
        EXPECT_TRUE(frame->Picture().marks->hinges[static_cast<std::size_t>(clicked)].chosen);
        w.reject();
    };
    CPlay play({{kStates, look}});
    Run("IDS_QM_UI_PUSH_STATES");
}

TEST_F(PushWindows, StoreysKeepEquilibriumAndOldResultsSaySo)
{
    PushIt();
    const T_PUSH_RUN run = Stored();
    const ACT look = [&](CDialogWindow& w) {
        Slide(w, 60);
        QAbstractItemModel& table = Grid(w, "storeys").Model();
        ASSERT_EQ(2, table.rowCount());
        // All lateral loads go through the lowest storey; drifts times heights add up to the top.
        constexpr double kKip = 4448.2216152605, kInch = 0.0254;
        EXPECT_NEAR(run.baseReaction[59] / kKip, Cell(table, 1, 6).toDouble(), 0.01);
        EXPECT_NEAR(18.0, Cell(table, 0, 2).toDouble(), 1e-3);
        double sum = 0.0;
        for (int row = 0; row < 2; ++row)
            sum += Cell(table, row, 4).toDouble() *
                   run.storeys[static_cast<std::size_t>(1 - row)].height / kInch;
        EXPECT_NEAR(18.0, sum, 18e-3);
        w.reject();
    };
    {
        CPlay play({{kStoreys, look}});
        Run("IDS_QM_UI_PUSH_STOREYS");
    }
    CDBDoc& doc = m_main->Doc();
    T_POLC_D record;
    ASSERT_TRUE(doc.Attr().GetPolc(run.key, record));
    record.steps = 60;
    CEditScope edit(doc, "Change the steps");
    ASSERT_TRUE(edit.Put(run.key, record) && edit.Commit());
    const ACT old = [](CDialogWindow& w) {
        EXPECT_TRUE(Says(w, "older than the model"));
        EXPECT_TRUE(QString::fromStdString(Picture(w).title).contains("out of date"));
        EXPECT_EQ(0, Grid(w, "hinges").Model().rowCount());
        w.reject();
    };
    CPlay play({{kStates, old}});
    Run("IDS_QM_UI_PUSH_STATES");
}
