// The view of the frame under its bar, with real events: choosing, turning, zooming, playing.
#include "desktoptest.h"

#include "resultspane.h"

#include "qm_ui/view/stepcurve.h"

#include <QApplication>
#include <QCheckBox>
#include <QClipboard>
#include <QComboBox>
#include <QDockWidget>
#include <QElapsedTimer>
#include <QFileInfo>
#include <QMenu>
#include <QMenuBar>
#include <QMouseEvent>
#include <QSlider>
#include <QToolButton>
#include <QWheelEvent>

#include <cmath>

using namespace desktop_test;

namespace {

void Mouse(QWidget& to, QEvent::Type type, QPointF at, Qt::MouseButton button = Qt::LeftButton,
           Qt::KeyboardModifiers with = {})
{
    QMouseEvent event(type, at, to.mapToGlobal(at), button, button, with);
    QCoreApplication::sendEvent(&to, &event);
}

void ClickAt(QWidget& to, QPointF at, Qt::KeyboardModifiers with = {})
{
    Mouse(to, QEvent::MouseButtonPress, at, Qt::LeftButton, with);
    Mouse(to, QEvent::MouseButtonRelease, at, Qt::LeftButton, with);
}

void Drag(QWidget& to, QPointF from, QPointF by, Qt::KeyboardModifiers with = {})
{
    Mouse(to, QEvent::MouseButtonPress, from, Qt::LeftButton, with);
    for (int k = 1; k <= 4; ++k)
        Mouse(to, QEvent::MouseMove, from + 0.25 * k * by, Qt::LeftButton, with);
    Mouse(to, QEvent::MouseButtonRelease, from + by, Qt::LeftButton, with);
}

/// Waits until it is so, at most two seconds.
bool Until(const std::function<bool()>& so)
{
    QElapsedTimer clock;
    for (clock.start(); !so() && clock.elapsed() < 2000;)
        QCoreApplication::processEvents(QEventLoop::WaitForMoreEvents, 50);
    return so();
}

class ResultsView : public DesktopTest {
protected:
    void Start(const char* example)
    {
        m_main->show();
        ASSERT_TRUE(Open(example));
        Settle();
    }
    CFramePane& Pane() { return m_main->Frame(); }
    CFrameView& View() { return Pane().View(); }
    const std::set<int>& Chosen(EXPLORER_TABLE table = EXPLORER_TABLE::Elements)
    {
        return m_main->Desktop().selection.Chosen(table);
    }
    /// Of the places that answer so the one nearest to their middle; none: a null point.
    QPointF Find(const std::function<bool(QPointF)>& hit)
    {
        (void)View().grab();
        QPolygonF hits;
        QPointF sum;
        for (int y = 0; y < View().height(); y += 3)
            for (int x = 0; x < View().width(); x += 3)
                if (hit(QPointF(x, y))) {
                    hits << QPointF(x, y);
                    sum += QPointF(x, y);
                }
        if (hits.isEmpty()) return {};
        const QPointF middle = sum / static_cast<double>(hits.size());
        return *std::ranges::min_element(hits, {},
                                         [&](QPointF at) { return QLineF(at, middle).length(); });
    }
    QPointF NodePlace(int id)
    {
        const QString begins = QString::number(id) + "  (";
        return Find([&](QPointF at) { return View().ReadOut(at).startsWith(begins); });
    }
    QPointF LinePlace(int id)
    {
        return Find([&](QPointF at) {
            const long line = View().LineAt(at);
            return line >= 0 &&
                   View().Picture().scene->lines[static_cast<std::size_t>(line)].id == id;
        });
    }
    /// The menus are opened before: they then know what can be done.
    void RunFromMenu(const char* key)
    {
        for (QMenu* menu : m_main->menuBar()->findChildren<QMenu*>())
            emit menu->aboutToShow();
        Run(key);
    }
    void Choose(const char* list, int index)
    {
        ChooseIndex(m_main->findChild<QComboBox*>(list), index);
    }
    void ShowKind(T_SHAPE_SOURCE::KIND kind)
    {
        const auto& all = Pane().Sources();
        const auto it = std::ranges::find(all, kind, &T_SHAPE_SOURCE::kind);
        ASSERT_NE(all.end(), it);
        Choose("view-source", static_cast<int>(it - all.begin()));
    }
};

} // namespace

TEST_F(ResultsView, ClicksChooseToggleAndAddAndHiddenElementsAreNotHit)
{
    Start("rc-frame-code-hinges");
    const QPointF beam = LinePlace(11), other = LinePlace(14);
    ASSERT_FALSE(beam.isNull() || other.isNull());
    ClickAt(View(), beam);
    EXPECT_EQ(std::set<int>{11}, Chosen());
    ClickAt(View(), other, Qt::ShiftModifier);
    EXPECT_EQ((std::set<int>{11, 14}), Chosen());
    ClickAt(View(), beam, Qt::ControlModifier);
    EXPECT_EQ(std::set<int>{14}, Chosen());
    EXPECT_EQ(1, std::ranges::count(View().Picture().chosen, true));
    ClickAt(View(), NodePlace(4));
    EXPECT_EQ(std::set<int>{}, Chosen());
    EXPECT_EQ(std::set<int>{4}, Chosen(EXPLORER_TABLE::Nodes));
    Key(&View(), Qt::Key_Escape);
    EXPECT_TRUE(m_main->Desktop().selection.IsEmpty());
    const std::size_t lines = View().Picture().scene->lines.size();
    ClickAt(View(), beam);
    RunFromMenu("IDS_QM_VIEW_HIDE_CHOSEN");
    EXPECT_EQ(lines - 1, View().Picture().scene->lines.size());
    EXPECT_TRUE(LinePlace(11).isNull());
    RunFromMenu("IDS_QM_VIEW_SHOW_ALL");
    EXPECT_FALSE(LinePlace(11).isNull());
    Drag(View(), QPointF(2, 2), QPointF(View().width() - 4, View().height() - 4),
         Qt::ControlModifier);
    EXPECT_EQ(lines, Chosen().size());
    ClickAt(View(), QPointF(3, View().height() / 2.0)); // beside everything
    EXPECT_TRUE(m_main->Desktop().selection.IsEmpty());
}

TEST_F(ResultsView, TheWheelKeepsThePlaceUnderItAndADragTurnsInTheSameScale)
{
    Start("rc-space-frame-3-storey");
    m_main->resize(1800, 1200); // nodes lie further apart than the reach of the pointer
    QCoreApplication::processEvents();
    for (const bool perspective : {false, true}) {
        if (perspective) Key(&View(), Qt::Key_P);
        Key(&View(), Qt::Key_0);
        const int id = View().Picture().scene->nodes.back().id;
        const QPointF at = NodePlace(id);
        ASSERT_FALSE(at.isNull());
        QWheelEvent wheel(at, View().mapToGlobal(at), {}, {0, 360}, {}, {}, Qt::NoScrollPhase,
                          false);
        QCoreApplication::sendEvent(&View(), &wheel);
        // Places are found on a grid of 3 px.
        EXPECT_NEAR(0.0, QLineF(at, NodePlace(id)).length(), 4.5) << perspective;
        EXPECT_GT(View().Camera().zoom, 1.5);
    }
    Key(&View(), Qt::Key_P);
    (void)View().grab();
    // Seen from above, a quarter turn about Z keeps distances on the page; the frame stays in view.
    Key(&View(), Qt::Key_4);
    // Of the ground, the lowest of nodes that lie over one another from here.
    const auto& nodes = View().Picture().scene->nodes;
    int far = nodes.front().id;
    double most = 0.0;
    for (const T_SCENE_NODE& node : nodes) {
        const double away = node.xyz[0] + node.xyz[1] - nodes.front().xyz[0] - nodes.front().xyz[1];
        if (node.xyz[2] > nodes.front().xyz[2] || away <= most) continue;
        most = away;
        far = node.id;
    }
    const QPointF a = NodePlace(nodes.front().id), b = NodePlace(far);
    ASSERT_FALSE(a.isNull() || b.isNull());
    Drag(View(), QPointF(200, 200), QPointF(-225, 0)); // 0.4 degrees a px
    EXPECT_NEAR(90.0, std::fabs(View().Camera().yawDeg), 1e-9);
    const QPointF a2 = NodePlace(nodes.front().id), b2 = NodePlace(far);
    EXPECT_NEAR(QLineF(a, b).length(), QLineF(a2, b2).length(), 6.0);
    EXPECT_NEAR(90.0, std::fabs(std::remainder(QLineF(a, b).angleTo(QLineF(a2, b2)), 180.0)), 2.0);
}

TEST_F(ResultsView, TheBarShowsDiagramsOfWhatIsAnalysed)
{
    Start("rc-frame-code-hinges");
    ShowKind(T_SHAPE_SOURCE::KIND::Static);
    Choose("view-what", static_cast<int>(VIEW_WHAT::My));
    EXPECT_EQ(nullptr, View().Picture().results.diagram); // said, not drawn as zero
    EXPECT_NE(std::string::npos, View().Picture().note.find("Not analysed"));
    Run("IDS_QM_UI_ANALYSE");
    ASSERT_NE(nullptr, View().Picture().results.diagram);
    const T_DIAGRAM& d = *View().Picture().results.diagram;
    EXPECT_EQ("kN*m", d.unit);
    int middles = 0;
    // Under q the mean of the end moments and that of the middle differ by q L^2 / 8, L between
    // the columns: 5 m less twice 0.2 m.
    for (const T_MEMBER_DIAGRAM& m : d.members) {
        if (View().Picture().scene->lines[m.line].id != 11) continue;
        const double ends = 0.5 * (d.Value(m.first) + d.Value(m.first + m.count - 1));
        for (std::size_t p = m.first; p < m.first + m.count; ++p) {
            if (std::fabs(d.points[p].at - 0.5) > 1e-9) continue;
            EXPECT_NEAR(32.6 * 4.6 * 4.6 / 8, ends - d.Value(p), 1e-6);
            ++middles;
        }
    }
    EXPECT_EQ(1, middles);
    Choose("view-what", static_cast<int>(VIEW_WHAT::Loads));
    EXPECT_EQ(4U, View().Picture().results.marks->bands.size());
}

TEST_F(ResultsView, PlayGoesThroughTheStepsAndStopsWithTheWindow)
{
    Start("rc-frame-3-storey");
    ShowKind(T_SHAPE_SOURCE::KIND::Pushover);
    CResultsBar& bar = Pane().Bar();
    bar.Slider().setValue(1);
    Click(&bar.PlayButton());
    EXPECT_TRUE(Until([&] { return bar.Slider().value() > 2; }));
    m_main->hide();
    EXPECT_FALSE(bar.IsPlaying());
    m_main->show();
    // A click on the curve is its step.
    const int step = bar.Slider().maximum() / 2;
    ClickAt(bar.Curve(), bar.Curve().PlaceOf(step));
    EXPECT_NEAR(step, bar.Slider().value(), 1);
    ShowKind(T_SHAPE_SOURCE::KIND::Mode);
    const double still = View().Picture().scale;
    Click(&bar.PlayButton());
    EXPECT_TRUE(Until([&] { return View().Picture().scale < 0.0; })) << "it swings both ways";
    Click(&bar.PlayButton());
    EXPECT_EQ(still, View().Picture().scale);
}

TEST_F(ResultsView, TheTableFollowsWhatIsShownAndChosen)
{
    Start("rc-frame-code-hinges");
    Run("IDS_QM_UI_ANALYSE");
    ShowKind(T_SHAPE_SOURCE::KIND::Static);
    Run("IDS_QM_VIEW_RESULTS");
    auto* pane = dynamic_cast<CResultsPane*>(
        m_main->findChild<QDockWidget*>("IDS_QM_VIEW_RESULTS")->widget());
    ASSERT_NE(nullptr, pane);
    const auto elements = [&] {
        std::set<int> ids;
        for (const auto& row : pane->Table().rows)
            ids.insert(static_cast<int>(row.at(1).number.value()));
        return ids;
    };
    EXPECT_EQ(10U, elements().size());
    auto* only = pane->findChild<QCheckBox*>();
    Key(only, Qt::Key_Space);
    EXPECT_TRUE(only->isChecked());
    ClickAt(View(), LinePlace(11));
    EXPECT_EQ(std::set<int>{11}, elements());
    pane->Copy();
    const QString text = QApplication::clipboard()->text();
    EXPECT_TRUE(text.startsWith("Case\tElement\tPosition\tN (kN)")) << text.toStdString();
    EXPECT_EQ(static_cast<int>(pane->Table().rows.size()) + 1, text.count('\n'));
    AnswerFileName(File("t.csv"));
    pane->Export();
    EXPECT_GT(QFileInfo(File("t.csv")).size(), 300);
}
