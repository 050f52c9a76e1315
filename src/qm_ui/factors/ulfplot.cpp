#include "qm_ui/factors/ulfplot.h"

#include "qm_base/msgfunction.h"
#include "qm_base/textformat.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <limits>

using zql::lib::MMSGFunction;

namespace {

constexpr double kEdge = 1.5;     // positions shown at most
constexpr double kRowPx = 21.0;   // page height of a row
constexpr double kPagePx = 180.0; // of titles, axis and notes
constexpr double kNan = std::numeric_limits<double>::quiet_NaN();

enum KIND : std::size_t { kWithin, kActive, kTarget, kViolated, kKinds };

struct T_KIND_STYLE {
    const char* key;
    T_PLOT_COLOR color;
    PLOT_MARKER marker;
};
constexpr std::array<T_KIND_STYLE, kKinds> kStyles{{
    {"IDS_QM_PLOT_WITHIN", {95, 140, 200}, PLOT_MARKER::None},
    {"IDS_QM_PLOT_ON_BOUND", {200, 120, 0}, PLOT_MARKER::Square},
    {"IDS_QM_PLOT_EQUALITY", {30, 120, 70}, PLOT_MARKER::Circle},
    {"IDS_QM_PLOT_NOT_MET", {190, 40, 30}, PLOT_MARKER::Cross},
}};

bool IsEquality(const T_ULF_BAR& b)
{
    return b.upper && b.lower && *b.upper == *b.lower;
}

KIND KindOf(const T_ULF_BAR& b)
{
    if (b.violated) return kViolated;
    if (IsEquality(b)) return kTarget;
    return b.active ? kActive : kWithin;
}

/// The row's own unit for distances.
double SizeOf(const T_ULF_BAR& b, double bound)
{
    return std::max(
        {bound != 0.0 ? std::fabs(bound) : std::max(b.scale, std::fabs(b.value)), 1e-300});
}

double FromBound(const T_ULF_BAR& b, double bound)
{
    return (b.value - bound) / SizeOf(b, bound);
}

std::string BoundText(const T_ULF_BAR& b)
{
    if (IsEquality(b)) return FormatText(", = %.4g", *b.upper);
    const auto text = [](double v) { return FormatText("%.4g", v); };
    if (b.upper && b.lower)
        return ", " + MMSGFunction::Format("IDS_QM_PLOT_FROM_TO", {text(*b.lower), text(*b.upper)});
    if (b.upper) return ", " + MMSGFunction::Format("IDS_QM_PLOT_AT_MOST", {text(*b.upper)});
    return b.lower ? ", " + MMSGFunction::Format("IDS_QM_PLOT_AT_LEAST", {text(*b.lower)})
                   : std::string();
}

std::string ValueText(const T_ULF_BAR& b)
{
    constexpr double kZero = 1e-10; // of the scale: what rounding leaves
    const double value = std::fabs(b.value) <= kZero * b.scale ? 0.0 : b.value;
    return FormatText("%.5g", value) + (b.unit.empty() ? "" : " " + b.unit) + BoundText(b);
}

void AddSegment(T_PLOT_SERIES& s, double x1, double y1, double x2, double y2)
{
    s.x.insert(s.x.end(), {x1, x2, kNan});
    s.y.insert(s.y.end(), {y1, y2, kNan});
}

T_PLOT_SERIES Series(const std::string& name, double width, T_PLOT_COLOR color)
{
    T_PLOT_SERIES s;
    s.name = name;
    s.width = width;
    s.color = color;
    s.line = PLOT_LINE::Solid;
    s.marker = PLOT_MARKER::None;
    return s;
}

/// The bars of one kind, and markers at their ends.
void AddKind(T_PLOT& plot, const std::vector<T_ULF_BAR>& bars, KIND kind)
{
    const T_KIND_STYLE& style = kStyles[kind];
    T_PLOT_SERIES line = Series(MMSGFunction::GetValue(style.key), 9.0, style.color);
    T_PLOT_SERIES ends = Series("", 0.0, style.color);
    ends.line = PLOT_LINE::None;
    ends.marker = style.marker;
    for (std::size_t i = 0; i < bars.size(); ++i) {
        if (KindOf(bars[i]) != kind || !std::isfinite(bars[i].value)) continue;
        const double y = static_cast<double>(bars.size() - 1 - i);
        const double at = std::clamp(UlfPosition(bars[i]), -kEdge, kEdge);
        AddSegment(line, 0.0, y, at, y);
        ends.x.push_back(at);
        ends.y.push_back(y);
    }
    if (line.x.empty()) return;
    plot.series.push_back(std::move(line));
    if (style.marker != PLOT_MARKER::None) plot.series.push_back(std::move(ends));
}

void AddBounds(T_PLOT& plot, const std::vector<T_ULF_BAR>& bars)
{
    constexpr double kHalf = 0.36; // of a row
    T_PLOT_SERIES marks =
        Series(MMSGFunction::GetValue("IDS_QM_PLOT_BOUND_OR_TARGET"), 2.2, {30, 30, 30});
    for (std::size_t i = 0; i < bars.size(); ++i) {
        const double y = static_cast<double>(bars.size() - 1 - i);
        const auto mark = [&](double x) { AddSegment(marks, x, y - kHalf, x, y + kHalf); };
        if (IsEquality(bars[i])) {
            mark(0.0);
            continue;
        }
        if (bars[i].lower) mark(-1.0);
        if (bars[i].upper) mark(1.0);
    }
    if (!marks.x.empty()) plot.series.push_back(std::move(marks));
}

/// Free rows on top for the legend, and a page high enough for them all.
void MakeRoom(T_PLOT& plot, double rows)
{
    constexpr double kLegendRowPx = 18.0, kLegendPx = 34.0;
    const auto entries = std::count_if(plot.series.begin(), plot.series.end(),
                                       [](const T_PLOT_SERIES& s) { return !s.name.empty(); });
    const double room = (kLegendRowPx * static_cast<double>(entries) + kLegendPx) / kRowPx;
    plot.y.range = T_PLOT_RANGE{-0.7, rows - 0.5 + room};
    plot.pageHeight = kPagePx + kRowPx * (rows + 0.2 + room);
}

} // namespace

T_ULF_PICTURE UlfPictureOf(const CUnknownLoadFactorResultDlg& dialog)
{
    const T_ULF_RESULT& r = dialog.Result();
    T_ULF_PICTURE picture;
    picture.title = MMSGFunction::Format("IDS_QM_PLOT_ULF_TITLE", {r.item.name});
    picture.subtitle =
        MMSGFunction::GetValue(r.exact ? "IDS_QM_PLOT_AS_EQUATIONS" : "IDS_QM_PLOT_OPTIMIZED") +
        ", " + dialog.ModelTitle();
    for (const T_ULF_RESULT_ROW& row : dialog.Rows()) {
        const std::size_t i = picture.bars.size();
        picture.bars.push_back({UlfNameAt(row.name, row.place), dialog.UnitOf(i), row.value,
                                row.upper, row.lower, row.active, !row.met, UlfScale(r, i)});
    }
    for (std::size_t i = 0; i < r.cases.size(); ++i)
        picture.notes.push_back(MMSGFunction::Format(
            r.cases[i].unknown ? "IDS_QM_PLOT_FACTOR_IS" : "IDS_QM_PLOT_FACTOR_IS_KNOWN",
            {r.cases[i].name, FormatText("%.6g", UlfShownFactor(r, i))}));
    if (!dialog.Notice().empty()) picture.notes.push_back(dialog.Notice());
    return picture;
}

double UlfPosition(const T_ULF_BAR& b)
{
    if (IsEquality(b)) {
        const double size = std::max({std::fabs(*b.upper), std::fabs(b.value), b.scale});
        return size > 0.0 ? (b.value - *b.upper) / size : 0.0;
    }
    if (b.upper && b.lower) return (2.0 * b.value - *b.upper - *b.lower) / (*b.upper - *b.lower);
    if (b.upper) return 1.0 + FromBound(b, *b.upper);
    return b.lower ? -1.0 + FromBound(b, *b.lower) : 0.0;
}

T_PLOT UlfPlot(const T_ULF_PICTURE& picture)
{
    const double rows = static_cast<double>(picture.bars.size());
    T_PLOT plot;
    plot.title = picture.title;
    plot.subtitle = picture.subtitle;
    plot.notes = picture.notes;
    plot.x.title = MMSGFunction::GetValue("IDS_QM_PLOT_PLACE");
    plot.x.range = T_PLOT_RANGE{-kEdge - 0.05, kEdge + 0.05};
    plot.x.labels = {{-1.0, MMSGFunction::GetValue("IDS_QM_PLOT_LOWER_BOUND")},
                     {0.0, MMSGFunction::GetValue("IDS_QM_PLOT_MIDDLE")},
                     {1.0, MMSGFunction::GetValue("IDS_QM_PLOT_UPPER_BOUND")}};
    plot.y.title = MMSGFunction::GetValue("IDS_QM_PLOT_CONSTRAINT");
    for (std::size_t i = 0; i < picture.bars.size(); ++i)
        plot.y.labels.push_back({rows - 1.0 - static_cast<double>(i), picture.bars[i].name,
                                 ValueText(picture.bars[i])});
    for (std::size_t kind = 0; kind < kKinds; ++kind)
        AddKind(plot, picture.bars, static_cast<KIND>(kind));
    AddBounds(plot, picture.bars);
    MakeRoom(plot, rows);
    return plot;
}
