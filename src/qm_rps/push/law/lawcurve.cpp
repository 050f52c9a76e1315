#include "qm_rps/push/law/lawcurve.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_rps/hinge/backbonerules.h"
#include "qm_rps/hinge/hingefindings.h"
#include "qm_rps/hinge/pageyield.h"

#include <algorithm>
#include <cmath>

namespace {

constexpr double kFar = 1000.0;    // Dy up to which stiffness ratios run
constexpr double kRounding = 1e-6; // of Dy: entered ratios have so many digits

/// How a side of the curve turns into the hinge's deformation.
struct T_MEASURE {
    double compliance = 0.0; // of the elastic part; 0: rigid
    bool spring = false;     // that part is the hinge's own
    double length = 1.0;

    /// Plastic part of a total deformation.
    double Plastic(double total, double force) const { return total - compliance * force; }
};

/// A point of a side: total deformation and force, magnitudes.
struct T_POINT {
    double total = 0.0, force = 0.0;
    char letter = 'B';
};
using T_POINTS = std::vector<T_POINT>;

int Fail(std::string& reason, std::string text)
{
    reason = std::move(text);
    return 0;
}

std::string SideText(bool positive)
{
    return positive ? "(+)" : "(-)";
}

/// Force of a side at a total deformation; at a drop the one before it.
double ForceAt(const T_POINTS& points, double total)
{
    const auto at =
        std::ranges::find_if(points, [&](const T_POINT& p) { return total <= p.total; });
    if (at == points.end()) return points.back().force;
    if (at == points.begin())
        return at->total > 0.0 ? at->force * std::max(total, 0.0) / at->total : at->force;
    const T_POINT& before = *(at - 1);
    const double width = at->total - before.total;
    return width > 0.0 ? before.force + (at->force - before.force) * (total - before.total) / width
                       : before.force;
}

/// Points as the engine takes them; equal ones become one under the later letter.
int PutPoints(const T_POINTS& points, const T_MEASURE& m, bool positive, solver::T_HINGE_SIDE& side,
              std::string& letters, std::string& reason)
{
    const double yield = std::max(m.compliance * points.front().force, 0.0);
    const double scale = std::max(yield, std::fabs(points.back().total));
    double before = 0.0;
    for (const T_POINT& p : points) {
        double plastic = m.Plastic(p.total, p.force);
        if (side.points.empty() && std::fabs(plastic) > kRounding * scale)
            return Fail(reason,
                        Say("IDS_QM_PUSH_LAW_FIRST", SideText(positive), std::string(1, p.letter)));
        if (plastic < before - kRounding * scale)
            return Fail(reason,
                        Say("IDS_QM_PUSH_LAW_FALLS", SideText(positive), std::string(1, p.letter)));
        plastic = side.points.empty() ? 0.0 : std::max(plastic, before);
        before = plastic;
        const double hinge = m.length * (plastic + (m.spring ? m.compliance * p.force : 0.0));
        const solver::T_BACKBONE_POINT point{hinge, p.force};
        if (!side.points.empty() && side.points.back().deformation == point.deformation &&
            side.points.back().force == point.force) {
            letters.back() = p.letter;
            continue;
        }
        side.points.push_back(point);
        letters += p.letter;
    }
    return 1;
}

double MarkAt(const T_POINTS& points, const T_MEASURE& m, double total)
{
    const double hinge = m.spring ? total : m.Plastic(total, ForceAt(points, total));
    return m.length * std::max(hinge, 0.0);
}

/// The elastic part of a side; false: the curve has no such stiffness.
T_MEASURE MeasureOf(INIT_STIFFNESS option, double user, const T_LAW_BASIS& basis)
{
    T_MEASURE m;
    m.length = basis.length;
    const double k = option == INIT_STIFFNESS::User ? user : basis.stiffness.value_or(0.0);
    m.compliance = k > 0.0 ? 1.0 / k : 0.0;
    m.spring = option == INIT_STIFFNESS::User && k > 0.0;
    return m;
}

// ---- FEMA and Eurocode 8 ------------------------------------------------------------------------

solver::UNLOADING UnloadingOf(UNLOAD_TYPE type)
{
    if (type == UNLOAD_TYPE::Origin) return solver::UNLOADING::Origin;
    return type == UNLOAD_TYPE::NonlinearElastic ? solver::UNLOADING::Backbone
                                                 : solver::UNLOADING::Elastic;
}

/// What a backbone says of both sides.
struct T_BACKBONE_PAGE {
    SKEL_MEASURE measure = SKEL_MEASURE::DDy;
    bool strengthLoss = true;
};

/// Total deformation of a value of the curve, a magnitude.
double TotalOf(const T_BACKBONE_PAGE& page, const T_MEASURE& m, double value, double yield)
{
    const double dy = m.compliance * yield;
    return page.measure == SKEL_MEASURE::DDy ? value * dy : value + dy;
}

/// `s` in magnitudes. Without strength loss the force of C stays.
T_POINTS BackbonePoints(const T_BACKBONE_PAGE& page, const T_MEASURE& m, const T_SKEL_SIDE& s,
                        double yield)
{
    T_POINTS points;
    const auto add = [&](const T_SKEL_POINT& p, double ratio, char letter) {
        points.push_back({TotalOf(page, m, p.deform, yield), ratio * yield, letter});
    };
    const double floor = page.strengthLoss ? 0.0 : s.C.strength;
    add(s.B, s.B.strength, 'B');
    add(s.C, s.C.strength, 'C');
    add(s.D, std::max(s.D.strength, floor), 'D');
    add(s.E, std::max(s.E.strength, floor), 'E');
    return points;
}

int BackboneSide(const T_BACKBONE_PAGE& page, const T_MEASURE& m, const T_SKEL_SIDE& s,
                 double yield, bool positive, T_PUSH_LAW& law, std::string& reason)
{
    if (page.measure == SKEL_MEASURE::DDy && !(m.compliance > 0.0))
        return Fail(reason, Say("IDS_QM_PUSH_LAW_RIGID"));
    solver::T_HINGE_SIDE& side = positive ? law.law.positive : law.law.negative;
    const T_POINTS points = BackbonePoints(page, m, s, yield);
    if (!PutPoints(points, m, positive, side, positive ? law.letters.pos : law.letters.neg, reason))
        return 0;
    if (law.criteria)
        for (const double v : {s.IO, s.LS, s.CP})
            side.marks.push_back(MarkAt(points, m, TotalOf(page, m, v, yield)));
    return 1;
}

template <class CURVE>
int BackboneLaw(const CURVE& curve, T_SIDES<T_SKEL_SIDE> sides, const T_LAW_BASIS& basis,
                T_PUSH_LAW& law, std::string& reason)
{
    const double ownStiffness = sides.neg.userStiffness;
    if (curve.symmetric) MirrorSide(sides.pos, sides.neg);
    MirrorSide(T_SKEL_SIDE(sides.neg), sides.neg); // magnitudes
    const bool two = HasTwoStiffnesses(T_SKEL_CURVE(curve));
    const T_BACKBONE_PAGE page{curve.measure, curve.strengthLoss};
    T_MEASURE pos = MeasureOf(curve.initStiffness, sides.pos.userStiffness, basis);
    T_MEASURE neg =
        MeasureOf(curve.initStiffness, two ? ownStiffness : sides.pos.userStiffness, basis);
    if (page.measure != SKEL_MEASURE::DDy && !pos.spring && !neg.spring) {
        pos.compliance *= basis.atAxial.pos;
        neg.compliance *= basis.atAxial.neg;
    }
    const auto any = [](const T_SKEL_SIDE& s) { return s.IO != 0.0 || s.LS != 0.0 || s.CP != 0.0; };
    law.criteria = any(sides.pos) || any(sides.neg);
    if constexpr (requires { curve.compliance; }) law.criteria = law.criteria && curve.compliance;
    law.fails = true;
    if (pos.spring != neg.spring || (pos.spring && std::fabs(pos.compliance - neg.compliance) >
                                                       kRounding * std::fabs(pos.compliance)))
        return Fail(reason, Say("IDS_QM_PUSH_LAW_STIFFNESSES"));
    law.law.stiffness = pos.spring ? 1.0 / (pos.compliance * pos.length) : 0.0;
    return BackboneSide(page, pos, sides.pos, basis.yield.pos, true, law, reason) &&
           BackboneSide(page, neg, sides.neg, basis.yield.neg, false, law, reason);
}

int Law(const T_SKEL_FEMA& curve, SKEL_TYPE, const T_LAW_BASIS& basis, T_PUSH_LAW& law,
        std::string& reason)
{
    // The general form holds drifts of the panel, whose height a hinge does not know.
    if (curve.infillStrut && curve.infillGeneral)
        return Fail(reason, Say("IDS_QM_PUSH_LAW_INFILL"));
    law.law.positive.unloading = law.law.negative.unloading = UnloadingOf(curve.unloadType);
    return BackboneLaw(curve, SidesAt(curve, basis.axial), basis, law, reason);
}

int Law(const T_SKEL_EC8& curve, SKEL_TYPE, const T_LAW_BASIS& basis, T_PUSH_LAW& law,
        std::string& reason)
{
    return BackboneLaw(curve, curve.sides, basis, law, reason);
}

// ---- multilinear --------------------------------------------------------------------------------

/// The strengths of a side: first point, yield of a trilinear curve, ultimate (0: none).
struct T_STRENGTHS {
    double first = 0.0, second = 0.0, ultimate = 0.0;
};

/// Adds a branch of this stiffness ratio up to a strength; 0: up to 1000 Dy.
void AddBranch(T_POINTS& points, const T_MEASURE& m, double ratio, double strength, double dy)
{
    const T_POINT from = points.back();
    const double slope = ratio / m.compliance;
    const double far = kFar * dy - from.total;
    const double total = strength > 0.0 ? (strength - from.force) / slope : far;
    points.push_back(
        {from.total + total, from.force + total * slope, static_cast<char>(from.letter + 1)});
}

int RatioPoints(const T_SKEL_MULTI_SIDE& s, const T_STRENGTHS& p, bool trilinear,
                const T_MEASURE& m, T_POINTS& points, std::string& reason)
{
    const double last = trilinear ? s.alpha2 : s.alpha1;
    if (s.alpha1 >= 1.0 || last >= 1.0) return Fail(reason, Say("IDS_QM_PUSH_LAW_RATIO"));
    const double yield = trilinear ? p.second : p.first;
    const bool cracks = trilinear && p.second > p.first;
    const bool rises = (cracks && s.alpha1 > 0.0) || last > 0.0;
    if (rises && !(m.compliance > 0.0)) return Fail(reason, Say("IDS_QM_PUSH_LAW_RIGID"));
    const double dy = m.compliance * yield;
    points.push_back({m.compliance * p.first, p.first, 'B'});
    if (cracks) {
        if (!(s.alpha1 > 0.0)) return 1; // the plateau never reaches the yield strength
        AddBranch(points, m, s.alpha1, p.second, dy);
    } else if (trilinear) {
        points.push_back({points.back().total, p.second, 'C'});
    }
    if (last > 0.0 && !(p.ultimate > 0.0 && p.ultimate <= yield))
        AddBranch(points, m, last, p.ultimate, std::max(dy, points.back().total));
    return 1;
}

/// Entered deformations; the first one is where the member yields.
void DeformPoints(const T_SKEL_MULTI_SIDE& s, const T_STRENGTHS& p, bool trilinear,
                  const T_MEASURE& m, T_POINTS& points)
{
    const double yield = m.compliance * p.first, second = trilinear ? p.second : p.ultimate;
    points.push_back({yield, p.first, 'B'});
    points.push_back({yield + s.D2 - s.D1, second > 0.0 ? second : p.first, 'C'});
    if (trilinear)
        points.push_back({yield + s.D3 - s.D1, p.ultimate > 0.0 ? p.ultimate : p.second, 'D'});
}

/// The ultimate strength of a bilinear curve with deformations is that of its second point.
T_STRENGTHS StrengthsOf(const T_SKEL_MULTI& curve, const T_SKEL_MULTI_SIDE& s, bool trilinear,
                        double yield, double crack)
{
    const double p3 = curve.useUltimate ? s.P3 : 0.0;
    if (trilinear) return {crack, yield, p3};
    return {yield, 0.0, curve.useDeformation && !curve.autoYield && s.P2 > 0.0 ? s.P2 : p3};
}

int MultiSide(const T_SKEL_MULTI& curve, const T_SKEL_MULTI_SIDE& s, SKEL_TYPE type,
              const T_LAW_BASIS& basis, bool positive, T_PUSH_LAW& law, std::string& reason)
{
    const bool trilinear = IsTrilinear(type);
    const T_MEASURE m = MeasureOf(curve.initStiffness, s.userStiffness, basis);
    const T_STRENGTHS p =
        StrengthsOf(curve, s, trilinear, positive ? basis.yield.pos : basis.yield.neg,
                    positive ? basis.crack.pos : basis.crack.neg);
    if (!(p.first > 0.0)) return Fail(reason, Say("IDS_QM_PUSH_LAW_CRACK", SideText(positive)));
    const double yield = trilinear ? p.second : p.first;
    if (p.first > yield || (p.ultimate > 0.0 && p.ultimate < yield))
        return Fail(reason, Say("IDS_QM_PUSH_LAW_ORDER", SideText(positive)));
    T_POINTS points;
    if (curve.useDeformation)
        DeformPoints(s, p, trilinear, m, points);
    else if (!RatioPoints(s, p, trilinear, m, points, reason))
        return 0;
    solver::T_HINGE_SIDE& side = positive ? law.law.positive : law.law.negative;
    return PutPoints(points, m, positive, side, positive ? law.letters.pos : law.letters.neg,
                     reason);
}

double GapOf(const T_SKEL_MULTI& curve, bool positive)
{
    const GAP_SIDES other = positive ? GAP_SIDES::Negative : GAP_SIDES::Positive;
    if (curve.gapSides == other) return 0.0;
    return positive ? curve.sides.pos.gap : curve.sides.neg.gap;
}

int Law(const T_SKEL_MULTI& curve, SKEL_TYPE type, const T_LAW_BASIS& basis, T_PUSH_LAW& law,
        std::string& reason)
{
    const T_SKEL_MULTI_SIDE& negative = curve.symmetric ? curve.sides.pos : curve.sides.neg;
    const T_MEASURE pos = MeasureOf(curve.initStiffness, curve.sides.pos.userStiffness, basis);
    const T_MEASURE neg = MeasureOf(curve.initStiffness, negative.userStiffness, basis);
    const bool free = type == SKEL_TYPE::CompressionOnly;
    if (!free &&
        (pos.spring != neg.spring || (pos.spring && std::fabs(pos.compliance - neg.compliance) >
                                                        kRounding * std::fabs(pos.compliance))))
        return Fail(reason, Say("IDS_QM_PUSH_LAW_STIFFNESSES"));
    law.law.stiffness = neg.spring ? 1.0 / (neg.compliance * neg.length) : 0.0;
    law.law.positive.free = free;
    if (IsSlip(type)) {
        law.law.positive.slips = law.law.negative.slips = true;
        law.law.positive.gap = GapOf(curve, true) * basis.length;
        law.law.negative.gap = GapOf(curve, false) * basis.length;
    }
    return (free || MultiSide(curve, curve.sides.pos, type, basis, true, law, reason)) &&
           MultiSide(curve, negative, type, basis, false, law, reason);
}

/// The point between two curves of the list.
T_SKEL_SIDE Between(const T_SKEL_SIDE& a, const T_SKEL_SIDE& b, double t)
{
    const auto mix = [t](double x, double y) { return t == 0.0 ? x : x + t * (y - x); };
    const auto point = [&](const T_SKEL_POINT& x, const T_SKEL_POINT& y) {
        return T_SKEL_POINT{mix(x.deform, y.deform), mix(x.strength, y.strength)};
    };
    T_SKEL_SIDE s = a;
    s.yield = mix(a.yield, b.yield);
    s.yieldDeform = mix(a.yieldDeform, b.yieldDeform);
    s.B = point(a.B, b.B), s.C = point(a.C, b.C);
    s.D = point(a.D, b.D), s.E = point(a.E, b.E);
    s.IO = mix(a.IO, b.IO), s.LS = mix(a.LS, b.LS), s.CP = mix(a.CP, b.CP);
    s.userStiffness = mix(a.userStiffness, b.userStiffness);
    return s;
}

} // namespace

T_SIDES<T_SKEL_SIDE> SidesAt(const T_SKEL_FEMA& curve, double axial)
{
    if (!curve.multiCurve || curve.curves.empty()) return curve.sides;
    const auto& list = curve.curves; // ascending
    const auto above = std::ranges::find_if(list, [&](const auto& c) { return c.axial >= axial; });
    if (above == list.begin()) return list.front().sides;
    if (above == list.end()) return list.back().sides;
    const T_SKEL_AXIAL &a = *(above - 1), &b = *above;
    const double t = (axial - a.axial) / (b.axial - a.axial);
    return {Between(a.sides.pos, b.sides.pos, t), Between(a.sides.neg, b.sides.neg, t)};
}

int MakeLaw(const T_SKEL_CURVE& curve, SKEL_TYPE type, const T_LAW_BASIS& basis, T_PUSH_LAW& out,
            std::string& reason)
{
    const bool onePart = type == SKEL_TYPE::CompressionOnly;
    if (!(basis.yield.neg > 0.0) || (!onePart && !(basis.yield.pos > 0.0)))
        return Fail(reason,
                    Say("IDS_QM_PUSH_LAW_STRENGTH", SideText(basis.yield.neg > 0.0 && !onePart)));
    T_PUSH_LAW law;
    const int done =
        std::visit([&](const auto& k) { return Law(k, type, basis, law, reason); }, curve);
    if (done) out = std::move(law);
    return done;
}
