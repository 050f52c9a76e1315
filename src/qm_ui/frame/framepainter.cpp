#include "qm_ui/frame/framepainter.h"

#include "qm_base/msgfunction.h"
#include "qm_base/textformat.h"
#include "qm_ui/frame/framelegend.h"
#include "qm_ui/plot/plot.h"

#include <QColor>
#include <QFont>
#include <QFontMetricsF>
#include <QPainter>
#include <QPolygonF>

#include <algorithm>
#include <array>
#include <cmath>
#include <limits>
#include <numbers>
#include <numeric>
#include <set>
#include <utility>

namespace {

constexpr double kMargin = 28.0;
constexpr double kHit = 10.0;
constexpr std::size_t kSmooth = 4000; // members up to which lines are smoothed
constexpr double kCell = 34.0;        // px between numbers that are drawn
constexpr double kFromEnd = 0.08;     // of a line: hinges at a joint stay apart

using KIND = ELEM_KIND;
constexpr std::array<KIND, 3> kKinds{KIND::Beam, KIND::Truss, KIND::Link};

/// Axes of the page in space.
struct T_AXES {
    std::array<double, 3> right{}, up{};
};

T_AXES AxesOf(const T_CAMERA& camera)
{
    constexpr double kRad = std::numbers::pi / 180.0;
    const double sy = std::sin(camera.yawDeg * kRad), cy = std::cos(camera.yawDeg * kRad);
    const double sp = std::sin(camera.pitchDeg * kRad), cp = std::cos(camera.pitchDeg * kRad);
    return {{cy, sy, 0.0}, {-sy * sp, cy * sp, cp}};
}

double Dot(const std::array<double, 3>& a, const std::array<double, 3>& b)
{
    return a[0] * b[0] + a[1] * b[1] + a[2] * b[2];
}

/// The three axes in the lower left corner.
void DrawTriad(QPainter& painter, const QRectF& area, const T_AXES& axes)
{
    constexpr double kLength = 28.0;
    const std::array<std::pair<const char*, QColor>, 3> names{{{"X", QColor(0xc6, 0x28, 0x28)},
                                                               {"Y", QColor(0x2e, 0x7d, 0x32)},
                                                               {"Z", QColor(0x15, 0x65, 0xc0)}}};
    const QPointF from = area.bottomLeft() + QPointF(14, -30);
    for (std::size_t d = 0; d < 3; ++d) {
        const QPointF tip = from + kLength * QPointF(axes.right[d], -axes.up[d]);
        if (QLineF(from, tip).length() < 3.0) continue; // it points at the viewer
        painter.setPen(QPen(names[d].second, 1.5));
        painter.drawLine(from, tip);
        painter.drawText(tip + 0.25 * (tip - from) + QPointF(-4, 4), names[d].first);
    }
}

} // namespace

/// Node places on the page. The frame fits at zoom 1, with room for displacements of the size that
/// a round scale gives them: the room is the same for all steps.
void CFramePainter::PlaceDesign(const T_FRAME_PICTURE& picture, const T_CAMERA& camera,
                                const QRectF& area)
{
    const auto& nodes = picture.scene->nodes;
    const T_AXES axes = AxesOf(camera);
    m_design.resize(nodes.size());
    constexpr double kFar = std::numeric_limits<double>::infinity();
    double left = kFar, right = -kFar, low = kFar, high = -kFar;
    for (std::size_t n = 0; n < nodes.size(); ++n) {
        const double x = Dot(nodes[n].xyz, axes.right), y = Dot(nodes[n].xyz, axes.up);
        m_design[n] = {x, y};
        left = std::min(left, x);
        right = std::max(right, x);
        low = std::min(low, y);
        high = std::max(high, y);
    }
    const double room = picture.displacement
                            ? 2.0 * CFrameScene::kShown * std::hypot(right - left, high - low)
                            : 0.0;
    const double w = std::max(right - left + room, 1e-12), h = std::max(high - low + room, 1e-12);
    const double px = camera.zoom * std::min(std::max(area.width() - 2 * kMargin, 10.0) / w,
                                             std::max(area.height() - 2 * kMargin, 10.0) / h);
    const QPointF centre = area.center() + camera.pan;
    const double cx = 0.5 * (left + right), cy = 0.5 * (low + high);
    for (QPointF& p : m_design)
        p = {centre.x() + px * (p.x() - cx), centre.y() - px * (p.y() - cy)};
    m_pxPerLength = px;
}

void CFramePainter::PlaceMoved(const T_FRAME_PICTURE& picture, const T_CAMERA& camera)
{
    const auto& nodes = picture.scene->nodes;
    const T_AXES axes = AxesOf(camera);
    m_moved = m_design;
    if (!picture.displacement || picture.displacement->size() != nodes.size()) return;
    for (std::size_t n = 0; n < nodes.size(); ++n) {
        const auto& move = (*picture.displacement)[n];
        m_moved[n] +=
            m_pxPerLength * picture.scale * QPointF(Dot(move, axes.right), -Dot(move, axes.up));
    }
}

void CFramePainter::DrawLines(QPainter& painter, const T_FRAME_SCENE& scene,
                              const std::vector<QPointF>& at, bool faint)
{
    for (const KIND kind : kKinds) {
        m_lines.clear();
        for (const T_SCENE_LINE& line : scene.lines)
            if (line.kind == kind) m_lines.emplace_back(at[line.i], at[line.j]);
        if (m_lines.empty()) continue;
        painter.setPen(FramePen(kind, faint, scene.lines.size() <= kSmooth));
        painter.drawLines(m_lines.data(), static_cast<int>(m_lines.size()));
    }
}

/// Each half of a member in the colour of its end and each joint as a dot, the worst bands on top.
void CFramePainter::DrawBands(QPainter& painter, const T_FRAME_PICTURE& picture) const
{
    for (std::size_t step = 0; step < kBands; ++step) {
        const std::size_t band = step == 0 ? kBandUnchecked : step - 1;
        painter.setPen(BandPen(band));
        for (const T_BANDED_HALF& half : picture.bands->halves) {
            if (half.band != band) continue;
            const T_SCENE_LINE& line = picture.scene->lines[half.line];
            const QPointF i = m_moved[line.i], j = m_moved[line.j];
            painter.drawLine(half.atJ ? j : i, 0.5 * (i + j));
        }
    }
    constexpr double kRadius = 4.5;
    painter.setPen(QPen(Qt::white, 1.0));
    for (std::size_t step = 0; step < kBands; ++step) {
        const std::size_t band = step == 0 ? kBandUnchecked : step - 1;
        painter.setBrush(BandPen(band).color());
        for (const T_BANDED_NODE& node : picture.bands->nodes)
            if (node.band == band) painter.drawEllipse(m_moved[node.node], kRadius, kRadius);
    }
    painter.setBrush(Qt::NoBrush);
}

/// A broad line below the one that is there.
void CFramePainter::DrawChosen(QPainter& painter, const T_FRAME_PICTURE& picture)
{
    const auto& lines = picture.scene->lines;
    m_lines.clear();
    for (std::size_t l = 0; l < lines.size() && l < picture.chosen.size(); ++l)
        if (picture.chosen[l]) m_lines.emplace_back(m_moved[lines[l].i], m_moved[lines[l].j]);
    if (m_lines.empty()) return;
    painter.setPen(QPen(kChosenColor, 7.0, Qt::SolidLine, Qt::RoundCap));
    painter.drawLines(m_lines.data(), static_cast<int>(m_lines.size()));
}

/// Of a model without elements, whose results came from another solver.
void CFramePainter::DrawNodes(QPainter& painter) const
{
    constexpr double kRadius = 3.0;
    painter.setPen(Qt::NoPen);
    painter.setBrush(FramePen(KIND::Beam, false, true).color());
    for (const QPointF p : m_moved)
        painter.drawEllipse(p, kRadius, kRadius);
    painter.setBrush(Qt::NoBrush);
}

/// A triangle under a node that is held from moving, a square where it can't turn either.
void CFramePainter::DrawSupports(QPainter& painter, const T_FRAME_SCENE& scene) const
{
    painter.setPen(QPen(kSupportColor, 1.2));
    painter.setBrush(kSupportColor.lighter(160));
    for (std::size_t n = 0; n < scene.nodes.size(); ++n) {
        const T_DIRS6& held = scene.nodes[n].held;
        if (!held[0] && !held[1] && !held[2]) continue;
        const QPointF p = m_design[n];
        if (held[3] || held[4] || held[5])
            painter.drawRect(QRectF(p.x() - 5, p.y(), 10, 6));
        else
            painter.drawPolygon(QPolygonF{{p, p + QPointF(-5, 8), p + QPointF(5, 8)}});
    }
    painter.setBrush(Qt::NoBrush);
}

void CFramePainter::DrawHinges(QPainter& painter, const T_FRAME_SCENE& scene) const
{
    constexpr double kRadius = 2.8;
    painter.setPen(Qt::NoPen);
    painter.setBrush(kHingeColor);
    for (const T_SCENE_LINE& line : scene.lines) {
        const QPointF i = m_moved[line.i], j = m_moved[line.j];
        if (line.hingeI) painter.drawEllipse(i + kFromEnd * (j - i), kRadius, kRadius);
        if (line.hingeJ) painter.drawEllipse(j + kFromEnd * (i - j), kRadius, kRadius);
    }
    painter.setBrush(Qt::NoBrush);
}

/// The worst state on top.
void CFramePainter::DrawMarks(QPainter& painter, const T_FRAME_PICTURE& picture)
{
    const auto& marks = picture.marks->hinges;
    m_hinges.resize(marks.size());
    m_order.resize(marks.size());
    std::iota(m_order.begin(), m_order.end(), std::size_t{0});
    std::ranges::stable_sort(m_order, {}, [&](std::size_t m) { return marks[m].state; });
    for (const std::size_t m : m_order) {
        m_hinges[m] = m_moved[marks[m].node];
        if (marks[m].line >= 0) {
            const auto& line = picture.scene->lines[static_cast<std::size_t>(marks[m].line)];
            const double at = kFromEnd + (1.0 - 2.0 * kFromEnd) * marks[m].at;
            m_hinges[m] = m_moved[line.i] + at * (m_moved[line.j] - m_moved[line.i]);
        }
        DrawHingeState(painter, m_hinges[m], marks[m].state);
    }
    const auto chosen = std::ranges::find(marks, true, &T_HINGE_MARK::chosen);
    if (chosen == marks.end()) return;
    painter.setPen(QPen(Qt::black, 1.6));
    painter.drawEllipse(m_hinges[static_cast<std::size_t>(chosen - marks.begin())], 8.5, 8.5);
}

/// Where numbers would cover one another only the first of a cell is drawn.
void CFramePainter::DrawNumbers(QPainter& painter, const QRectF& area,
                                const T_FRAME_PICTURE& picture,
                                const T_FRAME_OPTIONS& options) const
{
    std::set<std::pair<long, long>> taken;
    const auto draw = [&](QPointF at, int id, const QColor& color) {
        if (!area.contains(at)) return;
        if (!taken.emplace(std::lround(at.x() / kCell), std::lround(at.y() / (kCell / 2))).second)
            return;
        painter.setPen(color);
        painter.drawText(at + QPointF(4, -4), QString::number(id));
    };
    if (options.nodeNumbers)
        for (std::size_t n = 0; n < m_moved.size(); ++n)
            draw(m_moved[n], picture.scene->nodes[n].id, QColor(0x4a, 0x14, 0x8c));
    if (options.elementNumbers)
        for (const T_SCENE_LINE& line : picture.scene->lines)
            draw(0.5 * (m_moved[line.i] + m_moved[line.j]), line.id, QColor(0x00, 0x60, 0x64));
}

void CFramePainter::DrawBackground(QPainter& painter, const QRectF& rect,
                                   const T_FRAME_PICTURE& picture, const T_CAMERA& camera,
                                   const T_FRAME_OPTIONS& options)
{
    painter.fillRect(rect, Qt::white);
    if (!picture.scene || picture.scene->nodes.empty()) return;
    const T_FRAME_SCENE& scene = *picture.scene;
    painter.save();
    painter.setClipRect(rect);
    PlaceDesign(picture, camera, DrawFrameLegend(nullptr, rect, picture, options));
    painter.setRenderHint(QPainter::Antialiasing, scene.lines.size() <= kSmooth);
    if (picture.displacement && options.undeformed) DrawLines(painter, scene, m_design, true);
    painter.setRenderHint(QPainter::Antialiasing, true);
    if (options.supports) DrawSupports(painter, scene);
    painter.restore();
}

void CFramePainter::DrawForeground(QPainter& painter, const QRectF& rect,
                                   const T_FRAME_PICTURE& picture, const T_CAMERA& camera,
                                   const T_FRAME_OPTIONS& options)
{
    if (!picture.scene) return;
    const T_FRAME_SCENE& scene = *picture.scene;
    painter.save();
    painter.setClipRect(rect);
    const QRectF area = DrawFrameLegend(&painter, rect, picture, options);
    if (scene.nodes.empty()) {
        painter.drawText(
            area, Qt::AlignCenter,
            QString::fromStdString(zql::lib::MMSGFunction::GetValue("IDS_QM_UI_FRAME_EMPTY")));
        painter.restore();
        return;
    }
    PlaceMoved(picture, camera);
    painter.setRenderHint(QPainter::Antialiasing, scene.lines.size() <= kSmooth);
    DrawChosen(painter, picture);
    DrawLines(painter, scene, m_moved, false);
    if (picture.bands) DrawBands(painter, picture);
    painter.setRenderHint(QPainter::Antialiasing, true);
    if (scene.lines.empty()) DrawNodes(painter);
    m_hinges.clear();
    if (options.hinges && picture.marks)
        DrawMarks(painter, picture);
    else if (options.hinges)
        DrawHinges(painter, scene);
    if (options.nodeNumbers || options.elementNumbers) DrawNumbers(painter, area, picture, options);
    DrawTriad(painter, area, AxesOf(camera));
    painter.restore();
}

void CFramePainter::Draw(QPainter& painter, const QRectF& rect, const T_FRAME_PICTURE& picture,
                         const T_CAMERA& camera, const T_FRAME_OPTIONS& options)
{
    DrawBackground(painter, rect, picture, camera, options);
    DrawForeground(painter, rect, picture, camera, options);
}

long CFramePainter::NodeAt(QPointF place) const
{
    long nearest = -1;
    double distance = kHit;
    for (std::size_t n = 0; n < m_moved.size(); ++n) {
        const double d = QLineF(place, m_moved[n]).length();
        if (d >= distance) continue;
        distance = d;
        nearest = static_cast<long>(n);
    }
    return nearest;
}

long CFramePainter::HingeAt(QPointF place) const
{
    long nearest = -1;
    double distance = kHit;
    for (auto m = m_order.rbegin(); m != m_order.rend(); ++m) {
        if (*m >= m_hinges.size()) continue;
        const double d = QLineF(place, m_hinges[*m]).length();
        if (d >= distance) continue;
        distance = d;
        nearest = static_cast<long>(*m);
    }
    return nearest;
}

long CFramePainter::LineAt(const T_FRAME_SCENE& scene, QPointF place) const
{
    long nearest = -1;
    double distance = kHit;
    for (std::size_t l = 0; l < scene.lines.size(); ++l) {
        const QPointF a = m_moved.at(scene.lines[l].i), b = m_moved.at(scene.lines[l].j);
        const QPointF along = b - a, from = place - a;
        const double square = QPointF::dotProduct(along, along);
        const double t =
            square > 0.0 ? std::clamp(QPointF::dotProduct(from, along) / square, 0.0, 1.0) : 0.0;
        const double d = QLineF(place, a + t * along).length();
        if (d >= distance) continue;
        distance = d;
        nearest = static_cast<long>(l);
    }
    return nearest;
}

std::vector<std::size_t> CFramePainter::LinesIn(const T_FRAME_SCENE& scene, const QRectF& box) const
{
    std::vector<std::size_t> lines;
    for (std::size_t l = 0; l < scene.lines.size(); ++l)
        if (box.contains(m_moved.at(scene.lines[l].i)) &&
            box.contains(m_moved.at(scene.lines[l].j)))
            lines.push_back(l);
    return lines;
}

const T_CAMERA& CameraFor(int flatAxis)
{
    constexpr const T_CAMERA* kStraight[] = {&kElevationYZ, &kElevationXZ, &kPlanXY};
    return flatAxis < 0 ? kIsometric : *kStraight[flatAxis];
}
