#include "qm_rps/hingesiderules.h"

#include "qm_db/compfunc.h"

#include <cmath>

namespace {

using B = T_BACKBONE;
using R = T_RULE<T_BACKBONE>;

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
bool RisesPos(const B& b)
{
    return b.pos.C.strength > b.pos.B.strength && !SameStrength(b.pos.C.strength, b.pos.B.strength);
}
bool RisesNeg(const B& b)
{
    return b.neg.C.strength < b.neg.B.strength && !SameStrength(b.neg.C.strength, b.neg.B.strength);
}
bool FlatEndPos(const B& b)
{
    return SameStrength(b.pos.D.strength, b.pos.E.strength);
}
bool FlatEndNeg(const B& b)
{
    return SameStrength(b.neg.D.strength, b.neg.E.strength);
}

// Conditions that stand in both order tables.
bool BelowBCPos(const B& b)
{
    return Below(b.pos.B.deform, b.pos.C.deform);
}
bool BelowBCNeg(const B& b)
{
    return Below(b.neg.C.deform, b.neg.B.deform);
}
bool ChainPos(const B& b)
{
    return NotAbove(b.pos.C.deform, b.pos.D.deform) && NotAbove(b.pos.D.deform, b.pos.E.deform);
}
bool ChainNeg(const B& b)
{
    return NotAbove(b.neg.E.deform, b.neg.D.deform) && NotAbove(b.neg.D.deform, b.neg.C.deform);
}
bool BelowDEPos(const B& b)
{
    return Below(b.pos.D.deform, b.pos.E.deform);
}
bool BelowDENeg(const B& b)
{
    return Below(b.neg.E.deform, b.neg.D.deform);
}
bool StrengthBCPos(const B& b)
{
    return NotAbove(b.pos.B.strength, b.pos.C.strength);
}
bool StrengthBCNeg(const B& b)
{
    return NotAbove(b.neg.C.strength, b.neg.B.strength);
}
bool StrengthDCPos(const B& b)
{
    return Below(b.pos.D.strength, b.pos.C.strength);
}
bool StrengthDCNeg(const B& b)
{
    return Below(b.neg.C.strength, b.neg.D.strength);
}
bool LossPos(const B& b)
{
    return b.strengthLoss;
}
bool NoLossPos(const B& b)
{
    return !b.strengthLoss;
}
bool LossNeg(const B& b)
{
    return TwoSided(b) && b.strengthLoss;
}
bool NoLossNeg(const B& b)
{
    return TwoSided(b) && !b.strengthLoss;
}

// clang-format off
const R kSignPos[] = {
    {{kMsg, kStr, "%s(B) > 0",  nullptr, "sides.pos.B.strength", kPos, "B"}, [](const B& b) { return Below(0, b.pos.B.strength); }},
    {{kMsg, kDef, "%s(B) > 0",  nullptr, "sides.pos.B.deform",   kPos, "B"}, [](const B& b) { return Below(0, b.pos.B.deform); },
     [](const B& b) { return b.ratios; }}, // a plastic deformation is 0 at B
    {{kMsg, kStr, "%s(C) > 0",  nullptr, "sides.pos.C.strength", kPos, "C"}, [](const B& b) { return Below(0, b.pos.C.strength); }},
    {{kMsg, kStr, "%s(D) >= 0", nullptr, "sides.pos.D.strength", kPos, "D"}, [](const B& b) { return NotAbove(0, b.pos.D.strength); }},
    {{kMsg, kStr, "%s(E) >= 0", nullptr, "sides.pos.E.strength", kPos, "E"}, [](const B& b) { return NotAbove(0, b.pos.E.strength); }},
};
const R kSignNeg[] = {
    {{kMsg, kStr, "%s(-B) < 0",  nullptr, "sides.neg.B.strength", kNeg, "B"}, [](const B& b) { return Below(b.neg.B.strength, 0); }, TwoSided},
    {{kMsg, kDef, "%s(-B) < 0",  nullptr, "sides.neg.B.deform",   kNeg, "B"}, [](const B& b) { return Below(b.neg.B.deform, 0); },
     [](const B& b) { return TwoSided(b) && b.ratios; }},
    {{kMsg, kStr, "%s(-C) < 0",  nullptr, "sides.neg.C.strength", kNeg, "C"}, [](const B& b) { return Below(b.neg.C.strength, 0); }, TwoSided},
    {{kMsg, kStr, "%s(-D) <= 0", nullptr, "sides.neg.D.strength", kNeg, "D"}, [](const B& b) { return NotAbove(b.neg.D.strength, 0); }, TwoSided},
    {{kMsg, kStr, "%s(-E) <= 0", nullptr, "sides.neg.E.strength", kNeg, "E"}, [](const B& b) { return NotAbove(b.neg.E.strength, 0); }, TwoSided},
};

// Deformations first, then strengths; positive side first. The spacing of the texts is meant.
const R kFemaOrder[] = {
    {{kMsg, kDef, "%s(B) <  %s(C)", nullptr, "sides.pos.C.deform", kPos, "C"}, BelowBCPos, RisesPos},
    {{kMsg, kDef, "%s(B) <= %s(C)", nullptr, "sides.pos.C.deform", kPos, "C", "", kNotLess, "%s(C)", "%s(B)"},
     [](const B& b) { return NotAbove(b.pos.B.deform, b.pos.C.deform); }, [](const B& b) { return !RisesPos(b); }},
    {{kMsg, kDef, "%s(C) <= %s(D) <= %s(E)", nullptr, "sides.pos.D.deform", kPos, "D"}, ChainPos},
    {{kMsg, kDef, "%s(D) <  %s(E)", nullptr, "sides.pos.E.deform", kPos, "E"}, BelowDEPos, FlatEndPos},
    {{kMsg, kStr, "%s(B) <= %s(C)", nullptr, "sides.pos.C.strength", kPos, "C", "", kNotLess, "%s(C)", "%s(B)"}, StrengthBCPos},
    {{kMsg, kStr, "%s(D) <  %s(C)", nullptr, "sides.pos.D.strength", kPos, "D"}, StrengthDCPos, LossPos},
    {{kMsg, kStr, "%s(E) <= %s(D)", nullptr, "sides.pos.E.strength", kPos, "E", "", kNotLess, "%s(D)", "%s(E)"},
     [](const B& b) { return NotAbove(b.pos.E.strength, b.pos.D.strength); }, LossPos},
    {{kMsg, kStr, "%s(E) = %s(D)",  nullptr, "sides.pos.E.strength", kPos, "E", "", kEqual, "%s(E)", "%s(D)"}, FlatEndPos, NoLossPos},

    {{kMsg, kDef, "%s(-C) < %s(-B)", nullptr, "sides.neg.C.deform", kNeg, "C"}, BelowBCNeg,
     [](const B& b) { return TwoSided(b) && RisesNeg(b); }},
    {{kMsg, kDef, "%s(-C) <= %s(-B)", nullptr, "sides.neg.C.deform", kNeg, "C", "", kNotLess, "%s(-B)", "%s(-C)"},
     [](const B& b) { return NotAbove(b.neg.C.deform, b.neg.B.deform); }, [](const B& b) { return TwoSided(b) && !RisesNeg(b); }},
    {{kMsg, kDef, "%s(-E) <=  %s(-D) <= %s(-C)", nullptr, "sides.neg.D.deform", kNeg, "D"}, ChainNeg, TwoSided},
    {{kMsg, kDef, "%s(-E) <  %s(-D)", nullptr, "sides.neg.E.deform", kNeg, "E"}, BelowDENeg,
     [](const B& b) { return TwoSided(b) && FlatEndNeg(b); }},
    {{kMsg, kStr, "%s(-C) <= %s(-B)", nullptr, "sides.neg.C.strength", kNeg, "C", "", kNotLess, "%s(-B)", "%s(-C)"}, StrengthBCNeg, TwoSided},
    {{kMsg, kStr, "%s(-C) <  %s(-D)", nullptr, "sides.neg.D.strength", kNeg, "D"}, StrengthDCNeg, LossNeg},
    {{kMsg, kStr, "%s(-D) <= %s(-E)", nullptr, "sides.neg.E.strength", kNeg, "E", "", kNotLess, "%s(-E)", "%s(-D)"},
     [](const B& b) { return NotAbove(b.neg.D.strength, b.neg.E.strength); }, LossNeg},
    {{kMsg, kStr, "%s(-E) = %s(-D)",  nullptr, "sides.neg.E.strength", kNeg, "E", "", kEqual, "%s(-E)", "%s(-D)"}, FlatEndNeg, NoLossNeg},
};

// EN 1998-3: D and E always share the residual strength; without strength loss it is not below C.
const R kEc8Order[] = {
    {{kMsg, kDef, "%s(B) <  %s(C)", nullptr, "sides.pos.C.deform", kPos, "C"}, BelowBCPos, RisesPos},
    {{kMsg, kDef, "%s(C) <= %s(D) <= %s(E)", nullptr, "sides.pos.D.deform", kPos, "D"}, ChainPos, RisesPos},
    {{kMsg, kDef, "%s(C) <= %s(C) <= %s(D) <= %s(E)", nullptr, "sides.pos.C.deform", kPos, "C"}, // the repeated C is meant
     [](const B& b) { return NotAbove(b.pos.B.deform, b.pos.C.deform) && ChainPos(b); }, [](const B& b) { return !RisesPos(b); }},
    {{kMsg, kDef, "%s(D) <  %s(E)", nullptr, "sides.pos.E.deform", kPos, "E"}, BelowDEPos, FlatEndPos},
    {{kMsg, kStr, "%s(B) <= %s(C)", nullptr, "sides.pos.C.strength", kPos, "C", "", kNotLess, "%s(C)", "%s(B)"}, StrengthBCPos},
    {{kMsg, kStr, "%s(D) <  %s(C)", nullptr, "sides.pos.D.strength", kPos, "D"}, StrengthDCPos, LossPos},
    {{kMsg, kStr, "%s(C) <= %s(D)", nullptr, "sides.pos.D.strength", kPos, "D", "", kNotLess, "%s(D)", "%s(C)"},
     [](const B& b) { return NotAbove(b.pos.C.strength, b.pos.D.strength); }, NoLossPos},
    {{kMsg, kStr, "%s(E) =  %s(D)", nullptr, "sides.pos.E.strength", kPos, "E", "", kEqual, "%s(E)", "%s(D)"}, FlatEndPos},

    {{kMsg, kDef, "%s(-C) < %s(-B)", nullptr, "sides.neg.C.deform", kNeg, "C"}, BelowBCNeg,
     [](const B& b) { return TwoSided(b) && RisesNeg(b); }},
    {{kMsg, kDef, "%s(-E) <=  %s(-D) <= %s(-C)", nullptr, "sides.neg.D.deform", kNeg, "D"}, ChainNeg,
     [](const B& b) { return TwoSided(b) && RisesNeg(b); }},
    {{kMsg, kDef, "%s(-E) <=  %s(-D) <= %s(-C) <= %s(-B)", nullptr, "sides.neg.C.deform", kNeg, "C"},
     [](const B& b) { return NotAbove(b.neg.C.deform, b.neg.B.deform) && ChainNeg(b); }, [](const B& b) { return TwoSided(b) && !RisesNeg(b); }},
    {{kMsg, kDef, "%s(-E) <  %s(-D)", nullptr, "sides.neg.E.deform", kNeg, "E"}, BelowDENeg,
     [](const B& b) { return TwoSided(b) && FlatEndNeg(b); }},
    {{kMsg, kStr, "%s(-C) <= %s(-B)", nullptr, "sides.neg.C.strength", kNeg, "C", "", kNotLess, "%s(-B)", "%s(-C)"}, StrengthBCNeg, TwoSided},
    {{kMsg, kStr, "%s(-C) <  %s(-D)", nullptr, "sides.neg.D.strength", kNeg, "D"}, StrengthDCNeg, LossNeg},
    {{kMsg, kStr, "%s(-D) <= %s(-C)", nullptr, "sides.neg.D.strength", kNeg, "D", "", kNotLess, "%s(-C)", "%s(-D)"},
     [](const B& b) { return NotAbove(b.neg.D.strength, b.neg.C.strength); }, NoLossNeg},
    {{kMsg, kStr, "%s(-E) =  %s(-D)", nullptr, "sides.neg.E.strength", kNeg, "E", "", kEqual, "%s(-E)", "%s(-D)"}, FlatEndNeg, TwoSided},
};

const R kAcceptance[] = {
    {{kMsg, kLit, "IO <= LS", nullptr, "sides.pos.LS", kPos, "LS"}, [](const B& b) { return NotAbove(b.pos.IO, b.pos.LS); }},
    {{kMsg, kLit, "IO <= LS", nullptr, "sides.neg.LS", kNeg, "LS"}, [](const B& b) { return NotAbove(b.neg.LS, b.neg.IO); }, TwoSided},
    {{kMsg, kLit, "LS <= CP", nullptr, "sides.pos.CP", kPos, "CP"}, [](const B& b) { return NotAbove(b.pos.LS, b.pos.CP); }},
    {{kMsg, kLit, "LS <= CP", nullptr, "sides.neg.CP", kNeg, "CP"}, [](const B& b) { return NotAbove(b.neg.CP, b.neg.LS); }, TwoSided},
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
