#include "qm_ui/frame/markpainter.h"

#include "qm_base/say.h"

#include <QLineF>
#include <QPainter>
#include <QPolygonF>

#include <algorithm>
#include <cmath>

namespace {

using P3 = std::array<double, 3>;

struct T_LOOK {
    QRgb color;
    const char* key; // of the legend
    bool doubleHead; // a moment by the right hand
    bool away;       // begins at its place
};
constexpr std::array<T_LOOK, kMarkKinds> kLooks{
    {{0xffc62828, "IDS_QM_VIEW_MARK_FORCES", false, false},
     {0xff6a1b9a, "IDS_QM_VIEW_MARK_MOMENTS", true, false},
     {0xff00838f, "IDS_QM_VIEW_MARK_MOVEMENTS", false, true},
     {0xff00838f, "IDS_QM_VIEW_MARK_TURNS", true, true}}};
const QColor kBandColor{0xad, 0x14, 0x57};

constexpr double kShortest = 20.0, kLongest = 58.0, kBand = 34.0, kHead = 7.0; // px

P3 Along(const P3& at, const P3& direction, double factor)
{
    return {at[0] + factor * direction[0], at[1] + factor * direction[1],
            at[2] + factor * direction[2]};
}

/// A head at `tip`, of a line that comes from `tail`; smaller on a line seen from its end.
void DrawHead(QPainter& painter, QPointF tail, QPointF tip)
{
    const QPointF way = tip - tail;
    const double length = std::hypot(way.x(), way.y());
    if (length < 2.0) return;
    const double head = std::min(kHead, 0.5 * length);
    const QPointF back = -head / length * way, across(-0.4 * back.y(), 0.4 * back.x());
    painter.drawPolygon(QPolygonF{{tip, tip + back + across, tip + back - across}});
}

/// Seen along its axis: a ring with a dot.
void DrawFromItsEnd(QPainter& painter, QPointF at)
{
    painter.setBrush(Qt::NoBrush);
    painter.drawEllipse(at, 5.0, 5.0);
    painter.drawEllipse(at, 1.0, 1.0);
}

} // namespace

QPointF DrawArrowMark(QPainter& painter, const CProjection& projection, const T_ARROW_MARK& arrow,
                      double px)
{
    const T_LOOK& look = kLooks[static_cast<std::size_t>(arrow.kind)];
    const double length = px * (kShortest + (kLongest - kShortest) * arrow.size);
    const QColor color(look.color);
    painter.setPen(QPen(color, 1.8, look.away ? Qt::DashLine : Qt::SolidLine));
    painter.setBrush(color);
    const QPointF at = projection.At(arrow.at);
    const QPointF end = projection.At(Along(arrow.at, arrow.along, look.away ? length : -length));
    const QPointF tail = look.away ? at : end, tip = look.away ? end : at;
    if (QLineF(tail, tip).length() < 4.0) {
        DrawFromItsEnd(painter, at);
        return at + QPointF(0, -8);
    }
    painter.drawLine(tail, tip);
    painter.setPen(QPen(color, 1.0));
    DrawHead(painter, tail, tip);
    if (look.doubleHead) DrawHead(painter, tail, tip + 0.22 * (tail - tip));
    painter.setBrush(Qt::NoBrush);
    return end;
}

T_DRAWN_BAND DrawBandMark(QPainter& painter, const CProjection& projection, const T_BAND_MARK& band,
                          double px)
{
    constexpr double kEvery = 22.0; // px between arrows
    const auto place = [&](double s, bool tail) {
        P3 at{}, w{};
        for (std::size_t d = 0; d < 3; ++d) {
            at[d] = (1.0 - s) * band.from[d] + s * band.to[d];
            w[d] = (1.0 - s) * band.along0[d] + s * band.along1[d];
        }
        return projection.At(tail ? Along(at, w, -kBand * px) : at);
    };
    const QPointF from = place(0, false), to = place(1, false);
    const int arrows = std::clamp(static_cast<int>(QLineF(from, to).length() / kEvery), 1, 40);
    painter.setPen(QPen(kBandColor, 1.0));
    painter.setBrush(kBandColor);
    for (int k = 0; k <= arrows; ++k) {
        const double s = static_cast<double>(k) / arrows;
        const QPointF tail = place(s, true), tip = place(s, false);
        painter.drawLine(tail, tip);
        DrawHead(painter, tail, tip);
    }
    painter.drawLine(place(0, true), place(1, true));
    painter.setBrush(Qt::NoBrush);
    return {place(0, true), place(1, true), from, to};
}

std::size_t StressBand(double magnitude, double largest)
{
    if (!(largest > 0.0)) return 0;
    const double part = magnitude / largest * static_cast<double>(kStressBands);
    return std::min(static_cast<std::size_t>(part), kStressBands - 1);
}

QPen StressPen(std::size_t band)
{
    constexpr std::array<QRgb, kStressBands + 1> kColors{0xff1565c0, 0xff00897b, 0xff9e9d24,
                                                         0xfff57c00, 0xffc62828, 0xff90a4ae};
    return {QColor(kColors[band]), band < kStressBands ? 3.6 : 2.0,
            band < kStressBands ? Qt::SolidLine : Qt::DashLine, Qt::FlatCap};
}

void AddMarkLegend(const T_LOAD_MARKS& marks, std::vector<T_LEGEND_ENTRY>& out)
{
    for (std::size_t kind = 0; kind < kMarkKinds; ++kind) {
        const T_LOOK look = kLooks[kind];
        const auto of = [kind](const T_ARROW_MARK& arrow) {
            return static_cast<std::size_t>(arrow.kind) == kind;
        };
        if (std::ranges::none_of(marks.arrows, of)) continue;
        out.push_back({QString::fromStdString(Say(look.key, marks.unit[kind])),
                       [look](QPainter& p, QPointF m) {
                           const QPointF tail = m - QPointF(12, 0), tip = m + QPointF(12, 0);
                           p.setPen(QPen(QColor(look.color), 1.8));
                           p.setBrush(QColor(look.color));
                           p.drawLine(tail, tip);
                           DrawHead(p, tail, tip);
                           if (look.doubleHead) DrawHead(p, tail, tip - QPointF(6, 0));
                           p.setBrush(Qt::NoBrush);
                       }});
    }
    if (marks.bands.empty()) return;
    out.push_back({QString::fromStdString(Say("IDS_QM_VIEW_MARK_BANDS", marks.bandUnit)),
                   [](QPainter& p, QPointF m) {
                       p.setPen(QPen(kBandColor, 1.2));
                       for (const int x : {-10, 0, 10})
                           p.drawLine(m + QPointF(x, -5), m + QPointF(x, 5));
                       p.drawLine(m + QPointF(-10, -5), m + QPointF(10, -5));
                   }});
}

void AddStressLegend(const T_STRESS_PICTURE& stress, std::vector<T_LEGEND_ENTRY>& out)
{
    const auto entry = [](const QString& text, std::size_t band) {
        return T_LEGEND_ENTRY{text, [band](QPainter& p, QPointF m) {
                                  p.setPen(StressPen(band));
                                  p.drawLine(m - QPointF(13, 0), m + QPointF(13, 0));
                              }};
    };
    const QString unit = " " + QString::fromStdString(stress.unit);
    for (std::size_t band = 0; band < kStressBands; ++band) {
        const double step = stress.largest / static_cast<double>(kStressBands);
        const double low = step * static_cast<double>(band);
        out.push_back(entry(ValueText(low) + " - " + ValueText(low + step) + unit, band));
    }
    if (stress.unchecked == 0) return;
    out.push_back(entry(QString::fromStdString(Say("IDS_QM_VIEW_STRESS_UNCHECKED")), kStressBands));
}
