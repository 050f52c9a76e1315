#include "qm_rps/yieldstrengthcalcoptdlg.h"

#include "qm_base/msgfunction.h"
#include "qm_rps/desk/elementlist.h"
#include "qm_rps/hinge/hingechoices.h"
#include "qm_rps/hinge/hingetable.h"
#include "qm_rps/yieldstrengthcalcopteffdescdlg.h"
#include "qm_rps/yieldstrengthcalcoptmatdescdlg.h"

#include <algorithm>

int CYieldStrengthCalcOptDlg::OnSelectElemChk(bool on,
                                              const std::vector<T_SELECTED_ELEM>& selection)
{
    T_YIELD_CALC_OPT data;
    data.selectedOnly = on;
    for (const T_SELECTED_ELEM& e : selection) {
        if (!on) break;
        if (e.element != m_element) {
            ShowMessage("IDS_CMD2_SOD_SEL_ELEM_WRONG_ELEM");
            return 0;
        }
        data.elements.push_back(e.id);
    }
    std::sort(data.elements.begin(), data.elements.end());
    m_data = data;
    return 1;
}

int CYieldStrengthCalcOptDlg::OnSelectionText(const std::string& text)
{
    const std::optional<std::vector<int>> ids = ParseElementList(text);
    if (!ids) {
        ShowMessage("IDS_QM_UI_HINGE_NO_LIST");
        return 0;
    }
    std::vector<T_SELECTED_ELEM> selection;
    for (const int id : *ids) {
        const std::optional<HINGE_ELEMENT> kind = HingeElementOf(m_doc, id);
        if (!kind) {
            const std::string why = zql::lib::MMSGFunction::GetValue("IDS_CMD_IEHP_NO_ELEM");
            ShowMessage(
                "IDS_CMD_IEHP_NO_ELEM",
                zql::lib::MMSGFunction::Format("IDS_QM_HINGE_ELEMENT", {std::to_string(id), why}));
            return 0;
        }
        selection.push_back({id, *kind});
    }
    return OnSelectElemChk(true, selection);
}

std::string CYieldStrengthCalcOptDlg::SelectionText() const
{
    return ElementListText(m_data.elements);
}

std::string CYieldStrengthCalcOptDlg::ModeText() const
{
    return YieldCodeText(m_doc.Lib().GetConCodeName(), m_doc.Lib().GetStlCodeName());
}

std::vector<int> CYieldStrengthCalcOptDlg::Elements() const
{
    return m_data.selectedOnly ? m_data.elements : ElementsForHinges(m_doc, m_element);
}

int CYieldStrengthCalcOptDlg::OnMatlDescBtn()
{
    CYieldStrengthCalcOptMatDescDlg dlg(m_doc, Elements());
    dlg.SetView(View());
    return dlg.DoModal();
}

int CYieldStrengthCalcOptDlg::OnEffeDescBtn()
{
    CYieldStrengthCalcOptEffDescDlg dlg(m_doc, Elements());
    dlg.SetView(View());
    return dlg.DoModal();
}
