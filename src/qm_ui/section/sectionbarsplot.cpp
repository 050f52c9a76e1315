#include "qm_ui/section/sectionbarsplot.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_rps/dialog/unithead.h"
#include "qm_rps/section/barlayout.h"

#include <limits>
#include <numbers>

namespace {

constexpr double kGap = std::numeric_limits<double>::quiet_NaN(); // the line starts anew

void AddPoint(T_PLOT_SERIES& s, double y, double z)
{
    s.x.push_back(y);
    s.y.push_back(z);
}

void AddCircle(T_PLOT_SERIES& s, double y, double z, double diameter)
{
    constexpr int kParts = 48;
    for (int i = 0; i <= kParts; ++i) {
        const double angle = 2.0 * std::numbers::pi * i / kParts;
        AddPoint(s, y + 0.5 * diameter * std::cos(angle), z + 0.5 * diameter * std::sin(angle));
    }
    AddPoint(s, kGap, kGap);
}

void AddRectangle(T_PLOT_SERIES& s, double height, double width)
{
    constexpr std::array<std::array<double, 2>, 5> kTurns{
        {{-1, -1}, {1, -1}, {1, 1}, {-1, 1}, {-1, -1}}};
    for (const auto& [y, z] : kTurns)
        AddPoint(s, 0.5 * y * width, 0.5 * z * height);
    AddPoint(s, kGap, kGap);
}

/// Upper half from the right to the left, then the lower one back.
void AddIShape(T_PLOT_SERIES& s, double height, double width, double web, double flange)
{
    const double top = 0.5 * height, inside = top - flange;
    const std::array<std::array<double, 2>, 6> half{{{0.5 * web, 0.0},
                                                     {0.5 * web, inside},
                                                     {0.5 * width, inside},
                                                     {0.5 * width, top},
                                                     {-0.5 * width, top},
                                                     {-0.5 * width, inside}}};
    for (const auto& [y, z] : half)
        AddPoint(s, y, z);
    AddPoint(s, -0.5 * web, inside);
    for (const auto& [y, z] : half)
        AddPoint(s, -y, -z);
    AddPoint(s, 0.5 * web, -inside);
    AddPoint(s, 0.5 * web, 0.0);
}

T_PLOT_SERIES Outline(const T_SECT_D& section)
{
    const auto [a, b, c, d] = section.size;
    T_PLOT_SERIES s;
    switch (section.shape) {
    case SECT_SHAPE::Rectangle:
        AddRectangle(s, a, b);
        break;
    case SECT_SHAPE::Circle:
        AddCircle(s, 0.0, 0.0, a);
        break;
    case SECT_SHAPE::Pipe:
        AddCircle(s, 0.0, 0.0, a);
        AddCircle(s, 0.0, 0.0, a - 2.0 * b);
        break;
    case SECT_SHAPE::Box:
        AddRectangle(s, a, b);
        AddRectangle(s, a - 2.0 * d, b - 2.0 * c);
        break;
    case SECT_SHAPE::IShape:
        AddIShape(s, a, b, c, d);
        break;
    case SECT_SHAPE::Value:
        break;
    }
    s.width = 2.4;
    s.color = T_PLOT_COLOR{60, 60, 60};
    return s;
}

/// Along its centre line.
T_PLOT_SERIES Stirrup(const T_SECT_D& section)
{
    T_PLOT_SERIES s;
    const T_SECT_DETAIL& detail = *section.detailing;
    const double inset = 2.0 * detail.cover + detail.stirrupDiameter;
    if (section.shape == SECT_SHAPE::Rectangle)
        AddRectangle(s, section.size[0] - inset, section.size[1] - inset);
    else if (section.shape == SECT_SHAPE::Circle)
        AddCircle(s, 0.0, 0.0, section.size[0] - inset);
    s.width = 1.4;
    s.color = T_PLOT_COLOR{21, 101, 192};
    return s;
}

T_PLOT_SERIES Bars(const T_SECT_D& section)
{
    T_PLOT_SERIES s;
    for (const T_REBAR& bar : section.bars)
        AddCircle(s, bar.y, bar.z, BarDiameter(bar));
    s.width = 2.0;
    s.color = T_PLOT_COLOR{184, 40, 30};
    return s;
}

/// "8 bars, stirrup 0.008 every 0.15 m": a legend would hide bars.
std::string Contents(const T_SECT_D& section, const T_UNITS& units)
{
    std::string text = Say("IDS_QM_PLOT_SECT_BARS", std::to_string(section.bars.size()));
    if (section.detailing)
        text += ", " + Say("IDS_QM_PLOT_SECT_STIRRUP",
                           FormatText("%.4g", section.detailing->stirrupDiameter),
                           FormatText("%.4g", section.detailing->stirrupSpacing) + " " +
                               std::string(NameOf(units.length)));
    return text;
}

} // namespace

T_PLOT SectionBarsPlot(const T_SECT_D& section, const T_UNITS& units)
{
    T_PLOT plot;
    plot.title = section.name;
    plot.x.title = HeadWithUnit("y", kDimLength, units);
    plot.y.title = HeadWithUnit("z", kDimLength, units);
    plot.equalScales = true;
    plot.legend = false;
    if (section.detailing || !section.bars.empty()) plot.subtitle = Contents(section, units);
    plot.series.push_back(Outline(section));
    if (plot.series.back().x.empty()) {
        plot.series.clear();
        plot.notes.push_back(Say("IDS_QM_PLOT_SECT_NONE"));
    }
    if (section.detailing && !plot.series.empty()) plot.series.push_back(Stirrup(section));
    if (!section.bars.empty()) plot.series.push_back(Bars(section));
    for (T_PLOT_SERIES& s : plot.series) {
        s.line = PLOT_LINE::Solid;
        s.marker = PLOT_MARKER::None;
    }
    return plot;
}
