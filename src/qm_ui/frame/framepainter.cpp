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

constexpr std::size_t kSmooth = 4000; // members up to which lines are smoothed
constexpr std::size_t kManyMarks = 2000;
constexpr double kCell = 34.0;    // px between numbers that are drawn
constexpr double kFromEnd = 0.08; // of a line: hinges at a joint stay apart

using KIND = ELEM_KIND;
constexpr std::array<KIND, 3> kKinds{KIND::Beam, KIND::Truss, KIND::Link};

} // namespace

double RoomOf(const T_FRAME_PICTURE& picture)
{
    constexpr double kForValues = 0.26; // of diagrams and arrows in the size that suits
    double room = picture.displacement ? 2.0 * CFrameScene::kShown : 0.0;
    if (picture.results.diagram || picture.results.marks)
        room += kForValues * std::min(picture.results.size, 2.0);
    return room;
}

void CFramePainter::PlaceMoved(const T_FRAME_PICTURE& picture)
{
    const auto& nodes = picture.scene->nodes;
    m_moved = m_design;
    m_bent.clear();
    m_bentAt.clear();
    if (!picture.displacement || picture.displacement->size() != nodes.size()) return;
    for (std::size_t n = 0; n < nodes.size(); ++n)
        m_moved[n] = m_projection.Moved(m_design[n], nodes[n].xyz, (*picture.displacement)[n],
                                        picture.scale);
    if (picture.results.bent) PlaceBent(picture);
}

/// As many points as the line's length on the page can show.
void CFramePainter::PlaceBent(const T_FRAME_PICTURE& picture)
{
    constexpr double kPxPerPart = 9.0;
    const T_FRAME_SCENE& scene = *picture.scene;
    const T_BENT_LINES& bent = *picture.results.bent;
    if (bent.moved.size() != scene.lines.size() * (bent.parts + 1)) return;
    const T_PLACED_FRAME placed{scene, m_projection, picture.displacement, &bent, picture.scale};
    for (std::size_t l = 0; l < scene.lines.size(); ++l) {
        m_bentAt.push_back(m_bent.size());
        const T_SCENE_LINE& line = scene.lines[l];
        const double px = QLineF(m_moved[line.i], m_moved[line.j]).length();
        std::size_t parts = 1;
        while (parts < bent.parts && kPxPerPart * static_cast<double>(parts) < px)
            parts *= 2;
        for (std::size_t k = 0; k <= parts; ++k)
            m_bent.push_back(
                m_projection.At(placed.On(l, static_cast<double>(k) / static_cast<double>(parts))));
    }
    m_bentAt.push_back(m_bent.size());
}

/// A rigid offset goes straight from its node.
void CFramePainter::AddLine(const T_FRAME_SCENE& scene, std::size_t l,
                            const std::vector<QPointF>& at, bool bent,
                            std::vector<QLineF>& out) const
{
    const T_SCENE_LINE& line = scene.lines[l];
    if (!bent || m_bentAt.empty()) {
        out.emplace_back(at[line.i], at[line.j]);
        return;
    }
    constexpr std::array<double, 3> kNone{};
    const std::size_t last = m_bentAt[l + 1] - 1;
    if (line.offsetI != kNone) out.emplace_back(at[line.i], m_bent[m_bentAt[l]]);
    for (std::size_t k = m_bentAt[l]; k < last; ++k)
        out.emplace_back(m_bent[k], m_bent[k + 1]);
    if (line.offsetJ != kNone) out.emplace_back(m_bent[last], at[line.j]);
}

void CFramePainter::DrawLines(QPainter& painter, const T_FRAME_SCENE& scene,
                              const std::vector<QPointF>& at, bool faint)
{
    for (auto& lines : m_kinds)
        lines.clear();
    for (std::size_t l = 0; l < scene.lines.size(); ++l) {
        const auto kind = static_cast<std::size_t>(scene.lines[l].kind);
        if (kind < m_kinds.size()) AddLine(scene, l, at, !faint, m_kinds[kind]);
    }
    for (std::size_t k = 0; k < m_kinds.size(); ++k) {
        if (m_kinds[k].empty()) continue;
        painter.setPen(FramePen(kKinds[k], faint, scene.lines.size() <= kSmooth));
        painter.drawLines(m_kinds[k].data(), static_cast<int>(m_kinds[k].size()));
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
        if (picture.chosen[l]) AddLine(*picture.scene, l, m_moved, true, m_lines);
    if (!m_lines.empty()) {
        painter.setPen(QPen(kChosenColor, 7.0, Qt::SolidLine, Qt::RoundCap));
        painter.drawLines(m_lines.data(), static_cast<int>(m_lines.size()));
    }
    painter.setPen(QPen(kChosenColor.darker(140), 1.0));
    painter.setBrush(kChosenColor);
    for (const std::size_t node : picture.chosenNodes)
        if (node < m_moved.size()) painter.drawEllipse(m_moved[node], 5.5, 5.5);
    painter.setBrush(Qt::NoBrush);
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
void CFramePainter::DrawSupports(QPainter& painter, const T_FRAME_SCENE& scene, bool quick)
{
    m_boxes.clear();
    painter.setPen(QPen(kSupportColor, 1.2));
    painter.setBrush(kSupportColor.lighter(160));
    for (std::size_t n = 0; n < scene.nodes.size(); ++n) {
        const T_DIRS6& held = scene.nodes[n].held;
        if (!scene.nodes[n].shown || (!held[0] && !held[1] && !held[2])) continue;
        const QPointF p = m_design[n];
        if (quick || held[3] || held[4] || held[5])
            m_boxes.emplace_back(p.x() - 5, p.y(), 10, 6);
        else
            painter.drawPolygon(QPolygonF{{p, p + QPointF(-5, 8), p + QPointF(5, 8)}});
    }
    if (quick) painter.setPen(Qt::NoPen);
    painter.drawRects(m_boxes.data(), static_cast<int>(m_boxes.size()));
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

/// The worst state on top; with perspective what is nearer over what is farther.
void CFramePainter::PlaceMarks(const T_FRAME_PICTURE& picture)
{
    const auto& marks = picture.marks->hinges;
    m_hinges.resize(marks.size());
    m_order.resize(marks.size());
    std::iota(m_order.begin(), m_order.end(), std::size_t{0});
    const auto depth = [&](std::size_t m) {
        if (!m_projection.IsPerspective()) return 0.0;
        const T_SCENE_NODE& node =
            marks[m].line < 0
                ? picture.scene->nodes[marks[m].node]
                : picture.scene
                      ->nodes[picture.scene->lines[static_cast<std::size_t>(marks[m].line)].i];
        return m_projection.Depth(node.xyz);
    };
    std::ranges::stable_sort(m_order, {},
                             [&](std::size_t m) { return std::pair(depth(m), marks[m].state); });
    for (const std::size_t m : m_order) {
        m_hinges[m] = m_moved[marks[m].node];
        if (marks[m].line >= 0) {
            const auto& line = picture.scene->lines[static_cast<std::size_t>(marks[m].line)];
            const double at = kFromEnd + (1.0 - 2.0 * kFromEnd) * marks[m].at;
            m_hinges[m] = m_moved[line.i] + at * (m_moved[line.j] - m_moved[line.i]);
        }
    }
    std::erase_if(m_order, [&](std::size_t m) { return !marks[m].shown; });
}

void CFramePainter::DrawMarks(QPainter& painter, const T_FRAME_PICTURE& picture, bool quick)
{
    const auto& marks = picture.marks->hinges;
    PlaceMarks(picture);
    if (quick && m_order.size() > kManyMarks) {
        painter.setPen(Qt::NoPen);
        for (std::size_t state = 0; state < kPushStateNames.size(); ++state) {
            m_boxes.clear();
            for (const std::size_t m : m_order)
                if (static_cast<std::size_t>(marks[m].state) == state)
                    m_boxes.emplace_back(m_hinges[m].x() - 2, m_hinges[m].y() - 2, 4, 4);
            painter.setBrush(HingeStateColor(static_cast<PUSH_STATE>(state)));
            painter.drawRects(m_boxes.data(), static_cast<int>(m_boxes.size()));
        }
        painter.setBrush(Qt::NoBrush);
        return;
    }
    for (const std::size_t m : m_order)
        DrawHingeState(painter, m_hinges[m], marks[m].state);
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
            if (picture.scene->nodes[n].shown)
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
    m_area = DrawFrameLegend(nullptr, rect, picture, options);
    painter.setClipRect(m_area); // titles and legend stay free
    m_projection.Place(scene, camera, m_area, RoomOf(picture), m_design);
    painter.setRenderHint(QPainter::Antialiasing, scene.lines.size() <= kSmooth && !options.quick);
    if (picture.displacement && options.undeformed) DrawLines(painter, scene, m_design, true);
    painter.setRenderHint(QPainter::Antialiasing, !options.quick);
    if (options.supports) DrawSupports(painter, scene, options.quick);
    painter.restore();
}

void CFramePainter::DrawForeground(QPainter& painter, const QRectF& rect,
                                   const T_FRAME_PICTURE& picture, const T_FRAME_OPTIONS& options)
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
    painter.setClipRect(area);
    PlaceMoved(picture);
    painter.setRenderHint(QPainter::Antialiasing, scene.lines.size() <= kSmooth && !options.quick);
    DrawChosen(painter, picture);
    DrawLines(painter, scene, m_moved, false);
    if (picture.bands) DrawBands(painter, picture);
    const T_BENT_LINES* const bent = m_bentAt.empty() ? nullptr : picture.results.bent;
    m_results.Draw(painter, area, {scene, m_projection, picture.displacement, bent, picture.scale},
                   picture.results, options.quick);
    painter.setRenderHint(QPainter::Antialiasing, !options.quick);
    if (scene.lines.empty()) DrawNodes(painter);
    m_hinges.clear();
    m_order.clear();
    if (options.hinges && picture.marks)
        DrawMarks(painter, picture, options.quick);
    else if (options.hinges && !picture.results.HasValues())
        DrawHinges(painter, scene);
    if (!options.quick && (options.nodeNumbers || options.elementNumbers))
        DrawNumbers(painter, area, picture, options);
    m_projection.DrawTriad(painter, area);
    painter.restore();
}

void CFramePainter::Draw(QPainter& painter, const QRectF& rect, const T_FRAME_PICTURE& picture,
                         const T_CAMERA& camera, const T_FRAME_OPTIONS& options)
{
    DrawBackground(painter, rect, picture, camera, options);
    DrawForeground(painter, rect, picture, options);
}
