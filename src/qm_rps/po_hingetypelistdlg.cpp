#include "qm_rps/po_hingetypelistdlg.h"

#include "qm_base/msgfunction.h"
#include "qm_db/editscope.h"
#include "qm_rps/hinge/hingecontext.h"
#include "qm_rps/hinge/hingelabels.h"
#include "qm_rps/hinge/hingetable.h"
#include "qm_rps/hingeoptionsdlg.h"
#include "qm_rps/po_hingetypedlg.h"

#include <algorithm>

using zql::lib::MMSGFunction;

namespace {

constexpr std::size_t kNamedUsers = 10; // a message names no more elements than these

std::string Listed(const std::vector<int>& ids)
{
    std::string text;
    for (std::size_t i = 0; i < ids.size() && i < kNamedUsers; ++i)
        text += (i ? ", " : "") + std::to_string(ids[i]);
    return ids.size() > kNamedUsers ? text + " ..." : text;
}

} // namespace

std::vector<CPO_HingeTypeListDlg::T_ROW> CPO_HingeTypeListDlg::Rows() const
{
    std::vector<T_ROW> rows;
    for (const auto& [key, type] : HingeTypesOf(m_doc))
        rows.push_back({key, NameOf(key, type.name), DataToStr(type.element), m_types.CodeText(key),
                        m_types.Fault(key)});
    return rows;
}

std::string CPO_HingeTypeListDlg::DataToStr(HINGE_ELEMENT element)
{
    return ElementText(element);
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
    const auto fault = ChoiceFault(m_selected, HingeTypesOf(m_doc).contains(m_selected));
    if (!fault) return 1;
    ShowMessage(fault->key, fault->text);
    return 0;
}

int CPO_HingeTypeListDlg::OnDelete()
{
    if (!CheckData()) return 0;
    const std::vector<int> users = m_doc.Attr().GetElemsByPhgt(m_selected);
    if (!users.empty()) {
        constexpr const char* used = "IDS_QM_HINGE_TYPE_USED";
        ShowMessage(used, MMSGFunction::Format(used, {std::to_string(m_selected), Listed(users)}));
        return 0;
    }
    if (!EraseHingeType(m_doc, m_selected)) return 0;
    m_selected = 0;
    return 1;
}

int CPO_HingeTypeListDlg::OnAdd()
{
    return Edit(NextKey(m_doc.Data().Model().hingeTypes), {}, true);
}

int CPO_HingeTypeListDlg::OnModify()
{
    return CheckData() ? Edit(m_selected, HingeTypesOf(m_doc).at(m_selected), false) : 0;
}

int CPO_HingeTypeListDlg::OnCopy()
{
    if (!CheckData()) return 0;
    const T_TABLE<T_PHGT_D> types = HingeTypesOf(m_doc);
    T_PHGT_D copy = types.at(m_selected);
    const auto taken = [&](const std::string& name) {
        return std::ranges::any_of(types, [&](const auto& t) { return t.second.name == name; });
    };
    const std::string name = copy.name;
    for (int n = 2; taken(copy.name); ++n)
        copy.name = name + " (" + std::to_string(n) + ")";
    const int key = NextKey(m_doc.Data().Model().hingeTypes);
    if (!StoreHingeType(m_doc, key, copy)) {
        ShowMessage("IDS_QM_HINGE_NOT_STORED");
        return 0;
    }
    m_selected = key;
    return 1;
}

std::string CPO_HingeTypeListDlg::Description() const
{
    const T_TABLE<T_PHGT_D> types = HingeTypesOf(m_doc);
    const auto type = types.find(m_selected);
    if (type == types.end()) return {};
    std::string components;
    for (std::size_t i = 0; i < type->second.components.size(); ++i)
        if (type->second.components[i].active)
            components += (components.empty() ? "" : ", ") + std::string(kComponentNames[i]);
    const std::vector<int> users = m_doc.Attr().GetElemsByPhgt(m_selected);
    return MMSGFunction::Format("IDS_QM_UI_HINGE_DESCRIPTION",
                                {NameOf(type->first, type->second.name),
                                 components.empty() ? "-" : components,
                                 users.empty() ? "-" : Listed(users)});
}

int CPO_HingeTypeListDlg::Edit(int key, const T_PHGT_D& type, bool fresh)
{
    CPO_HingeTypeDlg dlg(HingeContextOf(m_doc));
    dlg.SetView(View());
    dlg.m_store = [&](const T_PHGT_D& t) { return StoreHingeType(m_doc, key, t); };
    dlg.m_editOptions = [&]() -> std::optional<T_HINGE_CONTEXT> {
        CHingeOptionsDlg options(m_doc);
        options.SetView(View());
        if (!options.DoModal()) return std::nullopt;
        return HingeContextOf(m_doc);
    };
    const std::vector<int> users = m_doc.Attr().GetElemsByPhgt(key);
    if (!users.empty() && !m_doc.Memb().GetMembLengByIncludeElem(users.front(), dlg.m_memberLength))
        dlg.m_memberLength = 0.0;
    for (const auto& [other, record] : HingeTypesOf(m_doc))
        if (other != key) dlg.m_otherNames.push_back(record.name);
    dlg.Data2Dlg(type);
    for (int c = 0; fresh && c < 6; ++c)
        dlg.InitDataByDof(static_cast<HINGE_COMPONENT>(c));
    if (!dlg.DoModal()) return 0;
    m_selected = key;
    return 1;
}
