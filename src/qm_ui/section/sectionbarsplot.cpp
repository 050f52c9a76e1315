#include "qm_ui/section/sectionbarsplot.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_db/sectionproperties.h"
#include "qm_rps/dialog/unithead.h"
#include "qm_rps/outline/sectionoutline.h"
#include "qm_rps/section/barlayout.h"

#include <cmath>
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

/// A side of a ring; its arc in parts.
void AddSide(T_PLOT_SERIES& s, const solver::T_CORNER& from, const solver::T_CORNER& to)
{
    AddPoint(s, from.y, from.z);
    if (from.bulge == 0.0) return;
    // The centre lies beside the middle of the chord.
    constexpr int kParts = 24;
    const double y = to.y - from.y, z = to.z - from.z;
    const double beside = (1.0 - from.bulge * from.bulge) / (4.0 * from.bulge);
    const double cy = 0.5 * (from.y + to.y) - beside * z, cz = 0.5 * (from.z + to.z) + beside * y;
    const double angle = 4.0 * std::atan(from.bulge);
    for (int i = 1; i < kParts; ++i) {
        const double c = std::cos(angle * i / kParts), t = std::sin(angle * i / kParts);
        AddPoint(s, cy + c * (from.y - cy) - t * (from.z - cz),
                 cz + t * (from.y - cy) + c * (from.z - cz));
    }
}

/// Empty of a section without a shape, or whose dimensions are not sound.
T_PLOT_SERIES Outline(const T_SECT_D& section)
{
    T_PLOT_SERIES s;
    T_SECT_D sound;
    SECT_FAULT fault = SECT_FAULT::None;
    if (CSectionProperties::Calc(section, sound, fault))
        for (const solver::T_RING& ring : SectionRings(sound)) {
            for (std::size_t i = 0; i < ring.size(); ++i)
                AddSide(s, ring[i], ring[(i + 1) % ring.size()]);
            AddPoint(s, ring.front().y, ring.front().z);
            AddPoint(s, kGap, kGap);
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
