#include "qm_rps/po_hingeskcvtabdlg.h"

#include "qm_rps/hinge/hingemirror.h"

#include "qm_db/compfunc.h"

#include <cmath>

namespace {

constexpr double kTol = 1e-9; // in the units of the values

struct T_CHECK {
    const T_SKEL_MULTI& m;
    const T_SKEL_MULTI_SIDE& pos;
    const T_SKEL_MULTI_SIDE& neg; // not looked at where symmetric, but for its gap
    bool tri = false, slip = false;
};
using C = T_CHECK;
using R = T_HINGE_RULE<T_CHECK>;
constexpr auto kKey = RULE_TEXT::Key;
constexpr auto kLit = RULE_TEXT::Literal;
constexpr auto kPos = HINGE_SIDE::Positive;
constexpr auto kNeg = HINGE_SIDE::Negative;
constexpr const char* kMsg = kHingeItemMessage;

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

bool Two(const C& c)
{
    return !c.m.symmetric;
}
bool Bi(const C& c)
{
    return !c.m.autoYield && !c.tri;
}
bool BiNeg(const C& c)
{
    return Bi(c) && Two(c);
}
bool Tri(const C& c)
{
    return !c.m.autoYield && c.tri;
}
bool TriNeg(const C& c)
{
    return Tri(c) && Two(c);
}
bool Ult(const C& c)
{
    return c.m.useUltimate;
}
bool UltNeg(const C& c)
{
    return Ult(c) && Two(c);
}
bool Def(const C& c)
{
    return c.m.useDeformation;
}
bool DefNeg(const C& c)
{
    return Def(c) && Two(c);
}
bool Def3(const C& c)
{
    return Def(c) && c.tri;
}
bool Def3Neg(const C& c)
{
    return Def3(c) && Two(c);
}
bool Rat(const C& c)
{
    return !c.m.useDeformation;
}
bool RatNeg(const C& c)
{
    return Rat(c) && Two(c);
}
bool Rat2(const C& c)
{
    return Rat(c) && c.tri;
}
bool Rat2Neg(const C& c)
{
    return Rat2(c) && Two(c);
}
bool GapPos(const C& c)
{
    return c.slip && c.m.gapSides != GAP_SIDES::Negative;
}
bool GapNeg(const C& c)
{
    return c.slip && c.m.gapSides != GAP_SIDES::Positive;
}
bool User(const C& c)
{
    return c.m.initStiffness == INIT_STIFFNESS::User;
}
bool UserNeg(const C& c)
{
    return User(c) && Two(c);
}

// clang-format off
const R kRules[] = {
    // strengths
    {{kMsg, kKey, "IDS_DB_YIELD_FORCE_POS1", "IDS_DB_YIELD_MOMENT_POS1", "sides.pos.P1", kPos, "P1"}, [](const C& c) { return Above0(c.pos.P1); }, Bi},
    {{kMsg, kKey, "IDS_DB_YIELD_FORCE_NEG1", "IDS_DB_YIELD_MOMENT_NEG1", "sides.neg.P1", kNeg, "P1"}, [](const C& c) { return Above0(c.neg.P1); }, BiNeg},
    {{kMsg, kKey, "IDS_DB_YIELD_FORCE_POS",  "IDS_DB_YIELD_MOMENT_POS",  "sides.pos.P2", kPos, "P2"}, [](const C& c) { return Above0(c.pos.P2); }, Tri},
    {{kMsg, kKey, "IDS_DB_YIELD_FORCE_NEG",  "IDS_DB_YIELD_MOMENT_NEG",  "sides.neg.P2", kNeg, "P2"}, [](const C& c) { return Above0(c.neg.P2); }, TriNeg},
    {{kMsg, kKey, "IDS_DB_CRACK_FORCE_COMP_PLUS", nullptr, "sides.pos.P1", kPos, "P1"}, [](const C& c) { return NotMore(c.pos.P1, c.pos.P2); }, Tri},
    {{kMsg, kKey, "IDS_DB_CRACK_FORCE_COMP_MNUS", nullptr, "sides.neg.P1", kNeg, "P1"}, [](const C& c) { return NotMore(c.neg.P1, c.neg.P2); }, TriNeg},
    // ultimate strength
    {{kMsg, kKey, "IDS_DB_ULTIMATE_FORCE_POS", "IDS_DB_ULTIMATE_MOMENT_POS", "sides.pos.P3", kPos, "P3"}, [](const C& c) { return Above0(c.pos.P3); }, Ult},
    {{kMsg, kKey, "IDS_DB_ULTIMATE_FORCE_NEG", "IDS_DB_ULTIMATE_MOMENT_NEG", "sides.neg.P3", kNeg, "P3"}, [](const C& c) { return Above0(c.neg.P3); }, UltNeg},
    {{kMsg, kKey, "IDS_DB_YIELD_FORCE_COMP_PLUS", nullptr, "sides.pos.P2", kPos, "P2"}, [](const C& c) { return NotMore(c.pos.P2, c.pos.P3); }, Ult},
    {{kMsg, kKey, "IDS_DB_YIELD_FORCE_COMP_MNUS", nullptr, "sides.neg.P2", kNeg, "P2"}, [](const C& c) { return NotMore(c.neg.P2, c.neg.P3); }, UltNeg},
    // deformations
    {{kMsg, kKey, "IDS_DB_1ST_YIELD_DISP", "IDS_DB_1ST_YIELD_ROTN", "sides.pos.D1", kPos, "D1"}, [](const C& c) { return Above0(c.pos.D1); }, Def},
    {{kMsg, kKey, "IDS_DB_1ST_YIELD_DISP", "IDS_DB_1ST_YIELD_ROTN", "sides.neg.D1", kNeg, "D1"}, [](const C& c) { return Above0(c.neg.D1); }, DefNeg},
    {{kMsg, kKey, "IDS_DB_2ND_YIELD_DISP", "IDS_DB_2ND_YIELD_ROTN", "sides.pos.D2", kPos, "D2"}, [](const C& c) { return Above0(c.pos.D2); }, Def},
    {{kMsg, kKey, "IDS_DB_2ND_YIELD_DISP", "IDS_DB_2ND_YIELD_ROTN", "sides.neg.D2", kNeg, "D2"}, [](const C& c) { return Above0(c.neg.D2); }, DefNeg},
    {{kMsg, kKey, "IDS_DB_3RD_YIELD_DISP", "IDS_DB_3RD_YIELD_ROTN", "sides.pos.D3", kPos, "D3"}, [](const C& c) { return Above0(c.pos.D3); }, Def3},
    {{kMsg, kKey, "IDS_DB_3RD_YIELD_DISP", "IDS_DB_3RD_YIELD_ROTN", "sides.neg.D3", kNeg, "D3"}, [](const C& c) { return Above0(c.neg.D3); }, Def3Neg},
    {{kMsg, kKey, "IDS_DB_YIELD_DISP_COMPARE1", "IDS_DB_YIELD_ROTN_COMPARE1", "sides.pos.D2", kPos, "D2"}, [](const C& c) { return NotMore(c.pos.D1, c.pos.D2); }, Def},
    {{kMsg, kLit, "D2 > D1 (if P2 > P1)", nullptr, "sides.pos.D2", kPos, "D2"}, [](const C& c) { return Rises(c.pos.D1, c.pos.D2, c.pos.P1, c.pos.P2); }, Def},
    {{kMsg, kKey, "IDS_DB_YIELD_DISP_COMPARE1", "IDS_DB_YIELD_ROTN_COMPARE1", "sides.neg.D2", kNeg, "D2"}, [](const C& c) { return NotMore(c.neg.D1, c.neg.D2); }, DefNeg},
    {{kMsg, kLit, "D2 > D1 (if P2 > P1)", nullptr, "sides.neg.D2", kNeg, "D2"}, [](const C& c) { return Rises(c.neg.D1, c.neg.D2, c.neg.P1, c.neg.P2); }, DefNeg},
    {{kMsg, kKey, "IDS_DB_YIELD_DISP_COMPARE2", "IDS_DB_YIELD_ROTN_COMPARE2", "sides.pos.D3", kPos, "D3"}, [](const C& c) { return NotMore(c.pos.D2, c.pos.D3); }, Def3},
    {{kMsg, kLit, "D3 > D2 (if P3 > P2)", nullptr, "sides.pos.D3", kPos, "D3"}, [](const C& c) { return Rises(c.pos.D2, c.pos.D3, c.pos.P2, c.pos.P3); }, Def3},
    {{kMsg, kKey, "IDS_DB_YIELD_DISP_COMPARE2", "IDS_DB_YIELD_ROTN_COMPARE2", "sides.neg.D3", kNeg, "D3"}, [](const C& c) { return NotMore(c.neg.D2, c.neg.D3); }, Def3Neg},
    {{kMsg, kLit, "D3 > D2 (if P3 > P2)", nullptr, "sides.neg.D3", kNeg, "D3"}, [](const C& c) { return Rises(c.neg.D2, c.neg.D3, c.neg.P2, c.neg.P3); }, Def3Neg},
    // stiffness reduction ratios
    {{kMsg, kKey, "IDS_DB_1ST_STIF_REDU_RATIO_POS", nullptr, "sides.pos.alpha1", kPos, "alpha1"}, [](const C& c) { return NotBelow0(c.pos.alpha1); }, Rat},
    {{kMsg, kKey, "IDS_DB_1ST_STIF_REDU_RATIO_NEG", nullptr, "sides.neg.alpha1", kNeg, "alpha1"}, [](const C& c) { return NotBelow0(c.neg.alpha1); }, RatNeg},
    {{kMsg, kKey, "IDS_DB_2ND_STIF_REDU_RATIO_POS", nullptr, "sides.pos.alpha2", kPos, "alpha2"}, [](const C& c) { return NotBelow0(c.pos.alpha2); }, Rat2},
    {{kMsg, kKey, "IDS_DB_2ND_STIF_REDU_RATIO_NEG", nullptr, "sides.neg.alpha2", kNeg, "alpha2"}, [](const C& c) { return NotBelow0(c.neg.alpha2); }, Rat2Neg},
    // initial gap
    {{kMsg, kKey, "IDS_DB_INIT_GAP_VALUE", nullptr, "sides.pos.gap", kPos, "gap"}, [](const C& c) { return NotBelow0(c.pos.gap); }, GapPos},
    {{kMsg, kKey, "IDS_DB_INIT_GAP_VALUE", nullptr, "sides.neg.gap", kNeg, "gap"}, [](const C& c) { return NotBelow0(c.neg.gap); }, GapNeg},
    // initial stiffness
    {{kMsg, kKey, "IDS_RPS_PO_PHGT_Initial_Stiffness", nullptr, "sides.pos.userStiffness", kPos, "", " >= 0"}, [](const C& c) { return NotBelow0(c.pos.userStiffness); }, User},
    {{kMsg, kKey, "IDS_RPS_PO_PHGT_Initial_Stiffness", nullptr, "sides.neg.userStiffness", kNeg, "", " >= 0"}, [](const C& c) { return NotBelow0(c.neg.userStiffness); }, UserNeg},
};
// clang-format on

bool IsMultilinear(SKEL_TYPE t)
{
    return t != SKEL_TYPE::Fema && t != SKEL_TYPE::Ec8;
}

} // namespace

int CPO_HingeSkcvTabDlg::Data2Dlg(HINGE_COMPONENT c, const T_HINGE_COMPONENT& data)
{
    if (!IsMultilinear(data.type) || !std::holds_alternative<T_SKEL_MULTI>(data.curves.I) ||
        !std::holds_alternative<T_SKEL_MULTI>(data.curves.J))
        return 0;
    m_component = c;
    m_data = data;
    return 1;
}

int CPO_HingeSkcvTabDlg::Dlg2Data(T_HINGE_COMPONENT& data)
{
    if (!CheckData()) return 0;
    data = MirroredComponent(m_data);
    return 1;
}

T_SKEL_MULTI* CPO_HingeSkcvTabDlg::Curve(HINGE_END end)
{
    const bool j = end == HINGE_END::J && !m_data.sameEnds;
    return std::get_if<T_SKEL_MULTI>(j ? &m_data.curves.J : &m_data.curves.I);
}

void CPO_HingeSkcvTabDlg::OnEdited()
{
    m_data = MirroredComponent(m_data);
}

std::vector<const char*> CPO_HingeSkcvTabDlg::PageTitles() const
{
    return PageTitleKeys(m_data);
}

void CPO_HingeSkcvTabDlg::SetDefaultAlpha(HINGE_END end, const T_SIDES<double>& alpha1,
                                          const T_SIDES<double>& alpha2)
{
    T_SKEL_MULTI* m = Curve(end);
    if (!m) return;
    m->sides.pos.alpha1 = alpha1.pos;
    m->sides.neg.alpha1 = alpha1.neg;
    m->sides.pos.alpha2 = alpha2.pos;
    m->sides.neg.alpha2 = alpha2.neg;
}

void CPO_HingeSkcvTabDlg::ChangeInitStiff(HINGE_END end, INIT_STIFFNESS option)
{
    if (T_SKEL_MULTI* m = Curve(end)) m->initStiffness = option;
}

void CPO_HingeSkcvTabDlg::OnChangeSlipInitGap(HINGE_END end, GAP_SIDES sides)
{
    if (T_SKEL_MULTI* m = Curve(end)) m->gapSides = sides;
}

std::vector<T_FINDING> CPO_HingeSkcvTabDlg::Findings() const
{
    std::vector<T_FINDING> out;
    if (!m_data.active) return out;
    ForEachPage(m_data, [&](HINGE_END end, const T_SKEL_CURVE& curve) {
        if (const T_SKEL_MULTI* m = std::get_if<T_SKEL_MULTI>(&curve))
            CurveFindings(*m, m_data.type, {static_cast<int>(m_component), end}, out);
    });
    return out;
}

void CPO_HingeSkcvTabDlg::CurveFindings(const T_SKEL_MULTI& curve, SKEL_TYPE type,
                                        const T_HINGE_PLACE& place, std::vector<T_FINDING>& out)
{
    const C check{curve, curve.sides.pos, curve.sides.neg,
                  type == SKEL_TYPE::Trilinear || type == SKEL_TYPE::SlipTrilinear,
                  type == SKEL_TYPE::SlipBilinear || type == SKEL_TYPE::SlipTrilinear};
    WalkRules(kRules, check, place, out);
}
