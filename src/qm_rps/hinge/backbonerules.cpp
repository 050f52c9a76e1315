#include "qm_rps/hinge/backbonerules.h"

#include "qm_rps/hinge/pointrule.h"

namespace {

using S = T_BACKBONE_SIDE;
using T_FINDINGS = std::vector<T_FINDING>;
using enum SKEL_POINT;

/// The strength rises from B to C.
bool Rises(const S& s)
{
    return Below(s.values.B.strength, s.values.C.strength) &&
           !SameStrength(s.values.C.strength, s.values.B.strength);
}
bool RisesNot(const S& s)
{
    return !Rises(s);
}
bool EndsFlat(const S& s)
{
    return SameStrength(s.values.D.strength, s.values.E.strength);
}
bool Loses(const S& s)
{
    return s.strengthLoss;
}
bool KeepsStrength(const S& s)
{
    return !s.strengthLoss;
}
/// A plastic deformation is 0 at B.
bool Ratios(const S& s)
{
    return s.ratios;
}

constexpr CPointRule kSigns[] = {
    Strengths(B).Above0(),    Deforms(B).Above0().If(Ratios), Strengths(C).Above0(),
    Strengths(D).NotBelow0(), Strengths(E).NotBelow0(),
};

constexpr CPointRule kFromOrigin[] = {Deforms(A).AtMost(B)};

constexpr CPointRule kDeformRises = Deforms(B).Below(C).If(Rises).Words(nullptr, "%s(-C) < %s(-B)");

// Deformations first, then strengths.
constexpr CPointRule kFemaOrder[] = {
    kDeformRises,
    Deforms(B).AtMost(C).If(RisesNot),
    Deforms(C).AtMost(D).AtMost(E).At(D),
    Deforms(D).Below(E).If(EndsFlat),
    Strengths(B).AtMost(C),
    Strengths(D).Below(C).At(D).If(Loses),
    Strengths(E).AtMost(D).At(E).If(Loses),
    Strengths(E).Equals(D).At(E).If(KeepsStrength),
};

// EN 1998-3: D and E always share the residual strength; without strength loss it is not below C.
constexpr CPointRule kEc8Order[] = {
    kDeformRises,
    Deforms(C).AtMost(D).AtMost(E).At(D).If(Rises),
    // The repeated C is meant.
    Deforms(B).AtMost(C).AtMost(D).AtMost(E).At(C).If(RisesNot).Words(
        "%s(C) <= %s(C) <= %s(D) <= %s(E)", nullptr),
    Deforms(D).Below(E).If(EndsFlat),
    Strengths(B).AtMost(C),
    Strengths(D).Below(C).At(D).If(Loses),
    Strengths(C).AtMost(D).If(KeepsStrength),
    Strengths(E).Equals(D).At(E).Words("%s(E) =  %s(D)", "%s(-E) =  %s(-D)"),
};

constexpr T_HINGE_RULE<S> kAcceptance[] = {
    {{.text = "IO <= LS", .field = "sides.pos.LS", .point = "LS"},
     [](const S& s) { return NotAbove(s.values.IO, s.values.LS); }},
    {{.text = "LS <= CP", .field = "sides.pos.CP", .point = "CP"},
     [](const S& s) { return NotAbove(s.values.LS, s.values.CP); }},
};

constexpr T_HINGE_RULE<S> kYield[] = {
    {{.key = {"IDS_RPS_PO_FEMA_Yield_FY_P", "IDS_RPS_PO_FEMA_Yield_FY_M"},
      .momentKey = {"IDS_RPS_PO_FEMA_Yield_MY_P", "IDS_RPS_PO_FEMA_Yield_MY_M"},
      .suffix = " > 0",
      .field = "sides.pos.yield"},
     [](const S& s) { return Below(0, s.values.yield); }},
};

template <int LOW, int HIGH>
bool Falls(const S& s)
{
    return NotAbove(s.values.energy[LOW], s.values.energy[HIGH]);
}
constexpr T_HINGE_RULE<S> kElasticEnergy[] = {
    {{.text = "A~B >= 0.0", .field = "sides.pos.energy[0]", .point = "A~B"},
     [](const S& s) { return NotAbove(0, s.values.energy[0]); }},
};
constexpr T_HINGE_RULE<S> kEnergy[] = {
    {{.text = "A~B >= C", .field = "sides.pos.energy[1]", .point = "C"}, Falls<1, 0>},
    {{.text = "C >= D", .field = "sides.pos.energy[2]", .point = "D"}, Falls<2, 1>},
    {{.text = "D >= E", .field = "sides.pos.energy[3]", .point = "E"}, Falls<3, 2>},
    {{.text = "E >= 0.0", .field = "sides.pos.energy[3]", .point = "E"},
     [](const S& s) { return NotAbove(0, s.values.energy[3]); }},
};

constexpr double kUsualTol = 1e-9; // of values that are 0 or 1
bool IsAbout(double v, double wanted)
{
    return std::fabs(v - wanted) <= kUsualTol;
}
bool Plastic(const S& s)
{
    return !s.ratios;
}
constexpr const char* kPointB = "IDS_QM_HINGE_POINT_B";
constexpr T_HINGE_RULE<S> kUsualB[] = {
    {{.message = kPointB, .text = "D(B) = 1", .field = "sides.pos.B.deform", .point = "B"},
     [](const S& s) { return IsAbout(s.values.B.deform, 1.0); },
     Ratios},
    {{.message = kPointB, .text = "D(B) = 0", .field = "sides.pos.B.deform", .point = "B"},
     [](const S& s) { return IsAbout(s.values.B.deform, 0.0); },
     Plastic},
    {{.message = kPointB, .text = "F(B) = 1", .field = "sides.pos.B.strength", .point = "B"},
     [](const S& s) { return IsAbout(s.values.B.strength, 1.0); }},
};
constexpr T_HINGE_RULE<S> kUsualCP[] = {
    {{.message = "IDS_QM_HINGE_CP_BEYOND_E",
      .text = "CP <= D(E)",
      .field = "sides.pos.CP",
      .point = "CP"},
     [](const S& s) { return NotAbove(s.values.CP, s.values.E.deform); }},
};

S Positive(const T_BACKBONE& b)
{
    return {b.pos, HINGE_SIDE::Positive, b.strengthLoss, b.ratios};
}
S Negative(const T_BACKBONE& b)
{
    S s{b.neg, HINGE_SIDE::Negative, b.strengthLoss, b.ratios};
    MirrorSide(b.neg, s.values);
    return s;
}
std::vector<S> SidesOf(const T_BACKBONE& b)
{
    if (b.symmetric) return {Positive(b)};
    return {Positive(b), Negative(b)};
}

void Walk(std::span<const CPointRule> rules, const S& side, const T_HINGE_PLACE& place,
          T_FINDINGS& out)
{
    for (const CPointRule& rule : rules)
        rule.Walk(side, place, out);
}
/// All rules on one side, then on the other.
void WalkSides(std::span<const CPointRule> rules, const T_BACKBONE& b, const T_HINGE_PLACE& place,
               T_FINDINGS& out)
{
    for (const S& side : SidesOf(b))
        Walk(rules, side, place, out);
}

} // namespace

void CheckPositiveSigns(const T_BACKBONE& b, const T_HINGE_PLACE& place, T_FINDINGS& out)
{
    Walk(kSigns, Positive(b), place, out);
}

void CheckNegativeSigns(const T_BACKBONE& b, const T_HINGE_PLACE& place, T_FINDINGS& out)
{
    if (!b.symmetric) Walk(kSigns, Negative(b), place, out);
}

void CheckFemaOrder(const T_BACKBONE& b, const T_HINGE_PLACE& place, T_FINDINGS& out)
{
    WalkSides(kFemaOrder, b, place, out);
}

void CheckEc8Order(const T_BACKBONE& b, const T_HINGE_PLACE& place, T_FINDINGS& out)
{
    WalkSides(kEc8Order, b, place, out);
}

void CheckFromOrigin(const T_BACKBONE& b, const T_HINGE_PLACE& place, T_FINDINGS& out)
{
    WalkSides(kFromOrigin, b, place, out);
}

void CheckAcceptance(const T_BACKBONE& b, const T_HINGE_PLACE& place, T_FINDINGS& out)
{
    if (b.criteria) WalkRulesBySide(kAcceptance, SidesOf(b), place, out);
}

void CheckYieldStrengths(const T_BACKBONE& b, const T_HINGE_PLACE& place, T_FINDINGS& out)
{
    if (!b.autoYield) WalkRulesBySide(kYield, SidesOf(b), place, out);
}

void CheckEnergyFactors(const T_BACKBONE& b, const T_HINGE_PLACE& place, T_FINDINGS& out)
{
    const S sides[] = {Positive(b), Negative(b)}; // a symmetric curve has both rows
    WalkRulesBySide(kElasticEnergy, sides, place, out);
    for (const S& side : sides)
        WalkRules(kEnergy, side, place.On(side.side), out);
}

void CheckUsualPoints(const T_BACKBONE& b, const T_HINGE_PLACE& place, T_FINDINGS& out)
{
    WalkRulesBySide(kUsualB, SidesOf(b), place, out);
    if (b.criteria) WalkRulesBySide(kUsualCP, SidesOf(b), place, out);
}

void MirrorSide(const T_SKEL_SIDE& pos, T_SKEL_SIDE& neg)
{
    const auto mirror = [](const T_SKEL_POINT& p) {
        return T_SKEL_POINT{0.0 - p.deform, 0.0 - p.strength};
    };
    neg.yield = pos.yield;
    neg.yieldDeform = pos.yieldDeform;
    neg.B = mirror(pos.B);
    neg.C = mirror(pos.C);
    neg.D = mirror(pos.D);
    neg.E = mirror(pos.E);
    neg.IO = 0.0 - pos.IO; // 0, not -0
    neg.LS = 0.0 - pos.LS;
    neg.CP = 0.0 - pos.CP;
}
