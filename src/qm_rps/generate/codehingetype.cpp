#include "qm_rps/generate/codehingetype.h"

#include "qm_base/say.h"
#include "qm_rps/generate/axialcurve.h"
#include "qm_rps/generate/masonryhinge.h"
#include "qm_rps/generate/rchinge.h"
#include "qm_rps/generate/steelhinge.h"
#include "qm_rps/push/law/lawaxial.h"

#include <algorithm>
#include <cmath>
#include <type_traits>

namespace {

int Refuse(std::string& reason, std::string words)
{
    reason = std::move(words);
    return 0;
}

/// By the signs of an analysis.
const T_CODE_SIDE& SideOf(const T_SIDES<T_CODE_SIDE>& sides, HINGE_COMPONENT component,
                          bool positive)
{
    return positive != IsSectionSignOpposite(component) ? sides.pos : sides.neg;
}

/// One side of a curve in plastic deformations. A limit before yield counts at yield.
T_SKEL_SIDE CurveSide(const T_CODE_SIDE& from, bool positive, bool follows)
{
    const double sign = positive ? 1.0 : -1.0;
    const T_CODE_BACKBONE& bone = from.bone;
    const auto sided = [&](double value) { return value > 0.0 ? sign * value : 0.0; };
    const auto plastic = [&](double deform) { return sided(bone.Plastic(deform)); };
    const auto point = [&](const T_CODE_POINT& p) {
        return T_SKEL_POINT{plastic(p.deform), sided(p.strength)};
    };
    T_SKEL_SIDE side;
    side.yield = follows ? from.strengthAtZero : from.strength; // of shear and axial force the same
    side.yieldDeform = bone.yieldDeform;
    side.B = point(bone.B);
    side.C = point(bone.C);
    side.D = point(bone.D);
    side.E = point(bone.E);
    if (!bone.acceptance) return side;
    side.IO = plastic((*bone.acceptance)[0]);
    side.LS = plastic((*bone.acceptance)[1]);
    side.CP = plastic((*bone.acceptance)[2]);
    return side;
}

template <class CURVE>
CURVE FilledCurve(const T_SIDES<T_CODE_SIDE>& sides, HINGE_COMPONENT component, bool follows)
{
    CURVE curve;
    curve.symmetric = false;
    curve.autoYield = false;
    curve.measure = SKEL_MEASURE::Plastic;
    curve.strengthLoss = sides.pos.bone.strengthLoss || sides.neg.bone.strengthLoss;
    for (const bool positive : {true, false})
        (positive ? curve.sides.pos : curve.sides.neg) =
            CurveSide(SideOf(sides, component, positive), positive, follows);
    return curve;
}

T_SKEL_CURVE CurveOf(const T_SIDES<T_CODE_SIDE>& sides, HINGE_COMPONENT component, bool follows,
                     bool chord)
{
    if (chord) return FilledCurve<T_SKEL_EC8>(sides, component, follows);
    return FilledCurve<T_SKEL_FEMA>(sides, component, follows);
}

void WarnEarly(const T_SIDES<T_CODE_SIDE>& sides, T_CODE_HINGE& hinge)
{
    const T_CODE_WARNING early{"IDS_QM_GEN_WARN_EARLY", {}};
    for (const T_CODE_SIDE* side : {&sides.pos, &sides.neg}) {
        const auto& limits = side->bone.acceptance;
        const bool before = limits && (*limits)[1] < side->bone.yieldDeform;
        if (before && std::ranges::find(hinge.warnings, early) == hinge.warnings.end())
            hinge.warnings.push_back(early);
    }
}

/// Where the component has hinges; none: both ends are released.
std::optional<HINGE_LOCATION> LocationOf(const T_HINGE_MEMBER& member, HINGE_COMPONENT component)
{
    const auto at = static_cast<std::size_t>(component);
    const bool i = !member.release.I[at], j = !member.release.J[at];
    if (i && j) return HINGE_LOCATION::BothEnds;
    if (i) return HINGE_LOCATION::IEnd;
    return j ? std::optional(HINGE_LOCATION::JEnd) : std::nullopt;
}

/// Sides of an end by what the member is made of.
int EndHinge(const T_MEMBER_END& end, T_SIDES<T_CODE_SIDE>& out, std::string& reason)
{
    switch (end.material.type) {
    case MATL_CLASS::Steel:
        return SteelHinge(end, out, reason);
    case MATL_CLASS::Masonry:
        return MasonryHinge(end, out, reason);
    default:
        return RcHinge(end, out, reason); // refuses what is no concrete
    }
}

/// A hinge of shear in the middle where a side asks for one: the weaker end's.
void AddShear(const T_CODE_COMPONENT& bending, T_CODE_HINGE& hinge)
{
    const auto& [I, J] = bending.ends;
    T_CODE_COMPONENT shear;
    shear.component =
        bending.component == HINGE_COMPONENT::My ? HINGE_COMPONENT::Fz : HINGE_COMPONENT::Fy;
    shear.location = HINGE_LOCATION::Center;
    const T_CODE_SIDE* weakest = nullptr;
    for (const T_CODE_SIDE* side : {&I.pos, &I.neg, &J.pos, &J.neg})
        if (side->shearBone && (!weakest || side->shearBone->yield < weakest->shearBone->yield))
            weakest = side;
    if (!weakest) return;
    T_CODE_SIDE side = *weakest;
    side.bone = *side.shearBone;
    side.strength = side.strengthAtZero = side.bone.yield;
    shear.ends = {{side, side}, {side, side}};
    hinge.components.push_back(std::move(shear));
}

/// V of a push in one direction is small at the end that the loads along the member relieve.
void WarnRelieved(const T_HINGE_MEMBER& member, T_CODE_HINGE& hinge)
{
    constexpr double kMuchLess = 0.75; // of the other end's V
    if (member.HasAxial()) return;
    for (std::size_t at = 0; at + 3 < member.pushed.size(); at += 4) {
        const double I = member.pushed[at], J = member.pushed[at + 2];
        const double less = std::min(I, J), more = std::max(I, J);
        if (less > 0.0 && less < kMuchLess * more)
            hinge.warnings.push_back(
                {"IDS_QM_GEN_WARN_RELIEVED",
                 {I < J ? "I" : "J", CodeNumber(less / 1000.0), CodeNumber(more / 1000.0)}});
    }
}

/// What the hinges of a member are made for.
struct T_TASK {
    const T_MODEL& model;
    const T_HINGE_MEMBER& member;
    const T_CODE_OPTIONS& options;
};

int BothEnds(const T_TASK& task, HINGE_COMPONENT component, const T_ENDS<double>& axial,
             T_ENDS<T_SIDES<T_CODE_SIDE>>& out, std::string& reason)
{
    const auto end = [&](bool atI) {
        return EndOf(task.model, task.member, task.options, component, atI,
                     atI ? axial.I : axial.J);
    };
    if (!EndHinge(end(true), out.I, reason)) return 0;
    const auto& joints = task.member.joints;
    const bool same =
        (!task.member.HasAxial() || axial.I == axial.J) && (!joints || joints->I == joints->J);
    if (same && task.member.pushed.empty()) {
        out.J = out.I;
        return 1;
    }
    return EndHinge(end(false), out.J, reason);
}

/// Even forces from the lower to the upper end, and 0.
std::vector<double> ForcesOf(const std::vector<double>& range)
{
    constexpr int kCurves = 6;
    std::vector<double> forces{0.0};
    for (int i = 0; i < kCurves; ++i) {
        const double t = static_cast<double>(i) / (kCurves - 1);
        const double force = range[0] + t * (range[1] - range[0]);
        if (std::fabs(force) > 1e-6 * (range[1] - range[0])) forces.push_back(force);
    }
    std::ranges::sort(forces);
    return forces;
}

/// Curves of columns by axial force.
int AddByAxial(const T_TASK& task, T_CODE_COMPONENT& bending, std::string& reason)
{
    if (task.options.axialRange.empty() || !task.member.HasAxial()) return 1;
    for (const double force : ForcesOf(task.options.axialRange)) {
        T_CODE_AXIAL at;
        at.axial = force;
        std::string why;
        if (!BothEnds(task, bending.component, {force, force}, at.ends, why))
            return Refuse(reason, Say("IDS_QM_GEN_AT_AXIAL", CodeNumber(force / 1000.0), why));
        bending.byAxial.push_back(std::move(at));
    }
    return 1;
}

/// The backbones of both ends about the axes that have hinges.
int Bend(const T_TASK& task, T_CODE_HINGE& hinge, std::string& reason)
{
    for (const HINGE_COMPONENT component : task.member.bending) {
        const auto location = LocationOf(task.member, component);
        if (!location) continue;
        T_CODE_COMPONENT bending;
        bending.component = component;
        bending.location = *location;
        if (!BothEnds(task, component, task.member.axial, bending.ends, reason) ||
            !AddByAxial(task, bending, reason))
            return 0;
        WarnEarly(bending.ends.I, hinge);
        WarnEarly(bending.ends.J, hinge);
        hinge.components.push_back(bending);
        AddShear(bending, hinge);
    }
    return hinge.components.empty() ? Refuse(reason, Say("IDS_QM_PUSH_HINGE_RELEASED")) : 1;
}

/// The hinge of axial force of a brace.
int Brace(const T_TASK& task, T_CODE_HINGE& hinge, std::string& reason)
{
    T_CODE_COMPONENT axial;
    axial.component = HINGE_COMPONENT::Fx;
    axial.location = HINGE_LOCATION::Center;
    const T_MEMBER_END end =
        EndOf(task.model, task.member, task.options, HINGE_COMPONENT::My, true, 0.0);
    if (!SteelBrace(end, axial.ends.I, reason)) return 0;
    axial.ends.J = axial.ends.I;
    hinge.components.push_back(std::move(axial));
    return 1;
}

/// The curves of an end of a FEMA component by axial force.
void PutByAxial(const T_CODE_COMPONENT& b, bool atI, T_SKEL_CURVE& curve)
{
    auto* fema = std::get_if<T_SKEL_FEMA>(&curve);
    if (!fema || b.byAxial.empty()) return;
    fema->multiCurve = true;
    for (const T_CODE_AXIAL& at : b.byAxial) {
        const auto& sides = atI ? at.ends.I : at.ends.J;
        T_SKEL_AXIAL row;
        row.axial = at.axial;
        row.sides.pos = CurveSide(SideOf(sides, b.component, true), true, false);
        row.sides.neg = CurveSide(SideOf(sides, b.component, false), false, false);
        fema->curves.push_back(row);
    }
}

void Fill(const T_HINGE_MEMBER& member, bool chord, T_CODE_HINGE& hinge)
{
    T_PHGT_D& type = hinge.type;
    const bool follows = type.pmm.has_value();
    for (const T_CODE_COMPONENT& b : hinge.components) {
        T_HINGE_COMPONENT& c = type.components[static_cast<std::size_t>(b.component)];
        c.active = true;
        c.type = chord ? SKEL_TYPE::Ec8 : SKEL_TYPE::Fema;
        c.location = b.location;
        c.curves.I = CurveOf(b.ends.I, b.component, follows, chord);
        c.curves.J = CurveOf(b.ends.J, b.component, follows, chord);
        PutByAxial(b, true, c.curves.I);
        PutByAxial(b, false, c.curves.J);
        c.sameEnds = c.curves.I == c.curves.J;
        if (!chord || !std::ranges::count(member.bending, b.component)) continue;
        T_ENDS<double>& length =
            b.component == HINGE_COMPONENT::My ? type.length.My : type.length.Mz;
        length = {b.ends.I.pos.hingeLength, b.ends.J.pos.hingeLength};
    }
    if (member.length - member.clear <= 1e-9 * member.length) return;
    type.length.autoSpan = false; // the elastic part is that between the rigid offsets
    type.length.span = member.clear;
}

/// The strengths of bending by axial force.
void PutAxialCurve(const T_TASK& task, T_CODE_HINGE& hinge)
{
    std::vector<T_MEMBER_END> ends;
    const T_HINGE_MEMBER& member = task.member;
    for (const T_CODE_COMPONENT& b : hinge.components)
        if (std::ranges::count(member.bending, b.component))
            ends.push_back(
                EndOf(task.model, member, task.options, b.component, true, member.axial.I));
    T_PHGT_D& type = hinge.type;
    type.pmm = type.material == MATL_CLASS::Steel ? SteelAxialCurve(ends, member.axial)
                                                  : AxialCurve(ends, member.axial);
    if (type.pmm)
        type.interaction = HINGE_INTERACTION::User;
    else
        hinge.warnings.push_back({"IDS_QM_GEN_WARN_NO_PM", {}});
}

/// The numbers that a generator fills.
class CNumberList {
public:
    explicit CNumberList(T_PHGT_D& type)
    {
        for (T_HINGE_COMPONENT& c : type.components)
            for (T_SKEL_CURVE* curve : {&c.curves.I, &c.curves.J})
                std::visit([this](auto& filled) { Add(filled); }, *curve);
        numbers.push_back(&type.length.span);
        for (T_ENDS<double>* length : {&type.length.My, &type.length.Mz})
            numbers.insert(numbers.end(), {&length->I, &length->J});
        if (!type.pmm) return;
        numbers.push_back(&type.pmm->Pmax);
        Add(type.pmm->curves);
        if (type.pmm->negative) Add(*type.pmm->negative);
    }
    std::vector<double*> numbers;

private:
    template <class CURVE>
    void Add([[maybe_unused]] CURVE& curve)
    {
        if constexpr (!std::is_same_v<CURVE, T_SKEL_MULTI>) AddSides(curve.sides);
        if constexpr (std::is_same_v<CURVE, T_SKEL_FEMA>)
            for (T_SKEL_AXIAL& at : curve.curves) {
                numbers.push_back(&at.axial);
                AddSides(at.sides);
            }
    }
    void AddSides(T_SIDES<T_SKEL_SIDE>& sides)
    {
        for (T_SKEL_SIDE* s : {&sides.pos, &sides.neg}) {
            numbers.insert(numbers.end(), {&s->yield, &s->yieldDeform});
            numbers.insert(numbers.end(), {&s->IO, &s->LS, &s->CP});
            for (T_SKEL_POINT* p : {&s->B, &s->C, &s->D, &s->E})
                numbers.insert(numbers.end(), {&p->deform, &p->strength});
        }
    }
    void Add(T_PMM_CURVES& curves)
    {
        for (auto& curve : curves)
            for (T_PM_POINT& p : curve)
                numbers.insert(numbers.end(), {&p.p, &p.m});
    }
};

} // namespace

int MakeCodeHinge(const T_MODEL& model, const T_HINGE_MEMBER& member, const T_CODE_OPTIONS& options,
                  T_CODE_HINGE& out, std::string& reason)
{
    T_CODE_HINGE hinge;
    const T_TASK task{model, member, options};
    T_PHGT_D& type = hinge.type;
    type.material = model.materials.at(member.material).type;
    if (member.kind == MEMBER_KIND::Brace) {
        if (!Brace(task, hinge, reason)) return 0;
        if (model.elements.at(member.element).kind == ELEM_KIND::Truss)
            type.element = HINGE_ELEMENT::Truss;
    } else {
        if (!Bend(task, hinge, reason)) return 0;
        WarnRelieved(member, hinge);
        if (member.HasAxial() && type.material != MATL_CLASS::Masonry && options.axialRange.empty())
            PutAxialCurve(task, hinge);
    }
    Fill(member, IsChordCode(options.code), hinge);
    type.generated = T_GENERATED{kHingeCodeNames[static_cast<std::size_t>(options.code)],
                                 options.secondary,
                                 member.HasAxial() ? member.axial : T_ENDS<double>{},
                                 InputsOf(model, member),
                                 member.pushed,
                                 options.axialRange,
                                 options.tie,
                                 member.joints ? options.connection : std::nullopt};
    PutSeal(*type.generated);
    out = std::move(hinge);
    return 1;
}

bool SameHinge(T_PHGT_D a, T_PHGT_D b)
{
    constexpr double kDigits = 1e-6, kNothing = 1e-12;
    for (T_PHGT_D* type : {&a, &b}) {
        type->name.clear();
        type->generated.reset();
        type->section = type->sectionMaterial = 0;
    }
    const CNumberList first(a), second(b);
    if (first.numbers.size() != second.numbers.size()) return false;
    for (std::size_t i = 0; i < first.numbers.size(); ++i) {
        double& x = *first.numbers[i];
        const double y = *second.numbers[i];
        if (!(std::fabs(x - y) <= kNothing + kDigits * std::max(std::fabs(x), std::fabs(y))))
            return false;
        x = y;
    }
    return a == b;
}
