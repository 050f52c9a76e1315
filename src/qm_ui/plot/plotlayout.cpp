#include "qm_ui/plot/plotlayout.h"

#include "qm_ui/plot/plotcurve.h"

#include <algorithm>
#include <cmath>
#include <utility>

namespace {

// All in px at 96 dpi.
constexpr double kMargin = 14.0;
constexpr double kRightMargin = 26.0; // half a tick label may stand out to the right
constexpr double kTitlePx = 17.0;
constexpr double kSubtitlePx = 13.0;
constexpr double kAxisTitlePx = 13.0;
constexpr double kTickGap = 8.0;   // frame to tick label
constexpr double kPowerRow = 18.0; // above the frame, for the power of ten of the y axis
constexpr double kMinArea = 40.0;  // a smaller area is not drawn
constexpr double kXTickRoom = 90.0;
constexpr double kYTickRoom = 48.0;
constexpr double kNoteColumnGap = 28.0;
constexpr double kNotesShare = 0.4; // of the page height at most

// What a text over it hides, see CPlotSpace.
constexpr double kGuideWeight = 1.2;
constexpr double kCurveWeight = 4.0;
constexpr double kMarkerWeight = 4.0;
constexpr double kAnchorWeight = 30.0;

double RowHeight(double sizePx)
{
    return sizePx * CPlotLayout::kLineFactor;
}

int TickCount(double length, double room)
{
    return std::max(2, static_cast<int>(std::floor(length / room)));
}

std::vector<std::string> SplitLines(const std::string& text)
{
    std::vector<std::string> lines;
    std::size_t begin = 0;
    for (std::size_t end; (end = text.find('\n', begin)) != std::string::npos; begin = end + 1)
        lines.push_back(text.substr(begin, end - begin));
    lines.push_back(text.substr(begin));
    return lines;
}

T_PLOT_RANGE About(T_PLOT_RANGE range, double span)
{
    const double middle = 0.5 * (range.lo + range.hi);
    return {middle - 0.5 * span, middle + 0.5 * span};
}

std::string PowerText(int exponent10)
{
    return "\u00d7" + PowerOfTenText(exponent10);
}

} // namespace

CPlotLayout::CPlotLayout(const T_PLOT& plot, PLOT_MEASURE measure)
    : m_plot(plot), m_measure(std::move(measure))
{
}

T_PLOT_LAYOUT CPlotLayout::Calc(const T_PLOT_BOX& page, const T_PLOT_VIEW& view) const
{
    T_PLOT_LAYOUT out;
    out.page = page;
    SetScales(view, out);
    T_PLOT_BOX rest{page.x + kMargin, page.y + kMargin, page.w - kMargin - kRightMargin,
                    page.h - 2 * kMargin};
    AddTitles(rest, out);
    AddNotes(rest, out);
    rest.y += kPowerRow;
    rest.h -= kPowerRow + kTickGap + RowHeight(kTextPx) + RowHeight(kAxisTitlePx);
    if (rest.h < kMinArea) return out;
    const double perPx = m_plot.equalScales ? EqualScales(rest, out) : 0.0;
    AddYAxis(rest, out);
    if (rest.w < kMinArea) return out;
    out.area = rest;
    const T_PLOT_RANGE xRange = perPx > 0.0 ? About(out.x.Range(), perPx * rest.w) : out.x.Range();
    out.x = CPlotScale(xRange, m_plot.x.log, rest.x, rest.Right());
    AddXAxis(out);
    AddCurves(out);
    AddGuides(out);
    Place(view, out);
    return out;
}

std::vector<double> CPlotLayout::AxisValues(bool isX) const
{
    std::vector<double> values;
    for (const T_PLOT_SERIES& s : m_plot.series)
        for (std::size_t i = 0; i < std::min(s.x.size(), s.y.size()); ++i)
            if (CPlotScale::CanShow(s.x[i], m_plot.x.log) &&
                CPlotScale::CanShow(s.y[i], m_plot.y.log))
                values.push_back(isX ? s.x[i] : s.y[i]);
    for (const T_PLOT_LABEL& l : m_plot.labels)
        if (CPlotScale::CanShow(l.x, m_plot.x.log) && CPlotScale::CanShow(l.y, m_plot.y.log))
            values.push_back(isX ? l.x : l.y);
    const PLOT_GUIDE across = isX ? PLOT_GUIDE::Vertical : PLOT_GUIDE::Horizontal;
    for (const T_PLOT_GUIDE& g : m_plot.guides)
        if (g.kind == across) values.push_back(g.value);
    return values;
}

T_PLOT_RANGE CPlotLayout::Range(const T_PLOT_AXIS& axis, const std::optional<T_PLOT_RANGE>& view,
                                bool isX) const
{
    if (view && CPlotScale::IsUsable(*view, axis.log)) return *view;
    if (axis.range && CPlotScale::IsUsable(*axis.range, axis.log)) return *axis.range;
    return AutoPlotRange(AxisValues(isX), axis.log);
}

void CPlotLayout::SetScales(const T_PLOT_VIEW& view, T_PLOT_LAYOUT& out) const
{
    out.x = CPlotScale(Range(m_plot.x, view.x, true), m_plot.x.log, 0.0, 1.0);
    out.y = CPlotScale(Range(m_plot.y, view.y, false), m_plot.y.log, 1.0, 0.0);
}

void CPlotLayout::AddTitles(T_PLOT_BOX& rest, T_PLOT_LAYOUT& out) const
{
    const auto add = [&](const std::string& text, double sizePx, bool bold) {
        if (text.empty()) return;
        const double h = RowHeight(sizePx);
        out.texts.push_back(
            {text, {rest.x, rest.y, rest.w, h}, sizePx, bold, PLOT_ALIGN::Left, false});
        rest.y += h;
        rest.h -= h;
    };
    add(m_plot.title, kTitlePx, true);
    add(m_plot.subtitle, kSubtitlePx, false);
}

void CPlotLayout::AddNotes(T_PLOT_BOX& rest, T_PLOT_LAYOUT& out) const
{
    if (m_plot.notes.empty()) return;
    const double rowH = RowHeight(kTextPx);
    double widest = 1.0;
    for (const std::string& note : m_plot.notes)
        widest = std::max(widest, m_measure(note, kTextPx, false));
    const double perRow = std::floor((rest.w + kNoteColumnGap) / (widest + kNoteColumnGap));
    const auto columns = static_cast<std::size_t>(std::clamp(perRow, 1.0, 4.0));
    const std::size_t wanted = (m_plot.notes.size() + columns - 1) / columns;
    const auto room = static_cast<std::size_t>(std::max(0.0, kNotesShare * out.page.h / rowH));
    const std::size_t rows = std::min(wanted, room);
    if (rows == 0) return;
    const double top = rest.Bottom() - static_cast<double>(rows) * rowH;
    for (std::size_t i = 0; i < std::min(m_plot.notes.size(), rows * columns); ++i) {
        const bool cut = i + 1 == rows * columns && i + 1 < m_plot.notes.size();
        const std::size_t column = i / rows;
        const double left = rest.x + static_cast<double>(column) * (widest + kNoteColumnGap);
        const double y = top + static_cast<double>(i % rows) * rowH;
        const double w = std::min(widest + 2.0, rest.Right() - left);
        out.texts.push_back({cut ? "\u2026" : m_plot.notes[i],
                             {left, y, w, rowH},
                             kTextPx,
                             false,
                             PLOT_ALIGN::Left,
                             false});
    }
    rest.h = top - kTickGap - rest.y;
}

T_PLOT_TICKS CPlotLayout::Ticks(const T_PLOT_AXIS& axis, T_PLOT_RANGE range, int count) const
{
    if (axis.bare) return {};
    if (axis.labels.empty()) return MakePlotTicks(range, axis.log, count);
    T_PLOT_TICKS ticks;
    for (const T_PLOT_AXIS_LABEL& l : axis.labels) {
        if (l.value >= range.lo && l.value <= range.hi) ticks.major.push_back({l.value, l.text});
    }
    return ticks;
}

/// Widens the y range so that both ranges fit in one scale, and returns the values per px. The
/// width of the y axis' numbers is that of the range before; a little air makes up for it.
double CPlotLayout::EqualScales(const T_PLOT_BOX& rest, T_PLOT_LAYOUT& out) const
{
    constexpr double kRoom = 1.03;
    T_PLOT_BOX trial = rest;
    T_PLOT_LAYOUT scratch = out;
    AddYAxis(trial, scratch);
    if (trial.w < kMinArea) return 0.0;
    const T_PLOT_RANGE x = out.x.Range(), y = out.y.Range();
    const double perPx = kRoom * std::max((x.hi - x.lo) / trial.w, (y.hi - y.lo) / rest.h);
    out.y = CPlotScale(About(y, perPx * rest.h), false, rest.Bottom(), rest.y);
    return perPx;
}

/// The labels on the right of the area; returns the width that they take.
double CPlotLayout::AddAcrossLabels(const T_PLOT_BOX& rest, T_PLOT_LAYOUT& out) const
{
    double width = 0.0;
    for (const T_PLOT_AXIS_LABEL& l : m_plot.y.labels)
        width = std::max(width, m_measure(l.across, kTextPx, false));
    if (!(width > 0.0)) return 0.0;
    const T_PLOT_RANGE range = out.y.Range();
    const double h = RowHeight(kTextPx);
    for (const T_PLOT_AXIS_LABEL& l : m_plot.y.labels) {
        if (l.across.empty() || !(l.value >= range.lo && l.value <= range.hi)) continue;
        out.texts.push_back({l.across,
                             {rest.Right() - width, out.y.ToPixel(l.value) - 0.5 * h, width + 1, h},
                             kTextPx,
                             false,
                             PLOT_ALIGN::Left,
                             false});
    }
    return width + kTickGap;
}

void CPlotLayout::AddYAxis(T_PLOT_BOX& rest, T_PLOT_LAYOUT& out) const
{
    out.y = CPlotScale(out.y.Range(), m_plot.y.log, rest.Bottom(), rest.y);
    out.yTicks = Ticks(m_plot.y, out.y.Range(), TickCount(rest.h, kYTickRoom));
    const double titleH = m_plot.y.title.empty() ? 0.0 : RowHeight(kAxisTitlePx) + 4.0;
    double labelW = 0.0;
    for (const T_PLOT_TICK& t : out.yTicks.major)
        labelW = std::max(labelW, m_measure(t.label, kTextPx, false));
    const double h = RowHeight(kTextPx);
    for (const T_PLOT_TICK& t : out.yTicks.major)
        out.texts.push_back({t.label,
                             {rest.x + titleH, out.y.ToPixel(t.value) - 0.5 * h, labelW + 1.0, h},
                             kTextPx,
                             false,
                             PLOT_ALIGN::Right,
                             false});
    if (titleH > 0.0)
        out.texts.push_back({m_plot.y.title,
                             {rest.x, rest.y, RowHeight(kAxisTitlePx), rest.h},
                             kAxisTitlePx,
                             false,
                             PLOT_ALIGN::Center,
                             true});
    const double left = titleH + labelW + kTickGap;
    rest.w -= left + AddAcrossLabels(rest, out);
    rest.x += left;
    if (out.yTicks.exponent10 != 0)
        out.texts.push_back({PowerText(out.yTicks.exponent10),
                             {rest.x, rest.y - h - 1.0, 80.0, h},
                             kTextPx,
                             false,
                             PLOT_ALIGN::Left,
                             false});
}

void CPlotLayout::AddXAxis(T_PLOT_LAYOUT& out) const
{
    const T_PLOT_BOX& area = out.area;
    double labelW = 0.0;
    for (int count = TickCount(area.w, kXTickRoom); count >= 2; --count) {
        out.xTicks = Ticks(m_plot.x, out.x.Range(), count);
        labelW = 0.0;
        for (const T_PLOT_TICK& t : out.xTicks.major)
            labelW = std::max(labelW, m_measure(t.label, kTextPx, false));
        const auto shown = static_cast<double>(std::max<std::size_t>(1, out.xTicks.major.size()));
        if (labelW + kTickGap <= area.w / shown) break; // the labels stand clear of each other
    }
    const double top = area.Bottom() + kTickGap;
    const double h = RowHeight(kTextPx);
    for (const T_PLOT_TICK& t : out.xTicks.major)
        out.texts.push_back({t.label,
                             {out.x.ToPixel(t.value) - 0.5 * labelW - 1.0, top, labelW + 2.0, h},
                             kTextPx,
                             false,
                             PLOT_ALIGN::Center,
                             false});
    const T_PLOT_BOX title{area.x, top + h, area.w, RowHeight(kAxisTitlePx)};
    out.texts.push_back({m_plot.x.title, title, kAxisTitlePx, false, PLOT_ALIGN::Center, false});
    if (out.xTicks.exponent10 != 0)
        out.texts.push_back(
            {PowerText(out.xTicks.exponent10), title, kTextPx, false, PLOT_ALIGN::Right, false});
}

void CPlotLayout::AddCurves(T_PLOT_LAYOUT& out) const
{
    for (std::size_t i = 0; i < m_plot.series.size(); ++i) {
        const T_PLOT_SERIES& s = m_plot.series[i];
        T_PLOT_CURVE curve;
        curve.style = ResolveStyle(s, i);
        const std::vector<PLOT_RUN> runs = MapSeries(s, out.x, out.y);
        out.hasData = out.hasData || !runs.empty();
        if (curve.style.line != PLOT_LINE::None) curve.lines = VisibleLines(runs, out.area);
        if (curve.style.marker != PLOT_MARKER::None)
            curve.markers = VisibleMarkers(runs, out.area, curve.style.line != PLOT_LINE::None);
        out.curves.push_back(std::move(curve));
    }
}

void CPlotLayout::AddGuides(T_PLOT_LAYOUT& out) const
{
    for (std::size_t i = 0; i < m_plot.guides.size(); ++i) {
        std::vector<PLOT_RUN> lines =
            ClipRun(out.area, MapGuide(m_plot.guides[i], out.x, out.y, out.area));
        if (!lines.empty()) out.guides.push_back({i, std::move(lines)});
    }
}

void CPlotLayout::Place(const T_PLOT_VIEW& view, T_PLOT_LAYOUT& out) const
{
    CPlotSpace space(out.area);
    for (const T_PLOT_GUIDE_LINE& g : out.guides)
        for (const PLOT_RUN& run : g.lines)
            space.MarkRun(run, kGuideWeight);
    for (const T_PLOT_CURVE& c : out.curves) {
        for (const PLOT_RUN& run : c.lines)
            space.MarkRun(run, kCurveWeight);
        for (const T_PLOT_PX& p : c.markers)
            space.MarkPoint(p, kMarkerWeight);
    }
    for (std::size_t i = 0; i < m_plot.labels.size(); ++i) {
        const T_PLOT_LABEL& l = m_plot.labels[i];
        if (!out.x.CanShow(l.x) || !out.y.CanShow(l.y)) continue;
        const T_PLOT_PX at{out.x.ToPixel(l.x), out.y.ToPixel(l.y)};
        if (!out.area.Holds(at)) continue;
        out.points.push_back(i);
        space.MarkPoint(at, kAnchorWeight);
    }
    if (m_plot.legend) PlaceLegend(view, space, out);
    PlaceLabels(space, out);
}

void CPlotLayout::PlaceLegend(const T_PLOT_VIEW& view, CPlotSpace& space, T_PLOT_LAYOUT& out) const
{
    T_PLOT_LEGEND legend;
    double nameW = 0.0;
    for (std::size_t i = 0; i < m_plot.series.size(); ++i) {
        if (m_plot.series[i].name.empty()) continue;
        legend.entries.push_back(i);
        nameW = std::max(nameW, m_measure(m_plot.series[i].name, kTextPx, false));
    }
    if (legend.entries.empty()) return;
    const double extra = kLegendSample + 3 * kLegendPad;
    nameW = std::min(nameW + 2.0, 0.6 * out.area.w - extra); // longer names are cut when drawn
    legend.rowHeight = 1.15 * RowHeight(kTextPx);
    legend.columnWidth = nameW + kLegendSample + 2 * kLegendPad;
    const double perColumn = std::max(1.0, std::floor(0.6 * out.area.h / legend.rowHeight));
    const std::size_t n = legend.entries.size();
    const auto columns = static_cast<std::size_t>(std::ceil(static_cast<double>(n) / perColumn));
    legend.rows = (n + columns - 1) / columns;
    const double w = static_cast<double>(columns) * legend.columnWidth + kLegendPad;
    const double h = static_cast<double>(legend.rows) * legend.rowHeight + kLegendPad;
    if (nameW <= 0.0 || w > out.area.w || h > out.area.h) return;
    if (view.legend) {
        const double x =
            out.area.x + std::clamp(view.legend->right * out.area.w, 0.0, out.area.w - w);
        const double y =
            out.area.y + std::clamp(view.legend->down * out.area.h, 0.0, out.area.h - h);
        legend.box = {x, y, w, h};
        space.Take(legend.box);
    } else if (const std::optional<T_PLOT_BOX> box = space.PlaceAnywhere(w, h)) {
        legend.box = *box;
    } else {
        return;
    }
    out.legend = std::move(legend);
}

CPlotLayout::T_LABEL_SIZE CPlotLayout::MeasureLabel(const std::string& text, bool bold) const
{
    constexpr double kPad = 3.0;
    T_LABEL_SIZE size{SplitLines(text), 0.0, 0.0};
    for (const std::string& line : size.lines)
        size.w = std::max(size.w, m_measure(line, kTextPx, bold) + 2 * kPad);
    size.h = static_cast<double>(size.lines.size()) * RowHeight(kTextPx);
    return size;
}

void CPlotLayout::PlaceLabels(CPlotSpace& space, T_PLOT_LAYOUT& out) const
{
    for (const std::size_t i : out.points) {
        const T_PLOT_LABEL& l = m_plot.labels[i];
        if (l.text.empty()) continue;
        T_LABEL_SIZE size = MeasureLabel(l.text, l.bold);
        const T_PLOT_PX at{out.x.ToPixel(l.x), out.y.ToPixel(l.y)};
        if (const auto place = space.PlaceNear(at, size.w, size.h))
            out.labels.push_back({std::move(size.lines), *place, l.bold});
    }
    for (const T_PLOT_GUIDE_LINE& g : out.guides) {
        const std::string& text = m_plot.guides[g.guide].label;
        if (text.empty()) continue;
        T_LABEL_SIZE size = MeasureLabel(text, false);
        if (const auto place = space.PlaceAlong(g.lines.back(), size.w, size.h))
            out.labels.push_back({std::move(size.lines), *place, false});
    }
}
