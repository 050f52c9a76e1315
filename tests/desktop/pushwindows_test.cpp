// The windows of the push, with real events.
#include "windowplay.h"

#include "pushoverwindow.h"
#include "pushtools.h"
#include "qm_db/editscope.h"
#include "qm_rps/evaluatedsteps.h"
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

TEST_F(PushWindows, ARunWaitsHoldsTheModelAndIsStoppedWithItsSteps)
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
        EXPECT_FALSE(w.findChild<QPushButton*>("IDS_QM_UI_PUSH_RUN_START")->isEnabled());
        paused = Points(w);
        // Neither an edit nor the end of the program gets at the model meanwhile.
        CDBDoc& doc = m_main->Doc();
        const long revision = doc.Data().Revision();
        T_POLC_D record = Model().pushovers.begin()->second;
        record.steps = 7;
        {
            CEditScope edit(doc, "Change the steps");
            EXPECT_FALSE(edit.Put(Model().pushovers.begin()->first, record) && edit.Commit());
        }
        EXPECT_EQ(revision, doc.Data().Revision());
        m_main->close();
        EXPECT_TRUE(m_main->isVisible());
        w.close();
        EXPECT_TRUE(w.isVisible());
        EXPECT_EQ(paused, Points(w)) << "it goes on";
        // Stopped twice: by the button, and by closing the window.
        Press("IDS_QM_UI_PUSH_RUN_CANCEL")(w);
        w.reject();
        EXPECT_TRUE(w.isVisible());
    };
    m_main->show();
    CPlay play({{kRun, start}, {kRun, stop, isPaused}, {kRun, Cancel, HasEnded}});
    Run("IDS_QM_UI_PUSH_RUN");
    const T_PUSH_RUN run = Stored();
    EXPECT_TRUE(run.cancelled);
    EXPECT_GE(run.displacement.size() + 1, paused); // the curve has the state before the push, too
    EXPECT_GE(run.displacement.size(), 1U);
    EXPECT_LT(run.displacement.size(), 108U);
    EXPECT_FALSE(m_main->Doc().Data().IsLocked());
}

TEST_F(PushWindows, StepsOfAnotherSolverAreReplacedOnlyWhenThePersonSaysSo)
{
    ASSERT_TRUE(Open("rc-frame-2-storey"));
    CDBDoc& doc = m_main->Doc();
    int ours = 0, theirs = 0;
    ASSERT_TRUE(doc.Attr().FindPolc("PX_HINGES", ours) && doc.Attr().FindPolc("PX_MODE1", theirs));
    T_POLC_D record = Model().pushovers.at(ours);
    record.name = "PX_MODE1";
    CEditScope edit(doc, "Push it, too");
    ASSERT_TRUE(edit.Put(theirs, record) && edit.Commit());
    for (const bool yes : {false, true}) {
        const ACT look = [&](CDialogWindow& w) {
            QAbstractItemModel& rows = Grid(w, "rows").Model();
            ASSERT_EQ(2, rows.rowCount());
            EXPECT_EQ("PX_MODE1", Cell(rows, 0, 0));
            EXPECT_EQ(!yes, Cell(rows, 0, 1) == "not pushed");
            EXPECT_EQ(!yes, Says(w, "steps of another solver are kept"));
            EXPECT_EQ(yes ? "up to date" : "of another solver",
                      Cell(Grid(w, "cases").Model(), 0, 2));
            Cancel(w);
        };
        CPlay play({{kRun, Press("IDS_QM_UI_PUSH_RUN_START")}, {kRun, look, HasEnded}});
        play.m_answer = yes ? QMessageBox::Yes : QMessageBox::No;
        Run("IDS_QM_UI_PUSH_RUN");
        EXPECT_EQ(1, play.m_texts.size());
        EXPECT_TRUE(play.m_texts.join("").contains("PX_MODE1"));
        EXPECT_NE(nullptr, doc.Post().RunOf(ours));
        EXPECT_EQ(yes, doc.Post().RunOf(theirs) != nullptr);
    }
}

TEST_F(PushWindows, TheHingesAtAPerformancePointAreOneClickFromTheEvaluation)
{
    ASSERT_TRUE(Open("masonry-wall"));
    PushIt();
    CDBDoc& doc = m_main->Doc();
    const std::string name = "PX TRIANGLE NTC2018";
    T_PUSH_EVALUATION found;
    std::string error;
    ASSERT_TRUE(EvaluateStored(doc, name, found, error)) << error;
    // The push goes straight from vertex to vertex: at a demand it stands between its neighbours.
    const T_PUSH_RUN run = Stored("PX TRIANGLE");
    const auto shearAt = [&](double d) {
        std::size_t i = 1;
        while (run.displacement.at(i) < d)
            ++i;
        const double part =
            (d - run.displacement[i - 1]) / (run.displacement[i] - run.displacement[i - 1]);
        return run.baseReaction[i - 1] + part * (run.baseReaction[i] - run.baseReaction[i - 1]);
    };
    const ACT look = [&](CDialogWindow& w) {
        auto* points = qobject_cast<QComboBox*>(Field(w, "point"));
        ASSERT_NE(nullptr, points);
        EXPECT_EQ("SLD: demand", points->currentText());
        for (const T_LIMIT_ROW& row : found.limitStates) {
            if (!row.demand) continue;
            const int i = points->findText(QString::fromStdString(row.name + ": demand"));
            ASSERT_GE(i, 0) << row.name;
            ChooseIndex(points, i);
            EXPECT_TRUE(Says(w, QString::fromStdString(row.name + ": demand of " + name)));
            const T_PLOT& plot = Picture(w);
            // An evaluation counts from the state before the push on.
            const double total = *row.demand + plot.series.front().x.front();
            EXPECT_NEAR(total, plot.series.back().x.front(), 1e-9);               // m
            EXPECT_NEAR(shearAt(total) / 1e3, plot.series.back().y.front(), 0.2); // kN
            const QString at = QString::number(total, 'g', 5);
            EXPECT_TRUE(Says(w, "at " + at + " m (" + points->currentText() + " of "));
            EXPECT_EQ("at " + at.toStdString() + " m", plot.series.back().name);
            EXPECT_FALSE(Says(w, "Step ")) << "the stored steps have other numbers";
        }
        Slide(w, 1);
        EXPECT_EQ(-1, points->currentIndex());
        w.reject();
    };
    CPlay play({{kStates, look}});
    CPushOverWindow& window = CPushOverWindow::Show(m_main->Desktop());
    ASSERT_TRUE(window.Model().OnOpen(name));
    window.Form().Refresh();
    Push(window, "hinges");
    EXPECT_TRUE(play.m_texts.isEmpty());
    EXPECT_EQ(2U, PushResultsOf(doc).size());
    EXPECT_EQ(run.displacement, Stored("PX TRIANGLE").displacement) << "the results stay";
}

TEST_F(PushWindows, PointsBeyondACancelledPushAreWithoutValues)
{
    ASSERT_TRUE(Open("masonry-wall"));
    CDBDoc& doc = m_main->Doc();
    int key = 0;
    ASSERT_TRUE(doc.Attr().FindPolc("PX TRIANGLE", key));
    const double target = Model().pushovers.at(key).control->masterMaxDispl;
    CPushRun push(doc);
    std::vector<T_PUSH_RUN> runs;
    std::string error;
    // Steps of 1 mm: cancelled after the fifth, between the demands of SLD and SLV.
    const auto goOn = [](const T_PUSH_PROGRESS& p) { return p.displacement < 0.0045; };
    ASSERT_TRUE(push.Run(key, goOn, runs, error)) << error;
    ASSERT_TRUE(runs.back().cancelled);
    const double end = runs.back().displacement.back();
    push.Keep(runs);
    T_PUSH_EVALUATION found;
    ASSERT_TRUE(EvaluateStored(doc, "PX TRIANGLE NTC2018", found, error)) << error;
    const std::vector<T_HINGES_AT> all = HingesOfEvaluations(doc, {&found, 1}, {});
    std::size_t reached = 0, beyond = 0;
    for (const T_PUSH_AT_POINT& at : all.at(0).points) {
        const double d = at.point.displacement;
        const bool isStored = d <= end + 1e-9;
        EXPECT_EQ(isStored, at.found == AT_POINT::Reached) << d << ", end " << end;
        EXPECT_EQ(isStored, !at.storeys.empty()) << d;
        reached += isStored ? 1 : 0;
        beyond += !isStored && d <= target ? 1 : 0; // a whole push would have come there
    }
    EXPECT_GT(reached, 0U);
    EXPECT_GT(beyond, 0U);
}

TEST_F(PushWindows, TheFrameShowsTheHingesOfEachDirection)
{
    CDBDoc& doc = m_main->Doc();
    int key = 0;
    T_POLC_D record; // in current units, as an edit takes it
    ASSERT_TRUE(doc.Attr().FindPolc("PX_HINGES", key) && doc.Attr().GetPolc(key, record));
    record.control->generateStaticAngle = true;
    record.control->staticAngle = 180.0;
    {
        CEditScope edit(doc, "Push it backwards");
        ASSERT_TRUE(edit.Put(key, record) && edit.Commit());
    }
    PushIt();
    CFramePane& frame = m_main->Frame();
    const auto source = std::ranges::find(frame.Sources(), "PX_HINGES@180", &T_SHAPE_SOURCE::name);
    ASSERT_NE(frame.Sources().end(), source);
    ASSERT_TRUE(frame.Show(*source, source->steps));
    const T_PUSH_RUN run = Stored("PX_HINGES@180");
    const T_HINGE_MARKS* marks = frame.View().Picture().marks;
    ASSERT_NE(nullptr, marks);
    ASSERT_EQ(run.hinges.size(), marks->hinges.size());
    std::size_t yielded = 0;
    for (std::size_t i = 0; i < run.hinges.size(); ++i) {
        EXPECT_EQ(run.hinges[i].state.back(), marks->hinges[i].state);
        yielded += run.hinges[i].state.back() != PUSH_STATE::Elastic ? 1 : 0;
    }
    EXPECT_GT(yielded, 0U);
    frame.SetStep(1);
    for (const T_HINGE_MARK& mark : frame.View().Picture().marks->hinges)
        EXPECT_EQ(PUSH_STATE::Elastic, mark.state);
}

TEST_F(PushWindows, AtOnceTheModelIsPushedAndItsHingesShown)
{
    CPlay play({{kStates,
                 [](CDialogWindow& w) {
                     EXPECT_TRUE(Says(w, "Step 108 of 108"));
                     w.reject();
                 }},
                {kRun, Cancel, HasEnded}});
    PushAtOnce(m_main->Desktop());
    EXPECT_EQ(108U, Stored().displacement.size());
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
