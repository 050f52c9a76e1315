#include "qm_ui/hinge/hingeplot.h"

#include "qm_base/msgfunction.h"
#include "qm_rps/hinge/hingelabels.h"
#include "qm_rps/hinge/hingepreview.h"

#include <array>
#include <span>

using zql::lib::MMSGFunction;

namespace {

constexpr T_PLOT_COLOR kBlack{0, 0, 0}, kRed{184, 40, 30};

struct T_CURVE_ROW {
    const char* name;
    const T_YIELD_AXIS T_YIELD_LEVEL::*axis;
    const T_PM_CURVE T_SIDES<T_PM_CURVE>::*side;
    PLOT_LINE line;
    const T_SIDES<std::vector<T_PM_POINT>> T_PM_LINES::*lines;
    const std::vector<T_PM_POINT> T_SIDES<std::vector<T_PM_POINT>>::*whole;
    const double T_SIDES<double>::*largest;
};

constexpr std::array<T_CURVE_ROW, 4> kCurves{{
    {"My(+)", &T_YIELD_LEVEL::y, &T_SIDES<T_PM_CURVE>::pos, PLOT_LINE::Solid, &T_PM_LINES::y,
     &T_SIDES<std::vector<T_PM_POINT>>::pos, &T_SIDES<double>::pos},
    {"My(-)", &T_YIELD_LEVEL::y, &T_SIDES<T_PM_CURVE>::neg, PLOT_LINE::Dash, &T_PM_LINES::y,
     &T_SIDES<std::vector<T_PM_POINT>>::neg, &T_SIDES<double>::neg},
    {"Mz(+)", &T_YIELD_LEVEL::z, &T_SIDES<T_PM_CURVE>::pos, PLOT_LINE::DashDot, &T_PM_LINES::z,
     &T_SIDES<std::vector<T_PM_POINT>>::pos, &T_SIDES<double>::pos},
    {"Mz(-)", &T_YIELD_LEVEL::z, &T_SIDES<T_PM_CURVE>::neg, PLOT_LINE::Dot, &T_PM_LINES::z,
     &T_SIDES<std::vector<T_PM_POINT>>::neg, &T_SIDES<double>::neg},
}};

void Append(std::span<const T_PM_POINT> points, T_PLOT_SERIES& s, T_PM_POINT scale = {1.0, 1.0})
{
    for (const T_PM_POINT& p : points) {
        s.x.push_back(p.m * scale.m);
        s.y.push_back(p.p * scale.p);
    }
}

} // namespace

T_PLOT HingeBackbonePlot(const T_PHGT_D& type, HINGE_COMPONENT component, const T_SKEL_CURVE& curve,
                         const std::string& page, bool box)
{
    const auto c = static_cast<std::size_t>(component);
    const bool moment = component >= HINGE_COMPONENT::Mx;
    T_PLOT plot;
    plot.title = MMSGFunction::Format("IDS_QM_PLOT_HINGE", {type.name, kComponentNames[c]});
    plot.subtitle = page;
    T_HINGE_PREVIEW preview;
    const auto shape = box ? PreviewOf : BackboneOf;
    if (!shape(curve, type.components[c].type, preview)) {
        plot.notes.push_back(MMSGFunction::GetValue("IDS_QM_PLOT_NO_SHAPE"));
        return plot;
    }
    plot.x.title = !preview.plasticAxis
                       ? std::string("D / Dy (-)")
                       : MMSGFunction::GetValue(moment ? "IDS_QM_PLOT_PLASTIC_TURN"
                                                       : "IDS_QM_PLOT_PLASTIC_MOVE");
    plot.y.title = moment ? "M / My (-)" : "F / Fy (-)";
    if (box) plot.x.range = plot.y.range = T_PLOT_RANGE{-kPreviewEdge, kPreviewEdge};
    T_PLOT_SERIES line;
    line.name = MMSGFunction::GetValue("IDS_QM_PLOT_BACKBONE");
    line.width = 2.4;
    line.color = kBlack;
    line.line = PLOT_LINE::Solid;
    line.marker = PLOT_MARKER::Circle;
    for (const T_PREVIEW_POINT& p : preview.line) {
        line.x.push_back(p.x);
        line.y.push_back(p.y);
        plot.labels.push_back({p.x, p.y, p.label, PLOT_MARKER::None, true});
    }
    plot.series.push_back(std::move(line));
    T_PLOT_SERIES marks;
    marks.name = MMSGFunction::GetValue("IDS_QM_PLOT_ACCEPTANCE");
    marks.line = PLOT_LINE::None;
    marks.marker = PLOT_MARKER::Triangle;
    marks.color = kRed;
    for (const T_PREVIEW_POINT& p : preview.marks) {
        marks.x.push_back(p.x);
        marks.y.push_back(p.y);
        plot.labels.push_back({p.x, p.y, p.label, PLOT_MARKER::None, false});
    }
    if (!marks.x.empty()) plot.series.push_back(std::move(marks));
    if (preview.schematicGap)
        plot.notes.push_back(MMSGFunction::GetValue("IDS_QM_PLOT_GAP_NO_SCALE"));
    return plot;
}

T_PLOT HingeInteractionPlot(const T_PHGT_D& type, const T_YIELD_LEVEL& level,
                            const std::string& what, const T_PM_LINES& lines,
                            const std::optional<T_UNITS>& values)
{
    T_PLOT plot;
    plot.title = MMSGFunction::Format("IDS_QM_PLOT_INTERACTION", {type.name});
    plot.subtitle = what;
    plot.x.title = values ? HeadWithUnit("M", kDimMoment, *values) : "M / MY,max (-)";
    plot.y.title = values ? HeadWithUnit("IDS_QM_PLOT_AXIAL", kDimForce, *values)
                          : MMSGFunction::GetValue("IDS_QM_PLOT_AXIAL_RATIO");
    T_PLOT_SERIES points; // on whole lines
    points.name = MMSGFunction::GetValue("IDS_QM_PLOT_INTERACTION_POINTS");
    points.line = PLOT_LINE::None;
    points.marker = PLOT_MARKER::Circle;
    for (const T_CURVE_ROW& row : kCurves) {
        const T_YIELD_AXIS& axis = level.*row.axis;
        if (!axis.used) continue;
        T_PLOT_SERIES s;
        s.name = row.name;
        s.line = row.line;
        const std::vector<T_PM_POINT>& whole = lines.*row.lines.*row.whole;
        if (whole.empty()) s.marker = PLOT_MARKER::Circle;
        const T_PM_POINT scale{values ? level.compression : 1.0,
                               values ? axis.momentMax.*row.largest : 1.0};
        Append(axis.curves.*row.side, whole.empty() ? s : points, scale);
        Append(whole, s, scale);
        plot.series.push_back(std::move(s));
    }
    if (!points.x.empty()) plot.series.push_back(std::move(points));
    return plot;
}

T_PLOT UserInteractionPlot(const T_PHGT_D& type, const T_PMM_TABLE& table)
{
    T_PLOT plot;
    plot.title = MMSGFunction::Format("IDS_QM_PLOT_USER_INTERACTION", {type.name});
    plot.x.title = "M / Mmax (-)";
    plot.y.title = MMSGFunction::GetValue("IDS_QM_PLOT_AXIAL_RATIO");
    const auto add = [&plot](const T_PMM_CURVES::value_type& curve, std::string name,
                             PLOT_LINE line) {
        T_PLOT_SERIES s;
        s.name = std::move(name);
        s.line = line;
        s.marker = PLOT_MARKER::Circle;
        Append(curve, s);
        plot.series.push_back(std::move(s));
    };
    const std::string sign = table.negative ? "(+)" : "";
    for (std::size_t i = 0; i < table.curves.size(); ++i) {
        const std::string name = i == 0 ? "Py-My" : "Pz-Mz";
        add(table.curves[i], name + sign, i == 0 ? PLOT_LINE::Solid : PLOT_LINE::Dash);
        if (table.negative)
            add((*table.negative)[i], name + "(-)", i == 0 ? PLOT_LINE::DashDot : PLOT_LINE::Dot);
    }
    return plot;
}
