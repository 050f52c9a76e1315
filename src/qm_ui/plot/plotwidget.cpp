#include "qm_ui/plot/plotwidget.h"

#include "qm_base/textformat.h"
#include "qm_ui/plot/plot.h"
#include "qm_ui/shown/showndecimals.h"

#include <QColor>
#include <QFont>
#include <QFontMetricsF>
#include <QMouseEvent>
#include <QPainter>
#include <QPen>
#include <QString>
#include <QStringList>
#include <QWheelEvent>

#include <algorithm>
#include <cmath>
#include <utility>

namespace {

constexpr double kHitPx = 24.0;       // farthest point that is read out
constexpr double kZoomPerNotch = 0.8; // span after one notch of the wheel
constexpr double kNotch = 120.0;      // eighths of a degree
constexpr int kDigits = 6;            // of the read-out

QString AxisLine(const T_PLOT_AXIS& axis, const char* fallback, double value)
{
    const std::string name = axis.title.empty() ? fallback : axis.title;
    const std::string whole = ShortestText(value), shown = ShownNumber(whole, name);
    return QString::fromStdString(name + ": " +
                                  (shown == whole ? PlotNumberText(value, kDigits) : shown));
}

} // namespace

CPlotWidget::CPlotWidget(QWidget* parent) : QWidget(parent)
{
    setMouseTracking(true);
    setAttribute(Qt::WA_OpaquePaintEvent);
    setSizePolicy(QSizePolicy::Expanding, QSizePolicy::Expanding);
}

void CPlotWidget::SetSizeHint(const QSize& size)
{
    m_wanted = size;
    updateGeometry();
}

QSize CPlotWidget::sizeHint() const
{
    return m_wanted;
}

QSize CPlotWidget::minimumSizeHint() const
{
    return {320, 240};
}

void CPlotWidget::SetPlot(T_PLOT plot)
{
    m_plot = std::move(plot);
    m_grab.reset();
    SetView({});
}

void CPlotWidget::UpdatePlot(T_PLOT plot)
{
    if (plot == m_plot) return;
    const bool sameAxes = plot.x.title == m_plot.x.title && plot.y.title == m_plot.y.title &&
                          plot.x.log == m_plot.x.log && plot.y.log == m_plot.y.log;
    if (!sameAxes) return SetPlot(std::move(plot));
    m_plot = std::move(plot);
    Forget();
}

void CPlotWidget::SetView(const T_PLOT_VIEW& view)
{
    m_view = view;
    Forget();
}

void CPlotWidget::Forget()
{
    m_layout.reset();
    m_picture = QPixmap();
    m_hit.reset();
    update();
}

const T_PLOT_LAYOUT& CPlotWidget::Layout()
{
    const bool fits = m_layout && m_layout->page.w == width() && m_layout->page.h == height();
    if (!fits) m_layout = CPlot::Layout(QRectF(rect()), m_plot, m_view);
    return *m_layout;
}

// Shows the value at the pixel with spans times the present ones. The y range comes first: its tick
// labels decide where the frame begins, which the x range then takes from the new layout.
void CPlotWidget::ShowValueAt(T_GRAB value, QPointF pos, double spanX, double spanY)
{
    if (Layout().area.w <= 0.0) return;
    T_PLOT_VIEW view = m_view;
    view.x = Layout().x.Range();
    view.y = Layout().y.RangeWithValueAt(value.y, pos.y(), spanY);
    SetView(view);
    view.x = Layout().x.RangeWithValueAt(value.x, pos.x(), spanX);
    SetView(view);
}

void CPlotWidget::wheelEvent(QWheelEvent* event)
{
    const QPointF pos = event->position();
    const T_PLOT_LAYOUT& layout = Layout();
    const double span = std::pow(kZoomPerNotch, event->angleDelta().y() / kNotch);
    const double spanX = pos.x() < layout.area.x ? 1.0 : span;
    const double spanY = pos.y() > layout.area.Bottom() ? 1.0 : span;
    ShowValueAt({layout.x.ToValue(pos.x()), layout.y.ToValue(pos.y())}, pos, spanX, spanY);
    event->accept();
}

void CPlotWidget::mousePressEvent(QMouseEvent* event)
{
    const T_PLOT_LAYOUT& layout = Layout();
    const QPointF pos = event->position();
    if (event->button() != Qt::LeftButton || !layout.area.Holds(T_PLOT_PX{pos.x(), pos.y()}))
        return;
    m_grab = T_GRAB{layout.x.ToValue(pos.x()), layout.y.ToValue(pos.y())};
    if (layout.legend) // it stays where it is while the curves move below it
        m_view.legend = T_PLOT_CORNER{(layout.legend->box.x - layout.area.x) / layout.area.w,
                                      (layout.legend->box.y - layout.area.y) / layout.area.h};
    setCursor(Qt::ClosedHandCursor);
}

void CPlotWidget::mouseMoveEvent(QMouseEvent* event)
{
    if (m_grab) {
        ShowValueAt(*m_grab, event->position(), 1.0, 1.0);
        return;
    }
    m_hit = FindHit(event->position());
    update();
}

void CPlotWidget::mouseReleaseEvent(QMouseEvent* event)
{
    if (event->button() != Qt::LeftButton || !m_grab) return;
    m_grab.reset();
    m_view.legend.reset();
    unsetCursor();
    Forget();
}

void CPlotWidget::mouseDoubleClickEvent(QMouseEvent* event)
{
    if (event->button() != Qt::LeftButton) return;
    m_grab.reset();
    SetView({});
}

void CPlotWidget::leaveEvent(QEvent* event)
{
    m_hit.reset();
    update();
    QWidget::leaveEvent(event);
}

void CPlotWidget::resizeEvent(QResizeEvent* event)
{
    Forget();
    QWidget::resizeEvent(event);
}

std::optional<CPlotWidget::T_HIT> CPlotWidget::FindHit(QPointF pos)
{
    const T_PLOT_LAYOUT& layout = Layout();
    std::optional<T_HIT> hit;
    double nearest = kHitPx;
    for (std::size_t s = 0; s < m_plot.series.size(); ++s) {
        const T_PLOT_SERIES& series = m_plot.series[s];
        for (std::size_t i = 0; i < std::min(series.x.size(), series.y.size()); ++i) {
            if (!layout.x.CanShow(series.x[i]) || !layout.y.CanShow(series.y[i])) continue;
            const T_PLOT_PX at{layout.x.ToPixel(series.x[i]), layout.y.ToPixel(series.y[i])};
            const double d = PlotDistance(at, {pos.x(), pos.y()});
            if (d >= nearest || !layout.area.Holds(at)) continue;
            nearest = d;
            hit = T_HIT{s, i, QPointF(at.x, at.y)};
        }
    }
    return hit;
}

QString CPlotWidget::HitText(const T_HIT& hit) const
{
    const T_PLOT_SERIES& series = m_plot.series[hit.series];
    const QString name = series.name.empty() ? QStringLiteral("series %1").arg(hit.series + 1)
                                             : QString::fromStdString(series.name);
    return name + u'\n' + AxisLine(m_plot.x, "x", series.x[hit.point]) + u'\n' +
           AxisLine(m_plot.y, "y", series.y[hit.point]);
}

QString CPlotWidget::ReadOut(QPointF pos)
{
    const std::optional<T_HIT> hit = FindHit(pos);
    return hit ? HitText(*hit) : QString();
}

void CPlotWidget::DrawReadOut(QPainter& painter)
{
    constexpr double kPad = 6.0;
    constexpr double kOffset = 14.0; // from the point to the box
    const QFont font = CPlot::Font(CPlotLayout::kTextPx, false);
    const QFontMetricsF metrics(font);
    const QStringList lines = HitText(*m_hit).split(u'\n');
    double w = 0.0;
    for (const QString& line : lines)
        w = std::max(w, metrics.horizontalAdvance(line));
    QRectF box(0, 0, w + 2 * kPad, metrics.height() * static_cast<double>(lines.size()) + 2 * kPad);
    const QPointF at = m_hit->at;
    const bool right = at.x() + kOffset + box.width() < width();
    const bool below = at.y() + kOffset + box.height() < height();
    box.moveLeft(right ? at.x() + kOffset : std::max(0.0, at.x() - kOffset - box.width()));
    box.moveTop(below ? at.y() + kOffset : std::max(0.0, at.y() - kOffset - box.height()));
    painter.setPen(QPen(Qt::black, 1.2));
    painter.setBrush(Qt::NoBrush);
    painter.drawEllipse(at, 5.0, 5.0);
    painter.setPen(QPen(QColor(120, 120, 120), 1.0));
    painter.setBrush(QColor(255, 255, 230));
    painter.drawRoundedRect(box, 3.0, 3.0);
    painter.setFont(font);
    painter.setPen(Qt::black);
    for (qsizetype i = 0; i < lines.size(); ++i)
        painter.drawText(QPointF(box.left() + kPad, box.top() + kPad + metrics.ascent() +
                                                        static_cast<double>(i) * metrics.height()),
                         lines[i]);
}

void CPlotWidget::paintEvent(QPaintEvent*)
{
    if (m_picture.isNull() && !size().isEmpty()) {
        m_picture = QPixmap(size() * devicePixelRatioF());
        m_picture.setDevicePixelRatio(devicePixelRatioF());
        QPainter picture(&m_picture);
        CPlot::Draw(picture, QRectF(rect()), m_plot, m_view);
    }
    QPainter painter(this);
    painter.setRenderHint(QPainter::Antialiasing);
    painter.drawPixmap(QPointF(0, 0), m_picture);
    if (m_hit) DrawReadOut(painter);
}
