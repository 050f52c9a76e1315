#include "qm_rps/hinge/hingesiderules.h"

#include "qm_db/compfunc.h"

#include <cmath>

namespace {

using B = T_BACKBONE;
using R = T_HINGE_RULE<T_BACKBONE>;

constexpr double kStrengthTol = 1e-9; // of strength / yield strength
constexpr const char* kMsg = kHingeRuleMessage;
constexpr auto kDef = RULE_TEXT::Deform;
constexpr auto kStr = RULE_TEXT::Strength;
constexpr auto kLit = RULE_TEXT::Literal;
constexpr auto kKey = RULE_TEXT::Key;
constexpr auto kPos = HINGE_SIDE::Positive;
constexpr auto kNeg = HINGE_SIDE::Negative;
constexpr const char* kEqual = "IDS_RPS_PO_FEMA_EQUAL_TO";
constexpr const char* kNotLess = "IDS_RPS_PO_FEMA_EQUAL_TO_OR_LARGER_THAN";

bool TwoSided(const B& b)
{
    return !b.symmetric;
}

// Conditions of one side, S = 1 or -1: values times S, so that the negative side reads like the
// positive one.
template <int S>
const T_SKEL_SIDE& Side(const B& b)
{
    return S > 0 ? b.pos : b.neg;
}
template <int S>
bool Applies(const B& b)
{
    return S > 0 || TwoSided(b);
}
using T_POINT_OF = T_SKEL_POINT T_SKEL_SIDE::*;
constexpr T_POINT_OF kB = &T_SKEL_SIDE::B, kC = &T_SKEL_SIDE::C, kD = &T_SKEL_SIDE::D,
                     kE = &T_SKEL_SIDE::E;
using T_VALUE_OF = double T_SKEL_POINT::*;
constexpr T_VALUE_OF kDeform = &T_SKEL_POINT::deform, kStrength = &T_SKEL_POINT::strength;

template <int S, T_VALUE_OF V, T_POINT_OF P>
double Value(const B& b)
{
    return S * (Side<S>(b).*P.*V);
}
template <int S, T_VALUE_OF V, T_POINT_OF P>
bool Above0(const B& b)
{
    return Below(0, Value<S, V, P>(b));
}
template <int S, T_VALUE_OF V, T_POINT_OF P>
bool NotBelow0(const B& b)
{
    return NotAbove(0, Value<S, V, P>(b));
}
template <int S, T_VALUE_OF V, T_POINT_OF P, T_POINT_OF Q>
bool Less(const B& b)
{
    return Below(Value<S, V, P>(b), Value<S, V, Q>(b));
}
template <int S, T_VALUE_OF V, T_POINT_OF P, T_POINT_OF Q>
bool NotMore(const B& b)
{
    return NotAbove(Value<S, V, P>(b), Value<S, V, Q>(b));
}
template <int S>
bool Chain(const B& b)
{
    return NotMore<S, kDeform, kC, kD>(b) && NotMore<S, kDeform, kD, kE>(b);
}
template <int S>
bool ChainFromB(const B& b)
{
    return NotMore<S, kDeform, kB, kC>(b) && Chain<S>(b);
}
/// The strength rises from B to C.
template <int S>
bool Up(const B& b)
{
    return Less<S, kStrength, kB, kC>(b) &&
           !SameStrength(Side<S>(b).C.strength, Side<S>(b).B.strength);
}
template <int S>
bool Rises(const B& b)
{
    return Applies<S>(b) && Up<S>(b);
}
template <int S>
bool RisesNot(const B& b)
{
    return Applies<S>(b) && !Up<S>(b);
}
template <int S>
bool FlatEnd(const B& b)
{
    return SameStrength(Side<S>(b).D.strength, Side<S>(b).E.strength);
}
template <int S>
bool EndsFlat(const B& b)
{
    return Applies<S>(b) && FlatEnd<S>(b);
}
/// A plastic deformation is 0 at B.
template <int S>
bool Ratios(const B& b)
{
    return Applies<S>(b) && b.ratios;
}
template <int S>
bool Loss(const B& b)
{
    return Applies<S>(b) && b.strengthLoss;
}
template <int S>
bool NoLoss(const B& b)
{
    return Applies<S>(b) && !b.strengthLoss;
}
template <int S>
bool Criteria(const B& b)
{
    return Applies<S>(b) && b.criteria;
}
template <int S, double T_SKEL_SIDE::*LOW, double T_SKEL_SIDE::*HIGH>
bool InOrder(const B& b)
{
    return NotAbove(S * (Side<S>(b).*LOW), S * (Side<S>(b).*HIGH));
}
constexpr auto kIO = &T_SKEL_SIDE::IO, kLS = &T_SKEL_SIDE::LS, kCP = &T_SKEL_SIDE::CP;

// clang-format off
const R kSignPos[] = {
    {{kMsg, kStr, "%s(B) > 0",  nullptr, "sides.pos.B.strength", kPos, "B"}, Above0<1, kStrength, kB>},
    {{kMsg, kDef, "%s(B) > 0",  nullptr, "sides.pos.B.deform",   kPos, "B"}, Above0<1, kDeform, kB>, Ratios<1>},
    {{kMsg, kStr, "%s(C) > 0",  nullptr, "sides.pos.C.strength", kPos, "C"}, Above0<1, kStrength, kC>},
    {{kMsg, kStr, "%s(D) >= 0", nullptr, "sides.pos.D.strength", kPos, "D"}, NotBelow0<1, kStrength, kD>},
    {{kMsg, kStr, "%s(E) >= 0", nullptr, "sides.pos.E.strength", kPos, "E"}, NotBelow0<1, kStrength, kE>},
};
const R kSignNeg[] = {
    {{kMsg, kStr, "%s(-B) < 0",  nullptr, "sides.neg.B.strength", kNeg, "B"}, Above0<-1, kStrength, kB>, TwoSided},
    {{kMsg, kDef, "%s(-B) < 0",  nullptr, "sides.neg.B.deform",   kNeg, "B"}, Above0<-1, kDeform, kB>, Ratios<-1>},
    {{kMsg, kStr, "%s(-C) < 0",  nullptr, "sides.neg.C.strength", kNeg, "C"}, Above0<-1, kStrength, kC>, TwoSided},
    {{kMsg, kStr, "%s(-D) <= 0", nullptr, "sides.neg.D.strength", kNeg, "D"}, NotBelow0<-1, kStrength, kD>, TwoSided},
    {{kMsg, kStr, "%s(-E) <= 0", nullptr, "sides.neg.E.strength", kNeg, "E"}, NotBelow0<-1, kStrength, kE>, TwoSided},
};

// Deformations first, then strengths; positive side first. The spacing of the texts is meant.
const R kFemaOrder[] = {
    {{kMsg, kDef, "%s(B) <  %s(C)", nullptr, "sides.pos.C.deform", kPos, "C"}, Less<1, kDeform, kB, kC>, Rises<1>},
    {{kMsg, kDef, "%s(B) <= %s(C)", nullptr, "sides.pos.C.deform", kPos, "C", "", kNotLess, "%s(C)", "%s(B)"},
     NotMore<1, kDeform, kB, kC>, RisesNot<1>},
    {{kMsg, kDef, "%s(C) <= %s(D) <= %s(E)", nullptr, "sides.pos.D.deform", kPos, "D"}, Chain<1>},
    {{kMsg, kDef, "%s(D) <  %s(E)", nullptr, "sides.pos.E.deform", kPos, "E"}, Less<1, kDeform, kD, kE>, FlatEnd<1>},
    {{kMsg, kStr, "%s(B) <= %s(C)", nullptr, "sides.pos.C.strength", kPos, "C", "", kNotLess, "%s(C)", "%s(B)"}, NotMore<1, kStrength, kB, kC>},
    {{kMsg, kStr, "%s(D) <  %s(C)", nullptr, "sides.pos.D.strength", kPos, "D"}, Less<1, kStrength, kD, kC>, Loss<1>},
    {{kMsg, kStr, "%s(E) <= %s(D)", nullptr, "sides.pos.E.strength", kPos, "E", "", kNotLess, "%s(D)", "%s(E)"},
     NotMore<1, kStrength, kE, kD>, Loss<1>},
    {{kMsg, kStr, "%s(E) = %s(D)",  nullptr, "sides.pos.E.strength", kPos, "E", "", kEqual, "%s(E)", "%s(D)"}, FlatEnd<1>, NoLoss<1>},

    {{kMsg, kDef, "%s(-C) < %s(-B)", nullptr, "sides.neg.C.deform", kNeg, "C"}, Less<-1, kDeform, kB, kC>,
     Rises<-1>},
    {{kMsg, kDef, "%s(-C) <= %s(-B)", nullptr, "sides.neg.C.deform", kNeg, "C", "", kNotLess, "%s(-B)", "%s(-C)"},
     NotMore<-1, kDeform, kB, kC>, RisesNot<-1>},
    {{kMsg, kDef, "%s(-E) <=  %s(-D) <= %s(-C)", nullptr, "sides.neg.D.deform", kNeg, "D"}, Chain<-1>, TwoSided},
    {{kMsg, kDef, "%s(-E) <  %s(-D)", nullptr, "sides.neg.E.deform", kNeg, "E"}, Less<-1, kDeform, kD, kE>,
     EndsFlat<-1>},
    {{kMsg, kStr, "%s(-C) <= %s(-B)", nullptr, "sides.neg.C.strength", kNeg, "C", "", kNotLess, "%s(-B)", "%s(-C)"}, NotMore<-1, kStrength, kB, kC>, TwoSided},
    {{kMsg, kStr, "%s(-C) <  %s(-D)", nullptr, "sides.neg.D.strength", kNeg, "D"}, Less<-1, kStrength, kD, kC>, Loss<-1>},
    {{kMsg, kStr, "%s(-D) <= %s(-E)", nullptr, "sides.neg.E.strength", kNeg, "E", "", kNotLess, "%s(-E)", "%s(-D)"},
     NotMore<-1, kStrength, kE, kD>, Loss<-1>},
    {{kMsg, kStr, "%s(-E) = %s(-D)",  nullptr, "sides.neg.E.strength", kNeg, "E", "", kEqual, "%s(-E)", "%s(-D)"}, FlatEnd<-1>, NoLoss<-1>},
};

// EN 1998-3: D and E always share the residual strength; without strength loss it is not below C.
const R kEc8Order[] = {
    {{kMsg, kDef, "%s(B) <  %s(C)", nullptr, "sides.pos.C.deform", kPos, "C"}, Less<1, kDeform, kB, kC>, Rises<1>},
    {{kMsg, kDef, "%s(C) <= %s(D) <= %s(E)", nullptr, "sides.pos.D.deform", kPos, "D"}, Chain<1>, Rises<1>},
    {{kMsg, kDef, "%s(C) <= %s(C) <= %s(D) <= %s(E)", nullptr, "sides.pos.C.deform", kPos, "C"}, // the repeated C is meant
     ChainFromB<1>, RisesNot<1>},
    {{kMsg, kDef, "%s(D) <  %s(E)", nullptr, "sides.pos.E.deform", kPos, "E"}, Less<1, kDeform, kD, kE>, FlatEnd<1>},
    {{kMsg, kStr, "%s(B) <= %s(C)", nullptr, "sides.pos.C.strength", kPos, "C", "", kNotLess, "%s(C)", "%s(B)"}, NotMore<1, kStrength, kB, kC>},
    {{kMsg, kStr, "%s(D) <  %s(C)", nullptr, "sides.pos.D.strength", kPos, "D"}, Less<1, kStrength, kD, kC>, Loss<1>},
    {{kMsg, kStr, "%s(C) <= %s(D)", nullptr, "sides.pos.D.strength", kPos, "D", "", kNotLess, "%s(D)", "%s(C)"},
     NotMore<1, kStrength, kC, kD>, NoLoss<1>},
    {{kMsg, kStr, "%s(E) =  %s(D)", nullptr, "sides.pos.E.strength", kPos, "E", "", kEqual, "%s(E)", "%s(D)"}, FlatEnd<1>},

    {{kMsg, kDef, "%s(-C) < %s(-B)", nullptr, "sides.neg.C.deform", kNeg, "C"}, Less<-1, kDeform, kB, kC>,
     Rises<-1>},
    {{kMsg, kDef, "%s(-E) <=  %s(-D) <= %s(-C)", nullptr, "sides.neg.D.deform", kNeg, "D"}, Chain<-1>,
     Rises<-1>},
    {{kMsg, kDef, "%s(-E) <=  %s(-D) <= %s(-C) <= %s(-B)", nullptr, "sides.neg.C.deform", kNeg, "C"},
     ChainFromB<-1>, RisesNot<-1>},
    {{kMsg, kDef, "%s(-E) <  %s(-D)", nullptr, "sides.neg.E.deform", kNeg, "E"}, Less<-1, kDeform, kD, kE>,
     EndsFlat<-1>},
    {{kMsg, kStr, "%s(-C) <= %s(-B)", nullptr, "sides.neg.C.strength", kNeg, "C", "", kNotLess, "%s(-B)", "%s(-C)"}, NotMore<-1, kStrength, kB, kC>, TwoSided},
    {{kMsg, kStr, "%s(-C) <  %s(-D)", nullptr, "sides.neg.D.strength", kNeg, "D"}, Less<-1, kStrength, kD, kC>, Loss<-1>},
    {{kMsg, kStr, "%s(-D) <= %s(-C)", nullptr, "sides.neg.D.strength", kNeg, "D", "", kNotLess, "%s(-C)", "%s(-D)"},
     NotMore<-1, kStrength, kC, kD>, NoLoss<-1>},
    {{kMsg, kStr, "%s(-E) =  %s(-D)", nullptr, "sides.neg.E.strength", kNeg, "E", "", kEqual, "%s(-E)", "%s(-D)"}, FlatEnd<-1>, TwoSided},
};

const R kAcceptance[] = {
    {{kMsg, kLit, "IO <= LS", nullptr, "sides.pos.LS", kPos, "LS"}, InOrder<1, kIO, kLS>, Criteria<1>},
    {{kMsg, kLit, "IO <= LS", nullptr, "sides.neg.LS", kNeg, "LS"}, InOrder<-1, kIO, kLS>, Criteria<-1>},
    {{kMsg, kLit, "LS <= CP", nullptr, "sides.pos.CP", kPos, "CP"}, InOrder<1, kLS, kCP>, Criteria<1>},
    {{kMsg, kLit, "LS <= CP", nullptr, "sides.neg.CP", kNeg, "CP"}, InOrder<-1, kLS, kCP>, Criteria<-1>},
};

const R kYield[] = {
    {{kMsg, kKey, "IDS_RPS_PO_FEMA_Yield_FY_P", "IDS_RPS_PO_FEMA_Yield_MY_P", "sides.pos.yield", kPos, "", " > 0"},
     [](const B& b) { return Below(0, b.pos.yield); }, [](const B& b) { return !b.autoYield; }},
    {{kMsg, kKey, "IDS_RPS_PO_FEMA_Yield_FY_M", "IDS_RPS_PO_FEMA_Yield_MY_M", "sides.neg.yield", kNeg, "", " > 0"},
     [](const B& b) { return Below(0, b.neg.yield); }, [](const B& b) { return !b.autoYield && TwoSided(b); }},
};
// clang-format on

} // namespace

T_BACKBONE_RULES PositiveSignRules()
{
    return kSignPos;
}
T_BACKBONE_RULES NegativeSignRules()
{
    return kSignNeg;
}
T_BACKBONE_RULES FemaOrderRules()
{
    return kFemaOrder;
}
T_BACKBONE_RULES Ec8OrderRules()
{
    return kEc8Order;
}
T_BACKBONE_RULES AcceptanceRules()
{
    return kAcceptance;
}
T_BACKBONE_RULES YieldStrengthRules()
{
    return kYield;
}

bool Below(double a, double b)
{
    return std::isfinite(a) && std::isfinite(b) && a < b;
}

bool NotAbove(double a, double b)
{
    return std::isfinite(a) && std::isfinite(b) && a <= b;
}

bool SameStrength(double a, double b)
{
    return std::isfinite(a) && std::isfinite(b) && CCompFunc::CompRealTol(a, b, kStrengthTol) == 0;
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
