#include "qm_ui/plotwidget.h"

#include "testapp.h"

#include <QApplication>
#include <QImage>
#include <QMouseEvent>
#include <QPixmap>
#include <QString>
#include <QWheelEvent>
#include <gtest/gtest.h>

#include <memory>

namespace {

class PlotWidget : public testing::Test {
protected:
    void SetUp() override
    {
        NeedApp();
        m_widget = std::make_unique<CPlotWidget>();
        m_widget->resize(700, 500);
        m_widget->SetPlot(Plot(false));
    }
    static T_PLOT Plot(bool log)
    {
        T_PLOT plot;
        plot.x = {"Displacement (m)", log, {}};
        plot.y = {"Force (kN)", log, {}};
        plot.series.push_back({"Capacity", {0.5, 1, 2, 3, 4}, {100, 600, 800, 900, 950}});
        return plot;
    }
    void Wheel(QPointF pos, int notches)
    {
        QWheelEvent event(pos, pos, QPoint(), QPoint(0, 120 * notches), Qt::NoButton,
                          Qt::NoModifier, Qt::NoScrollPhase, false);
        QApplication::sendEvent(m_widget.get(), &event);
    }
    void Mouse(QEvent::Type type, QPointF pos, Qt::MouseButton button)
    {
        const bool up = type == QEvent::MouseButtonRelease;
        QMouseEvent event(type, pos, pos, type == QEvent::MouseMove ? Qt::NoButton : button,
                          up ? Qt::NoButton : button, Qt::NoModifier);
        QApplication::sendEvent(m_widget.get(), &event);
    }
    [[nodiscard]] T_PLOT_PX PixelOf(double x, double y)
    {
        const T_PLOT_LAYOUT& layout = m_widget->Layout();
        return {layout.x.ToPixel(x), layout.y.ToPixel(y)};
    }
    [[nodiscard]] static double Span(const T_PLOT_RANGE& r) { return r.hi - r.lo; }

    std::unique_ptr<CPlotWidget> m_widget;
};

TEST_F(PlotWidget, ZoomKeepsTheDataPointBelowTheCursor)
{
    for (const bool log : {false, true}) {
        m_widget->SetPlot(Plot(log));
        const T_PLOT_PX at = PixelOf(2.0, 800.0);
        const double span = Span(m_widget->Layout().x.Range());
        for (int i = 0; i < 25; ++i) { // the labels of the y axis grow and move the frame
            Wheel(QPointF(at.x, at.y), i < 20 ? 1 : -2);
            EXPECT_NEAR(at.x, PixelOf(2.0, 800.0).x, 0.01) << log << i;
            EXPECT_NEAR(at.y, PixelOf(2.0, 800.0).y, 0.01) << log << i;
        }
        EXPECT_LT(Span(m_widget->Layout().x.Range()), 0.2 * span) << log;
    }
}

TEST_F(PlotWidget, OneNotchZoomsByOneFifth)
{
    const T_PLOT_RANGE x = m_widget->Layout().x.Range();
    Wheel(QPointF(350, 200), 1);
    EXPECT_NEAR(0.8 * Span(x), Span(m_widget->Layout().x.Range()), 1e-9);
}

TEST_F(PlotWidget, WheelBesideAnAxisZoomsThatAxisOnly)
{
    const T_PLOT_RANGE x = m_widget->Layout().x.Range();
    const T_PLOT_RANGE y = m_widget->Layout().y.Range();
    Wheel(QPointF(3, 200), 1);
    EXPECT_NEAR(Span(x), Span(m_widget->Layout().x.Range()), 1e-9);
    EXPECT_NEAR(0.8 * Span(y), Span(m_widget->Layout().y.Range()), 1e-9);
    Wheel(QPointF(350, 495), 1);
    EXPECT_NEAR(0.8 * Span(x), Span(m_widget->Layout().x.Range()), 1e-9);
    EXPECT_NEAR(0.8 * Span(y), Span(m_widget->Layout().y.Range()), 1e-9);
}

TEST_F(PlotWidget, DragMovesTheGrabbedPointWithTheMouse)
{
    const T_PLOT_PX at = PixelOf(2.0, 800.0);
    Mouse(QEvent::MouseButtonPress, QPointF(at.x, at.y), Qt::LeftButton);
    Mouse(QEvent::MouseMove, QPointF(at.x - 60, at.y + 300), Qt::LeftButton);
    Mouse(QEvent::MouseMove, QPointF(at.x + 40, at.y + 25), Qt::LeftButton);
    Mouse(QEvent::MouseButtonRelease, QPointF(at.x + 40, at.y + 25), Qt::LeftButton);
    EXPECT_NEAR(at.x + 40, PixelOf(2.0, 800.0).x, 0.01);
    EXPECT_NEAR(at.y + 25, PixelOf(2.0, 800.0).y, 0.01);
    const T_PLOT_VIEW view = m_widget->View();
    Mouse(QEvent::MouseMove, QPointF(at.x, at.y), Qt::NoButton); // no longer held
    EXPECT_EQ(view, m_widget->View());
}

TEST_F(PlotWidget, LegendStaysWhereItIsDuringADragOnly)
{
    ASSERT_TRUE(m_widget->Layout().legend);
    const T_PLOT_BOX before = m_widget->Layout().legend->box;
    const T_PLOT_PX at = PixelOf(2.0, 800.0);
    Mouse(QEvent::MouseButtonPress, QPointF(at.x, at.y), Qt::LeftButton);
    const T_PLOT_PX under{before.x + 0.5 * before.w, before.y + 0.5 * before.h};
    Mouse(QEvent::MouseMove, QPointF(under.x, under.y), Qt::LeftButton); // the curve below it
    const T_PLOT_LAYOUT held = m_widget->Layout();
    ASSERT_TRUE(held.legend);
    EXPECT_NEAR((before.y - held.area.y), (held.legend->box.y - held.area.y), 1.0);
    EXPECT_NEAR(before.Right(), held.legend->box.Right(), 30.0);
    Mouse(QEvent::MouseButtonRelease, QPointF(under.x, under.y), Qt::LeftButton);
    EXPECT_FALSE(m_widget->View().legend);
    ASSERT_TRUE(m_widget->Layout().legend);
    EXPECT_FALSE(m_widget->Layout().legend->box.Holds(under)); // off the curve again
}

TEST_F(PlotWidget, DoubleClickShowsTheWholePlotAgain)
{
    const T_PLOT_RANGE x = m_widget->Layout().x.Range();
    Wheel(QPointF(350, 200), 5);
    ASSERT_NE(x, m_widget->Layout().x.Range());
    Mouse(QEvent::MouseButtonDblClick, QPointF(350, 200), Qt::LeftButton);
    EXPECT_EQ(T_PLOT_VIEW(), m_widget->View());
    EXPECT_EQ(x, m_widget->Layout().x.Range());
}

TEST_F(PlotWidget, ReadsOutTheNearestPoint)
{
    const T_PLOT_PX at = PixelOf(3.0, 900.0);
    EXPECT_EQ(QString("Capacity\nDisplacement (m): 3\nForce (kN): 900"),
              m_widget->ReadOut(QPointF(at.x + 5, at.y - 5)));
    EXPECT_EQ(QString(), m_widget->ReadOut(QPointF(at.x, at.y + 150)));
}

TEST_F(PlotWidget, HoverDrawsTheReadOutAndLeavingRemovesIt)
{
    m_widget->show();
    const QImage before = m_widget->grab().toImage();
    const T_PLOT_PX at = PixelOf(3.0, 900.0);
    Mouse(QEvent::MouseMove, QPointF(at.x + 3, at.y), Qt::NoButton);
    EXPECT_NE(before, m_widget->grab().toImage());
    QEvent leave(QEvent::Leave);
    QApplication::sendEvent(m_widget.get(), &leave);
    EXPECT_EQ(before, m_widget->grab().toImage());
}

TEST_F(PlotWidget, AnEmptyPlotTakesEveryGesture)
{
    m_widget->SetPlot(T_PLOT());
    Wheel(QPointF(350, 200), 3);
    Mouse(QEvent::MouseMove, QPointF(350, 200), Qt::NoButton);
    EXPECT_EQ(QString(), m_widget->ReadOut(QPointF(350, 200)));
    EXPECT_NEAR(0.512, Span(m_widget->Layout().x.Range()), 1e-9); // 0.8 cubed, of 0 to 1
    m_widget->resize(20, 20);
    Wheel(QPointF(5, 5), 1);
    EXPECT_EQ(0.0, m_widget->Layout().area.w);
}

} // namespace
