// Rules of bilinear, trilinear, slip and compression-only curves. Both sides hold magnitudes.
#include "qm_db/compfunc.h"
#include "qm_rps/hinge/curvefindings.h"

namespace {

constexpr double kTol = 1e-9; // in the units of the values

/// One side of a curve and what its rules ask for.
struct T_MULTI_SIDE {
    const T_SKEL_MULTI& m;
    const T_SKEL_MULTI_SIDE& v;
    HINGE_SIDE side;
    bool tri = false, slip = false;
};
using S = T_MULTI_SIDE;
using R = T_HINGE_RULE<S>;
constexpr const char* kItem = kHingeItemMessage;

int Compare(double a, double b)
{
    return CCompFunc::CompRealTol(a, b, kTol);
}
bool Above0(double v)
{
    return std::isfinite(v) && Compare(v, 0.0) > 0;
}
bool NotBelow0(double v)
{
    return std::isfinite(v) && Compare(v, 0.0) >= 0;
}
bool NotMore(double a, double b)
{
    return std::isfinite(a) && std::isfinite(b) && Compare(a, b) <= 0;
}
/// Equal deformations are allowed for equal strengths alone.
bool Rises(double d1, double d2, double p1, double p2)
{
    return Compare(d1, d2) != 0 || !(p2 - p1 > kTol);
}

using T_VALUE = double T_SKEL_MULTI_SIDE::*;
template <T_VALUE V>
bool Positive(const S& s)
{
    return Above0(s.v.*V);
}
template <T_VALUE V>
bool NotNegative(const S& s)
{
    return NotBelow0(s.v.*V);
}
template <T_VALUE LOW, T_VALUE HIGH>
bool InOrder(const S& s)
{
    return NotMore(s.v.*LOW, s.v.*HIGH);
}
constexpr T_VALUE kP1 = &T_SKEL_MULTI_SIDE::P1, kP2 = &T_SKEL_MULTI_SIDE::P2,
                  kP3 = &T_SKEL_MULTI_SIDE::P3, kD1 = &T_SKEL_MULTI_SIDE::D1,
                  kD2 = &T_SKEL_MULTI_SIDE::D2, kD3 = &T_SKEL_MULTI_SIDE::D3;

bool EntersBilinear(const S& s)
{
    return !s.m.autoYield && !s.tri;
}
bool EntersTrilinear(const S& s)
{
    return !s.m.autoYield && s.tri;
}
/// Calculated strengths have no crack strength; it is entered.
bool EntersCrack(const S& s)
{
    return s.m.autoYield && s.tri;
}
bool EntersUltimate(const S& s)
{
    return s.m.useUltimate;
}
bool EntersDeforms(const S& s)
{
    return s.m.useDeformation;
}
bool EntersThirdDeform(const S& s)
{
    return s.m.useDeformation && s.tri;
}
bool EntersRatios(const S& s)
{
    return !s.m.useDeformation;
}
bool EntersSecondRatio(const S& s)
{
    return !s.m.useDeformation && s.tri;
}
bool HasGap(const S& s)
{
    const GAP_SIDES other =
        s.side == HINGE_SIDE::Positive ? GAP_SIDES::Negative : GAP_SIDES::Positive;
    return s.slip && s.m.gapSides != other;
}
bool HasUserStiffness(const S& s)
{
    return s.m.initStiffness == INIT_STIFFNESS::User;
}

// clang-format off
constexpr R kStrengths[] = {
    {{.message = kItem, .key = {"IDS_DB_YIELD_FORCE_POS1", "IDS_DB_YIELD_FORCE_NEG1"},
      .momentKey = {"IDS_DB_YIELD_MOMENT_POS1", "IDS_DB_YIELD_MOMENT_NEG1"},
      .field = "sides.pos.P1", .point = "P1"}, Positive<kP1>, EntersBilinear},
    {{.message = kItem, .key = {"IDS_DB_YIELD_FORCE_POS", "IDS_DB_YIELD_FORCE_NEG"},
      .momentKey = {"IDS_DB_YIELD_MOMENT_POS", "IDS_DB_YIELD_MOMENT_NEG"},
      .field = "sides.pos.P2", .point = "P2"}, Positive<kP2>, EntersTrilinear},
    {{.message = kItem, .key = {"IDS_DB_CRACK_FORCE_COMP_PLUS", "IDS_DB_CRACK_FORCE_COMP_MNUS"},
      .field = "sides.pos.P1", .point = "P1"}, InOrder<kP1, kP2>, EntersTrilinear},
    {{.message = "IDS_QM_HINGE_NO_CRACK", .text = "P1 > 0", .field = "sides.pos.P1",
      .point = "P1"}, Positive<kP1>, EntersCrack},
    {{.message = kItem, .key = {"IDS_DB_ULTIMATE_FORCE_POS", "IDS_DB_ULTIMATE_FORCE_NEG"},
      .momentKey = {"IDS_DB_ULTIMATE_MOMENT_POS", "IDS_DB_ULTIMATE_MOMENT_NEG"},
      .field = "sides.pos.P3", .point = "P3"}, Positive<kP3>, EntersUltimate},
    {{.message = kItem, .key = {"IDS_DB_YIELD_FORCE_COMP_PLUS", "IDS_DB_YIELD_FORCE_COMP_MNUS"},
      .field = "sides.pos.P2", .point = "P2"}, InOrder<kP2, kP3>, EntersUltimate},
};
constexpr R kDeforms[] = {
    {{.message = kItem, .key = {"IDS_DB_1ST_YIELD_DISP"}, .momentKey = {"IDS_DB_1ST_YIELD_ROTN"},
      .field = "sides.pos.D1", .point = "D1"}, Positive<kD1>, EntersDeforms},
    {{.message = kItem, .key = {"IDS_DB_2ND_YIELD_DISP"}, .momentKey = {"IDS_DB_2ND_YIELD_ROTN"},
      .field = "sides.pos.D2", .point = "D2"}, Positive<kD2>, EntersDeforms},
    {{.message = kItem, .key = {"IDS_DB_3RD_YIELD_DISP"}, .momentKey = {"IDS_DB_3RD_YIELD_ROTN"},
      .field = "sides.pos.D3", .point = "D3"}, Positive<kD3>, EntersThirdDeform},
};
constexpr R kSecondDeform[] = {
    {{.message = kItem, .key = {"IDS_DB_YIELD_DISP_COMPARE1"},
      .momentKey = {"IDS_DB_YIELD_ROTN_COMPARE1"}, .field = "sides.pos.D2", .point = "D2"},
     InOrder<kD1, kD2>, EntersDeforms},
    {{.message = kItem, .text = "D2 > D1 (if P2 > P1)", .field = "sides.pos.D2", .point = "D2"},
     [](const S& s) { return Rises(s.v.D1, s.v.D2, s.v.P1, s.v.P2); }, EntersDeforms},
};
constexpr R kThirdDeform[] = {
    {{.message = kItem, .key = {"IDS_DB_YIELD_DISP_COMPARE2"},
      .momentKey = {"IDS_DB_YIELD_ROTN_COMPARE2"}, .field = "sides.pos.D3", .point = "D3"},
     InOrder<kD2, kD3>, EntersThirdDeform},
    {{.message = kItem, .text = "D3 > D2 (if P3 > P2)", .field = "sides.pos.D3", .point = "D3"},
     [](const S& s) { return Rises(s.v.D2, s.v.D3, s.v.P2, s.v.P3); }, EntersThirdDeform},
};
constexpr R kRatios[] = {
    {{.message = kItem, .key = {"IDS_DB_1ST_STIF_REDU_RATIO_POS", "IDS_DB_1ST_STIF_REDU_RATIO_NEG"},
      .field = "sides.pos.alpha1", .point = "alpha1"},
     NotNegative<&T_SKEL_MULTI_SIDE::alpha1>, EntersRatios},
    {{.message = kItem, .key = {"IDS_DB_2ND_STIF_REDU_RATIO_POS", "IDS_DB_2ND_STIF_REDU_RATIO_NEG"},
      .field = "sides.pos.alpha2", .point = "alpha2"},
     NotNegative<&T_SKEL_MULTI_SIDE::alpha2>, EntersSecondRatio},
};
constexpr R kGap[] = {
    {{.message = kItem, .key = {"IDS_DB_INIT_GAP_VALUE"}, .field = "sides.pos.gap",
      .point = "gap"}, NotNegative<&T_SKEL_MULTI_SIDE::gap>, HasGap},
};
constexpr R kStiffness[] = {
    {{.message = kItem, .key = {"IDS_RPS_PO_PHGT_Initial_Stiffness"}, .suffix = " >= 0",
      .field = "sides.pos.userStiffness"},
     NotNegative<&T_SKEL_MULTI_SIDE::userStiffness>, HasUserStiffness},
};
constexpr const char* kAlpha = "IDS_RPS_PO_MULTI_WARNING_ALPHA";
constexpr R kSuitableRatios[] = {
    {{.message = kAlpha, .text = "alpha1 <= 1", .field = "sides.pos.alpha1", .point = "alpha1"},
     [](const S& s) { return NotAbove(s.v.alpha1, 1); }},
    {{.message = kAlpha, .text = "alpha2 <= alpha1", .field = "sides.pos.alpha2",
      .point = "alpha2"},
     [](const S& s) { return NotAbove(s.v.alpha2, s.v.alpha1); },
     [](const S& s) { return s.tri; }},
};
// clang-format on

std::vector<S> BothSides(const T_SKEL_MULTI& m, SKEL_TYPE type)
{
    const bool tri = IsTrilinear(type), slip = IsSlip(type);
    return {{m, m.sides.pos, HINGE_SIDE::Positive, tri, slip},
            {m, m.sides.neg, HINGE_SIDE::Negative, tri, slip}};
}

/// The sides that are entered: of a symmetric curve the positive one.
std::span<const S> Entered(const std::vector<S>& both)
{
    return std::span(both).first(both.front().m.symmetric ? 1 : 2);
}

} // namespace

void CurveFindings(const T_SKEL_MULTI& curve, SKEL_TYPE type, const T_HINGE_PLACE& place,
                   std::vector<T_FINDING>& out)
{
    const std::vector<S> both = BothSides(curve, type);
    const std::span<const S> sides = Entered(both);
    WalkRulesBySide(kStrengths, sides, place, out);
    WalkRulesBySide(kDeforms, sides, place, out);
    for (const S& side : sides)
        WalkRules(kSecondDeform, side, place.On(side.side), out);
    for (const S& side : sides)
        WalkRules(kThirdDeform, side, place.On(side.side), out);
    WalkRulesBySide(kRatios, sides, place, out);
    WalkRulesBySide(kGap, both, place, out); // each side has a gap of its own
    WalkRulesBySide(kStiffness, sides, place, out);
}

void RatioFindings(const T_SKEL_MULTI& curve, SKEL_TYPE type, const T_HINGE_PLACE& place,
                   std::vector<T_FINDING>& out)
{
    const std::vector<S> both = BothSides(curve, type);
    WalkRulesBySide(kRatios, Entered(both), place, out);
}

void RatioWarnings(const T_SKEL_MULTI& curve, SKEL_TYPE type, const T_HINGE_PLACE& place,
                   std::vector<T_FINDING>& out)
{
    const std::vector<S> both = BothSides(curve, type);
    WalkRulesBySide(kSuitableRatios, Entered(both), place, out);
}
