#include "qm_rps/hinge/hingepreview.h"

#include "qm_rps/hinge/backbonerules.h"
#include "qm_rps/hinge/hingemeasure.h"

#include <algorithm>
#include <cmath>

namespace {

constexpr double kEdge = kPreviewEdge;
constexpr double kZeroTheta = 1e-7;
constexpr double kSchematicGap = 0.25; // of Dy

using T_LINE = std::vector<T_PREVIEW_POINT>;

/// Moves `end` along the line from `from` to x = edge, or to y = edge where that comes first.
void Extend(T_PREVIEW_POINT& end, const T_PREVIEW_POINT& from, double edge)
{
    if (end.x == from.x) return;
    const double slope = (end.y - from.y) / (end.x - from.x);
    const double y = end.y + slope * (edge - end.x);
    const bool beyond = edge < 0.0 ? y < edge : y > edge;
    if (beyond) {
        end.x += (edge - end.y) / slope;
        end.y = edge;
        return;
    }
    end.x = edge;
    end.y = y;
}

/// y of a side's line at x; x runs away from the origin. Beyond the end: the end's y.
double OnLine(const T_LINE& side, double x)
{
    for (std::size_t i = 1; i < side.size(); ++i) {
        const T_PREVIEW_POINT &a = side[i - 1], &b = side[i];
        if (std::fabs(x) > std::fabs(b.x)) continue;
        if (a.x == b.x) return b.y;
        return a.y + (b.y - a.y) * (x - a.x) / (b.x - a.x);
    }
    return side.empty() ? 0.0 : side.back().y;
}

/// Joins the sides, each from the origin outwards without the origin.
T_LINE Join(const T_LINE& neg, const T_LINE& pos)
{
    T_LINE line(neg.rbegin(), neg.rend());
    line.push_back({0.0, 0.0, "A"});
    line.insert(line.end(), pos.begin(), pos.end());
    return line;
}

bool AllFinite(const T_HINGE_PREVIEW& p)
{
    const auto finite = [](const T_PREVIEW_POINT& q) {
        return std::isfinite(q.x) && std::isfinite(q.y);
    };
    return std::all_of(p.line.begin(), p.line.end(), finite) &&
           std::all_of(p.marks.begin(), p.marks.end(), finite);
}

/// Deformation on the preview's axis; sign -1 on the negative side.
double Abscissa(double value, double sign, double theta, SKEL_MEASURE measure, bool plasticAxis)
{
    if (measure == SKEL_MEASURE::DDy || plasticAxis) return value;
    return sign * RatioFromPlastic(sign * value, theta);
}

T_LINE BackboneSide(const T_SKEL_SIDE& s, double sign, SKEL_MEASURE measure, T_HINGE_PREVIEW& out)
{
    const double theta = std::fabs(s.yieldDeform);
    const std::string prefix = sign < 0.0 ? "-" : "";
    const auto at = [&](double v) { return Abscissa(v, sign, theta, measure, out.plasticAxis); };
    T_LINE side;
    const std::pair<const char*, const T_SKEL_POINT*> points[] = {
        {"B", &s.B}, {"C", &s.C}, {"D", &s.D}, {"E", &s.E}};
    for (const auto& [name, p] : points)
        side.push_back({at(p->deform), p->strength, prefix + name});
    T_LINE fromOrigin = side;
    fromOrigin.insert(fromOrigin.begin(), T_PREVIEW_POINT{});
    const std::pair<const char*, double> criteria[] = {{"IO", s.IO}, {"LS", s.LS}, {"CP", s.CP}};
    for (const auto& [name, v] : criteria)
        if (v != 0.0) out.marks.push_back({at(v), OnLine(fromOrigin, at(v)), prefix + name});
    return side;
}

void Backbone(T_SIDES<T_SKEL_SIDE> sides, bool symmetric, SKEL_MEASURE measure,
              T_HINGE_PREVIEW& out)
{
    if (symmetric) MirrorSide(sides.pos, sides.neg);
    out.plasticAxis =
        measure == SKEL_MEASURE::Plastic && (std::fabs(sides.pos.yieldDeform) < kZeroTheta ||
                                             std::fabs(sides.neg.yieldDeform) < kZeroTheta);
    const T_LINE neg = BackboneSide(sides.neg, -1.0, measure, out);
    out.line = Join(neg, BackboneSide(sides.pos, 1.0, measure, out));
}

/// Points of one side from entered deformations, normalised by the yield point.
bool FromDeformations(const T_SKEL_MULTI& m, const T_SKEL_MULTI_SIDE& s, bool tri, T_LINE& side)
{
    const double dy = tri ? s.D2 : s.D1, py = tri ? s.P2 : s.P1;
    if (!(dy > 0.0) || !(py > 0.0)) return false;
    const double p2 = s.P2 > 0.0 ? s.P2 : s.P1, p3 = m.useUltimate ? s.P3 : p2;
    side = {{s.D1 / dy, s.P1 / py, ""}, {s.D2 / dy, (tri ? s.P2 : p2) / py, ""}};
    if (tri) side.push_back({s.D3 / dy, p3 / py, ""});
    return true;
}

/// Points of one side from the stiffness ratios; x is in units of yield strength / stiffness.
bool FromRatios(const T_SKEL_MULTI_SIDE& s, bool tri, T_LINE& side)
{
    if (!tri) {
        side = {{1.0, 1.0, ""}, {kEdge, 1.0 + s.alpha1 * (kEdge - 1.0), ""}};
        return true;
    }
    if (!(s.P1 > 0.0) || !(s.P2 >= s.P1)) return false;
    const double crack = s.P1 / s.P2;
    side = {{crack, crack, ""}};
    if (crack < 1.0 && !(s.alpha1 > 0.0)) { // the crack plateau never reaches the yield strength
        side.push_back({crack + 1.0, crack, ""});
        return true;
    }
    const double x = crack < 1.0 ? crack + (1.0 - crack) / s.alpha1 : 1.0;
    if (crack < 1.0) side.push_back({x, 1.0, ""});
    side.push_back({x + 1.0, 1.0 + s.alpha2, ""});
    return true;
}

/// Gap in units of the yield deformation.
double GapOf(const T_SKEL_MULTI& m, const T_SKEL_MULTI_SIDE& s, bool tri, bool& schematic)
{
    const double py = tri ? s.P2 : s.P1;
    double dy = m.useDeformation ? (tri ? s.D2 : s.D1) : 0.0;
    if (!m.useDeformation && m.initStiffness == INIT_STIFFNESS::User && s.userStiffness > 0.0)
        dy = py / s.userStiffness;
    if (dy > 0.0) return s.gap / dy;
    schematic = schematic || s.gap > 0.0;
    return s.gap > 0.0 ? kSchematicGap : 0.0;
}

bool MultiSide(const T_SKEL_MULTI& m, const T_SKEL_MULTI_SIDE& s, SKEL_TYPE type, bool hasGap,
               T_HINGE_PREVIEW& out, T_LINE& side)
{
    const bool tri = IsTrilinear(type);
    if (!(m.useDeformation ? FromDeformations(m, s, tri, side) : FromRatios(s, tri, side)))
        return false;
    if (!IsSlip(type) || !hasGap) return true;
    const double gap = GapOf(m, s, tri, out.schematicGap);
    if (!(gap > 0.0)) return true;
    for (T_PREVIEW_POINT& p : side)
        p.x += gap;
    side.insert(side.begin(), {gap, 0.0, ""});
    return true;
}

bool Multi(const T_SKEL_MULTI& m, SKEL_TYPE type, T_HINGE_PREVIEW& out)
{
    T_SKEL_MULTI_SIDE negative = m.symmetric ? m.sides.pos : m.sides.neg;
    negative.gap = m.sides.neg.gap; // a gap has its own entry on each side
    T_LINE pos, neg;
    if (!MultiSide(m, m.sides.pos, type, m.gapSides != GAP_SIDES::Negative, out, pos) ||
        !MultiSide(m, negative, type, m.gapSides != GAP_SIDES::Positive, out, neg))
        return false;
    if (type == SKEL_TYPE::CompressionOnly) pos = {{1.0, 0.0, ""}}; // no resistance in tension
    for (T_PREVIEW_POINT& p : neg)
        p.x = -p.x, p.y = -p.y;
    out.line = Join(neg, pos);
    return true;
}

} // namespace

void AdjustEndPoint(std::vector<T_PREVIEW_POINT>& line)
{
    if (line.size() < 2) return;
    T_PREVIEW_POINT& first = line.front();
    if (first.x > -kEdge && first.y > -kEdge) {
        Extend(first, line[1], -kEdge);
        return; // the positive side waits for the next call
    }
    T_PREVIEW_POINT& last = line.back();
    if (last.x < kEdge && last.y < kEdge) Extend(last, line[line.size() - 2], kEdge);
}

int BackboneOf(const T_SKEL_CURVE& curve, SKEL_TYPE type, T_HINGE_PREVIEW& out)
{
    T_HINGE_PREVIEW p;
    bool ok = true;
    if (const auto* m = std::get_if<T_SKEL_MULTI>(&curve)) {
        ok = Multi(*m, type, p);
    } else if (const auto* f = std::get_if<T_SKEL_FEMA>(&curve)) {
        const bool list = f->multiCurve && !f->curves.empty();
        Backbone(list ? f->curves.front().sides : f->sides, f->symmetric, f->measure, p);
        if (!f->compliance) p.marks.clear(); // inactive criteria
    } else {
        const T_SKEL_EC8& e = std::get<T_SKEL_EC8>(curve);
        Backbone(e.sides, e.symmetric, e.measure, p);
    }
    ok = ok && AllFinite(p);
    out = ok ? p : T_HINGE_PREVIEW();
    return ok ? 1 : 0;
}

int PreviewOf(const T_SKEL_CURVE& curve, SKEL_TYPE type, T_HINGE_PREVIEW& out)
{
    if (!BackboneOf(curve, type, out)) return 0;
    AdjustEndPoint(out.line);
    AdjustEndPoint(out.line); // the positive side may have waited
    return 1;
}
