#include "qm_rps/hinge/hingegenerator.h"

#include "qm_base/msgfunction.h"
#include "qm_db/editscope.h"
#include "qm_rps/hinge/hingetypefindings.h"

#include <set>

namespace {

using zql::lib::MMSGFunction;

int Refuse(int element, const char* key, T_HINGE_REFUSAL& refusal, const std::string& text = {})
{
    const std::string why = text.empty() ? MMSGFunction::GetValue(key) : text;
    refusal = {element, key,
               element == 0
                   ? why
                   : MMSGFunction::Format("IDS_QM_HINGE_ELEMENT", {std::to_string(element), why})};
    return 0;
}

/// Strengths of one component from its curve, or from the calculation where they are automatic.
struct T_STRENGTHS {
    T_SIDES<double> yield, crack;
};
template <class CURVE>
T_STRENGTHS EnteredStrengths(const CURVE& curve, SKEL_TYPE type)
{
    const auto& pos = curve.sides.pos;
    const auto& neg = curve.symmetric ? pos : curve.sides.neg;
    T_STRENGTHS s;
    s.yield = {CHingeGenerator::EnteredYield(pos, type), CHingeGenerator::EnteredYield(neg, type)};
    if constexpr (std::is_same_v<CURVE, T_SKEL_MULTI>) {
        if (IsTrilinear(type)) s.crack = {pos.P1, neg.P1};
    }
    return s;
}

/// The curve of a component's first page.
const T_SKEL_CURVE& FirstCurve(const T_HINGE_COMPONENT& c)
{
    const T_SKEL_CURVE* first = nullptr;
    ForEachPage(c, [&](HINGE_END, const T_SKEL_CURVE& curve) {
        if (!first) first = &curve;
    });
    return *first;
}

} // namespace

double CHingeGenerator::EnteredYield(const T_SKEL_SIDE& side, SKEL_TYPE)
{
    return side.yield;
}

double CHingeGenerator::EnteredYield(const T_SKEL_MULTI_SIDE& side, SKEL_TYPE type)
{
    return IsTrilinear(type) ? side.P2 : side.P1;
}

int CHingeGenerator::ReadElement(const T_PHGT_D& type, int element, T_HINGE_ELEMENT& out,
                                 T_HINGE_REFUSAL& refusal) const
{
    T_ELEM_D e;
    T_HINGE_ELEMENT found;
    if (!m_doc.Attr().GetElem(element, e)) return Refuse(element, "IDS_CMD_IEHP_NO_ELEM", refusal);
    if (!m_doc.Attr().GetSect(e.section, found.section))
        return Refuse(element, "IDS_CMD_IEHP_NO_SECT", refusal);
    if (!m_doc.Attr().GetMatl(e.material, found.material))
        return Refuse(element, "IDS_CMD_IEHP_NO_MATL", refusal);
    if (!m_doc.Memb().GetMembLengByIncludeElem(element, found.memberLength))
        return Refuse(element, "IDS_CMD_IEHP_NO_MEMB", refusal);
    if (type.element == HINGE_ELEMENT::Wall && !CHingeSources::IsWall(found.section))
        return Refuse(element, "IDS_CMD_IEHP_NO_WALL", refusal);
    found.result = m_sources->Strength(e.section, e.material);
    out = std::move(found);
    return 1;
}

int CHingeGenerator::CalcHinge(int hingeType, int element, T_PHGE_D& out,
                               T_HINGE_REFUSAL& refusal) const
{
    T_PHGT_D type;
    T_HINGE_ELEMENT e;
    if (!m_doc.Attr().GetPhgt(hingeType, type))
        return Refuse(0, "IDS_PUSHOVER_No_selected_Hinge_Data_Type__nChoose_o", refusal);
    if (!ReadElement(type, element, e, refusal)) return 0;
    std::vector<T_FINDING> faults;
    AutoStrengthFindings(type, *e.result, faults);
    if (!faults.empty()) {
        const bool method = e.result->fault == SECT_FAULT::None;
        return Refuse(element, method ? "IDS_QM_HINGE_NO_METHOD" : MessageKeyOf(e.result->fault),
                      refusal, method ? faults.front().text : std::string());
    }
    T_PHGE_D hinge;
    hinge.element = element;
    hinge.hingeType = hingeType;
    for (std::size_t i = 0; i < type.components.size(); ++i) {
        const T_HINGE_COMPONENT& c = type.components[i];
        if (!c.active) continue;
        const T_SKEL_CURVE& curve = FirstCurve(c);
        T_STRENGTHS s;
        if (IsAutoYield(curve))
            s.yield = e.result->strength.yield[i].value_or(T_SIDES<double>{});
        else
            s = std::visit([&](const auto& k) { return EnteredStrengths(k, c.type); }, curve);
        hinge.yield[i] = s.yield;
        hinge.crack[i] = s.crack;
    }
    out = hinge;
    return 1;
}

int CHingeGenerator::Generate(int hingeType, const std::vector<int>& elements,
                              T_HINGE_REFUSAL& refusal)
{
    if (elements.empty()) return Refuse(0, "IDS_CMD_IEHP_NO_ELEM", refusal);
    std::map<int, T_PHGE_D> fresh; // by element
    for (const int element : elements)
        if (!CalcHinge(hingeType, element, fresh[element], refusal)) return 0;

    std::set<int> extra;
    std::map<int, int> keys; // of the hinges that are replaced, by element
    int next = NextKey(m_doc.Data().Model().hinges);
    for (const auto& [key, hinge] : m_doc.Data().Model().hinges)
        if (fresh.contains(hinge.element) && !keys.emplace(hinge.element, key).second)
            extra.insert(key);
    CEditScope edit(m_doc, "hinges of elements");
    for (const int key : extra)
        (void)edit.Erase<T_PHGE_D>(key);
    for (const auto& [element, hinge] : fresh) {
        const auto old = keys.find(element);
        (void)edit.Put(old == keys.end() ? next++ : old->second, hinge);
    }
    if (edit.Commit()) return 1;
    return Refuse(0, "IDS_QM_HINGE_NOT_STORED", refusal);
}

std::vector<T_FINDING> CHingeGenerator::ElementFindings(int hingeType) const
{
    T_PHGT_D type;
    std::vector<T_FINDING> out;
    if (!m_doc.Attr().GetPhgt(hingeType, type) || !AnyAutoYield(type)) return out;
    for (const int element : m_doc.Attr().GetElemsByPhgt(hingeType)) {
        T_HINGE_ELEMENT e;
        T_HINGE_REFUSAL refusal;
        const std::string field = "element " + std::to_string(element);
        const std::size_t first = out.size();
        if (ReadElement(type, element, e, refusal)) {
            AutoStrengthFindings(type, *e.result, out);
        } else {
            T_FINDING& f = out.emplace_back();
            f.ruleText = f.messageKey = refusal.key;
            f.text = MMSGFunction::GetValue(refusal.key);
        }
        for (std::size_t i = first; i < out.size(); ++i)
            out[i].field = field;
    }
    return out;
}
