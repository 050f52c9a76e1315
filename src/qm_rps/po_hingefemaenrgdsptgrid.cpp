#include "qm_rps/po_hingefemaenrgdsptgrid.h"

namespace {

using B = T_BACKBONE;
constexpr auto kLit = RULE_TEXT::Literal;

// clang-format off
const T_HINGE_RULE<B> kEnergy[] = {
    {{kHingeRuleMessage, kLit, "A~B >= 0.0", nullptr, "sides.pos.energy[0]", HINGE_SIDE::Positive, "A~B"}, [](const B& b) { return NotAbove(0, b.pos.energy[0]); }},
    {{kHingeRuleMessage, kLit, "A~B >= 0.0", nullptr, "sides.neg.energy[0]", HINGE_SIDE::Negative, "A~B"}, [](const B& b) { return NotAbove(0, b.neg.energy[0]); }},
    {{kHingeRuleMessage, kLit, "A~B >= C",   nullptr, "sides.pos.energy[1]", HINGE_SIDE::Positive, "C"},   [](const B& b) { return NotAbove(b.pos.energy[1], b.pos.energy[0]); }},
    {{kHingeRuleMessage, kLit, "C >= D",     nullptr, "sides.pos.energy[2]", HINGE_SIDE::Positive, "D"},   [](const B& b) { return NotAbove(b.pos.energy[2], b.pos.energy[1]); }},
    {{kHingeRuleMessage, kLit, "D >= E",     nullptr, "sides.pos.energy[3]", HINGE_SIDE::Positive, "E"},   [](const B& b) { return NotAbove(b.pos.energy[3], b.pos.energy[2]); }},
    {{kHingeRuleMessage, kLit, "E >= 0.0",   nullptr, "sides.pos.energy[3]", HINGE_SIDE::Positive, "E"},   [](const B& b) { return NotAbove(0, b.pos.energy[3]); }},
    {{kHingeRuleMessage, kLit, "A~B >= C",   nullptr, "sides.neg.energy[1]", HINGE_SIDE::Negative, "C"},   [](const B& b) { return NotAbove(b.neg.energy[1], b.neg.energy[0]); }},
    {{kHingeRuleMessage, kLit, "C >= D",     nullptr, "sides.neg.energy[2]", HINGE_SIDE::Negative, "D"},   [](const B& b) { return NotAbove(b.neg.energy[2], b.neg.energy[1]); }},
    {{kHingeRuleMessage, kLit, "D >= E",     nullptr, "sides.neg.energy[3]", HINGE_SIDE::Negative, "E"},   [](const B& b) { return NotAbove(b.neg.energy[3], b.neg.energy[2]); }},
    {{kHingeRuleMessage, kLit, "E >= 0.0",   nullptr, "sides.neg.energy[3]", HINGE_SIDE::Negative, "E"},   [](const B& b) { return NotAbove(0, b.neg.energy[3]); }},
};
// clang-format on

} // namespace

void CPO_HingeFEMAEnrgDsptGrid::Data2Dlg(const T_SIDES<T_SKEL_SIDE>& sides)
{
    m_factors = {sides.pos.energy, sides.neg.energy};
}

void CPO_HingeFEMAEnrgDsptGrid::Dlg2Data(T_SIDES<T_SKEL_SIDE>& sides) const
{
    sides.pos.energy = m_factors[0];
    sides.neg.energy = m_factors[1];
}

int CPO_HingeFEMAEnrgDsptGrid::CheckData()
{
    T_SIDES<T_SKEL_SIDE> sides;
    Dlg2Data(sides);
    std::vector<T_FINDING> found;
    WalkRules(Rules(), T_BACKBONE{sides.pos, sides.neg}, {}, found);
    if (found.empty()) return 1;
    ShowMessage(found.front().messageKey, found.front().text);
    return 0;
}

T_BACKBONE_RULES CPO_HingeFEMAEnrgDsptGrid::Rules()
{
    return kEnergy;
}
