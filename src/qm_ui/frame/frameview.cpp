#include "qm_ui/frame/frameview.h"

#include "qm_base/say.h"
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
constexpr double kLeastZoom = 0.05, kMostZoom = 1000.0;
constexpr std::size_t kQuickLines = 1500; // beyond: nothing but lines while the view moves
constexpr int kStillMs = 180;             // after which it stands
constexpr double kNodeHit = 7.0;          // px: nearer to a node than this it is the node

PICK HowOf(Qt::KeyboardModifiers with, bool box)
{
    if (with.testFlag(Qt::ShiftModifier)) return PICK::Add;
    return with.testFlag(Qt::ControlModifier) && !box ? PICK::Toggle : PICK::Only;
}

} // namespace

CFrameView::CFrameView(QWidget* parent) : QWidget(parent)
{
    setMouseTracking(true);
    setFocusPolicy(Qt::StrongFocus);
    setAttribute(Qt::WA_OpaquePaintEvent);
    setSizePolicy(QSizePolicy::Expanding, QSizePolicy::Expanding);
    m_still.setSingleShot(true);
    connect(&m_still, &QTimer::timeout, this, [this] {
        m_options.quick = false;
        update();
    });
}

void CFrameView::Moving()
{
    m_options.quick = m_picture.scene && m_picture.scene->lines.size() > kQuickLines;
    if (m_options.quick) m_still.start(kStillMs);
    update();
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
    return {m_picture.scene,
            m_picture.scene ? m_picture.scene->revision : 0,
            m_picture.scene ? m_picture.scene->variant : 0,
            m_picture.displacement != nullptr,
            m_picture.note,
            !m_picture.subtitle.empty(),
            CResultPainter::Legend(m_picture.results).size(),
            RoomOf(m_picture),
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
        const QSize px = size() * devicePixelRatio();
        if (m_background.size() != px) m_background = QPixmap(px);
        m_background.setDevicePixelRatio(devicePixelRatio());
        QPainter painter(&m_background);
        m_painter.DrawBackground(painter, area, m_picture, m_camera, m_options);
        m_kept = key;
    }
    QPainter painter(this);
    painter.drawPixmap(0, 0, m_background);
    m_painter.DrawForeground(painter, area, m_picture, m_options);
    if (!m_isBox) return;
    painter.setPen(QPen(palette().color(QPalette::Highlight), 1.0, Qt::DashLine));
    painter.drawRect(Box());
}

QRectF CFrameView::Box() const
{
    return QRectF(m_press, m_grab).normalized();
}

QString CFrameView::LineText(std::size_t line) const
{
    QString text = QString::fromStdString(
        Say("IDS_QM_VIEW_ELEMENT", std::to_string(m_picture.scene->lines[line].id)));
    const T_DIAGRAM* const diagram = m_picture.results.diagram;
    if (!diagram) return text;
    const auto it = std::ranges::find(diagram->members, line, &T_MEMBER_DIAGRAM::line);
    if (it == diagram->members.end()) return text;
    const auto number = [&](std::size_t point) {
        return LocalNumberText(FormatText("%.5g", diagram->Value(point)));
    };
    return text + "\n" + QString::fromStdString(diagram->name) + ": " + number(it->smallest) +
           QStringLiteral(" \u2026 ") + number(it->largest) + " " +
           QString::fromStdString(diagram->unit);
}

QString CFrameView::ReadOut(QPointF place) const
{
    if (!m_picture.scene) return {};
    const long n = m_painter.NodeAt(*m_picture.scene, place);
    if (n < 0) {
        const long line = m_onPick ? LineAt(place) : -1;
        return line < 0 ? QString() : LineText(static_cast<std::size_t>(line));
    }
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
    m_pivot.reset();
    m_isBox = (m_onLines || m_onPick) && event->button() == Qt::LeftButton &&
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

void CFrameView::Pick(QPointF place, Qt::KeyboardModifiers with)
{
    T_PICK pick{HowOf(with, false), {}, {}};
    const T_FRAME_SCENE& scene = *m_picture.scene;
    const long node = m_painter.NodeAt(scene, place);
    const auto n = static_cast<std::size_t>(node);
    if (node >= 0 && QLineF(place, m_painter.Nodes()[n]).length() < kNodeHit)
        pick.nodes.push_back(n);
    else if (const long line = LineAt(place); line >= 0)
        pick.lines.push_back(static_cast<std::size_t>(line));
    m_onPick(pick);
}

void CFrameView::PickBox(Qt::KeyboardModifiers with)
{
    const T_FRAME_SCENE& scene = *m_picture.scene;
    if (!m_onPick) return m_onLines(m_painter.LinesIn(scene, Box()));
    m_onPick({HowOf(with, true), m_painter.LinesIn(scene, Box()), m_painter.NodesIn(scene, Box())});
}

/// A click, where the mouse has not moved.
void CFrameView::mouseReleaseEvent(QMouseEvent* event)
{
    constexpr double kStill = 3.0; // px
    const bool isBox = std::exchange(m_isBox, false);
    const bool moved = QLineF(m_press, event->position()).length() > kStill;
    if (event->button() == Qt::RightButton && !moved && m_onMenu)
        return m_onMenu(event->globalPosition().toPoint());
    if (event->button() != Qt::LeftButton) return;
    if (moved) {
        m_grab = event->position();
        update();
        if (isBox && m_picture.scene) PickBox(event->modifiers());
        return;
    }
    const long hinge = m_onHinge ? HingeAt(event->position()) : -1;
    if (hinge >= 0) return m_onHinge(hinge);
    if (m_onPick && m_picture.scene) return Pick(event->position(), event->modifiers());
    const long line = m_onLine ? LineAt(event->position()) : -1;
    if (line >= 0) m_onLine(static_cast<std::size_t>(line));
}

/// The middle of the nodes that are seen.
CProjection::T_PLACE CFrameView::Pivot() const
{
    CProjection::T_PLACE sum{};
    double count = 0.0;
    const auto& nodes = m_picture.scene->nodes;
    const auto& at = m_painter.Nodes();
    for (std::size_t n = 0; n < std::min(nodes.size(), at.size()); ++n) {
        if (!nodes[n].shown || !m_painter.Area().contains(at[n])) continue;
        count += 1.0;
        for (std::size_t d = 0; d < 3; ++d)
            sum[d] += nodes[n].xyz[d];
    }
    if (count == 0.0) return m_painter.Projection().Target();
    for (double& x : sum)
        x /= count;
    return sum;
}

/// The scale stays, and what it turns about stays where it is on the page.
void CFrameView::Turn(double yawDeg, double pitchDeg)
{
    m_camera.yawDeg = std::remainder(m_camera.yawDeg + yawDeg, 360.0);
    m_camera.pitchDeg = std::clamp(m_camera.pitchDeg + pitchDeg, -90.0, 90.0);
    if (m_picture.scene && !m_picture.scene->nodes.empty() && !m_painter.Nodes().empty()) {
        const CProjection& now = m_painter.Projection();
        if (!m_pivot) m_pivot = Pivot();
        const double room = RoomOf(m_picture);
        std::vector<QPointF>& places = m_places;
        T_CAMERA turned = m_camera;
        CProjection next;
        next.Place(*m_picture.scene, turned, m_painter.Area(), room, places);
        turned.zoom = std::clamp(now.PxPerLength() / next.PxAtZoom1(), kLeastZoom, kMostZoom);
        next.Place(*m_picture.scene, turned, m_painter.Area(), room, places);
        turned.pan += now.At(*m_pivot) - next.At(*m_pivot);
        m_camera = turned;
        m_painter.Put(*m_picture.scene, m_camera, room); // for a further turn before it is drawn
    }
    Moving();
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
    m_pivot.reset();
    Moving();
}

void CFrameView::mouseDoubleClickEvent(QMouseEvent*)
{
    FitAll();
}

void CFrameView::FitAll()
{
    m_camera.zoom = 1.0;
    m_camera.pan = {};
    m_pivot.reset();
    update();
}

void CFrameView::FitChosen()
{
    if (!m_picture.scene) return;
    QPolygonF places;
    const auto& at = m_painter.Nodes();
    for (std::size_t l = 0; l < m_picture.chosen.size(); ++l)
        if (const T_SCENE_LINE& line = m_picture.scene->lines[l]; m_picture.chosen[l])
            places << at.at(line.i) << at.at(line.j);
    for (const std::size_t node : m_picture.chosenNodes)
        places << at.at(node);
    if (places.isEmpty()) return FitAll();
    constexpr double kPart = 0.8, kLeast = 60.0; // of the area; px
    const QRectF box = places.boundingRect(), area = m_painter.Area();
    const double factor =
        std::clamp(kPart * std::min(area.width() / std::max(box.width(), kLeast),
                                    area.height() / std::max(box.height(), kLeast)),
                   kLeastZoom / m_camera.zoom, kMostZoom / m_camera.zoom);
    m_camera.pan = -factor * (box.center() - area.center() - m_camera.pan);
    m_camera.zoom *= factor;
    m_pivot.reset();
    update();
}

void CFrameView::ZoomAt(QPointF place, double factor)
{
    const double zoom = std::clamp(m_camera.zoom * factor, kLeastZoom, kMostZoom);
    const QPointF centre = m_painter.Area().center() + m_camera.pan;
    m_camera.pan += (place - centre) * (1.0 - zoom / m_camera.zoom);
    m_camera.zoom = zoom;
    m_pivot.reset();
    Moving();
}

void CFrameView::wheelEvent(QWheelEvent* event)
{
    ZoomAt(event->position(), std::pow(kZoomPerNotch, event->angleDelta().y() / kNotch));
    event->accept();
}

void CFrameView::keyPressEvent(QKeyEvent* event)
{
    const QPointF centre = m_painter.Area().center();
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
        return FitAll();
    case Qt::Key_F:
        return FitChosen();
    case Qt::Key_P:
        m_camera.perspective = !m_camera.perspective;
        return update();
    case Qt::Key_Escape:
        return m_onEscape ? m_onEscape() : QWidget::keyPressEvent(event);
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
