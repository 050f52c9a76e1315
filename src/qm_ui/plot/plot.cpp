#include "qm_ui/plot/plot.h"

#include "qm_base/msgfunction.h"

#include <QColor>
#include <QFont>
#include <QFontMetricsF>
#include <QPainter>
#include <QPen>
#include <QPolygonF>
#include <QString>

#include <algorithm>
#include <cmath>
#include <cstddef>
#include <vector>

namespace {

constexpr T_PLOT_COLOR kInk{35, 35, 35};
constexpr T_PLOT_COLOR kFrame{70, 70, 70};
constexpr T_PLOT_COLOR kGrid{222, 222, 222};
constexpr T_PLOT_COLOR kFineGrid{240, 240, 240};
constexpr double kTick = 5.0;       // px outside the frame
constexpr double kMinorTick = 3.0;  // px
constexpr double kGuideWidth = 1.1; // px
constexpr int kLabelCover = 215;    // opacity of the white behind a label, of 255

QPointF ToQt(T_PLOT_PX p)
{
    return {p.x, p.y};
}
QRectF ToQt(const T_PLOT_BOX& b)
{
    return {b.x, b.y, b.w, b.h};
}

// Half pixels, so that thin upright lines are sharp on a screen.
double Crisp(double px)
{
    return std::floor(px) + 0.5;
}

QPen LinePen(const T_PLOT_COLOR& color, double width, PLOT_LINE line)
{
    QPen pen(CPlot::Color(color), width, Qt::SolidLine, Qt::FlatCap, Qt::RoundJoin);
    // Lengths in line widths.
    switch (line) {
    case PLOT_LINE::Dash:
        pen.setDashPattern({6.0, 3.0});
        break;
    case PLOT_LINE::Dot:
        pen.setDashPattern({1.5, 2.5});
        break;
    case PLOT_LINE::DashDot:
        pen.setDashPattern({8.0, 2.5, 1.5, 2.5});
        break;
    default:
        break;
    }
    return pen;
}

// Two strokes, white below, so that they stand out on a line.
void DrawStrokes(QPainter& painter, QPointF at, QPointF half, const QPen& pen)
{
    const QPointF other(-half.y(), half.x());
    for (const QPen& p : {QPen(Qt::white, pen.widthF() + 1.2), pen}) {
        painter.setPen(p);
        painter.drawLine(at - half, at + half);
        painter.drawLine(at - other, at + other);
    }
}

void DrawMarker(QPainter& painter, QPointF at, PLOT_MARKER marker, double size,
                const T_PLOT_COLOR& color)
{
    const double r = 0.5 * size;
    const QPen pen(CPlot::Color(color), std::max(1.2, 0.2 * size));
    painter.setPen(pen);
    painter.setBrush(Qt::white); // hollow: the curve below stays readable in black and white
    switch (marker) {
    case PLOT_MARKER::Circle:
        painter.drawEllipse(at, r, r);
        break;
    case PLOT_MARKER::Square:
        painter.drawRect(QRectF(at.x() - 0.9 * r, at.y() - 0.9 * r, 1.8 * r, 1.8 * r));
        break;
    case PLOT_MARKER::Triangle:
        painter.drawPolygon(QPolygonF({at + QPointF(0, -1.15 * r), at + QPointF(1.1 * r, 0.85 * r),
                                       at + QPointF(-1.1 * r, 0.85 * r)}));
        break;
    case PLOT_MARKER::Cross:
        DrawStrokes(painter, at, QPointF(r, r), pen);
        break;
    case PLOT_MARKER::Plus:
        DrawStrokes(painter, at, QPointF(1.2 * r, 0), pen);
        break;
    case PLOT_MARKER::Auto:
    case PLOT_MARKER::None:
        break;
    }
}

void DrawRuns(QPainter& painter, const std::vector<PLOT_RUN>& runs)
{
    painter.setBrush(Qt::NoBrush);
    for (const PLOT_RUN& run : runs) {
        QPolygonF line;
        for (const T_PLOT_PX& p : run)
            line.append(ToQt(p));
        if (run.size() == 1) line.append(ToQt(run[0]) + QPointF(painter.pen().widthF(), 0));
        painter.drawPolyline(line);
    }
}

// A text in its box, cut with an ellipsis when it is too long.
void DrawText(QPainter& painter, const T_PLOT_TEXT& text, const T_PLOT_COLOR& color)
{
    const QFont font = CPlot::Font(text.sizePx, text.bold);
    const QFontMetricsF metrics(font);
    const double w = text.turned ? text.box.h : text.box.w;
    const double h = text.turned ? text.box.w : text.box.h;
    const QString shown =
        metrics.elidedText(QString::fromStdString(text.text), Qt::ElideRight, w + 1.0);
    const double rest = w - metrics.horizontalAdvance(shown);
    const double left = text.align == PLOT_ALIGN::Left    ? 0.0
                        : text.align == PLOT_ALIGN::Right ? rest
                                                          : 0.5 * rest;
    const double base = 0.5 * (h + metrics.ascent() - metrics.descent());
    painter.setFont(font);
    painter.setPen(CPlot::Color(color));
    if (!text.turned) {
        painter.drawText(QPointF(text.box.x + left, text.box.y + base), shown);
        return;
    }
    painter.save();
    painter.translate(text.box.x, text.box.Bottom());
    painter.rotate(-90.0);
    painter.drawText(QPointF(left, base), shown);
    painter.restore();
}

void DrawGrid(QPainter& painter, const T_PLOT_LAYOUT& layout)
{
    const T_PLOT_BOX& a = layout.area;
    const auto upright = [&](double v, double top, double bottom) {
        const double x = Crisp(layout.x.ToPixel(v));
        painter.drawLine(QPointF(x, top), QPointF(x, bottom));
    };
    const auto level = [&](double v, double left, double right) {
        const double y = Crisp(layout.y.ToPixel(v));
        painter.drawLine(QPointF(left, y), QPointF(right, y));
    };
    painter.setPen(QPen(CPlot::Color(kFineGrid), 1.0));
    if (layout.x.IsLog())
        for (const double v : layout.xTicks.minor)
            upright(v, a.y, a.Bottom());
    if (layout.y.IsLog())
        for (const double v : layout.yTicks.minor)
            level(v, a.x, a.Right());
    painter.setPen(QPen(CPlot::Color(kGrid), 1.0));
    for (const T_PLOT_TICK& t : layout.xTicks.major)
        upright(t.value, a.y, a.Bottom());
    for (const T_PLOT_TICK& t : layout.yTicks.major)
        level(t.value, a.x, a.Right());
    painter.setPen(QPen(CPlot::Color(kFrame), 1.0));
    for (const T_PLOT_TICK& t : layout.xTicks.major)
        upright(t.value, a.Bottom(), a.Bottom() + kTick);
    for (const double v : layout.xTicks.minor)
        upright(v, a.Bottom(), a.Bottom() + kMinorTick);
    for (const T_PLOT_TICK& t : layout.yTicks.major)
        level(t.value, a.x - kTick, a.x);
    for (const double v : layout.yTicks.minor)
        level(v, a.x - kMinorTick, a.x);
}

void DrawFrame(QPainter& painter, const T_PLOT_BOX& a)
{
    painter.setPen(QPen(CPlot::Color(kFrame), 1.0, Qt::SolidLine, Qt::FlatCap, Qt::MiterJoin));
    painter.setBrush(Qt::NoBrush);
    painter.drawRect(
        QRectF(QPointF(Crisp(a.x), Crisp(a.y)), QPointF(Crisp(a.Right()), Crisp(a.Bottom()))));
}

void DrawLines(QPainter& painter, const T_PLOT_LAYOUT& layout)
{
    for (const T_PLOT_CURVE& c : layout.curves) {
        painter.setPen(LinePen(c.style.color, c.style.width, c.style.line));
        DrawRuns(painter, c.lines);
    }
}

void DrawMarkers(QPainter& painter, const T_PLOT_LAYOUT& layout)
{
    for (const T_PLOT_CURVE& c : layout.curves)
        for (const T_PLOT_PX& p : c.markers)
            DrawMarker(painter, ToQt(p), c.style.marker, c.style.markerSize, c.style.color);
}

void DrawLegend(QPainter& painter, const T_PLOT& plot, const T_PLOT_LAYOUT& layout)
{
    if (!layout.legend) return;
    const T_PLOT_LEGEND& g = *layout.legend;
    painter.setPen(QPen(CPlot::Color({170, 170, 170}), 1.0));
    painter.setBrush(Qt::white);
    painter.drawRect(
        QRectF(Crisp(g.box.x), Crisp(g.box.y), std::floor(g.box.w), std::floor(g.box.h)));
    for (std::size_t i = 0; i < g.entries.size(); ++i) {
        const T_PLOT_STYLE& s = layout.curves[g.entries[i]].style;
        const double pad = CPlotLayout::kLegendPad;
        const std::size_t column = i / g.rows;
        const double x = g.box.x + pad + static_cast<double>(column) * g.columnWidth;
        const double y = g.box.y + 0.5 * pad + static_cast<double>(i % g.rows) * g.rowHeight;
        const double mid = y + 0.5 * g.rowHeight;
        const double end = x + CPlotLayout::kLegendSample;
        painter.setPen(LinePen(s.color, s.width, s.line));
        if (s.line != PLOT_LINE::None) painter.drawLine(QPointF(x, mid), QPointF(end, mid));
        DrawMarker(painter, QPointF(0.5 * (x + end), mid), s.marker, s.markerSize, s.color);
        const double nameW = g.columnWidth - CPlotLayout::kLegendSample - 2 * pad;
        DrawText(painter,
                 {plot.series[g.entries[i]].name,
                  {end + pad, y, nameW, g.rowHeight},
                  CPlotLayout::kTextPx,
                  false,
                  PLOT_ALIGN::Left,
                  false},
                 kInk);
    }
}

// The white behind labels and the leader lines: over lines, but below markers.
void DrawLabelGround(QPainter& painter, const T_PLOT_LAYOUT& layout)
{
    for (const T_PLOT_LABEL_PLACE& l : layout.labels) {
        QColor cover(Qt::white);
        cover.setAlpha(kLabelCover);
        painter.fillRect(ToQt(l.place.box), cover);
        if (!l.place.leaderEnd) continue;
        painter.setPen(QPen(CPlot::Color({120, 120, 120}), 0.9));
        painter.drawLine(ToQt(l.place.anchor), ToQt(*l.place.leaderEnd));
    }
}

void DrawLabels(QPainter& painter, const T_PLOT& plot, const T_PLOT_LAYOUT& layout)
{
    for (const std::size_t i : layout.points) {
        const T_PLOT_LABEL& l = plot.labels[i];
        const PLOT_MARKER marker = l.marker == PLOT_MARKER::Auto ? PLOT_MARKER::Circle : l.marker;
        const QPointF at(layout.x.ToPixel(l.x), layout.y.ToPixel(l.y));
        DrawMarker(painter, at, marker, l.bold ? 9.0 : 6.0, {0, 0, 0});
    }
    for (const T_PLOT_LABEL_PLACE& l : layout.labels) {
        const T_PLOT_BOX& b = l.place.box;
        const double rowH = b.h / static_cast<double>(l.lines.size());
        for (std::size_t k = 0; k < l.lines.size(); ++k)
            DrawText(painter,
                     {l.lines[k],
                      {b.x, b.y + static_cast<double>(k) * rowH, b.w, rowH},
                      CPlotLayout::kTextPx,
                      l.bold,
                      PLOT_ALIGN::Center,
                      false},
                     kInk);
    }
}

void DrawArea(QPainter& painter, const T_PLOT& plot, const T_PLOT_LAYOUT& layout)
{
    DrawGrid(painter, layout);
    for (const T_PLOT_GUIDE_LINE& g : layout.guides) {
        const T_PLOT_GUIDE& guide = plot.guides[g.guide];
        painter.setPen(LinePen(guide.color, kGuideWidth, guide.line));
        DrawRuns(painter, g.lines);
    }
    DrawLines(painter, layout);
    DrawFrame(painter, layout.area);
    DrawLabelGround(painter, layout);
    DrawMarkers(painter, layout);
    DrawLabels(painter, plot, layout);
    DrawLegend(painter, plot, layout);
    if (!layout.hasData)
        DrawText(painter,
                 {zql::lib::MMSGFunction::GetValue("IDS_QM_PLOT_NO_DATA"), layout.area, 16.0, false,
                  PLOT_ALIGN::Center, false},
                 {150, 150, 150});
}

} // namespace

QFont CPlot::Font(double sizePx, bool bold)
{
    QFont font(QStringLiteral("DejaVu Sans"));
    font.setStyleHint(QFont::SansSerif);
    font.setPixelSize(static_cast<int>(std::lround(sizePx)));
    font.setBold(bold);
    font.setHintingPreference(QFont::PreferNoHinting); // the same widths at every scale
    return font;
}

QColor CPlot::Color(const T_PLOT_COLOR& color)
{
    return {color.r, color.g, color.b};
}

T_PLOT_LAYOUT CPlot::Layout(const QRectF& rect, const T_PLOT& plot, const T_PLOT_VIEW& view)
{
    const auto measure = [](const std::string& line, double sizePx, bool bold) {
        return QFontMetricsF(Font(sizePx, bold)).horizontalAdvance(QString::fromStdString(line));
    };
    return CPlotLayout(plot, measure).Calc({rect.x(), rect.y(), rect.width(), rect.height()}, view);
}

void CPlot::Draw(QPainter& painter, const QRectF& rect, const T_PLOT& plot, const T_PLOT_VIEW& view)
{
    const T_PLOT_LAYOUT layout = Layout(rect, plot, view);
    painter.save();
    painter.setRenderHint(QPainter::Antialiasing);
    painter.fillRect(rect, Qt::white);
    if (layout.area.w > 0.0) DrawArea(painter, plot, layout);
    for (const T_PLOT_TEXT& text : layout.texts)
        DrawText(painter, text, kInk);
    painter.restore();
}
