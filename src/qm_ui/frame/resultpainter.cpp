#include "qm_ui/frame/resultpainter.h"

#include "qm_base/textformat.h"
#include "qm_ui/form/localnumber.h"
#include "qm_ui/frame/markpainter.h"

#include <QPainter>

#include <algorithm>
#include <cmath>

namespace {

using P3 = std::array<double, 3>;

const QColor kPositive{0x1e, 0x88, 0xe5}, kNegative{0xe5, 0x39, 0x35};
constexpr int kFillAlpha = 70;
constexpr std::size_t kManyMembers = 4000; // beyond: outlines alone, few points
constexpr std::size_t kMostLabels = 600;   // that fit on a page

P3 Plus(const P3& a, const P3& b, double factor)
{
    return {a[0] + factor * b[0], a[1] + factor * b[1], a[2] + factor * b[2]};
}

/// The largest ordinate: a part of the frame's size, less than the members are long.
double LargestOrdinate(const T_PLACED_FRAME& frame, const T_DIAGRAM& diagram)
{
    double sum = 0.0;
    for (const T_MEMBER_DIAGRAM& m : diagram.members) {
        const T_SCENE_LINE& line = frame.scene.lines[m.line];
        const P3 &i = frame.scene.nodes[line.i].xyz, &j = frame.scene.nodes[line.j].xyz;
        sum += std::hypot(j[0] - i[0], j[1] - i[1], j[2] - i[2]);
    }
    const double mean = sum / static_cast<double>(diagram.members.size());
    const double size = frame.projection.Size();
    return std::clamp(0.5 * mean, 0.03 * size, 0.1 * size);
}

/// 1, 2 or 5 times a power of ten, at most this.
double RoundValue(double most)
{
    const double power = std::pow(10.0, std::floor(std::log10(most)));
    for (const double digit : {5.0, 2.0})
        if (most >= digit * power) return digit * power;
    return power;
}

/// A bar as long as a round value is drawn, in the lower right corner.
void DrawScaleBar(QPainter& painter, const QRectF& area, double pxPerValue, const std::string& unit)
{
    constexpr double kLongest = 90.0;
    if (!(pxPerValue > 0.0)) return;
    const double value = RoundValue(kLongest / pxPerValue), px = value * pxPerValue;
    const QPointF right = area.bottomRight() + QPointF(-14, -14), left = right - QPointF(px, 0);
    painter.setPen(QPen(Qt::black, 1.4));
    painter.drawLine(left, right);
    for (const QPointF& end : {left, right})
        painter.drawLine(end - QPointF(0, 4), end + QPointF(0, 4));
    const QString text = ValueText(value) + " " + QString::fromStdString(unit);
    painter.drawText(QRectF(right.x() - 220, right.y() - 24, 220, 18),
                     Qt::AlignRight | Qt::AlignVCenter, text);
}

} // namespace

QString ValueText(double value)
{
    const double size = std::fabs(value);
    return LocalNumberText(FormatText(size >= 1e3 && size < 1e7 ? "%.0f" : "%.4g", value));
}

P3 T_PLACED_FRAME::On(std::size_t index, double s) const
{
    const T_SCENE_LINE& line = scene.lines[index];
    const P3 i = Plus(scene.nodes[line.i].xyz, line.offsetI, 1.0);
    const P3 j = Plus(scene.nodes[line.j].xyz, line.offsetJ, 1.0);
    const P3 design = Plus(Plus({}, i, 1.0 - s), j, s);
    if (!moves) return design;
    if (!bent)
        return Plus(Plus(design, (*moves)[line.i], scale * (1.0 - s)), (*moves)[line.j], scale * s);
    const std::size_t parts = bent->parts, first = index * (parts + 1);
    const double x = s * static_cast<double>(parts);
    const auto k = std::min(static_cast<std::size_t>(x), parts - 1);
    const double t = x - static_cast<double>(k);
    return Plus(Plus(design, bent->moved[first + k], scale * (1.0 - t)), bent->moved[first + k + 1],
                scale * t);
}

void CResultPainter::Draw(QPainter& painter, const QRectF& area, const T_PLACED_FRAME& frame,
                          const T_FRAME_RESULTS& results, bool quick)
{
    m_labels.clear();
    if (results.stress) DrawStress(painter, frame, *results.stress);
    if (results.diagram) DrawDiagram(painter, area, frame, results, quick);
    if (results.marks) DrawMarks(painter, frame, results, quick);
    if (!quick && results.labels != VIEW_LABELS::None) DrawLabels(painter, area);
}

void CResultPainter::PlaceMember(const T_PLACED_FRAME& frame, const T_DIAGRAM& diagram,
                                 const T_MEMBER_DIAGRAM& member, double perValue)
{
    m_base.clear();
    m_tip.clear();
    for (std::size_t p = member.first; p < member.first + member.count; ++p) {
        const P3 at = frame.On(member.line, diagram.points[p].at);
        m_base.push_back(frame.projection.At(at));
        m_tip.push_back(
            frame.projection.At(Plus(at, member.along, perValue * diagram.points[p].value)));
    }
}

/// A polygon between two places where the value is 0, or an end: of one sign throughout.
void CResultPainter::FillMember(const T_DIAGRAM& diagram, const T_MEMBER_DIAGRAM& member)
{
    const auto fill = [this](const QPointF& a, const QPointF& ta, const QPointF& tb,
                             const QPointF& b, bool positive) {
        QPainterPath& path = positive ? m_positive : m_negative;
        // One way round, so that what overlaps is filled, too.
        const QPointF d1 = tb - a, d2 = b - ta;
        const bool left = d1.x() * d2.y() - d1.y() * d2.x() < 0.0;
        path.addPolygon(left ? QPolygonF{{a, b, tb, ta, a}} : QPolygonF{{a, ta, tb, b, a}});
    };
    for (std::size_t k = 0; k + 1 < member.count; ++k) {
        const double v0 = diagram.Value(member.first + k), v1 = diagram.Value(member.first + k + 1);
        if (v0 == 0.0 && v1 == 0.0) continue;
        if (v0 * v1 >= 0.0) {
            fill(m_base[k], m_tip[k], m_tip[k + 1], m_base[k + 1], v0 + v1 > 0.0);
            continue;
        }
        const QPointF zero = m_base[k] + v0 / (v0 - v1) * (m_base[k + 1] - m_base[k]);
        fill(m_base[k], m_tip[k], zero, zero, v0 > 0.0);
        fill(zero, zero, m_tip[k + 1], m_base[k + 1], v1 > 0.0);
    }
}

void CResultPainter::LabelMember(const T_DIAGRAM& diagram, const T_MEMBER_DIAGRAM& member,
                                 std::size_t index, VIEW_LABELS labels)
{
    const auto add = [&](std::size_t point) {
        const std::size_t k = point - member.first;
        const double value = diagram.Value(point);
        if (value == 0.0) return;
        m_labels.push_back({m_tip[k], m_base[k], std::fabs(value), ValueText(value)});
    };
    const bool largest = labels != VIEW_LABELS::Largest || index == diagram.largest;
    const bool smallest = labels != VIEW_LABELS::Largest || index == diagram.smallest;
    if (diagram.Value(member.smallest) == diagram.Value(member.largest)) {
        const double value = diagram.Value(member.largest);
        if ((largest || smallest) && value != 0.0)
            m_labels.push_back({0.5 * (m_tip.front() + m_tip.back()),
                                0.5 * (m_base.front() + m_base.back()), std::fabs(value),
                                ValueText(value)});
        return;
    }
    if (largest) add(member.largest);
    if (smallest) add(member.smallest);
    if (labels != VIEW_LABELS::All) return;
    for (const std::size_t end : {member.first, member.first + member.count - 1})
        if (end != member.largest && end != member.smallest) add(end);
}

void CResultPainter::DrawDiagram(QPainter& painter, const QRectF& area, const T_PLACED_FRAME& frame,
                                 const T_FRAME_RESULTS& results, bool quick)
{
    const T_DIAGRAM& diagram = *results.diagram;
    const double size = diagram.Size();
    if (!(size > 0.0)) return;
    const double perValue = results.size * LargestOrdinate(frame, diagram) / size;
    const bool many = diagram.members.size() > kManyMembers;
    const bool fills = results.filled && !many && !quick;
    m_positive.clear();
    m_negative.clear();
    m_positive.setFillRule(Qt::WindingFill);
    m_negative.setFillRule(Qt::WindingFill);
    m_outline.clear();
    for (std::size_t m = 0; m < diagram.members.size(); ++m) {
        const T_MEMBER_DIAGRAM& member = diagram.members[m];
        PlaceMember(frame, diagram, member, perValue);
        m_outline.emplace_back(m_base.front(), m_tip.front());
        for (std::size_t k = 0; k + 1 < m_tip.size(); ++k)
            m_outline.emplace_back(m_tip[k], m_tip[k + 1]);
        m_outline.emplace_back(m_tip.back(), m_base.back());
        if (fills) FillMember(diagram, member);
        if (!many && !quick && results.labels != VIEW_LABELS::None)
            LabelMember(diagram, member, m, results.labels);
    }
    const auto paint = [&](const QPainterPath& path, QColor color) {
        color.setAlpha(kFillAlpha);
        painter.fillPath(path, color);
    };
    paint(m_positive, kPositive);
    paint(m_negative, kNegative);
    painter.setPen(QPen(QColor(0x45, 0x5a, 0x64), many ? 0.0 : 1.0));
    painter.drawLines(m_outline.data(), static_cast<int>(m_outline.size()));
    DrawScaleBar(painter, area, perValue * frame.projection.PxPerLength(), diagram.unit);
}

void CResultPainter::DrawMarks(QPainter& painter, const T_PLACED_FRAME& frame,
                               const T_FRAME_RESULTS& results, bool quick)
{
    const auto label = [&](QPointF at, QPointF from, double value, const QString& text) {
        if (!quick) m_labels.push_back({at, from, value, text});
    };
    const double px = results.size / frame.projection.PxPerLength();
    for (const T_BAND_MARK& band : results.marks->bands) {
        const T_DRAWN_BAND drawn = DrawBandMark(painter, frame.projection, band, px);
        label(drawn.from, drawn.base, std::fabs(band.value[0]), ValueText(band.value[0]));
        if (band.value[0] != band.value[1])
            label(drawn.to, drawn.baseTo, std::fabs(band.value[1]), ValueText(band.value[1]));
    }
    double most = 0.0;
    for (const T_ARROW_MARK& arrow : results.marks->arrows)
        most = std::max(most, arrow.size);
    for (const T_ARROW_MARK& arrow : results.marks->arrows) {
        const QPointF tail = DrawArrowMark(painter, frame.projection, arrow, px);
        if (results.labels != VIEW_LABELS::Largest || arrow.size == most)
            label(tail, frame.projection.At(arrow.at), arrow.value, ValueText(arrow.value));
    }
    for (const T_WORD_MARK& word : results.marks->words)
        label(frame.projection.At(word.at), frame.projection.At(word.at), 0.0,
              QString::fromStdString(word.text));
}

void CResultPainter::DrawStress(QPainter& painter, const T_PLACED_FRAME& frame,
                                const T_STRESS_PICTURE& stress)
{
    for (std::size_t band = 0; band <= kStressBands; ++band) {
        m_outline.clear();
        for (const T_LINE_STRESS& line : stress.lines) {
            const bool unchecked = line.value.empty();
            if (unchecked != (band == kStressBands)) continue;
            const std::size_t count = unchecked ? 2 : line.value.size();
            for (std::size_t p = 0; p + 1 < count; ++p) {
                const double last = static_cast<double>(count - 1);
                const auto place = [&](std::size_t k) {
                    return frame.projection.At(frame.On(line.line, static_cast<double>(k) / last));
                };
                const double value =
                    unchecked ? 0.0
                              : std::max(std::fabs(line.value[p]), std::fabs(line.value[p + 1]));
                if (unchecked || StressBand(value, stress.largest) == band)
                    m_outline.emplace_back(place(p), place(p + 1));
            }
        }
        if (m_outline.empty()) continue;
        painter.setPen(StressPen(band));
        painter.drawLines(m_outline.data(), static_cast<int>(m_outline.size()));
    }
}

/// The largest values first; a text that would cover another one is left out.
void CResultPainter::DrawLabels(QPainter& painter, const QRectF& area)
{
    std::ranges::stable_sort(m_labels, std::greater{}, &T_LABEL::value);
    const QFontMetricsF metrics(painter.font());
    m_taken.clear();
    painter.setPen(Qt::black);
    for (const T_LABEL& label : m_labels) {
        if (m_taken.size() >= kMostLabels) break;
        if (!area.contains(label.at)) continue;
        const QPointF away = label.at - label.from;
        const double length = std::hypot(away.x(), away.y());
        const QPointF step = length > 1.0 ? 9.0 / length * away : QPointF(0, -9);
        const double w = metrics.horizontalAdvance(label.text) + 2, h = metrics.height() - 2;
        QRectF box(0, 0, w, h);
        box.moveCenter(label.at + step + QPointF(0.5 * w * step.x() / 9.0, 0));
        const bool covers = std::ranges::any_of(
            m_taken, [&](const QRectF& other) { return other.intersects(box); });
        if (covers) continue;
        m_taken.push_back(box);
        painter.fillRect(box, QColor(255, 255, 255, 170));
        painter.drawText(box, Qt::AlignCenter, label.text);
    }
}

std::vector<T_LEGEND_ENTRY> CResultPainter::Legend(const T_FRAME_RESULTS& results)
{
    std::vector<T_LEGEND_ENTRY> out;
    const auto block = [](QColor color) {
        color.setAlpha(kFillAlpha);
        return [color](QPainter& p, QPointF m) {
            p.fillRect(QRectF(m.x() - 12, m.y() - 5, 24, 10), color);
        };
    };
    if (results.diagram && results.diagram->Size() > 0.0) {
        const QString name =
            QString::fromStdString(results.diagram->name + " (" + results.diagram->unit + ")");
        out.push_back({name + " +", block(kPositive)});
        out.push_back({name + QStringLiteral(" \u2212"), block(kNegative)});
    }
    if (results.marks) AddMarkLegend(*results.marks, out);
    if (results.stress) AddStressLegend(*results.stress, out);
    return out;
}
