#include "qm_rps/pushovercasegeneratordlg.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_rps/po_loadcasedlg.h"

void CPushOverCaseGeneratorDlg::SetDoc(CDBDoc* doc)
{
    CRPSDlgBase::SetDoc(doc);
    if (doc) m_choice.directions = PushableDirections(doc->Data().Model());
}

std::string CPushOverCaseGeneratorDlg::BasisText() const
{
    const std::string length(Doc() ? NameOf(Doc()->Unit().Units().length) : "");
    const auto number = [](double v) { return FormatText("%.6g", v); };
    const std::string text =
        Say(m_isTargetGiven ? "IDS_QM_PUSH_GEN_BASIS" : "IDS_QM_PUSH_GEN_BASIS_HEIGHT",
            std::to_string(m_basis.controlNode), number(m_basis.target), length,
            number(m_basis.height));
    const std::string modes = ModeBasisText(m_basis);
    return modes.empty() ? text : text + "\n" + modes;
}

int CPushOverCaseGeneratorDlg::OnOK()
{
    if (!Doc()) return 0;
    std::vector<T_POLC_D> cases;
    T_CASE_BASIS basis;
    std::string error;
    if (!GenerateCases(*Doc(), m_choice, cases, basis, error)) {
        ShowMessage("IDS_QM_UI_POLC_EIGHT", error);
        return 0;
    }
    m_basis = basis;
    m_isTargetGiven = m_choice.target.has_value();
    int key = CPO_LoadCaseDlg::NextKey(*Doc());
    return Edit("IDS_QM_UI_POLC_EIGHT", [&](CEditScope& edit) {
        for (const T_POLC_D& record : cases)
            if (!edit.Put(key++, record)) return false;
        return true;
    });
}
