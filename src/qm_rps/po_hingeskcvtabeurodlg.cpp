#include "qm_rps/po_hingeskcvtabeurodlg.h"

#include "qm_rps/hinge/hingemeasure.h"
#include "qm_rps/hinge/hingemirror.h"
#include "qm_rps/hinge/hingesiderules.h"

namespace {

using B = T_BACKBONE;

// clang-format off
const T_HINGE_RULE<B> kStiffness[] = {
    {{kHingeRuleMessage, RULE_TEXT::Key, "IDS_RPS_PO_PHGT_Initial_Stiffness", nullptr, "sides.pos.userStiffness", HINGE_SIDE::Positive, "", " > 0"},
     [](const B& b) { return Below(0, b.pos.userStiffness); }, [](const B& b) { return b.initStiffness == INIT_STIFFNESS::User; }},
    {{kHingeRuleMessage, RULE_TEXT::Key, "IDS_RPS_PO_PHGT_Initial_Stiffness", nullptr, "sides.neg.userStiffness", HINGE_SIDE::Negative, "", " > 0"},
     [](const B& b) { return Below(0, b.neg.userStiffness); },
     [](const B& b) { return b.initStiffness == INIT_STIFFNESS::User && !b.symmetric; }},
};
// clang-format on

} // namespace

int CPO_HingeSkcvTabEuroDlg::Data2Dlg(HINGE_COMPONENT c, const T_HINGE_COMPONENT& data)
{
    if (data.type != SKEL_TYPE::Ec8 || !std::holds_alternative<T_SKEL_EC8>(data.curves.I) ||
        !std::holds_alternative<T_SKEL_EC8>(data.curves.J))
        return 0;
    m_component = c;
    m_data = data;
    m_switches = {};
    return 1;
}

int CPO_HingeSkcvTabEuroDlg::Dlg2Data(T_HINGE_COMPONENT& data)
{
    if (!CheckData()) return 0;
    data = MirroredComponent(m_data);
    return 1;
}

T_SKEL_EC8* CPO_HingeSkcvTabEuroDlg::Curve(HINGE_END end)
{
    const bool j = end == HINGE_END::J && !m_data.sameEnds;
    return std::get_if<T_SKEL_EC8>(j ? &m_data.curves.J : &m_data.curves.I);
}

void CPO_HingeSkcvTabEuroDlg::OnEdited()
{
    m_data = MirroredComponent(m_data);
}

std::vector<const char*> CPO_HingeSkcvTabEuroDlg::PageTitles() const
{
    return PageTitleKeys(m_data);
}

int CPO_HingeSkcvTabEuroDlg::OnMeasureRdo(HINGE_END end, SKEL_MEASURE measure)
{
    T_SKEL_EC8* curve = Curve(end);
    if (!curve) return 0;
    if (curve->measure == measure) return 1;
    const T_SKEL_EC8 was = *curve;
    ConvertSides(curve->sides, measure);
    curve->measure = measure;
    std::optional<T_SWITCH>& last = m_switches[end == HINGE_END::J && !m_data.sameEnds ? 1 : 0];
    if (last && last->before.measure == measure)
        RestoreSides(curve->sides, was.sides, last->after.sides, last->before.sides);
    last = T_SWITCH{was, *curve};
    return 1;
}

bool CPO_HingeSkcvTabEuroDlg::IsEurocodePair(const std::string& concreteCode,
                                             const std::string& steelCode)
{
    return (concreteCode == "Eurocode2" || concreteCode == "Eurocode2:04") &&
           (steelCode == "Eurocode3" || steelCode == "Eurocode3:05");
}

std::vector<T_FINDING> CPO_HingeSkcvTabEuroDlg::Findings() const
{
    std::vector<T_FINDING> out;
    if (!m_data.active) return out;
    ForEachPage(m_data, [&](HINGE_END end, const T_SKEL_CURVE& curve) {
        if (const T_SKEL_EC8* e = std::get_if<T_SKEL_EC8>(&curve))
            CurveFindings(*e, {static_cast<int>(m_component), end}, out);
    });
    return out;
}

void CPO_HingeSkcvTabEuroDlg::CurveFindings(const T_SKEL_EC8& curve, const T_HINGE_PLACE& place,
                                            std::vector<T_FINDING>& out)
{
    const B b{curve.sides.pos,    curve.sides.neg, curve.symmetric,
              curve.strengthLoss, curve.autoYield, curve.measure == SKEL_MEASURE::DDy,
              curve.initStiffness};
    for (const T_BACKBONE_RULES& rules :
         {PositiveSignRules(), NegativeSignRules(), Ec8OrderRules(), AcceptanceRules(),
          YieldStrengthRules(), T_BACKBONE_RULES(kStiffness)})
        WalkRules(rules, b, place, out);
}
