#include "qm_ui/plot/plotwidget.h"

#include "testapp.h"

#include <QApplication>
#include <QMouseEvent>
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

TEST_F(PlotWidget, ReadsOutTheNearestPoint)
{
    const T_PLOT_PX at = PixelOf(3.0, 900.0);
    EXPECT_EQ(QString("Capacity\nDisplacement (m): 3\nForce (kN): 900"),
              m_widget->ReadOut(QPointF(at.x + 5, at.y - 5)));
    EXPECT_EQ(QString(), m_widget->ReadOut(QPointF(at.x, at.y + 150)));
}

} // namespace
