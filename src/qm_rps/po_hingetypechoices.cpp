// The lists and texts of the hinge type editor.
#include "qm_base/msgfunction.h"
#include "qm_base/textformat.h"
#include "qm_rps/po_hingetypedlg.h"
#include "qm_rps/po_hingetypelistdlg.h"

#include <algorithm>

namespace {

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

/// A material for a type of that class; a composite one takes either of its two.
bool Fits(MATL_CLASS material, MATL_CLASS type)
{
    return material == type || (type == MATL_CLASS::Composite && material != MATL_CLASS::Masonry);
}

} // namespace

std::string CPO_HingeTypeDlg::StrengthMaterials() const
{
    std::string text;
    for (const char* key : InitComboByMaterialType(m_type.material))
        text += (text.empty() ? "" : ", ") + zql::lib::MMSGFunction::GetValue(key);
    return text.empty() ? zql::lib::MMSGFunction::GetValue("IDS_QM_UI_HINGE_ENTERED") : text;
}

std::array<std::string, 5> CPO_HingeTypeDlg::StiffnessCells(const T_STIFFNESS_ROW& row) const
{
    const auto value = [&](const std::optional<double>& k) {
        return k ? FormatText("%.6g", *k) + StiffnessHead("", row.component, Owner())
                 : std::string("-");
    };
    const int option = StiffnessPosition(row.component, row.option);
    const std::vector<std::string> options = StiffnessTexts(row.component);
    const bool known = option >= 0 && option < static_cast<int>(options.size());
    return {kComponentNames[static_cast<std::size_t>(row.component)],
            zql::lib::MMSGFunction::GetValue(PageTitleKey(At(m_type, row.component), row.end)),
            known ? options[static_cast<std::size_t>(option)] : "-", value(row.stiffness.pos),
            value(row.stiffness.neg)};
}

std::string CPO_HingeTypeDlg::HingeLengthsText() const
{
    std::string text;
    for (std::size_t i = 0; i < kComponentNames.size(); ++i) {
        const auto c = static_cast<HINGE_COMPONENT>(i);
        const bool rotation = m_type.definition == HINGE_DEFINITION::MomentRotation;
        const std::string lengths = rotation ? GetHingeLength_MTheta(c) : GetHingeLength_MPhi(c);
        if (lengths.empty()) continue;
        text += (text.empty() ? "" : "; ") + std::string(kComponentNames[i]) + ": " + lengths;
    }
    return text.empty() ? "-" : text;
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
    return SectionList(m_context,
                       m_type.element == HINGE_ELEMENT::Wall ? CHingeSources::IsWall : AnySection,
                       NameOfSection);
}

CPO_HingeTypeDlg::T_REF_LIST CPO_HingeTypeDlg::InitPropCombo_Thik() const
{
    return SectionList(m_context, CHingeSources::IsWall,
                       [](const T_SECT_D& s) { return ShortestText(CHingeSources::Thickness(s)); });
}

CPO_HingeTypeDlg::T_REF_LIST CPO_HingeTypeDlg::InitPropCombo_Matl() const
{
    T_REF_LIST list;
    if (!m_context.sources) return list;
    for (const auto& [key, material] : m_context.sources->Materials())
        if (Fits(material.type, m_type.material) || key == m_type.sectionMaterial)
            list.push_back({key, std::to_string(key) + " : " + material.name});
    return list;
}

int CPO_HingeTypeDlg::ConvertInteraction(int index, HINGE_INTERACTION& code)
{
    if (index < 0 || index >= static_cast<int>(kInteractions.size())) return 0;
    code = kInteractions[static_cast<std::size_t>(index)];
    return 1;
}

int CPO_HingeTypeDlg::ConvertInteraction(HINGE_INTERACTION code)
{
    const auto at = std::find(kInteractions.begin(), kInteractions.end(), code);
    return at == kInteractions.end() ? -1 : static_cast<int>(at - kInteractions.begin());
}

std::string CPO_HingeTypeDlg::LengthText(HINGE_COMPONENT c, const T_ENDS<double>& length) const
{
    const T_ENDS<bool> needs =
        LengthNeeds(m_type, m_context.altHysteresis)[static_cast<std::size_t>(c)];
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
