#include "qm_rps/unknownloadfactordlg.h"

#include "qm_rps/unknownloadfactoritemdlg.h"

std::vector<CUnknownLoadFactorDlg::T_ROW> CUnknownLoadFactorDlg::Rows() const
{
    const T_MODEL& model = m_doc.Data().Model();
    std::vector<T_ROW> rows;
    for (const auto& [key, item] : model.ulfItems) {
        const auto it = model.combinations.find(item.combination);
        const bool known = it != model.combinations.end();
        rows.push_back({key, item.name, known ? it->second.name : std::string()});
    }
    return rows;
}

int CUnknownLoadFactorDlg::CheckData()
{
    if (m_doc.Data().Model().ulfItems.contains(m_selected)) return 1;
    ShowMessage("IDS_RPS_ULFD_MODIFY_DATA_NON_EXIST");
    return 0;
}

int CUnknownLoadFactorDlg::OnAdd()
{
    if (m_doc.Data().Model().combinations.empty()) {
        ShowMessage("IDS_RPS_No_General_Load_Combination_exist_");
        return 0;
    }
    CUnknownLoadFactorItemDlg dlg(m_doc);
    dlg.SetView(View());
    if (!dlg.DoModal()) return 0;
    m_selected = dlg.Key();
    return 1;
}

int CUnknownLoadFactorDlg::OnModify()
{
    if (!CheckData()) return 0;
    CUnknownLoadFactorItemDlg dlg(m_doc, m_selected);
    dlg.SetView(View());
    return dlg.DoModal();
}

int CUnknownLoadFactorDlg::OnDelete()
{
    if (!CheckData()) return 0;
    CEditData& edit = m_doc.Edit();
    if (!edit.Begin(m_doc.Data().Model().ulfItems.at(m_selected).name)) return 0;
    if (!edit.Erase<T_ULFI_D>(m_selected) || !edit.Commit()) {
        edit.Rollback();
        return 0;
    }
    m_selected = 0;
    return 1;
}
