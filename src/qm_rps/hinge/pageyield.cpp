#include "qm_rps/hinge/pageyield.h"

#include "qm_rps/hinge/hingetypefindings.h"

#include <algorithm>

namespace {

double EnteredYield(const T_SKEL_SIDE& side, SKEL_TYPE)
{
    return side.yield;
}
double EnteredYield(const T_SKEL_MULTI_SIDE& side, SKEL_TYPE type)
{
    return IsTrilinear(type) ? side.P2 : side.P1;
}

double EnteredCrack(const T_SKEL_SIDE&, SKEL_TYPE)
{
    return 0.0;
}
double EnteredCrack(const T_SKEL_MULTI_SIDE& side, SKEL_TYPE type)
{
    return IsTrilinear(type) ? side.P1 : 0.0;
}

/// The sides of a curve that count without an axial force.
template <class CURVE>
auto SidesInUse(const CURVE& curve)
{
    if constexpr (std::is_same_v<CURVE, T_SKEL_FEMA>)
        return SidesWithoutForce(curve);
    else
        return curve.sides;
}

/// The neighbours of 0 in the list; either is null where there is none on its side.
struct T_AROUND_0 {
    const T_SKEL_AXIAL* below = nullptr; // or at 0
    const T_SKEL_AXIAL* above = nullptr; // or at 0
};
T_AROUND_0 Around0(const std::vector<T_SKEL_AXIAL>& curves)
{
    T_AROUND_0 at;
    for (const T_SKEL_AXIAL& c : curves) {
        if (c.axial <= 0.0 && (!at.below || c.axial > at.below->axial)) at.below = &c;
        if (c.axial >= 0.0 && (!at.above || c.axial < at.above->axial)) at.above = &c;
    }
    return at;
}

/// a at t = 0, b at t = 1; of the values that depend on the axial force.
T_SKEL_SIDE Between(const T_SKEL_SIDE& a, const T_SKEL_SIDE& b, double t)
{
    T_SKEL_SIDE side = t < 0.5 ? a : b;
    side.yield = a.yield + t * (b.yield - a.yield);
    side.userStiffness = a.userStiffness + t * (b.userStiffness - a.userStiffness);
    return side;
}

/// What the type's own section and material give, or null.
const CHingeSources::T_RESULT* ResultOf(const T_HINGE_OWNER& owner)
{
    const T_PHGT_D& type = owner.type;
    const auto* result =
        owner.sources ? owner.sources->Strength(type.section, type.sectionMaterial) : nullptr;
    return result && result->fault == SECT_FAULT::None ? result : nullptr;
}

void PutYield(T_SKEL_SIDE& side, SKEL_TYPE, double yield)
{
    side.yield = yield;
}
void PutYield(T_SKEL_MULTI_SIDE& side, SKEL_TYPE type, double yield)
{
    (IsTrilinear(type) ? side.P2 : side.P1) = yield;
}
void PutDeform(T_SKEL_SIDE& side, double deform)
{
    side.yieldDeform = deform;
}
void PutDeform(T_SKEL_MULTI_SIDE&, double) {} // has none

std::optional<double> DeformOf(HINGE_COMPONENT c, HINGE_LOCATION end, INIT_STIFFNESS option,
                               double userStiffness, const T_THETA_LOOKUP& lookup,
                               std::optional<double> yield)
{
    if (!yield) return std::nullopt;
    const double deform =
        IsMoment(c) ? CHingeTheta::CalcThetaMoment(lookup, c, end, option, userStiffness, *yield)
                    : CHingeTheta::CalcThetaShear(lookup, c, end, option, userStiffness, *yield);
    return deform != 0.0 ? std::optional(deform) : std::nullopt; // 0: it has none
}

} // namespace

T_PAGE_STRENGTH PageStrength(const T_SKEL_CURVE& curve, SKEL_TYPE type, HINGE_COMPONENT c,
                             const CHingeSources::T_RESULT& result)
{
    T_PAGE_STRENGTH s;
    std::visit(
        [&](const auto& k) {
            const auto sides = SidesInUse(k);
            const auto& neg = k.symmetric ? sides.pos : sides.neg;
            s.crack = {EnteredCrack(sides.pos, type), EnteredCrack(neg, type)};
            if (!k.autoYield)
                s.yield = {EnteredYield(sides.pos, type), EnteredYield(neg, type)};
            else if (const auto& found = result.strength.yield[static_cast<std::size_t>(c)])
                s.yield = {found->pos, found->neg};
        },
        curve);
    return s;
}

T_SIDES<T_SKEL_SIDE> SidesWithoutForce(const T_SKEL_FEMA& curve)
{
    if (!curve.multiCurve || curve.curves.empty()) return curve.sides;
    const auto [below, above] = Around0(curve.curves);
    if (!below || !above) return (below ? below : above)->sides;
    const double width = above->axial - below->axial;
    const double t = width > 0.0 ? -below->axial / width : 0.0;
    return {Between(below->sides.pos, above->sides.pos, t),
            Between(below->sides.neg, above->sides.neg, t)};
}

std::optional<double> ForceAwayFrom0(const T_SKEL_FEMA& curve)
{
    if (!curve.multiCurve || curve.curves.empty()) return std::nullopt;
    const auto [below, above] = Around0(curve.curves);
    if (below && above) return std::nullopt;
    return (below ? below : above)->axial;
}

T_THETA_LOOKUP LookupOf(const T_PHGT_D& type, const T_SECT_D* section, const T_MATL_D* material,
                        double memberLength)
{
    T_THETA_LOOKUP lookup{section, material, memberLength};
    if (!type.length.autoSpan) lookup.memberLength = type.length.span;
    lookup.perLength = type.definition != HINGE_DEFINITION::MomentRotation;
    lookup.needsSection = HasLineElement(type);
    return lookup;
}

T_SIDE_VALUES PageDeform(const T_SKEL_CURVE& curve, HINGE_COMPONENT c, HINGE_LOCATION end,
                         const T_THETA_LOOKUP& lookup, const T_SIDE_VALUES& yield)
{
    return std::visit(
        [&](const auto& k) -> T_SIDE_VALUES {
            const auto sides = SidesInUse(k);
            const auto& neg = HasTwoStiffnesses(curve) ? sides.neg : sides.pos;
            const auto deform = [&](double user, const std::optional<double>& strength) {
                return DeformOf(c, end, k.initStiffness, user, lookup, strength);
            };
            return {deform(sides.pos.userStiffness, yield.pos),
                    deform(neg.userStiffness, yield.neg)};
        },
        curve);
}

bool HasTwoStiffnesses(const T_SKEL_CURVE& curve)
{
    return std::visit(
        [](const auto& k) {
            if constexpr (requires { k.asymStiffness; })
                return k.asymStiffness;
            else
                return !k.symmetric;
        },
        curve);
}

T_PAGE_VALUES CalculatedPage(const T_HINGE_OWNER& owner, HINGE_COMPONENT c, HINGE_END end,
                             const T_SKEL_CURVE& curve)
{
    T_PAGE_VALUES values;
    const auto* fema = std::get_if<T_SKEL_FEMA>(&curve);
    if (!IsAutoYield(curve) || (fema && fema->multiCurve)) return values;
    const T_PHGT_D& type = owner.type;
    const auto* result = ResultOf(owner);
    if (!result) return values;
    values.yield = PageStrength(curve, At(type, c).type, c, *result).yield;
    // Without a span of the type the member's length counts, which is not known here.
    const T_THETA_LOOKUP lookup = LookupOf(type, owner.sources->Section(type.section),
                                           owner.sources->Material(type.sectionMaterial), 0.0);
    const auto at = end == HINGE_END::J ? HINGE_LOCATION::JEnd : HINGE_LOCATION::IEnd;
    values.deform = PageDeform(curve, c, at, lookup, values.yield);
    return values;
}

void PutCalculated(const T_PAGE_VALUES& values, SKEL_TYPE type, T_SKEL_CURVE& curve)
{
    std::visit(
        [&](auto& k) {
            if (values.yield.pos) PutYield(k.sides.pos, type, *values.yield.pos);
            if (values.yield.neg) PutYield(k.sides.neg, type, *values.yield.neg);
            if (values.deform.pos) PutDeform(k.sides.pos, *values.deform.pos);
            if (values.deform.neg) PutDeform(k.sides.neg, *values.deform.neg);
        },
        curve);
}

bool IsYieldShown(const T_SKEL_CURVE& curve, const T_PAGE_VALUES& values)
{
    return !IsAutoYield(curve) || values.yield.pos;
}

std::optional<T_YIELD_LEVEL> CalculatedLevel(const T_HINGE_OWNER& owner)
{
    const auto* result = ResultOf(owner);
    return result ? std::optional(result->strength.level) : std::nullopt;
}
