#include "qm_rps/po_hingetypedlg.h"

#include "qm_base/msgfunction.h"
#include "qm_rps/po_hingemasonrydlg.h"
#include "qm_rps/po_hingeskcvtabdlg.h"
#include "qm_rps/po_hingeskcvtabeurodlg.h"
#include "qm_rps/po_hingeskcvtabfemadlg.h"

#include <algorithm>

namespace {

using ENTRY = CPO_HingeTypeDlg::T_SKCV_ENTRY;
using zql::lib::MMSGFunction;
constexpr auto kLit = RULE_TEXT::Literal;
constexpr ENTRY kBilinear{"IDS_RPS_PO_PHGT_SKCV_Bilinear_Type", SKEL_TYPE::Bilinear};
constexpr ENTRY kTrilinear{"IDS_RPS_PO_PHGT_SKCV_Trilinear_Type", SKEL_TYPE::Trilinear};
constexpr ENTRY kSlipBi{"IDS_RPS_PO_PHGT_SKCV_Slip_Bilinear_Type", SKEL_TYPE::SlipBilinear};
constexpr ENTRY kSlipTri{"IDS_RPS_PO_PHGT_SKCV_Slip_Trilinear_Type", SKEL_TYPE::SlipTrilinear};
constexpr ENTRY kCompression{"IDS_RPS_PO_PHGT_SKCV_Compression_Only_Type",
                             SKEL_TYPE::CompressionOnly};
constexpr ENTRY kFema{"IDS_RPS_PO_PHGT_SKCV_FEMA", SKEL_TYPE::Fema};
constexpr ENTRY kDegrading{"IDS_RPS_PO_PHGT_SKCV_STRENGTH_DEG_TYPE", SKEL_TYPE::Fema};
constexpr ENTRY kGsd{"IDS_RPS_PO_PHGT_SKCV_GSD_TYPE", SKEL_TYPE::Fema};
constexpr const char* kEc8Key = "IDS_RPS_PO_PHGT_SKCV_EC8";

/// The entry under which code 4 is listed, or null.
const ENTRY* FemaEntry(const T_PHGT_D& t, HINGE_COMPONENT c, const T_HINGE_CONTEXT& x)
{
    if (!x.altHysteresis) return &kFema;
    if (t.element == HINGE_ELEMENT::Wall && x.strengthDegradation) return &kDegrading;
    const bool bending = c == HINGE_COMPONENT::My || c == HINGE_COMPONENT::Mz;
    return bending && x.gsd && x.gsdAllowed ? &kGsd : nullptr;
}

int Position(const std::vector<ENTRY>& list, SKEL_TYPE code)
{
    for (std::size_t i = 0; i < list.size(); ++i)
        if (list[i].code == code) return static_cast<int>(i);
    return -1;
}

T_SKEL_CURVE DefaultCurve(SKEL_TYPE type)
{
    if (type == SKEL_TYPE::Fema) return T_SKEL_FEMA();
    if (type == SKEL_TYPE::Ec8) return T_SKEL_EC8();
    return T_SKEL_MULTI();
}

void SetType(T_HINGE_COMPONENT& c, SKEL_TYPE type)
{
    const T_SKEL_CURVE fresh = DefaultCurve(type);
    c.type = type;
    if (c.curves.I.index() != fresh.index()) c.curves.I = fresh;
    if (c.curves.J.index() != fresh.index()) c.curves.J = fresh;
}

/// Runs a curve editor that holds one component.
template <class DLG>
int RunEditor(DLG& dlg, zql::frx::IDialogView* view, HINGE_COMPONENT c, const T_HINGE_COMPONENT& in)
{
    dlg.SetView(view);
    return dlg.Data2Dlg(c, in) && dlg.DoModal();
}

void CurveFindings(SKEL_TYPE type, const T_SKEL_CURVE& curve, const T_PLACE& place,
                   std::vector<T_FINDING>& out)
{
    if (const auto* m = std::get_if<T_SKEL_MULTI>(&curve))
        CPO_HingeSkcvTabDlg::CurveFindings(*m, type, place, out);
    else if (const auto* f = std::get_if<T_SKEL_FEMA>(&curve))
        CPO_HingeSkcvTabFemaDlg::CurveFindings(*f, place, out);
    else
        CPO_HingeSkcvTabEuroDlg::CurveFindings(std::get<T_SKEL_EC8>(curve), place, out);
}

bool AutoYield(const T_SKEL_CURVE& curve)
{
    return std::visit([](const auto& c) { return c.autoYield; }, curve);
}

bool AnyAutoYield(const T_PHGT_D& t)
{
    bool any = false;
    for (const T_HINGE_COMPONENT& c : t.components)
        if (c.active)
            ForEachPage(c, [&](HINGE_END, const T_SKEL_CURVE& k) { any = any || AutoYield(k); });
    return any;
}

struct T_TYPE_CHECK {
    const T_PHGT_D& type;
    const T_SECT_D* section; // null: none, or not looked up
    const T_MATL_D* material;
    bool looksUp; // sections and materials can be looked up
};
using T = T_TYPE_CHECK;

// clang-format off
const T_RULE<T> kTypeRules[] = {
    {{"IDS_QM_HINGE_NAME_EMPTY", kLit, nullptr, nullptr, "name"}, [](const T& t) { return !t.type.name.empty(); }},
    {{"IDS_CMD_IEHP_NO_SECT", kLit, nullptr, nullptr, "section"}, [](const T& t) { return t.section != nullptr; }, [](const T& t) { return t.looksUp && t.type.section != 0; }},
    {{"IDS_CMD_IEHP_NO_MATL", kLit, nullptr, nullptr, "sectionMaterial"}, [](const T& t) { return t.material != nullptr; }, [](const T& t) { return t.looksUp && t.type.sectionMaterial != 0; }},
    {{"IDS_CMD_IEHP_NO_RBAR", kLit, nullptr, nullptr, "section"}, [](const T& t) { return !t.section->bars.empty(); },
     [](const T& t) { return t.section && t.material && t.material->type == MATL_CLASS::Concrete && AnyAutoYield(t.type); }},
};
// clang-format on

/// An active component's curve type that is not offered for such a type.
void OfferFindings(const T_PHGT_D& type, const T_HINGE_CONTEXT& context, std::size_t i,
                   std::vector<T_FINDING>& out)
{
    const auto c = static_cast<HINGE_COMPONENT>(i);
    const SKEL_TYPE code = type.components[i].type;
    if (Position(CPO_HingeTypeDlg::CustomizeSkcvCmb(type, c, context), code) >= 0) return;
    static constexpr const char* keys[] = {kBilinear.key,   kTrilinear.key, kSlipBi.key,
                                           kSlipTri.key,    kFema.key,      kEc8Key,
                                           kCompression.key};
    const auto at = static_cast<std::size_t>(code);
    out.push_back(
        FindingOf({"IDS_QM_HINGE_CURVE_NOT_OFFERED", RULE_TEXT::Key,
                   at < std::size(keys) ? keys[at] : "IDS_PUSHOVER_Error", nullptr, "type"},
                  {static_cast<int>(i)}));
}

} // namespace

CPO_HingeTypeDlg::CPO_HingeTypeDlg(T_HINGE_CONTEXT context) : m_context(std::move(context)) {}

void CPO_HingeTypeDlg::Data2Dlg(const T_PHGT_D& data)
{
    m_type = data;
    RefillSkcv();
}

int CPO_HingeTypeDlg::Dlg2Data(T_PHGT_D& data)
{
    if (!CheckData()) return 0;
    data = m_type;
    return 1;
}

void CPO_HingeTypeDlg::SetSection(int section, int material)
{
    m_type.section = section;
    m_type.sectionMaterial = material;
}

std::vector<ENTRY> CPO_HingeTypeDlg::CustomizeSkcvCmb(const T_PHGT_D& type, HINGE_COMPONENT c,
                                                      const T_HINGE_CONTEXT& context)
{
    if (type.element == HINGE_ELEMENT::PointSpring) return {kCompression, kBilinear, kTrilinear};
    if (type.definition == HINGE_DEFINITION::CurvatureDistributed) return {kFema};
    std::vector<ENTRY> list{kBilinear, kTrilinear};
    if (const ENTRY* fema = FemaEntry(type, c, context)) list.push_back(*fema);
    list.push_back(kSlipBi);
    list.push_back(kSlipTri);
    if (!context.altHysteresis && c != HINGE_COMPONENT::Mx &&
        type.element != HINGE_ELEMENT::GeneralLink)
        list.push_back(
            {kEc8Key, SKEL_TYPE::Ec8,
             CPO_HingeSkcvTabEuroDlg::IsEurocodePair(context.concreteCode, context.steelCode)});
    return list;
}

int CPO_HingeTypeDlg::SelectedSkcv(HINGE_COMPONENT c) const
{
    return Position(CustomizeSkcvCmb(m_type, c, m_context),
                    m_type.components[static_cast<std::size_t>(c)].type);
}

std::vector<const char*> CPO_HingeTypeDlg::InitComboByMaterialType(MATL_CLASS material)
{
    switch (material) {
    case MATL_CLASS::Concrete:
        return {"IDS_CMD_IEHP_CONC_PO"};
    case MATL_CLASS::Steel:
        return {"IDS_CMD_IEHP_STEL_PO"};
    case MATL_CLASS::Composite:
        return {"IDS_CMD_IEHP_CONC_PO", "IDS_CMD_IEHP_STEL_PO"};
    case MATL_CLASS::Masonry:
        break; // strengths of masonry are entered
    }
    return {};
}

void CPO_HingeTypeDlg::OnSelChangeElement(HINGE_ELEMENT element)
{
    m_type.element = element;
    RefillSkcv();
}

void CPO_HingeTypeDlg::OnSelChangeDefinition(HINGE_DEFINITION definition)
{
    m_type.definition = definition;
    RefillSkcv();
}

void CPO_HingeTypeDlg::OnSelChangeMaterial(MATL_CLASS material)
{
    m_type.material = material;
    RefillSkcv();
}

void CPO_HingeTypeDlg::OnComponentCtrl(HINGE_COMPONENT c, bool active)
{
    At(c).active = active;
}

void CPO_HingeTypeDlg::OnLocationCtrl(HINGE_COMPONENT c, HINGE_LOCATION location)
{
    At(c).location = location;
}

void CPO_HingeTypeDlg::OnIJSymmetryRdo(HINGE_COMPONENT c, bool sameEnds)
{
    if (At(c).sameEnds == sameEnds) return;
    At(c).sameEnds = sameEnds;
    At(c).curves.J = At(c).curves.I;
}

int CPO_HingeTypeDlg::OnSelChangeSkcv(HINGE_COMPONENT c, int index)
{
    const std::vector<ENTRY> list = CustomizeSkcvCmb(m_type, c, m_context);
    if (index < 0 || index >= static_cast<int>(list.size())) return 0;
    const ENTRY& entry = list[static_cast<std::size_t>(index)];
    if (!entry.enabled) return 0;
    SetType(At(c), entry.code);
    return 1;
}

int CPO_HingeTypeDlg::OnBtnSkcvProp(HINGE_COMPONENT c)
{
    T_HINGE_COMPONENT& component = At(c);
    if (component.type == SKEL_TYPE::Fema) {
        CPO_HingeSkcvTabFemaDlg dlg;
        return RunEditor(dlg, View(), c, component) && dlg.Dlg2Data(c, component);
    }
    if (component.type == SKEL_TYPE::Ec8) {
        CPO_HingeSkcvTabEuroDlg dlg;
        return RunEditor(dlg, View(), c, component) && dlg.Dlg2Data(component);
    }
    CPO_HingeSkcvTabDlg dlg;
    return RunEditor(dlg, View(), c, component) && dlg.Dlg2Data(component);
}

int CPO_HingeTypeDlg::ConvertInteraction(int index, HINGE_INTERACTION& code)
{
    if (index < 0 || index >= static_cast<int>(kBendingInteractions.size())) return 0;
    code = kBendingInteractions[static_cast<std::size_t>(index)];
    return 1;
}

int CPO_HingeTypeDlg::ConvertInteraction(HINGE_INTERACTION code)
{
    const auto at = std::find(kBendingInteractions.begin(), kBendingInteractions.end(), code);
    return at == kBendingInteractions.end() ? -1
                                            : static_cast<int>(at - kBendingInteractions.begin());
}

int CPO_HingeTypeDlg::OnSelChangeInteraction(int index)
{
    return ConvertInteraction(index, m_type.interaction);
}

CPO_HingeTypeDlg::T_LENGTH_STATE CPO_HingeTypeDlg::GetHingeLengthEnableState(const T_PHGT_D& type,
                                                                             bool altHysteresis)
{
    T_LENGTH_STATE state{};
    for (std::size_t i = 0; i < state.size(); ++i) {
        const T_HINGE_COMPONENT& c = type.components[i];
        const auto which = static_cast<HINGE_COMPONENT>(i);
        const bool bending = which == HINGE_COMPONENT::My ||
                             (which == HINGE_COMPONENT::Mz && !type.withholdMzLength);
        const bool needs = c.active && (altHysteresis || (bending && c.type == SKEL_TYPE::Ec8));
        const bool both = c.location == HINGE_LOCATION::BothEnds;
        state[i].I = needs && (both || c.location == HINGE_LOCATION::IEnd);
        state[i].J = needs && (both || c.location == HINGE_LOCATION::JEnd);
    }
    return state;
}

const char* CPO_HingeTypeDlg::HingeLengthCaptionKey(bool altHysteresis)
{
    return altHysteresis ? "IDS_RPS_PO_HINGE_LENGTH_LV" : "IDS_RPS_PO_HINGE_LENGTH_LPL";
}

bool CPO_HingeTypeDlg::IsHingeLengthEnabled() const
{
    const T_LENGTH_STATE state = GetHingeLengthEnableState(m_type, m_context.altHysteresis);
    return std::any_of(state.begin(), state.end(),
                       [](const T_ENDS<bool>& e) { return e.I || e.J; });
}

std::vector<T_FINDING> CPO_HingeTypeDlg::TypeFindings(const T_PHGT_D& type,
                                                      const T_HINGE_CONTEXT& context)
{
    const bool looksUp = context.section && context.material;
    const T_TYPE_CHECK check{type, looksUp ? context.section(type.section) : nullptr,
                             looksUp ? context.material(type.sectionMaterial) : nullptr, looksUp};
    std::vector<T_FINDING> out;
    WalkRules(std::span<const T_RULE<T>>(kTypeRules), check, {}, out);
    for (std::size_t i = 0; i < type.components.size(); ++i) {
        const T_HINGE_COMPONENT& c = type.components[i];
        if (!c.active) continue;
        OfferFindings(type, context, i, out);
        ForEachPage(c, [&](HINGE_END end, const T_SKEL_CURVE& curve) {
            CurveFindings(c.type, curve, {static_cast<int>(i), end}, out);
        });
    }
    if (type.masonry) {
        CPO_HingeMasonryDlg masonry;
        masonry.Data2Dlg(*type.masonry);
        for (T_FINDING& f : masonry.Findings()) {
            f.field = "masonry." + f.field;
            out.push_back(f);
        }
    }
    if (context.interactionFindings) context.interactionFindings(type, out);
    return out;
}

int CPO_HingeTypeDlg::CheckData()
{
    const std::vector<T_FINDING> found = Findings();
    if (found.empty()) return 1;
    ShowMessage(found.front().messageKey, found.front().text);
    return 0;
}

T_HINGE_COMPONENT& CPO_HingeTypeDlg::At(HINGE_COMPONENT c)
{
    return m_type.components[static_cast<std::size_t>(c)];
}

/// A stored curve type that is not in its list gives way to the first entry.
void CPO_HingeTypeDlg::RefillSkcv()
{
    for (std::size_t i = 0; i < m_type.components.size(); ++i) {
        const auto c = static_cast<HINGE_COMPONENT>(i);
        const std::vector<ENTRY> list = CustomizeSkcvCmb(m_type, c, m_context);
        if (Position(list, m_type.components[i].type) < 0)
            SetType(m_type.components[i], list.front().code);
    }
}
