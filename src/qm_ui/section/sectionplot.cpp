#include "qm_ui/section/sectionplot.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_rps/dialog/unithead.h"
#include "qm_rps/section/sectiontexts.h"

#include <cmath>
#include <numbers>

namespace {

using namespace solver;
constexpr T_DIM kDimCurvature{0, -1};
constexpr T_PLOT_COLOR kGrey{120, 120, 120};

std::string Degrees(double direction)
{
    return FormatText("%.4g", direction * 180.0 / std::numbers::pi);
}

std::string Force(double axial, const T_UNITS& units)
{
    return FormatText("%.5g %s", FromSi(axial, units, kDimForce) + 0.0,
                      std::string(NameOf(units.force)).c_str());
}

/// A point with its name; the series has its marker.
void Mark(T_PLOT& plot, double x, double y, const std::string& text)
{
    plot.labels.push_back({x, y, text, PLOT_MARKER::Circle, false});
}

void AddCurvature(const T_SECTION_CURVATURE& c, const T_UNITS& units, T_PLOT& plot)
{
    const auto x = [&](double v) { return FromSi(v, units, kDimCurvature); };
    const auto y = [&](double v) { return FromSi(v, units, kDimMoment); };
    T_PLOT_SERIES s;
    s.name = Say("IDS_QM_PLOT_SECC_LINE", Degrees(c.direction), Force(c.axial, units));
    s.marker = PLOT_MARKER::None;
    for (const T_CURVATURE_POINT& p : c.curve.points) {
        s.x.push_back(x(p.curvature));
        s.y.push_back(y(p.moment));
    }
    plot.series.push_back(std::move(s));
    const T_CURVATURE_POINT& yield = c.curve.points[c.curve.yield];
    const T_CURVATURE_POINT& last = c.curve.points.back();
    if (c.curve.yields.kind != FIBRE_KIND::None)
        Mark(plot, x(yield.curvature), y(yield.moment), Say("IDS_QM_SECC_YIELD"));
    Mark(plot, x(last.curvature), y(last.moment), Say("IDS_QM_SECC_ULTIMATE"));
    if (!c.curve.idealised) return;
    T_PLOT_SERIES ideal;
    ideal.name = Say("IDS_QM_PLOT_SECC_LINE_IDEAL");
    ideal.line = PLOT_LINE::Dash;
    ideal.color = kGrey;
    ideal.width = 1.2;
    ideal.marker = PLOT_MARKER::None;
    const T_CURVATURE_POINT& first = c.curve.points.front();
    ideal.x = {x(first.curvature), x(c.curve.idealCurvature), x(last.curvature)};
    ideal.y = {y(first.moment), y(c.curve.idealMoment), y(c.curve.idealMoment)};
    if (plot.series.size() > 1) ideal.name.clear(); // once in the legend
    plot.series.push_back(std::move(ideal));
}

void AddInteraction(const T_SECTION_INTERACTION& c, const T_UNITS& units, T_PLOT& plot)
{
    const double along = std::cos(c.direction), across = std::sin(c.direction);
    const auto place = [&](const T_CAPACITY& p) {
        return std::pair(FromSi(p.My * along + p.Mz * across, units, kDimMoment),
                         FromSi(p.axial, units, kDimForce));
    };
    T_PLOT_SERIES s;
    s.name = Say("IDS_QM_PLOT_SECC_DIRECTION", Degrees(c.direction));
    s.marker = PLOT_MARKER::None;
    for (const T_CAPACITY& p : c.curve.points) {
        const auto [x, y] = place(p);
        s.x.push_back(x);
        s.y.push_back(y);
    }
    plot.series.push_back(std::move(s));
    const auto mark = [&](long at, const char* key) {
        if (at < 0) return;
        const auto [x, y] = place(c.curve.points[static_cast<std::size_t>(at)]);
        Mark(plot, x, y, Say(key));
    };
    mark(c.curve.largest, "IDS_QM_SECC_LARGEST");
    mark(c.curve.bending, "IDS_QM_SECC_BENDING");
    if (c.curve.balanced != c.curve.largest) mark(c.curve.balanced, "IDS_QM_SECC_BALANCED");
}

/// The ends of a surface are points.
bool IsPoint(const T_SECTION_CONTOUR& contour, double least)
{
    for (const T_CAPACITY& p : contour.points)
        if (std::hypot(p.My - contour.points[0].My, p.Mz - contour.points[0].Mz) > least)
            return false;
    return true;
}

void AddContours(const T_SECTION_ANSWER& answer, const T_UNITS& units, T_PLOT& plot)
{
    double largest = 0.0;
    for (const T_SECTION_CONTOUR& contour : answer.contours)
        for (const T_CAPACITY& p : contour.points)
            largest = std::max(largest, std::hypot(p.My, p.Mz));
    for (const T_SECTION_CONTOUR& contour : answer.contours) {
        T_PLOT_SERIES s;
        s.name = "N = " + Force(contour.axial, units);
        s.marker = IsPoint(contour, 1e-9 * largest) ? PLOT_MARKER::Plus : PLOT_MARKER::None;
        for (std::size_t i = 0; i <= contour.points.size(); ++i) {
            const T_CAPACITY& p = contour.points[i % contour.points.size()];
            s.x.push_back(FromSi(p.My, units, kDimMoment));
            s.y.push_back(FromSi(p.Mz, units, kDimMoment));
        }
        plot.series.push_back(std::move(s));
    }
}

void AddCapacities(const T_SECTION_ANSWER& answer, const T_UNITS& units, T_PLOT& plot)
{
    T_PLOT_SERIES s;
    s.name = Say("IDS_QM_PLOT_SECC_CAPACITY");
    s.line = PLOT_LINE::None;
    for (const T_SECTION_CAPACITY_AT& c : answer.capacities) {
        s.x.push_back(FromSi(c.at.My, units, kDimMoment));
        s.y.push_back(FromSi(c.at.Mz, units, kDimMoment));
        plot.labels.push_back(
            {s.x.back(), s.y.back(),
             Say("IDS_QM_PLOT_SECC_LINE", Degrees(c.direction), Force(c.at.axial, units)),
             PLOT_MARKER::None, false});
    }
    plot.series.push_back(std::move(s));
}

} // namespace

T_PLOT SectionPlot(const T_SECTION_ANSWER& answer, const T_UNITS& units)
{
    constexpr std::array<const char*, 4> kTitles{
        "IDS_QM_PLOT_SECC_CAPACITY", "IDS_QM_PLOT_SECC_CURVATURE", "IDS_QM_PLOT_SECC_INTERACTION",
        "IDS_QM_PLOT_SECC_SURFACE"};
    T_PLOT plot;
    plot.title = Say(kTitles[static_cast<std::size_t>(answer.task)]) + ": " + answer.section;
    plot.subtitle = answer.material + ", " + SectionOptionsText(answer);
    plot.notes = {Say("IDS_QM_SECC_SIGNS")};
    const std::string moment = HeadWithUnit("M", kDimMoment, units);
    plot.x.title = HeadWithUnit("My", kDimMoment, units);
    plot.y.title = HeadWithUnit("Mz", kDimMoment, units);
    switch (answer.task) {
    case SECTION_TASK::Capacity:
        AddCapacities(answer, units, plot);
        break;
    case SECTION_TASK::Curvature:
        plot.x.title = HeadWithUnit(Say("IDS_QM_SECC_HEAD_CURVATURE"), kDimCurvature, units);
        plot.y.title = moment;
        for (const T_SECTION_CURVATURE& c : answer.curvatures)
            AddCurvature(c, units, plot);
        break;
    case SECTION_TASK::Interaction:
        plot.x.title = moment;
        plot.y.title = HeadWithUnit("N", kDimForce, units);
        for (const T_SECTION_INTERACTION& c : answer.interactions)
            AddInteraction(c, units, plot);
        break;
    case SECTION_TASK::Surface:
        plot.equalScales = true;
        AddContours(answer, units, plot);
        break;
    }
    return plot;
}
