#include "qm_rps/po_hingetypelistdlg.h"

#include "qm_base/msgfunction.h"

using zql::lib::MMSGFunction;

namespace {

constexpr std::array<const char*, 5> kElementKeys{
    "IDS_RPS_PO_Element_Beam_Column", "IDS_RPS_PO_Element_Wall", "IDS_RPS_PO_Element_Truss",
    "IDS_RPS_PO_Element_GeneralLink", "IDS_RPS_PO_Element_PointSpringSupport"};
constexpr std::size_t kNamedUsers = 10; // a message names no more elements than these

std::string Listed(const std::vector<int>& ids)
{
    std::string text;
    for (std::size_t i = 0; i < ids.size() && i < kNamedUsers; ++i)
        text += (i ? ", " : "") + std::to_string(ids[i]);
    return ids.size() > kNamedUsers ? text + " ..." : text;
}

} // namespace

CPO_HingeTypeListDlg::CPO_HingeTypeListDlg(T_HINGE_LIST_ACCESS access) : m_access(std::move(access))
{
}

std::vector<CPO_HingeTypeListDlg::T_ROW> CPO_HingeTypeListDlg::Rows() const
{
    std::vector<T_ROW> rows;
    for (const auto& [key, type] : m_access.types())
        rows.push_back({key, NameOf(key, type.name), DataToStr(type.element)});
    return rows;
}

std::string CPO_HingeTypeListDlg::DataToStr(HINGE_ELEMENT element)
{
    const auto at = static_cast<std::size_t>(element);
    return MMSGFunction::GetValue(at < kElementKeys.size() ? kElementKeys[at]
                                                           : "IDS_PUSHOVER_Error");
}

std::string CPO_HingeTypeListDlg::NameOf(int key, const std::string& name)
{
    return std::to_string(key) + " : " + name;
}

std::optional<zql::frx::T_MESSAGE> CPO_HingeTypeListDlg::ChoiceFault(int key, bool exists)
{
    constexpr const char* none = "IDS_PUSHOVER_No_selected_Hinge_Data_Type__nChoose_o";
    constexpr const char* gone = "IDS_PUSHOVER_Hinge_Data_Type_key__d_does_not_exits_";
    if (key == 0) return zql::frx::T_MESSAGE{none, MMSGFunction::GetValue(none)};
    if (exists) return std::nullopt;
    return zql::frx::T_MESSAGE{gone, MMSGFunction::Format(gone, {std::to_string(key)})};
}

int CPO_HingeTypeListDlg::CheckData()
{
    const auto fault = ChoiceFault(m_selected, m_access.types().contains(m_selected));
    if (!fault) return 1;
    ShowMessage(fault->key, fault->text);
    return 0;
}

int CPO_HingeTypeListDlg::OnDelete()
{
    if (!CheckData()) return 0;
    const std::vector<int> users = m_access.users(m_selected);
    if (!users.empty()) {
        constexpr const char* used = "IDS_QM_HINGE_TYPE_USED";
        ShowMessage(used, MMSGFunction::Format(used, {std::to_string(m_selected), Listed(users)}));
        return 0;
    }
    if (!m_access.erase(m_selected)) return 0;
    m_selected = 0;
    return 1;
}
