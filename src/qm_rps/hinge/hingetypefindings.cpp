#include "qm_rps/hinge/hingetypefindings.h"

#include "qm_rps/hinge/hingemirror.h"
#include "qm_rps/hinge/hingesiderules.h"
#include "qm_rps/po_hingemasonrydlg.h"
#include "qm_rps/po_hingeskcvtabdlg.h"
#include "qm_rps/po_hingeskcvtabeurodlg.h"
#include "qm_rps/po_hingeskcvtabfemadlg.h"
#include "qm_rps/po_hingetypedlg.h"
#include "qm_rps/po_hingeyieldpropdlgnew.h"
#include "qm_rps/pushoverpmminteractiondlg.h"

#include <algorithm>

namespace {

constexpr auto kLit = RULE_TEXT::Literal;
constexpr auto kKey = RULE_TEXT::Key;

struct T_TYPE_CHECK {
    const T_PHGT_D& type;
    const CHingeSources* sources; // null: nothing is looked up
    const T_SECT_D* Section() const { return sources->Section(type.section); }
    const T_MATL_D* Material() const { return sources->Material(type.sectionMaterial); }
    const T_SECT_D* Fibre() const { return sources->Section(type.fibreSection); }
    const T_SECT_D* Thickness() const { return sources->Section(type.thicknessSection); }
    bool IsWall() const { return type.element == HINGE_ELEMENT::Wall; }
    /// Automatic strengths are calculated from the type's own section and material.
    bool Calculates() const
    {
        return sources && (type.section != 0 || type.sectionMaterial != 0) && AnyAutoYield(type);
    }
};
using T = T_TYPE_CHECK;

bool HasLineElement(const T_PHGT_D& t)
{
    return t.element != HINGE_ELEMENT::GeneralLink && t.element != HINGE_ELEMENT::PointSpring;
}

// clang-format off
const T_HINGE_RULE<T> kTypeRules[] = {
    {{"IDS_QM_HINGE_NAME_EMPTY", kLit, nullptr, nullptr, "name"}, [](const T& t) { return !t.type.name.empty(); }},
    {{"IDS_CMD_IEHP_NO_SECT", kLit, nullptr, nullptr, "section"}, [](const T& t) { return t.Section() != nullptr; },
     [](const T& t) { return t.sources && (t.type.section != 0 || t.Calculates()); }},
    {{"IDS_CMD_IEHP_NO_MATL", kLit, nullptr, nullptr, "sectionMaterial"}, [](const T& t) { return t.Material() != nullptr; },
     [](const T& t) { return t.sources && (t.type.sectionMaterial != 0 || t.Calculates()); }},
    {{"IDS_CMD_IEHP_NO_SECT", kLit, nullptr, nullptr, "fibreSection"}, [](const T& t) { return t.Fibre() != nullptr; },
     [](const T& t) { return t.sources && t.type.fibreSection != 0; }},
    {{"IDS_QM_HINGE_NO_FIBRES", kLit, nullptr, nullptr, "fibreSection"}, [](const T& t) { return HasLineElement(t.type); },
     [](const T& t) { return t.type.fibreSection != 0; }},
    {{"IDS_QM_HINGE_FIBRE_SHAPE", kLit, nullptr, nullptr, "fibreSection"},
     [](const T& t) { return t.IsWall() ? CHingeSources::IsWall(*t.Fibre()) : CHingeSources::HasFibres(*t.Fibre()); },
     [](const T& t) { return t.sources && t.Fibre() && HasLineElement(t.type); }},
    {{"IDS_CMD_IEHP_NO_SECT", kLit, nullptr, nullptr, "thicknessSection"}, [](const T& t) { return t.Thickness() != nullptr; },
     [](const T& t) { return t.sources && t.type.thicknessSection != 0; }},
    {{"IDS_CMD_IEHP_NO_WALL", kLit, nullptr, nullptr, "thicknessSection"},
     [](const T& t) { return t.IsWall() && (!t.sources || !t.Thickness() || CHingeSources::IsWall(*t.Thickness())); },
     [](const T& t) { return t.type.thicknessSection != 0; }},
    {{"IDS_CMD_IEHP_NO_WALL", kLit, nullptr, nullptr, "section"}, [](const T& t) { return CHingeSources::IsWall(*t.Section()); },
     [](const T& t) { return t.sources && t.IsWall() && t.Section(); }},
    {{"IDS_CMD_IEHP_NO_RBAR", kLit, nullptr, nullptr, "section"}, [](const T& t) { return !t.Section()->bars.empty(); },
     [](const T& t) { return t.Calculates() && t.Section() && t.Material() && t.Material()->type == MATL_CLASS::Concrete; }},
};
// clang-format on

/// An active component's curve type that is not offered for such a type, or not under the codes.
void OfferFindings(const T_PHGT_D& type, const T_HINGE_CONTEXT& context, std::size_t i,
                   std::vector<T_FINDING>& out)
{
    const auto c = static_cast<HINGE_COMPONENT>(i);
    const SKEL_TYPE code = type.components[i].type;
    const auto list = CPO_HingeTypeDlg::CustomizeSkcvCmb(type, c, context);
    const auto at = std::ranges::find(list, code, &CPO_HingeTypeDlg::T_SKCV_ENTRY::code);
    if (at != list.end() && at->enabled) return;
    const bool offered = at != list.end();
    out.push_back(
        FindingOf({offered ? "IDS_QM_HINGE_CURVE_CODES" : "IDS_QM_HINGE_CURVE_NOT_OFFERED", kKey,
                   CPO_HingeTypeDlg::SkcvKey(code), nullptr, "type"},
                  {static_cast<int>(i)}));
}

void CurveFindings(SKEL_TYPE type, const T_SKEL_CURVE& curve, const T_HINGE_PLACE& place,
                   std::vector<T_FINDING>& out)
{
    if (const auto* m = std::get_if<T_SKEL_MULTI>(&curve))
        CPO_HingeSkcvTabDlg::CurveFindings(*m, type, place, out);
    else if (const auto* f = std::get_if<T_SKEL_FEMA>(&curve))
        CPO_HingeSkcvTabFemaDlg::CurveFindings(*f, place, out);
    else
        CPO_HingeSkcvTabEuroDlg::CurveFindings(std::get<T_SKEL_EC8>(curve), place, out);
    MirrorFindings(curve, place, out);
}

/// What another editor finds, its fields as members of the type.
void Append(const char* prefix, std::vector<T_FINDING> found, std::vector<T_FINDING>& out)
{
    for (T_FINDING& f : found) {
        f.field = prefix + f.field;
        out.push_back(std::move(f));
    }
}

void PartFindings(const T_PHGT_D& type, std::vector<T_FINDING>& out)
{
    if (type.masonry) {
        CPO_HingeMasonryDlg masonry;
        masonry.Data2Dlg(*type.masonry);
        Append("masonry.", masonry.Findings(), out);
    }
    if (type.yieldSurface) {
        T_YIELD_SURFACE surface = *type.yieldSurface;
        const SKEL_TYPE curve = CPO_HingeTypeDlg::YieldSurfaceCurve(type);
        Append("yieldSurface.", CPO_HingeYieldPropDlgNew(surface, curve).Findings(), out);
    }
    if (type.pmm) {
        T_PMM_TABLE table = *type.pmm;
        Append("pmm.", CPushOverPMMInteractionDlg(table).Findings(), out);
    }
}

/// A multilinear curve whose stiffness follows from ratios, where it stands.
struct T_RATIO_CHECK {
    const T_SKEL_MULTI& m;
    bool tri;
};
using Q = T_RATIO_CHECK;
template <bool POS>
const T_SKEL_MULTI_SIDE& RatioSide(const Q& q)
{
    return POS ? q.m.sides.pos : q.m.sides.neg;
}
template <bool POS>
bool Alpha1Suits(const Q& q)
{
    return NotAbove(RatioSide<POS>(q).alpha1, 1);
}
template <bool POS>
bool Alpha2Suits(const Q& q)
{
    return NotAbove(RatioSide<POS>(q).alpha2, RatioSide<POS>(q).alpha1);
}
constexpr const char* kAlpha = "IDS_RPS_PO_MULTI_WARNING_ALPHA";
// clang-format off
const T_HINGE_RULE<Q> kAlphaRules[] = {
    {{kAlpha, kLit, "alpha1 <= 1", nullptr, "sides.pos.alpha1", HINGE_SIDE::Positive, "alpha1"}, Alpha1Suits<true>},
    {{kAlpha, kLit, "alpha1 <= 1", nullptr, "sides.neg.alpha1", HINGE_SIDE::Negative, "alpha1"}, Alpha1Suits<false>, [](const Q& q) { return !q.m.symmetric; }},
    {{kAlpha, kLit, "alpha2 <= alpha1", nullptr, "sides.pos.alpha2", HINGE_SIDE::Positive, "alpha2"}, Alpha2Suits<true>, [](const Q& q) { return q.tri; }},
    {{kAlpha, kLit, "alpha2 <= alpha1", nullptr, "sides.neg.alpha2", HINGE_SIDE::Negative, "alpha2"}, Alpha2Suits<false>, [](const Q& q) { return q.tri && !q.m.symmetric; }},
};
// clang-format on

} // namespace

bool IsTrilinear(SKEL_TYPE type)
{
    return type == SKEL_TYPE::Trilinear || type == SKEL_TYPE::SlipTrilinear;
}

bool IsAutoYield(const T_SKEL_CURVE& curve)
{
    return std::visit([](const auto& c) { return c.autoYield; }, curve);
}

bool AnyAutoYield(const T_PHGT_D& type)
{
    bool any = false;
    for (const T_HINGE_COMPONENT& c : type.components)
        if (c.active)
            ForEachPage(c, [&](HINGE_END, const T_SKEL_CURVE& k) { any = any || IsAutoYield(k); });
    return any;
}

void AutoStrengthFindings(const T_PHGT_D& type, const CHingeSources::T_RESULT& result,
                          std::vector<T_FINDING>& out)
{
    for (std::size_t i = 0; i < type.components.size(); ++i) {
        const T_HINGE_COMPONENT& c = type.components[i];
        if (!c.active || (result.fault == SECT_FAULT::None && result.strength.yield[i])) continue;
        const char* why = result.fault == SECT_FAULT::None ? "IDS_QM_HINGE_NO_METHOD"
                                                           : MessageKeyOf(result.fault);
        ForEachPage(c, [&](HINGE_END end, const T_SKEL_CURVE& curve) {
            if (IsAutoYield(curve))
                out.push_back(
                    FindingOf({"IDS_QM_HINGE_AUTO_STRENGTH", kKey, why, nullptr, "autoYield"},
                              {static_cast<int>(i), end}));
        });
    }
}

std::vector<T_FINDING> HingeTypeFindings(const T_PHGT_D& type, const T_HINGE_CONTEXT& context)
{
    const T check{type, context.sources.get()};
    std::vector<T_FINDING> out;
    WalkRules(kTypeRules, check, {}, out);
    for (std::size_t i = 0; i < type.components.size(); ++i) {
        const T_HINGE_COMPONENT& c = type.components[i];
        if (!c.active) continue;
        OfferFindings(type, context, i, out);
        ForEachPage(c, [&](HINGE_END end, const T_SKEL_CURVE& curve) {
            CurveFindings(c.type, curve, {static_cast<int>(i), end}, out);
        });
    }
    if (check.Calculates()) {
        const auto* result = context.sources->Strength(type.section, type.sectionMaterial);
        // Bars that are missing have their own rule above.
        if (result && result->fault != SECT_FAULT::NoBars) AutoStrengthFindings(type, *result, out);
    }
    PartFindings(type, out);
    return out;
}

std::vector<T_FINDING> HingeTypeWarnings(const T_PHGT_D& type)
{
    std::vector<T_FINDING> out;
    int curves = 0;
    for (std::size_t i = 0; i < type.components.size(); ++i) {
        const T_HINGE_COMPONENT& c = type.components[i];
        if (!c.active) continue;
        ForEachPage(c, [&](HINGE_END end, const T_SKEL_CURVE& curve) {
            const auto* m = std::get_if<T_SKEL_MULTI>(&curve);
            if (!m || m->useDeformation) return;
            ++curves;
            WalkRules(kAlphaRules, Q{*m, IsTrilinear(c.type)}, {static_cast<int>(i), end}, out);
        });
    }
    if (curves < 2) out.clear(); // the warning is about several curves at once
    return out;
}
