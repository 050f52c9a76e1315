#include "desktoptest.h"
#include "pushoverwindow.h"
#include "tempfolder.h"

#include "qm_rps/push/pushrun.h"
#include "qm_ui/evaluate/deskfields.h"
#include "qm_ui/plot/plotwidget.h"

#include <QClipboard>
#include <QElapsedTimer>
#include <QGuiApplication>
#include <QJsonArray>
#include <QJsonDocument>
#include <QJsonObject>
#include <QListWidget>
#include <QMimeData>
#include <QSettings>
#include <QToolButton>
#include <QWheelEvent>

using namespace desktop_test;

namespace {

/// Paint events of a widget while it lives.
class CPaints : public QObject {
public:
    explicit CPaints(QWidget& widget) { widget.installEventFilter(this); }
    int m_count = 0;

protected:
    bool eventFilter(QObject*, QEvent* event) override
    {
        m_count += event->type() == QEvent::Paint;
        return false;
    }
};

void Mouse(QWidget& widget, QEvent::Type type, QPointF at)
{
    const Qt::MouseButtons held =
        type == QEvent::MouseButtonRelease ? Qt::NoButton : Qt::LeftButton;
    const Qt::MouseButton one = type == QEvent::MouseMove ? Qt::NoButton : Qt::LeftButton;
    QMouseEvent event(type, at, widget.mapToGlobal(at), one, held, Qt::NoModifier);
    QApplication::sendEvent(&widget, &event);
}

class EvaluationWindow : public DesktopTest {
protected:
    void OpenWindow(const char* example)
    {
        ASSERT_TRUE(Open(example));
        m_main->show();
        Run("IDS_QM_UI_PUSH_CURVE");
        m_window = &CPushOverWindow::Show(m_main->Desktop());
        Settle();
    }
    QWidget* At(const char* name) { return desktop_test::Field(*m_window, name); }
    QListWidget& List() { return *qobject_cast<QListWidget*>(At("list")); }
    CPlotWidget& Plot()
    {
        (void)At("plot"); // its page in front
        return dynamic_cast<CDeskPane&>(*m_window->Form().Find("plot")).Plot();
    }
    QToolButton* Tool(const char* name) { return m_window->findChild<QToolButton*>(name); }
    /// A click on the box of a row.
    void Tick(int row)
    {
        List().scrollToItem(List().item(row));
        const QRect rect = List().visualItemRect(List().item(row));
        const QPointF at(rect.left() + 10.0, rect.center().y());
        Mouse(*List().viewport(), QEvent::MouseButtonPress, at);
        Mouse(*List().viewport(), QEvent::MouseButtonRelease, at);
        Settle();
    }
    CPushOverWindow* m_window = nullptr;
};

} // namespace

TEST_F(EvaluationWindow, TwoAreTickedZoomedCopiedAndCompared)
{
    OpenWindow("rc-frame-3-storey");
    Tick(1);
    Tick(3);
    ASSERT_EQ(2U, m_window->Model().Overlaid().size());
    const auto has = [this](const std::string& name) {
        const std::vector<T_PLOT_SERIES>& all = Plot().Plot().series;
        return std::ranges::find(all, name, &T_PLOT_SERIES::name) != all.end();
    };
    EXPECT_TRUE(has("PX_MODE1 ATC-40 B"));
    EXPECT_TRUE(has("PX_MODE1 FEMA440 B"));
    const T_PLOT_RANGE region = Plot().Layout().x.Range();
    const QPointF middle = QRectF(Plot().rect()).center();
    QWheelEvent wheel(middle, Plot().mapToGlobal(middle), {}, {0, 240}, Qt::NoButton,
                      Qt::NoModifier, Qt::NoScrollPhase, false);
    QApplication::sendEvent(&Plot(), &wheel);
    const T_PLOT_RANGE zoomed = Plot().Layout().x.Range();
    EXPECT_LT(zoomed.hi - zoomed.lo, 0.7 * (region.hi - region.lo));
    Mouse(Plot(), QEvent::MouseButtonPress, middle);
    Mouse(Plot(), QEvent::MouseMove, middle + QPointF(40, 0));
    Mouse(Plot(), QEvent::MouseButtonRelease, middle + QPointF(40, 0));
    EXPECT_LT(Plot().Layout().x.Range().lo, zoomed.lo); // what was left of it has come in
    Click(Tool("copyVector"));
    const QByteArray svg = QGuiApplication::clipboard()->mimeData()->data("image/svg+xml");
    EXPECT_TRUE(svg.contains("<svg"));
    EXPECT_TRUE(svg.contains("PX_MODE1 FEMA440 B"));
    Click(Tool("copyPicture"));
    EXPECT_EQ(1920, QGuiApplication::clipboard()->image().width());
    Click(Tool("whole"));
    EXPECT_GT(Plot().Layout().x.Range().hi, 2.0 * region.hi);
    EXPECT_EQ(2, Grid(*m_window, "overview").Model().rowCount());
}

// The picture is drawn again at most twice, and the numbers are those of the command on the case.
TEST_F(EvaluationWindow, AnEditGivesTheResultOfTheCommandAtOnce)
{
    OpenWindow("rc-frame-3-storey");
    QWidget* const damping = At("elasticDamping");
    Settle();
    {
        CPaints paints(Plot());
        Type(damping, "8");
        Settle();
        EXPECT_LE(1, paints.m_count);
        EXPECT_GE(2, paints.m_count);
    }
    const QString edited = File("edited.json");
    ASSERT_TRUE(m_main->Desktop().frame.OnExportCase(edited.toStdString()));
    const QByteArray text =
        Program({"evaluate", edited, "--only", "PX_MODE1 ATC-40 A", "--json", "-"});
    const double D = QJsonDocument::fromJson(text)[0]["performance_point"]["D"].toDouble();
    EXPECT_GT(D, 0.0);
    EXPECT_EQ(D, m_window->Model().Result().point->D);
    Run("IDS_QM_UI_UNDO");
    (void)CPushOverWindow::Show(m_main->Desktop());
    EXPECT_EQ(5.0, TextAt(*m_window, "elasticDamping").toDouble());
    EXPECT_GT(m_window->Model().Result().point->D, D); // less damping
}

// While one types the value is evaluated after a pause, and what was typed stays as it is.
TEST_F(EvaluationWindow, TypingIsEvaluatedAfterAPauseAndKeptWhenTheFieldIsLeft)
{
    OpenWindow("rc-frame-3-storey");
    auto* damping = qobject_cast<QLineEdit*>(At("elasticDamping"));
    QApplication::setActiveWindow(m_window);
    damping->setFocus();
    damping->selectAll();
    Key(damping, 0, "8.");
    QElapsedTimer clock;
    clock.start();
    while (m_window->Model().Result().eval.elasticDamping != 8.0 && clock.elapsed() < 5000)
        QApplication::processEvents(QEventLoop::WaitForMoreEvents, 50);
    EXPECT_EQ(8.0, m_window->Model().Result().eval.elasticDamping);
    EXPECT_EQ("8.", damping->text());
    EXPECT_FALSE(m_main->Doc().Data().IsModified());
    Key(damping, 0, "5");
    Key(damping, Qt::Key_Tab);
    EXPECT_EQ(8.5, m_main->Doc().Data().Model().evaluations.at(1).elasticDamping);
}

TEST_F(EvaluationWindow, ClosingAsksAboutWhatIsNotStoredAndKeepsTheAxes)
{
    OpenWindow("rc-frame-3-storey");
    Type(At("axes.x"), "4");
    EXPECT_EQ(4.0, Plot().Layout().x.Range().hi);
    Type(At("name"), "mine");
    {
        CAnswers answers({CAnswers::Press(QMessageBox::Cancel)});
        m_window->close();
        EXPECT_TRUE(answers.m_texts.value(0).contains("mine"));
    }
    ASSERT_TRUE(m_window->isVisible());
    const auto count = Model().evaluations.size();
    {
        CAnswers answers({CAnswers::Press(QMessageBox::Yes)});
        m_window->close();
    }
    EXPECT_EQ(count + 1, Model().evaluations.size());
    QApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    m_window = &CPushOverWindow::Show(m_main->Desktop());
    EXPECT_EQ(4.0, m_window->Model().m_axes.xTo);
    EXPECT_FALSE(m_main->Doc().Undo().UndoTitle().empty());
}

TEST_F(EvaluationWindow, TheFrameStandsBesideOrItIsSaidWhyNot)
{
    OpenWindow("rc-frame-3-storey"); // pushed by another program
    Click(Tool("frame"));
    EXPECT_EQ(nullptr, m_window->Model().Frame());
    EXPECT_NE("", m_window->Model().FrameNote());
    m_window->close();
    QApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    ASSERT_TRUE(Open("masonry-wall"));
    CDBDoc& doc = m_main->Doc();
    int key = 0;
    ASSERT_TRUE(doc.Attr().FindPolc("PX TRIANGLE", key));
    CPushRun push(doc);
    std::vector<T_PUSH_RUN> runs;
    std::string error;
    ASSERT_TRUE(push.Run(key, {}, runs, error)) << error;
    push.Keep(runs);
    Run("IDS_QM_UI_PUSH_CURVE");
    m_window = &CPushOverWindow::Show(m_main->Desktop());
    ASSERT_TRUE(m_window->Model().OnOpen("PX TRIANGLE NTC2018"));
    Click(Tool("frame"));
    CPushOverHingeStateDlg* const frame = m_window->Model().Frame();
    ASSERT_NE(nullptr, frame) << m_window->Model().FrameNote();
    EXPECT_FALSE(frame->Marks().hinges.empty());
    ASSERT_GE(frame->PointIndex(), 0); // at a point of the evaluation, not at a stored step
    EXPECT_EQ("SLV: demand", frame->PointTexts().at(static_cast<std::size_t>(frame->PointIndex())));
}
