#include "qm_rps/hinge/curvefindings.h"

#include "qm_base/msgfunction.h"
#include "qm_base/textformat.h"
#include "qm_rps/hinge/backbonerules.h"
#include "qm_rps/hinge/pageyield.h"

#include <algorithm>
#include <cmath>

namespace {

using T_FINDINGS = std::vector<T_FINDING>;
using F = T_SKEL_FEMA;

bool InUnit(double v)
{
    return NotAbove(0, v) && NotAbove(v, 1);
}

constexpr T_HINGE_RULE<double> kDcRatio[] = {
    {{.message = "IDS_RPS_Error_Pushove_Hinge_Properties_DC_RATIO", .field = "dcRatio.pos"},
     [](const double& ratio) { return InUnit(ratio); }},
};

constexpr T_HINGE_HEAD StiffnessHead(const char* bound)
{
    return {.key = {"IDS_RPS_PO_PHGT_Initial_Stiffness"},
            .suffix = bound,
            .field = "sides.pos.userStiffness"};
}
constexpr T_HINGE_RULE<double> kFemaStiffness[] = {
    {StiffnessHead(" >= 0"), [](const double& k) { return NotAbove(0, k); }},
};
constexpr T_HINGE_RULE<double> kEc8Stiffness[] = {
    {StiffnessHead(" > 0"), [](const double& k) { return Below(0, k); }},
};

constexpr T_HINGE_RULE<F> kUnloading[] = {
    {{.key = {"IDS_RPS_PO_PHGT_UNLOADING_EXP"}, .field = "unloadExponent"},
     [](const F& f) { return NotAbove(0, f.unloadExponent); }},
    {{.key = {"IDS_RPS_PO_PHGT_UNLOADING_PRF"}, .field = "unloadProportion"},
     [](const F& f) { return InUnit(f.unloadProportion); }},
};
constexpr T_HINGE_RULE<F> kUnloadFactor[] = {
    {{.text = "-1.0 <= Unloading Stiffness Factor <= 1.0", .field = "unloadFactor"},
     [](const F& f) { return NotAbove(-1, f.unloadFactor) && NotAbove(f.unloadFactor, 1); }},
};

/// A rule of one number of each side.
void WalkSides(const T_HINGE_RULE<double> (&rules)[1], double pos, std::optional<double> neg,
               const T_HINGE_PLACE& place, T_FINDINGS& out)
{
    WalkRules(rules, pos, place.On(HINGE_SIDE::Positive), out);
    if (neg) WalkRules(rules, *neg, place.On(HINGE_SIDE::Negative), out);
}

template <class CURVE>
void CheckStiffness(const CURVE& curve, const T_SIDES<T_SKEL_SIDE>& sides, bool two,
                    const T_HINGE_RULE<double> (&rules)[1], const T_HINGE_PLACE& place,
                    T_FINDINGS& out)
{
    if (curve.initStiffness != INIT_STIFFNESS::User) return;
    const auto neg = two ? std::optional(sides.neg.userStiffness) : std::nullopt;
    WalkSides(rules, sides.pos.userStiffness, neg, place, out);
}

/// The list of curves by axial force: at least two, no force twice.
void CheckList(const F& f, const T_HINGE_PLACE& place, T_FINDINGS& out)
{
    if (f.curves.size() < 2)
        out.push_back(FindingOf(
            T_HINGE_HEAD{.message = "IDS_RPS_MULTI_CURVE_COUNT", .field = "curves"}, place));
    for (std::size_t i = 0; i < f.curves.size(); ++i) {
        const auto same = [&](const T_SKEL_AXIAL& a) { return a.axial == f.curves[i].axial; };
        const auto end = f.curves.begin() + static_cast<std::ptrdiff_t>(i);
        if (std::find_if(f.curves.begin(), end, same) == end) continue;
        const std::string rule = FormatText("Axial Force %g already exists!", f.curves[i].axial);
        out.push_back(FindingOf(T_HINGE_HEAD{.text = rule.c_str(), .field = "axial"},
                                {place.component, place.end, static_cast<int>(i)}));
    }
}

/// Calls check(sides, place) for the curve's own sides, or for those of each axial force.
template <class CHECK>
void ForEachForce(const F& f, const T_HINGE_PLACE& place, CHECK check)
{
    if (!f.multiCurve) return check(f.sides, place);
    for (std::size_t i = 0; i < f.curves.size(); ++i)
        check(f.curves[i].sides, {place.component, place.end, static_cast<int>(i)});
}

/// Findings of a group under the message of a table.
void CheckUnder(const char* key, BACKBONE_CHECK check, const T_BACKBONE& b,
                const T_HINGE_PLACE& place, T_FINDINGS& out)
{
    const std::size_t first = out.size();
    check(b, place, out);
    for (std::size_t i = first; i < out.size(); ++i) {
        out[i].messageKey = key;
        out[i].text = zql::lib::MMSGFunction::GetValue(key);
    }
}

/// A strength and the deformation that is entered for it.
template <class SIDE>
struct T_YIELD_ENTRY {
    double SIDE::*strength;
    double SIDE::*deform;
    const char *name, *field;
};
constexpr T_YIELD_ENTRY<T_SKEL_SIDE> kYieldDeform{&T_SKEL_SIDE::yield, &T_SKEL_SIDE::yieldDeform,
                                                  "yield_deform", "sides.pos.yieldDeform"};
constexpr T_YIELD_ENTRY<T_SKEL_MULTI_SIDE> kFirstDeform{
    &T_SKEL_MULTI_SIDE::P1, &T_SKEL_MULTI_SIDE::D1, "D1", "sides.pos.D1"};

/// `two`: the negative side has a user stiffness of its own.
template <class SIDE>
void WarnOfStiffness(const T_YIELD_ENTRY<SIDE>& entry, const T_SIDES<SIDE>& sides, bool symmetric,
                     bool two, const T_HINGE_PLACE& place, T_FINDINGS& out)
{
    constexpr double kApart = 0.01; // entered numbers have few digits
    const auto warn = [&](const SIDE& s, double stiffness, HINGE_SIDE side) {
        const double strength = std::fabs(s.*entry.strength), deform = std::fabs(s.*entry.deform);
        if (!(strength > 0.0 && deform > 0.0 && stiffness > 0.0)) return;
        const double acting = strength / stiffness;
        if (std::fabs(deform - acting) <= kApart * acting) return;
        const std::string text = FormatText("%.6g / %.6g = %.6g; %s = %.6g", strength, stiffness,
                                            acting, entry.name, deform);
        out.push_back(FindingOf(T_HINGE_HEAD{.message = "IDS_QM_HINGE_STIFFNESS_ACTS",
                                             .text = text.c_str(),
                                             .field = entry.field},
                                place.On(side)));
    };
    warn(sides.pos, sides.pos.userStiffness, HINGE_SIDE::Positive);
    if (!symmetric)
        warn(sides.neg, (two ? sides.neg : sides.pos).userStiffness, HINGE_SIDE::Negative);
}

} // namespace

void CurveFindings(const T_SKEL_FEMA& curve, const T_HINGE_PLACE& place, T_FINDINGS& out)
{
    using T_SIDES_OF_CURVE = T_SIDES<T_SKEL_SIDE>;
    const auto group = [&](BACKBONE_CHECK check) {
        ForEachForce(curve, place, [&](const T_SIDES_OF_CURVE& sides, const T_HINGE_PLACE& at) {
            check(CheckedSides(curve, sides), at, out);
        });
    };
    if (curve.multiCurve) CheckList(curve, place, out);
    group(CheckPositiveSigns);
    group(CheckNegativeSigns);
    group(CheckFemaOrder);
    group(CheckAcceptance);
    if (curve.dcRatio) WalkSides(kDcRatio, curve.dcRatio->pos, curve.dcRatio->neg, place, out);
    group(CheckYieldStrengths);
    ForEachForce(curve, place, [&](const T_SIDES_OF_CURVE& sides, const T_HINGE_PLACE& at) {
        CheckStiffness(curve, sides, curve.asymStiffness, kFemaStiffness, at, out);
    });
    WalkRules(kUnloading, curve, place, out);
    if (!curve.energyBased) return;
    group(CheckEnergyFactors);
    WalkRules(kUnloadFactor, curve, place, out);
}

void CurveFindings(const T_SKEL_EC8& curve, const T_HINGE_PLACE& place, T_FINDINGS& out)
{
    const T_BACKBONE b = CheckedSides(curve, curve.sides);
    for (BACKBONE_CHECK* check : {CheckPositiveSigns, CheckNegativeSigns, CheckEc8Order,
                                  CheckAcceptance, CheckYieldStrengths})
        check(b, place, out);
    CheckStiffness(curve, curve.sides, !curve.symmetric, kEc8Stiffness, place, out);
}

void CurveFindings(const T_SKEL_CURVE& curve, SKEL_TYPE type, const T_HINGE_PLACE& place,
                   T_FINDINGS& out)
{
    if (const auto* m = std::get_if<T_SKEL_MULTI>(&curve))
        CurveFindings(*m, type, place, out);
    else if (const auto* f = std::get_if<T_SKEL_FEMA>(&curve))
        CurveFindings(*f, place, out);
    else
        CurveFindings(std::get<T_SKEL_EC8>(curve), place, out);
}

void PushFindings(const T_SKEL_CURVE& curve, SKEL_TYPE type, const T_HINGE_PLACE& place,
                  T_FINDINGS& out)
{
    if (const auto* m = std::get_if<T_SKEL_MULTI>(&curve)) {
        RatioFindings(*m, type, place, out);
    } else if (const auto* f = std::get_if<T_SKEL_FEMA>(&curve)) {
        ForEachForce(*f, place, [&](const T_SIDES<T_SKEL_SIDE>& sides, const T_HINGE_PLACE& at) {
            CheckAcceptance(CheckedSides(*f, sides), at, out);
        });
    } else {
        const auto& e = std::get<T_SKEL_EC8>(curve);
        CheckAcceptance(CheckedSides(e, e.sides), place, out);
    }
}

std::vector<T_FINDING> ComponentFindings(HINGE_COMPONENT c, const T_HINGE_COMPONENT& component)
{
    T_FINDINGS out;
    if (!component.active) return out;
    ForEachPage(component, [&](HINGE_END end, const T_SKEL_CURVE& curve) {
        CurveFindings(curve, component.type, {static_cast<int>(c), end}, out);
    });
    return out;
}

std::vector<T_FINDING> DiagramFindings(const T_SKEL_FEMA& curve, HINGE_COMPONENT c)
{
    const T_BACKBONE b = CheckedSides(curve, curve.sides);
    const T_HINGE_PLACE place{static_cast<int>(c)};
    T_FINDINGS out;
    for (BACKBONE_CHECK* check :
         {CheckPositiveSigns, CheckNegativeSigns, CheckFromOrigin, CheckFemaOrder})
        CheckUnder("IDS_PUSHOVER_Wrong_Data_in_the_Hinge_Diagram_Table_", *check, b, place, out);
    CheckUnder("IDS_PUSHOVER_Wrong_Data_in_Acceptance_Criteria_", CheckAcceptance, b, place, out);
    return out;
}

void StiffnessWarnings(const T_SKEL_CURVE& curve, SKEL_TYPE type, const T_HINGE_PLACE& place,
                       T_FINDINGS& out)
{
    const bool two = HasTwoStiffnesses(curve);
    const auto* m = std::get_if<T_SKEL_MULTI>(&curve);
    if (m) {
        const bool isEntered = !m->autoYield || IsTrilinear(type); // P1
        if (!m->useDeformation || m->initStiffness != INIT_STIFFNESS::User || !isEntered) return;
        WarnOfStiffness(kFirstDeform, m->sides, m->symmetric, two, place, out);
    } else if (const auto* e = std::get_if<T_SKEL_EC8>(&curve)) {
        if (e->autoYield || e->initStiffness != INIT_STIFFNESS::User) return;
        WarnOfStiffness(kYieldDeform, e->sides, e->symmetric, two, place, out);
    } else {
        const F& f = std::get<F>(curve);
        if (f.autoYield || f.initStiffness != INIT_STIFFNESS::User) return;
        ForEachForce(f, place, [&](const T_SIDES<T_SKEL_SIDE>& sides, const T_HINGE_PLACE& at) {
            WarnOfStiffness(kYieldDeform, sides, f.symmetric, two, at, out);
        });
    }
}

void PointWarnings(const T_SKEL_CURVE& curve, const T_HINGE_PLACE& place, T_FINDINGS& out)
{
    if (const auto* e = std::get_if<T_SKEL_EC8>(&curve))
        CheckUsualPoints(CheckedSides(*e, e->sides), place, out);
    const auto* f = std::get_if<T_SKEL_FEMA>(&curve);
    if (!f || (f->infillStrut && f->infillGeneral)) return;
    ForEachForce(*f, place, [&](const T_SIDES<T_SKEL_SIDE>& sides, const T_HINGE_PLACE& at) {
        CheckUsualPoints(CheckedSides(*f, sides), at, out);
    });
}
