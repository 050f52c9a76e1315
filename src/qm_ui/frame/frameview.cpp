#include "qm_ui/frame/frameview.h"

#include "qm_base/textformat.h"
#include "qm_ui/form/localnumber.h"

#include <QKeyEvent>
#include <QMouseEvent>
#include <QPainter>
#include <QToolTip>
#include <QWheelEvent>

#include <algorithm>
#include <cmath>
#include <utility>

namespace {

constexpr double kDegPerPx = 0.4;
constexpr double kDegPerKey = 5.0;
constexpr double kZoomPerNotch = 1.25;
constexpr double kNotch = 120.0; // eighths of a degree

} // namespace

CFrameView::CFrameView(QWidget* parent) : QWidget(parent)
{
    setMouseTracking(true);
    setFocusPolicy(Qt::StrongFocus);
    setAttribute(Qt::WA_OpaquePaintEvent);
    setSizePolicy(QSizePolicy::Expanding, QSizePolicy::Expanding);
}

void CFrameView::SetPicture(T_FRAME_PICTURE picture)
{
    m_picture = std::move(picture);
    update();
}

void CFrameView::SetCamera(const T_CAMERA& camera)
{
    m_camera = camera;
    update();
}

void CFrameView::SetOptions(const T_FRAME_OPTIONS& options)
{
    m_options = options;
    update();
}

CFrameView::T_KEPT CFrameView::Key() const
{
    const std::size_t lines =
        (m_picture.subtitle.empty() ? 0U : 1U) + (m_picture.note.empty() ? 0U : 1U);
    return {m_picture.scene,
            m_picture.scene ? m_picture.scene->revision : 0,
            m_picture.displacement != nullptr,
            lines,
            !m_picture.drifts.empty(),
            m_picture.marks != nullptr,
            std::ranges::count(m_picture.chosen, true),
            m_camera,
            m_options,
            size()};
}

void CFrameView::paintEvent(QPaintEvent*)
{
    const QRectF area(rect());
    const T_KEPT key = Key();
    if (key != m_kept || m_background.isNull()) {
        m_background = QPixmap(size() * devicePixelRatio());
        m_background.setDevicePixelRatio(devicePixelRatio());
        QPainter painter(&m_background);
        m_painter.DrawBackground(painter, area, m_picture, m_camera, m_options);
        m_kept = key;
    }
    QPainter painter(this);
    painter.drawPixmap(0, 0, m_background);
    m_painter.DrawForeground(painter, area, m_picture, m_camera, m_options);
    if (!m_isBox) return;
    painter.setPen(QPen(palette().color(QPalette::Highlight), 1.0, Qt::DashLine));
    painter.drawRect(Box());
}

QRectF CFrameView::Box() const
{
    return QRectF(m_press, m_grab).normalized();
}

QString CFrameView::ReadOut(QPointF place) const
{
    const long n = m_picture.scene ? m_painter.NodeAt(place) : -1;
    if (n < 0 || static_cast<std::size_t>(n) >= m_picture.scene->nodes.size()) return {};
    const T_SCENE_NODE& node = m_picture.scene->nodes[static_cast<std::size_t>(n)];
    std::string text = FormatText("%d  (", node.id);
    const auto add = [&](const std::array<double, 3>& v) {
        for (std::size_t d = 0; d < 3; ++d)
            text += (d ? "  " : "") + LocalNumberText(FormatText("%.6g", v[d])).toStdString();
    };
    add(node.xyz);
    text += ") " + m_picture.scene->lengthUnit;
    if (m_picture.displacement && m_picture.displacement->size() > static_cast<std::size_t>(n)) {
        text += "\nu = (";
        add((*m_picture.displacement)[static_cast<std::size_t>(n)]);
        text += ")";
    }
    return QString::fromStdString(text);
}

void CFrameView::mousePressEvent(QMouseEvent* event)
{
    m_grab = m_press = event->position();
    m_isBox = m_onLines && event->button() == Qt::LeftButton &&
              event->modifiers().testFlag(Qt::ControlModifier);
}

long CFrameView::HingeAt(QPointF place) const
{
    return m_picture.marks ? m_painter.HingeAt(place) : -1;
}

long CFrameView::LineAt(QPointF place) const
{
    return m_picture.scene ? m_painter.LineAt(*m_picture.scene, place) : -1;
}

/// A click, where the mouse has not moved.
void CFrameView::mouseReleaseEvent(QMouseEvent* event)
{
    constexpr double kStill = 3.0; // px
    const bool isBox = std::exchange(m_isBox, false);
    if (event->button() != Qt::LeftButton) return;
    if (QLineF(m_press, event->position()).length() > kStill) {
        m_grab = event->position();
        update();
        if (isBox && m_picture.scene) m_onLines(m_painter.LinesIn(*m_picture.scene, Box()));
        return;
    }
    const long hinge = m_onHinge ? HingeAt(event->position()) : -1;
    if (hinge >= 0) return m_onHinge(hinge);
    const long line = m_onLine ? LineAt(event->position()) : -1;
    if (line >= 0) m_onLine(static_cast<std::size_t>(line));
}

void CFrameView::Turn(double yawDeg, double pitchDeg)
{
    m_camera.yawDeg = std::remainder(m_camera.yawDeg + yawDeg, 360.0);
    m_camera.pitchDeg = std::clamp(m_camera.pitchDeg + pitchDeg, -90.0, 90.0);
    update();
}

void CFrameView::mouseMoveEvent(QMouseEvent* event)
{
    const QPointF by = event->position() - m_grab;
    const bool shift = event->modifiers().testFlag(Qt::ShiftModifier);
    if (event->buttons() == Qt::NoButton) {
        QToolTip::showText(event->globalPosition().toPoint(), ReadOut(event->position()), this);
        return;
    }
    m_grab = event->position();
    if (m_isBox) return update();
    if (event->buttons().testFlag(Qt::LeftButton) && !shift)
        return Turn(-kDegPerPx * by.x(), kDegPerPx * by.y());
    m_camera.pan += by;
    update();
}

void CFrameView::mouseDoubleClickEvent(QMouseEvent*)
{
    m_camera.zoom = 1.0;
    m_camera.pan = {};
    update();
}

void CFrameView::ZoomAt(QPointF place, double factor)
{
    const double zoom = std::clamp(m_camera.zoom * factor, 0.05, 1000.0);
    const QPointF centre = QRectF(rect()).center() + m_camera.pan;
    m_camera.pan += (place - centre) * (1.0 - zoom / m_camera.zoom);
    m_camera.zoom = zoom;
    update();
}

void CFrameView::wheelEvent(QWheelEvent* event)
{
    ZoomAt(event->position(), std::pow(kZoomPerNotch, event->angleDelta().y() / kNotch));
    event->accept();
}

void CFrameView::keyPressEvent(QKeyEvent* event)
{
    const QPointF centre = QRectF(rect()).center();
    switch (event->key()) {
    case Qt::Key_Left:
        return Turn(kDegPerKey, 0);
    case Qt::Key_Right:
        return Turn(-kDegPerKey, 0);
    case Qt::Key_Up:
        return Turn(0, kDegPerKey);
    case Qt::Key_Down:
        return Turn(0, -kDegPerKey);
    case Qt::Key_Plus:
        return ZoomAt(centre, kZoomPerNotch);
    case Qt::Key_Minus:
        return ZoomAt(centre, 1.0 / kZoomPerNotch);
    case Qt::Key_0:
        return mouseDoubleClickEvent(nullptr);
    case Qt::Key_1:
        return SetCamera(kIsometric);
    case Qt::Key_2:
        return SetCamera(kElevationXZ);
    case Qt::Key_3:
        return SetCamera(kElevationYZ);
    case Qt::Key_4:
        return SetCamera(kPlanXY);
    default:
        QWidget::keyPressEvent(event);
    }
}
