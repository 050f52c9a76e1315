#include "qm_rps/unknownloadfactorresultdlg.h"

#include "qm_base/messagehistory.h"
#include "qm_base/msgfunction.h"
#include "qm_rps/ulfcombination.h"

using zql::lib::MMSGFunction;

namespace {

int Refuse(const char* key, const std::string& name = {})
{
    GSaveHistoryFormatNF("%s", MMSGFunction::Format(key, {name}).c_str());
    return 0;
}

} // namespace

CUnknownLoadFactorResultDlg::CUnknownLoadFactorResultDlg(CDBDoc& doc, T_ULF_RESULT result)
    : m_doc(doc), m_result(std::move(result))
{
}

int CUnknownLoadFactorResultDlg::OnExport(const std::string& path,
                                          const T_ULF_SHEET_SETTINGS& settings)
{
    T_SHEET sheet;
    if (!MakeUlfSheet(m_result, settings, sheet)) {
        ShowMessage("IDS_RPS_UNKNOWN_LOAD_EXCEED_COLUMN_ERROR");
        return 0;
    }
    T_FILE_ERROR error;
    if (WriteSheet(path, sheet, error)) return 1;
    ShowMessage("IDS_QM_ULF_SHEET_NOT_WRITTEN", error.text);
    return 0;
}

int CUnknownLoadFactorResultDlg::CheckData()
{
    if (m_result.stage) return Refuse("IDS_QM_ULSI_NO_COMBINATION", m_result.item.name);
    if (m_combinationName.empty()) return Refuse("IDS_RPS_UNKNOWN_LOAD_NAME_NOTENTERED");
    if (m_doc.Attr().ExistLcom(m_combinationName))
        return Refuse("IDS_RPS_UNKNOWN_LOAD_LCOM_EXIST", m_combinationName);
    return 1;
}

int CUnknownLoadFactorResultDlg::OnMakeCombination()
{
    if (!CheckData()) return 0;
    T_LCOM_D combination, flat;
    if (!m_doc.Attr().GetLcom(m_result.item.combination, combination) ||
        !m_doc.Attr().NormalizeLcom(combination, flat))
        return Refuse("IDS_RPS_UNKNOWN_LOAD_LCOM_FAIL", m_combinationName);
    std::map<int, double> factors;
    for (std::size_t i = 0; i < m_result.cases.size(); ++i)
        factors[m_result.cases[i].key] = m_result.factors[i];
    return AddUlfCombinations(m_doc, m_combinationName,
                              PlanUlfCombinations(m_combinationName, flat, factors));
}
