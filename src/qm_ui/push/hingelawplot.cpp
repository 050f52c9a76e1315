#include "qm_ui/push/hingelawplot.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_rps/push/pushatpointtext.h"
#include "qm_rps/push/pushquantity.h"

#include <algorithm>
#include <cmath>

namespace {

using SIDE = solver::T_HINGE_SIDE;

/// What the x axis has to reach: the path and the criteria with some room, vertices that are not
/// far beyond them (a bilinear law goes on to a thousand times its yield).
double Reach(const T_PUSH_HINGE_SERIES& hinge)
{
    constexpr double kRoom = 1.2, kFar = 4.0;
    double reach = 0.0;
    for (const double d : hinge.deformation)
        reach = std::max(reach, std::fabs(d));
    const SIDE* sides[] = {&hinge.law.positive, &hinge.law.negative};
    for (const SIDE* side : sides)
        for (const double mark : side->marks)
            reach = std::max(reach, mark + side->gap);
    double vertices = 0.0, least = 0.0;
    for (const SIDE* side : sides)
        for (const solver::T_BACKBONE_POINT& p : side->points) {
            const double d = p.deformation + side->gap;
            if (d > 0.0 && (least == 0.0 || d < least)) least = d;
            if (reach == 0.0 || d <= kFar * reach) vertices = std::max(vertices, d);
        }
    reach = std::max({kRoom * reach, kRoom * vertices, least});
    return reach > 0.0 ? reach : 1.0;
}

void AddSide(T_PLOT& plot, const T_PUSH_HINGE_SERIES& hinge, bool positive, double axial,
             double reach, const T_UNITS& units)
{
    const SIDE& side = positive ? hinge.law.positive : hinge.law.negative;
    const double sign = positive ? 1.0 : -1.0;
    const HINGE_COMPONENT c = hinge.place.component;
    T_PLOT_SERIES s;
    if (positive) s.name = Say("IDS_QM_PLOT_LAW");
    for (const auto& p : BackboneUpTo(side, StrengthFactor(hinge.law, positive, axial), reach)) {
        s.x.push_back(DeformationOf(c, units).Shown(sign * p.deformation));
        s.y.push_back(ForceOf(c, units).Shown(sign * p.force));
    }
    s.line = PLOT_LINE::Solid;
    s.color = T_PLOT_COLOR{120, 120, 120};
    plot.series.push_back(std::move(s));
    constexpr const char* kNames[] = {"IO", "LS", "CP"};
    for (std::size_t i = 0; i < side.marks.size() && i < std::size(kNames); ++i) {
        T_PLOT_GUIDE guide;
        guide.value = DeformationOf(c, units).Shown(sign * side.marks[i]);
        guide.label = kNames[i];
        plot.guides.push_back(guide);
    }
}

void AddPath(T_PLOT& plot, const T_PUSH_HINGE_SERIES& hinge, std::size_t count,
             const T_UNITS& units)
{
    const HINGE_COMPONENT c = hinge.place.component;
    T_PLOT_SERIES s;
    s.name = Say("IDS_QM_PLOT_LAW_PATH");
    for (std::size_t i = 0; i < count; ++i) {
        s.x.push_back(DeformationOf(c, units).Shown(hinge.deformation[i]));
        s.y.push_back(ForceOf(c, units).Shown(hinge.force[i]));
    }
    s.line = PLOT_LINE::Solid;
    s.width = 2.6;
    s.color = T_PLOT_COLOR{21, 78, 140};
    plot.labels.push_back(
        {s.x.back(), s.y.back(), PushStateText(hinge.state[count - 1]), PLOT_MARKER::Square, true});
    plot.series.push_back(std::move(s));
}

} // namespace

std::vector<solver::T_BACKBONE_POINT> BackboneUpTo(const SIDE& side, double factor,
                                                   double deformation)
{
    std::vector<solver::T_BACKBONE_POINT> out{{0.0, 0.0}};
    const double gap = side.free ? deformation : std::min(side.gap, deformation);
    if (gap > 0.0) out.push_back({gap, 0.0});
    for (const solver::T_BACKBONE_POINT& p : side.points) {
        if (side.free || out.back().deformation >= deformation) break;
        solver::T_BACKBONE_POINT next{p.deformation + gap, factor * p.force};
        if (next.deformation > deformation) {
            const solver::T_BACKBONE_POINT& last = out.back();
            const double part =
                (deformation - last.deformation) / (next.deformation - last.deformation);
            next = {deformation, last.force + part * (next.force - last.force)};
        }
        out.push_back(next);
    }
    if (out.back().deformation < deformation) out.push_back({deformation, out.back().force});
    return out;
}

double StrengthFactor(const solver::T_HINGE_LAW& law, bool positive, double axial)
{
    const SIDE& side = positive ? law.positive : law.negative;
    if (law.byAxial.empty() || side.points.empty() || !(side.points.front().force > 0.0))
        return 1.0;
    const auto strength = [positive](const solver::T_AXIAL_STRENGTH& row) {
        return positive ? row.positive : row.negative;
    };
    const auto next =
        std::ranges::lower_bound(law.byAxial, axial, {}, &solver::T_AXIAL_STRENGTH::axial);
    double value = 0.0;
    if (next == law.byAxial.begin() || next == law.byAxial.end()) {
        value = strength(next == law.byAxial.end() ? law.byAxial.back() : *next);
    } else {
        const solver::T_AXIAL_STRENGTH& before = *(next - 1);
        const double part = (axial - before.axial) / (next->axial - before.axial);
        value = strength(before) + part * (strength(*next) - strength(before));
    }
    return value / side.points.front().force;
}

T_PLOT HingeLawPlot(const T_PUSH_RUN& run, std::size_t hinge, int step, const T_UNITS& units)
{
    T_PLOT plot;
    if (hinge >= run.hinges.size() || step < 1) return plot;
    const T_PUSH_HINGE_SERIES& h = run.hinges[hinge];
    const HINGE_COMPONENT c = h.place.component;
    const auto count = static_cast<std::size_t>(step);
    const double axial = run.data.states.at(count - 1).at(hinge).axial;
    plot.title = Say("IDS_QM_UI_PUSH_HINGE_NAME", std::to_string(h.place.element), h.place.end,
                     kComponentNames[static_cast<std::size_t>(c)]);
    if (!h.law.byAxial.empty())
        plot.subtitle =
            Say("IDS_QM_PLOT_LAW_AXIAL", FormatText("%.4g", FromSi(axial, units, kDimForce) + 0.0) +
                                             " " + std::string(NameOf(units.force)));
    else if (h.biaxial)
        plot.subtitle = Say("IDS_QM_PLOT_LAW_BIAXIAL");
    plot.x.title = DeformationOf(c, units).Head("IDS_QM_PLOT_LAW_DEFORMATION");
    plot.y.title = ForceOf(c, units).Head(c < HINGE_COMPONENT::Mx ? "IDS_QM_PLOT_LAW_FORCE"
                                                                  : "IDS_QM_PLOT_LAW_MOMENT");
    const double reach = Reach(h);
    for (const bool positive : {true, false})
        AddSide(plot, h, positive, axial, reach, units);
    AddPath(plot, h, count, units);
    return plot;
}
