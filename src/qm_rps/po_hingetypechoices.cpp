// What the hinge type editor offers: lists, states of its parts, labels.
#include "qm_base/textformat.h"
#include "qm_rps/hinge/hingetheta.h"
#include "qm_rps/po_hingeskcvtabeurodlg.h"
#include "qm_rps/po_hingetypedlg.h"
#include "qm_rps/po_hingetypelistdlg.h"

#include <algorithm>

namespace {

using ENTRY = CPO_HingeTypeDlg::T_SKCV_ENTRY;
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

using T = T_PHGT_D;

bool IsFrame(const T& t)
{
    return t.element == HINGE_ELEMENT::BeamColumn;
}
bool IsWall(const T& t)
{
    return t.element == HINGE_ELEMENT::Wall;
}
bool IsTruss(const T& t)
{
    return t.element == HINGE_ELEMENT::Truss;
}
bool Bends(const T& t)
{
    return IsFrame(t) || IsWall(t);
}
bool IsLine(const T& t)
{
    return Bends(t) || IsTruss(t);
}
bool BySection(const T& t)
{
    return t.definition != HINGE_DEFINITION::MomentRotation;
}
bool BendingActive(const T& t)
{
    return t.components[4].active || t.components[5].active;
}

/// A part of the editor. Disabled where it is not shown.
struct T_PART_ROW {
    CPO_HingeTypeDlg::PART part;
    bool (*shown)(const T&);
    bool (*enabled)(const T&); // null: always
};
using P = CPO_HingeTypeDlg::PART;
// clang-format off
constexpr T_PART_ROW kParts[] = {
    {P::Interaction,       Bends,   BendingActive},
    {P::YieldSurface,      Bends,   [](const T& t) { return BendingActive(t) && t.interaction == HINGE_INTERACTION::PMM; }},
    {P::UserInteraction,   Bends,   [](const T& t) { return BendingActive(t) && t.interaction == HINGE_INTERACTION::User; }},
    {P::Section,           IsLine,  nullptr},
    {P::Thickness,         IsWall,  nullptr},
    {P::FibreFrame,        [](const T& t) { return (IsFrame(t) || IsTruss(t)) && BySection(t); }, nullptr},
    {P::FibreWall,         [](const T& t) { return IsWall(t) && BySection(t); }, nullptr},
    {P::IntegrationPoints, [](const T& t) { return Bends(t) && t.definition == HINGE_DEFINITION::CurvatureDistributed; }, nullptr},
    {P::HingeLength,       Bends,   nullptr}, // enabled by the components
    {P::Location,          Bends,   nullptr},
    {P::Masonry,           [](const T& t) { return Bends(t) && t.material == MATL_CLASS::Masonry; }, nullptr},
    {P::InfillStrut,       IsTruss, [](const T& t) { return t.components[0].active && t.components[0].type == SKEL_TYPE::Fema; }},
};
// clang-format on

/// Sections that fit, with their names or thicknesses.
template <class FITS, class TEXT>
CPO_HingeTypeDlg::T_REF_LIST SectionList(const T_HINGE_CONTEXT& context, FITS fits, TEXT text)
{
    CPO_HingeTypeDlg::T_REF_LIST list;
    if (!context.sources) return list;
    for (const auto& [key, section] : context.sources->Sections())
        if (fits(section)) list.push_back({key, CPO_HingeTypeListDlg::NameOf(key, text(section))});
    return list;
}
std::string NameOfSection(const T_SECT_D& s)
{
    return s.name;
}
bool AnySection(const T_SECT_D&)
{
    return true;
}

} // namespace

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

const char* CPO_HingeTypeDlg::SkcvKey(SKEL_TYPE code)
{
    static constexpr const char* keys[] = {kBilinear.key,   kTrilinear.key, kSlipBi.key,
                                           kSlipTri.key,    kFema.key,      kEc8Key,
                                           kCompression.key};
    const auto at = static_cast<std::size_t>(code);
    return at < std::size(keys) ? keys[at] : "IDS_PUSHOVER_Error";
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

CPO_HingeTypeDlg::T_REF_LIST CPO_HingeTypeDlg::InitFiberCombo_Fibr() const
{
    return SectionList(m_context, CHingeSources::HasFibres, NameOfSection);
}

CPO_HingeTypeDlg::T_REF_LIST CPO_HingeTypeDlg::InitFiberCombo_Fibw() const
{
    return SectionList(m_context, CHingeSources::IsWall, NameOfSection);
}

CPO_HingeTypeDlg::T_REF_LIST CPO_HingeTypeDlg::InitPropCombo_Sect() const
{
    return SectionList(m_context, IsWall(m_type) ? CHingeSources::IsWall : AnySection,
                       NameOfSection);
}

CPO_HingeTypeDlg::T_REF_LIST CPO_HingeTypeDlg::InitPropCombo_Thik() const
{
    return SectionList(m_context, CHingeSources::IsWall,
                       [](const T_SECT_D& s) { return ShortestText(CHingeSources::Thickness(s)); });
}

CPO_HingeTypeDlg::T_MODE CPO_HingeTypeDlg::CustomizeDlgByMode() const
{
    T_MODE mode{};
    for (const T_PART_ROW& row : kParts) {
        T_PART_STATE& state = mode[static_cast<std::size_t>(row.part)];
        state.shown = row.shown(m_type);
        state.enabled = state.shown && (!row.enabled || row.enabled(m_type));
    }
    T_PART_STATE& length = mode[static_cast<std::size_t>(P::HingeLength)];
    length.enabled = length.shown && IsHingeLengthEnabled();
    return mode;
}

bool CPO_HingeTypeDlg::HasComponent(HINGE_ELEMENT element, HINGE_COMPONENT c)
{
    return element != HINGE_ELEMENT::Truss || c == HINGE_COMPONENT::Fx;
}

std::string CPO_HingeTypeDlg::HingeModelLabel(HINGE_DEFINITION definition, HINGE_COMPONENT c)
{
    static constexpr const char* labels[] = {"Moment - Rotation (M-%s)",
                                             "Moment - Curvature (M-%s Lumped)",
                                             "Moment - Curvature (M-%s Distributed)"};
    static constexpr const char* symbols[] = {"Rx", "Ry", "Rz"};
    if (c < HINGE_COMPONENT::Mx) return {};
    const auto symbol = static_cast<std::size_t>(c) - static_cast<std::size_t>(HINGE_COMPONENT::Mx);
    return FormatText(labels[static_cast<std::size_t>(definition)], symbols[symbol]);
}

std::vector<CPO_HingeTypeDlg::T_STIFFNESS_ROW>
CPO_HingeTypeDlg::UpdateInitialStiffness(double memberLength) const
{
    T_THETA_LOOKUP lookup;
    lookup.memberLength = m_type.length.autoSpan ? memberLength : m_type.length.span;
    if (m_context.sources) {
        lookup.section = m_context.sources->Section(m_type.section);
        lookup.material = m_context.sources->Material(m_type.sectionMaterial);
    }
    std::vector<T_STIFFNESS_ROW> rows;
    for (std::size_t i = 0; i < m_type.components.size(); ++i) {
        if (!m_type.components[i].active) continue;
        const auto c = static_cast<HINGE_COMPONENT>(i);
        const auto use = [&](HINGE_END end, const auto& curve) {
            const auto at = end == HINGE_END::J ? HINGE_LOCATION::JEnd : HINGE_LOCATION::IEnd;
            const auto stiffness = [&](const auto& side) {
                return CHingeTheta::CalcStiffness(lookup, c, at, curve.initStiffness,
                                                  side.userStiffness);
            };
            bool two = !curve.symmetric;
            if constexpr (requires { curve.asymStiffness; }) two = curve.asymStiffness;
            rows.push_back(
                {c,
                 end,
                 curve.initStiffness,
                 {stiffness(curve.sides.pos), stiffness(two ? curve.sides.neg : curve.sides.pos)}});
        };
        ForEachPage(m_type.components[i], [&](HINGE_END end, const T_SKEL_CURVE& curve) {
            std::visit([&](const auto& k) { use(end, k); }, curve);
        });
    }
    return rows;
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

SKEL_TYPE CPO_HingeTypeDlg::YieldSurfaceCurve(const T_PHGT_D& type)
{
    const T_HINGE_COMPONENT& my = type.components[4];
    return my.active ? my.type : type.components[5].type;
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

std::string CPO_HingeTypeDlg::LengthText(HINGE_COMPONENT c, const T_ENDS<double>& length) const
{
    const T_LENGTH_STATE state = GetHingeLengthEnableState(m_type, m_context.altHysteresis);
    const T_ENDS<bool>& needs = state[static_cast<std::size_t>(c)];
    std::string text;
    if (needs.I) text = "I " + ShortestText(length.I);
    if (needs.J) text += (text.empty() ? "J " : ", J ") + ShortestText(length.J);
    return text;
}

std::string CPO_HingeTypeDlg::GetHingeLength_MTheta(HINGE_COMPONENT c) const
{
    if (c == HINGE_COMPONENT::My) return LengthText(c, m_type.length.My);
    return c == HINGE_COMPONENT::Mz ? LengthText(c, m_type.length.Mz) : std::string();
}

std::string CPO_HingeTypeDlg::GetHingeLength_MPhi(HINGE_COMPONENT c) const
{
    const auto i = static_cast<std::size_t>(c);
    const auto& blocks = m_type.length.components;
    return LengthText(c, {blocks.I[i], blocks.J[i]});
}
