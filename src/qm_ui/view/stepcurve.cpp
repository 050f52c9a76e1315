#include "qm_ui/view/stepcurve.h"

#include "qm_base/textformat.h"
#include "qm_ui/form/localnumber.h"

#include <QMouseEvent>
#include <QPainter>

#include <algorithm>
#include <cmath>
#include <limits>

namespace {

constexpr double kMargin = 4.0;

/// Smallest and largest of the values and 0.
std::pair<double, double> Range(const std::vector<double>& values)
{
    double low = 0.0, high = 0.0;
    for (const double v : values) {
        low = std::min(low, v);
        high = std::max(high, v);
    }
    return {low, high > low ? high : low + 1.0};
}

} // namespace

CStepCurve::CStepCurve(QWidget* parent) : QWidget(parent)
{
    setSizePolicy(QSizePolicy::Fixed, QSizePolicy::Fixed);
    setCursor(Qt::PointingHandCursor);
}

void CStepCurve::SetCurve(const T_VIEW_CURVE& curve, int step)
{
    m_curve = &curve;
    m_step = step;
    const auto at = static_cast<std::size_t>(step - 1);
    if (at < curve.displacement.size()) {
        const auto number = [](double v) { return LocalNumberText(FormatText("%.5g", v)); };
        setToolTip("D = " + number(curve.displacement[at]) + " " +
                   QString::fromStdString(curve.lengthUnit) + ", V = " +
                   number(curve.reaction[at]) + " " + QString::fromStdString(curve.forceUnit));
    }
    update();
}

QPointF CStepCurve::PlaceOf(int step) const
{
    const auto at = static_cast<std::size_t>(step - 1);
    const auto [left, right] = Range(m_curve->displacement);
    const auto [low, high] = Range(m_curve->reaction);
    const double d = step > 0 ? m_curve->displacement.at(at) : 0.0;
    const double v = step > 0 ? m_curve->reaction.at(at) : 0.0;
    return {kMargin + (d - left) / (right - left) * (width() - 2 * kMargin),
            height() - kMargin - (v - low) / (high - low) * (height() - 2 * kMargin)};
}

void CStepCurve::paintEvent(QPaintEvent*)
{
    QPainter painter(this);
    painter.fillRect(rect(), palette().base());
    if (!m_curve || m_curve->displacement.empty()) return;
    painter.setRenderHint(QPainter::Antialiasing);
    painter.setPen(palette().color(QPalette::Mid));
    painter.drawRect(QRectF(rect()).adjusted(0.5, 0.5, -0.5, -0.5));
    QPolygonF line{PlaceOf(0)};
    const int steps = static_cast<int>(m_curve->displacement.size());
    for (int step = 1; step <= steps; ++step)
        line << PlaceOf(step);
    painter.setPen(QPen(QColor(0x15, 0x4e, 0x8c), 1.6));
    painter.drawPolyline(line);
    if (m_step < 1 || m_step > steps) return;
    const QPointF at = PlaceOf(m_step);
    painter.setPen(QPen(QColor(0xc6, 0x28, 0x28), 1.0));
    painter.drawLine(QPointF(at.x(), kMargin), QPointF(at.x(), height() - kMargin));
    painter.setBrush(QColor(0xc6, 0x28, 0x28));
    painter.drawEllipse(at, 3.0, 3.0);
}

void CStepCurve::Go(QPointF place)
{
    if (!m_curve || m_curve->displacement.empty() || !m_onStep) return;
    int nearest = 1;
    double distance = std::numeric_limits<double>::infinity();
    for (int step = 1; step <= static_cast<int>(m_curve->displacement.size()); ++step) {
        const double d = std::fabs(PlaceOf(step).x() - place.x());
        if (d < distance) {
            distance = d;
            nearest = step;
        }
    }
    m_onStep(nearest);
}

void CStepCurve::mousePressEvent(QMouseEvent* event)
{
    Go(event->position());
}

void CStepCurve::mouseMoveEvent(QMouseEvent* event)
{
    if (event->buttons().testFlag(Qt::LeftButton)) Go(event->position());
}
