#include "qm_rps/unknownloadfactordlg.h"

#include "qm_rps/factors/ulfstore.h"
#include "qm_rps/unknownloadfactoritemdlg.h"
#include "qm_rps/unknownstageitemdlg.h"

std::vector<CUnknownLoadFactorDlg::T_ROW> CUnknownLoadFactorDlg::Rows() const
{
    const T_MODEL& model = m_doc.Data().Model();
    std::vector<T_ROW> rows;
    for (const auto& [key, item] : model.ulfItems) {
        const auto it = model.combinations.find(item.combination);
        const bool known = it != model.combinations.end();
        rows.push_back({key, item.name, known ? it->second.name : std::string()});
    }
    for (const auto& [key, item] : model.ulfStageItems)
        rows.push_back({key, item.name, {}, true});
    return rows;
}

int CUnknownLoadFactorDlg::CheckData()
{
    const T_MODEL& model = m_doc.Data().Model();
    if (m_stage ? model.ulfStageItems.contains(m_selected) : model.ulfItems.contains(m_selected))
        return 1;
    ShowMessage("IDS_RPS_ULFD_MODIFY_DATA_NON_EXIST");
    return 0;
}

std::unique_ptr<CUlfItemDialog> CUnknownLoadFactorDlg::ChosenItem()
{
    if (!CheckData()) return nullptr;
    std::unique_ptr<CUlfItemDialog> item;
    if (m_stage)
        item = std::make_unique<CUnknownStageItemDlg>(m_doc, m_selected);
    else
        item = std::make_unique<CUnknownLoadFactorItemDlg>(m_doc, m_selected);
    item->SetView(View());
    return item;
}

template <class DIALOG>
int CUnknownLoadFactorDlg::Show(DIALOG&& dialog, bool stage)
{
    dialog.SetView(View());
    if (!dialog.DoModal()) return 0;
    m_selected = dialog.Key();
    m_stage = stage;
    return 1;
}

int CUnknownLoadFactorDlg::OnAdd()
{
    if (m_doc.Data().Model().combinations.empty()) {
        ShowMessage("IDS_RPS_No_General_Load_Combination_exist_");
        return 0;
    }
    return Show(CUnknownLoadFactorItemDlg(m_doc), false);
}

int CUnknownLoadFactorDlg::OnAddStage()
{
    if (m_doc.Data().Model().stages.empty()) {
        ShowMessage("IDS_QM_ULSI_NO_STAGES");
        return 0;
    }
    return Show(CUnknownStageItemDlg(m_doc), true);
}

int CUnknownLoadFactorDlg::OnModify()
{
    if (!CheckData()) return 0;
    return m_stage ? Show(CUnknownStageItemDlg(m_doc, m_selected), true)
                   : Show(CUnknownLoadFactorItemDlg(m_doc, m_selected), false);
}

int CUnknownLoadFactorDlg::OnDelete()
{
    if (!CheckData()) return 0;
    return m_stage ? DeleteRecord<T_ULSI_D>(m_doc, m_selected)
                   : DeleteRecord<T_ULFI_D>(m_doc, m_selected);
}
