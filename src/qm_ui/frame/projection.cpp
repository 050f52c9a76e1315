#include "qm_ui/frame/projection.h"

#include <QColor>
#include <QLineF>
#include <QPainter>
#include <QPen>

#include <algorithm>
#include <cmath>
#include <limits>
#include <numbers>

namespace {

constexpr double kMargin = 28.0;
/// From the middle of the scene to the eye, over the scene's diagonal: nothing is behind the eye.
constexpr double kEye = 1.6;

double Dot(const std::array<double, 3>& a, const std::array<double, 3>& b)
{
    return a[0] * b[0] + a[1] * b[1] + a[2] * b[2];
}

/// A box that grows.
template <std::size_t N>
struct T_BOX {
    std::array<double, N> low, high;
    T_BOX()
    {
        low.fill(std::numeric_limits<double>::infinity());
        high.fill(-std::numeric_limits<double>::infinity());
    }
    void Add(const std::array<double, N>& p)
    {
        for (std::size_t d = 0; d < N; ++d) {
            low[d] = std::min(low[d], p[d]);
            high[d] = std::max(high[d], p[d]);
        }
    }
};

} // namespace

void CProjection::Place(const T_FRAME_SCENE& scene, const T_CAMERA& camera, const QRectF& area,
                        double room, std::vector<QPointF>& nodes)
{
    constexpr double kRad = std::numbers::pi / 180.0;
    const double sy = std::sin(camera.yawDeg * kRad), cy = std::cos(camera.yawDeg * kRad);
    const double sp = std::sin(camera.pitchDeg * kRad), cp = std::cos(camera.pitchDeg * kRad);
    m_right = {cy, sy, 0.0};
    m_up = {-sy * sp, cy * sp, cp};
    m_back = {sy * cp, -cy * cp, sp};
    m_perspective = camera.perspective;
    T_BOX<3> space;
    for (const T_SCENE_NODE& node : scene.nodes)
        space.Add(node.xyz);
    m_size = 0.0;
    for (std::size_t d = 0; d < 3; ++d) {
        m_target[d] = 0.5 * (space.low[d] + space.high[d]);
        m_size = std::hypot(m_size, space.high[d] - space.low[d]);
    }
    nodes.resize(scene.nodes.size());
    T_BOX<2> page;
    for (std::size_t n = 0; n < nodes.size(); ++n) {
        nodes[n] = Unit(scene.nodes[n].xyz);
        page.Add({nodes[n].x(), nodes[n].y()});
    }
    const double width = page.high[0] - page.low[0], height = page.high[1] - page.low[1];
    const double more = room * std::hypot(width, height);
    m_fit = std::min(std::max(area.width() - 2 * kMargin, 10.0) / std::max(width + more, 1e-12),
                     std::max(area.height() - 2 * kMargin, 10.0) / std::max(height + more, 1e-12));
    m_px = camera.zoom * m_fit;
    m_centre = area.center() + camera.pan;
    m_middle = 0.5 * QPointF(page.low[0] + page.high[0], page.low[1] + page.high[1]);
    for (QPointF& p : nodes)
        p = m_centre + m_px * (p - m_middle);
}

/// In lengths, from the target, down positive.
QPointF CProjection::Unit(const T_PLACE& place) const
{
    const T_PLACE from{place[0] - m_target[0], place[1] - m_target[1], place[2] - m_target[2]};
    const QPointF flat(Dot(from, m_right), -Dot(from, m_up));
    if (!m_perspective || !(m_size > 0.0)) return flat;
    const double eye = kEye * m_size;
    return flat * (eye / std::max(eye - Dot(from, m_back), 0.1 * eye));
}

QPointF CProjection::Moved(QPointF from, const T_PLACE& place, const T_PLACE& by,
                           double factor) const
{
    if (m_perspective)
        return At(
            {place[0] + factor * by[0], place[1] + factor * by[1], place[2] + factor * by[2]});
    return from + m_px * factor * QPointF(Dot(by, m_right), -Dot(by, m_up));
}

double CProjection::Depth(const T_PLACE& place) const
{
    return Dot(place, m_back);
}

void CProjection::DrawTriad(QPainter& painter, const QRectF& area) const
{
    constexpr double kLength = 28.0;
    const std::array<std::pair<const char*, QColor>, 3> names{{{"X", QColor(0xc6, 0x28, 0x28)},
                                                               {"Y", QColor(0x2e, 0x7d, 0x32)},
                                                               {"Z", QColor(0x15, 0x65, 0xc0)}}};
    const QPointF from = area.bottomLeft() + QPointF(14, -30);
    for (std::size_t d = 0; d < 3; ++d) {
        const QPointF tip = from + kLength * QPointF(m_right[d], -m_up[d]);
        if (QLineF(from, tip).length() < 3.0) continue; // it points at the viewer
        painter.setPen(QPen(names[d].second, 1.5));
        painter.drawLine(from, tip);
        painter.drawText(tip + 0.25 * (tip - from) + QPointF(-4, 4), names[d].first);
    }
}

const T_CAMERA& CameraFor(int flatAxis)
{
    constexpr const T_CAMERA* kStraight[] = {&kElevationYZ, &kElevationXZ, &kPlanXY};
    return flatAxis < 0 ? kIsometric : *kStraight[flatAxis];
}
