#include "qm_rps/pushoverhingelistdlg.h"

#include "qm_base/appbase.h"
#include "qm_base/msgfunction.h"
#include "qm_rps/hinge/hingechoices.h"
#include "qm_rps/hinge/hingegenerator.h"
#include "qm_rps/hinge/hingetable.h"
#include "qm_rps/po_hingetypelistdlg.h"

#include <algorithm>

using zql::lib::MMSGFunction;

namespace {

using T_STRENGTHS = std::array<T_SIDES<double>, 6>;
constexpr std::array<const char*, 2> kEndKeys{"IDS_RPS_PO_LOCATION_I_end",
                                              "IDS_RPS_PO_LOCATION_J_end"};

bool HasOwnEnd(const T_PHGE_D& hinge)
{
    return hinge.yieldJ != T_STRENGTHS{} || hinge.crackJ != T_STRENGTHS{};
}

/// Strengths at one end; 0 where the component has its hinge at the other one.
T_STRENGTHS StrengthsAt(const T_PHGT_D& type, const T_PHGE_D& hinge, HINGE_LOCATION end, bool crack)
{
    const bool j = end == HINGE_LOCATION::JEnd;
    const HINGE_LOCATION other = j ? HINGE_LOCATION::IEnd : HINGE_LOCATION::JEnd;
    T_STRENGTHS out{};
    for (std::size_t i = 0; i < out.size(); ++i) {
        const T_HINGE_COMPONENT& c = type.components[i];
        if (c.location == other) continue;
        const bool own = j && NeedsIJPages(c);
        out[i] =
            crack ? (own ? hinge.crackJ : hinge.crack)[i] : (own ? hinge.yieldJ : hinge.yield)[i];
    }
    return out;
}

} // namespace

std::string CPushOverHingeListDlg::InteractionText(int code)
{
    switch (code) {
    case 0:
        return "P";
    case 1:
        return "My-Mz";
    case 2:
        return "Vy-Vz";
    case 3:
        return "PMM";
    case 4:
        return MMSGFunction::GetValue("IDS_RPS_PUSHOVER_User");
    default:
        break;
    }
    if (CAppBase::IsReleaseAssert_ST())
        CAppBase::ReleaseAssertion_ST("src/qm_rps/pushoverhingelistdlg", __LINE__);
    return {};
}

std::string CPushOverHingeListDlg::FamilyText(int code)
{
    if (code == 0) return MMSGFunction::GetValue("IDS_RPS_MULTILINEAR");
    return code == 1 ? "FEMA" : MMSGFunction::GetValue("IDS_PUSHOVER_Error");
}

std::string CPushOverHingeListDlg::KindText(const T_PHGT_D& type)
{
    std::string text = InteractionText(static_cast<int>(type.interaction));
    if (type.interactionMz) text += ", " + InteractionText(static_cast<int>(*type.interactionMz));
    std::vector<std::string> families;
    for (const T_HINGE_COMPONENT& c : type.components) {
        if (!c.active) continue;
        const bool fema = c.type == SKEL_TYPE::Fema;
        const std::string family = c.type == SKEL_TYPE::Ec8
                                       ? MMSGFunction::GetValue(CurveKey(c.type))
                                       : FamilyText(fema ? 1 : 0);
        if (std::ranges::find(families, family) == families.end()) families.push_back(family);
    }
    for (std::size_t i = 0; i < families.size(); ++i)
        text += (i == 0 ? "; " : ", ") + families[i];
    return text;
}

std::string CPushOverHingeListDlg::TypeKind() const
{
    const T_TABLE<T_PHGT_D>& types = m_doc.Data().Model().hingeTypes;
    const auto type = types.find(m_type);
    return type == types.end() ? std::string() : KindText(type->second);
}

std::string CPushOverHingeListDlg::ColumnHead(HINGE_COMPONENT c, bool positive)
{
    return std::string(kComponentNames[static_cast<std::size_t>(c)]) + (positive ? "(+)" : "(-)");
}

std::string CPushOverHingeListDlg::StrengthText(HINGE_COMPONENT c, bool crack)
{
    const bool moment = c >= HINGE_COMPONENT::Mx;
    if (crack)
        return MMSGFunction::GetValue(moment ? "IDS_RPS_PUSHOVER_CRACK_MOMENT"
                                             : "IDS_RPS_PUSHOVER_CRACK_FROCE");
    return MMSGFunction::GetValue(moment ? "IDS_RPS_PUSHOVER_YIELD_MOMENT"
                                         : "IDS_RPS_PUSHOVER_YIELD_FROCE");
}

std::vector<std::string> CPushOverHingeListDlg::Heads()
{
    std::vector<std::string> heads;
    for (int c = 0; c < 6; ++c)
        for (const bool positive : {true, false})
            heads.push_back(ColumnHead(static_cast<HINGE_COMPONENT>(c), positive));
    return heads;
}

std::vector<CPushOverHingeListDlg::T_ROW> CPushOverHingeListDlg::Rows(bool crack) const
{
    std::vector<T_ROW> rows;
    const CHingeGenerator generator(m_doc);
    const T_TABLE<T_PHGT_D> types = HingeTypesOf(m_doc);
    for (const auto& [key, hinge] : HingesOf(m_doc)) {
        const auto type = types.find(hinge.hingeType);
        const bool gone = type == types.end();
        const std::string name = CPO_HingeTypeListDlg::NameOf(
            hinge.hingeType,
            gone ? MMSGFunction::GetValue("IDS_PUSHOVER_Error") : type->second.name);
        T_ROW row{key,
                  hinge.element,
                  name,
                  crack ? hinge.crack : hinge.yield,
                  generator.StaleText(hinge),
                  m_types.Fault(hinge.hingeType)};
        if (gone || !HasOwnEnd(hinge)) {
            rows.push_back(row);
            continue;
        }
        for (const HINGE_LOCATION end : {HINGE_LOCATION::IEnd, HINGE_LOCATION::JEnd}) {
            const bool j = end == HINGE_LOCATION::JEnd;
            row.type = name + ", " + MMSGFunction::GetValue(kEndKeys[j ? 1 : 0]);
            row.strengths = StrengthsAt(type->second, hinge, end, crack);
            rows.push_back(row);
        }
    }
    return rows;
}

int CPushOverHingeListDlg::CheckData()
{
    if (m_selected == 0) {
        ShowMessage("IDS_PUSHOVER_No_selected_Hinge_Data__nChoose_one_an");
        return 0;
    }
    if (m_doc.Data().Model().hinges.contains(m_selected)) return 1;
    constexpr const char* gone = "IDS_PUSHOVER_Generated_Hinge_key__d_does_not_exits_";
    ShowMessage(gone, MMSGFunction::Format(gone, {std::to_string(m_selected)}));
    return 0;
}

std::optional<HINGE_ELEMENT> CPushOverHingeListDlg::TypeElement() const
{
    const T_TABLE<T_PHGT_D>& types = m_doc.Data().Model().hingeTypes;
    const auto type = types.find(m_type);
    return type == types.end() ? std::nullopt : std::optional(type->second.element);
}

void CPushOverHingeListDlg::OnSelChangeType(int type)
{
    const std::optional<HINGE_ELEMENT> before = TypeElement();
    m_type = type;
    if (TypeElement() != before) m_options = {};
}

std::vector<int> CPushOverHingeListDlg::Elements() const
{
    if (m_options.selectedOnly) return m_options.elements;
    const std::optional<HINGE_ELEMENT> element = TypeElement();
    return element ? ElementsForHinges(m_doc, *element) : std::vector<int>();
}

int CPushOverHingeListDlg::OnOptionBtn()
{
    const std::optional<HINGE_ELEMENT> element = TypeElement();
    if (const auto fault = CPO_HingeTypeListDlg::ChoiceFault(m_type, element.has_value())) {
        ShowMessage(fault->key, fault->text);
        return 0;
    }
    // Walls are elements of beams in the model.
    const bool wall = *element == HINGE_ELEMENT::Wall;
    CYieldStrengthCalcOptDlg dlg(m_doc, wall ? HINGE_ELEMENT::BeamColumn : *element);
    dlg.SetView(View());
    dlg.SetData(m_options);
    if (!dlg.DoModal()) return 0;
    dlg.GetData(m_options);
    return 1;
}

int CPushOverHingeListDlg::OnGenerate()
{
    if (const auto fault = CPO_HingeTypeListDlg::ChoiceFault(m_type, TypeElement().has_value())) {
        ShowMessage(fault->key, fault->text);
        return 0;
    }
    T_HINGE_REFUSAL refusal;
    if (CHingeGenerator(m_doc).Generate(m_type, Elements(), refusal)) return 1;
    ShowMessage("IDS_QM_HINGE_NOT_STORED", refusal.text);
    return 0;
}

int CPushOverHingeListDlg::OnDelete()
{
    if (!CheckData()) return 0;
    if (!EraseHinge(m_doc, m_selected)) {
        ShowMessage("IDS_QM_HINGE_NOT_STORED");
        return 0;
    }
    m_selected = 0;
    return 1;
}
