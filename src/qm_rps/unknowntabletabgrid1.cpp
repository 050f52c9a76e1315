#include "qm_rps/unknowntabletabgrid1.h"

#include "qm_base/msgfunction.h"
#include "qm_rps/factors/ulfstageplace.h"
#include "qm_rps/factors/ulfstore.h"
#include "qm_rps/unknownloadfactorconstraintdlg.h"

#include <algorithm>

using zql::lib::MMSGFunction;

namespace {

/// Items of both kinds, static and of construction stages.
std::string ItemsThatUse(const T_MODEL& model, const std::string& constraint)
{
    std::string names;
    const auto collect = [&](const auto& table) {
        for (const auto& [key, item] : table)
            if (std::ranges::find(item.constraints, constraint) != item.constraints.end())
                names += (names.empty() ? "" : ", ") + item.name;
    };
    collect(model.ulfItems);
    collect(model.ulfStageItems);
    return names;
}

} // namespace

std::vector<CUnknownTableTabGrid1::T_ROW> CUnknownTableTabGrid1::Rows() const
{
    std::vector<T_ROW> rows;
    for (const int key : m_doc.Attr().GetUlfcKeys()) {
        T_ULFC_D c;
        if (!m_doc.Attr().GetUlfc(key, c)) continue;
        rows.push_back({key, c.name, UlfConstraintText(m_doc.Data(), c)});
    }
    return rows;
}

int CUnknownTableTabGrid1::CheckData()
{
    if (m_doc.Data().Model().ulfConstraints.contains(m_selected)) return 1;
    ShowMessage("IDS_QM_ULFC_GONE");
    return 0;
}

int CUnknownTableTabGrid1::OnAdd()
{
    CUnknownLoadFactorConstraintDlg dlg(m_doc);
    dlg.SetView(View());
    if (!dlg.DoModal()) return 0;
    m_selected = dlg.Key();
    return 1;
}

int CUnknownTableTabGrid1::OnModify()
{
    if (!CheckData()) return 0;
    CUnknownLoadFactorConstraintDlg dlg(m_doc, m_selected);
    dlg.SetView(View());
    return dlg.DoModal();
}

int CUnknownTableTabGrid1::OnDelete()
{
    if (!CheckData()) return 0;
    const std::string name = m_doc.Data().Model().ulfConstraints.at(m_selected).name;
    const std::string users = ItemsThatUse(m_doc.Data().Model(), name);
    if (!users.empty()) {
        constexpr const char* used = "IDS_QM_ULFC_USED";
        ShowMessage(used, MMSGFunction::Format(used, {name, users}));
        return 0;
    }
    return DeleteRecord<T_ULFC_D>(m_doc, m_selected);
}
