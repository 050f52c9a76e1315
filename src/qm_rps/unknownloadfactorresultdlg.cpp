#include "qm_rps/unknownloadfactorresultdlg.h"

#include "qm_base/messagehistory.h"
#include "qm_base/msgfunction.h"
#include "qm_base/textformat.h"
#include "qm_rps/factors/checks/ulfcombinationchecks.h"
#include "qm_rps/factors/ulfcombination.h"

#include <filesystem>

using zql::lib::MMSGFunction;

namespace {

std::string NumberText(const std::optional<double>& value)
{
    return value ? FormatText("%.9g", *value + 0.0) : std::string();
}

} // namespace

int CUnknownLoadFactorResultDlg::Refuse(std::string reason)
{
    m_outcome = std::move(reason);
    GSaveHistoryFormatNF("%s", m_outcome.c_str());
    return 0;
}

CUnknownLoadFactorResultDlg::CUnknownLoadFactorResultDlg(CDBDoc& doc, T_ULF_RESULT result)
    : m_doc(doc), m_result(std::move(result))
{
    m_sheet.fileName = std::filesystem::path(doc.Path()).filename().string();
}

const T_ULF_RESULT_ROW& CUnknownLoadFactorResultDlg::RowAt(std::size_t constraint) const
{
    if (m_rows.empty()) m_rows = UlfResultRows(m_result);
    return m_rows.at(constraint);
}

CUnknownLoadFactorResultDlg::STATE CUnknownLoadFactorResultDlg::StateOf(std::size_t i) const
{
    const T_ULF_RESULT_ROW& row = RowAt(i);
    return !row.met ? STATE::NotMet : row.active ? STATE::Active : STATE::Within;
}

std::string CUnknownLoadFactorResultDlg::UnitOf(std::size_t i) const
{
    return RowAt(i).unit;
}

std::vector<T_ULF_STAY> CUnknownLoadFactorResultDlg::Stays() const
{
    std::vector<T_ULF_STAY> stays;
    T_LCOM_D all;
    for (std::size_t j = 0; j < m_result.cases.size(); ++j)
        all.items.push_back({false, m_result.cases[j].key, m_result.factors[j]});
    const bool hasForces = !m_result.stage && m_doc.Post().SelectLoadCombNew(all);
    for (std::size_t j = 0; j < m_result.cases.size(); ++j) {
        const T_ULF_CASE& c = m_result.cases[j];
        T_STLD_D load;
        if (!c.unknown || !m_doc.Attr().GetStld(c.key, load)) continue;
        for (const auto& [element, start] : PretensionByElement(load)) {
            stays.push_back({element, load.name, start, start * m_result.factors[j]});
            double axial = 0.0;
            T_DOF6 forces{};
            if (hasForces && m_doc.Post().GetStrtNew(element, axial))
                stays.back().force = axial;
            else if (hasForces && m_doc.Post().GetStrbNew(element, 0, forces))
                stays.back().force = forces[0];
        }
    }
    return stays;
}

std::string CUnknownLoadFactorResultDlg::Notice() const
{
    return m_result.linearForecast ? MMSGFunction::GetValue("IDS_QM_ULF_LINEAR_FORECAST")
                                   : std::string();
}

std::string CUnknownLoadFactorResultDlg::ModelTitle() const
{
    return m_doc.Data().Model().styp.title;
}

std::string CUnknownLoadFactorResultDlg::FactorText(std::size_t row, std::size_t column) const
{
    const T_ULF_CASE& c = m_result.cases.at(row);
    if (column == 0) return c.name;
    if (column == 1) return NumberText(UlfShownFactor(m_result, row));
    return MMSGFunction::GetValue(c.unknown ? "IDS_RPS_GXGRID_Unknown" : "IDS_RPS_GXGRID_known");
}

std::string CUnknownLoadFactorResultDlg::ConstraintText(std::size_t i, std::size_t column) const
{
    const T_ULF_RESULT_ROW& row = RowAt(i);
    const double scale = UlfScale(m_result, i);
    switch (column) {
    case 0:
        return UlfNameAt(row.name, row.place);
    case 1:
        return NumberText(UlfShown(row.value, scale));
    case 2:
        return NumberText(row.upper);
    case 3:
        return NumberText(row.lower);
    case 4:
        return NumberText(UlfShown(row.residual, scale));
    case 5:
        return MMSGFunction::GetValue(kStateKeys[static_cast<std::size_t>(StateOf(i))]);
    case 6:
        return UnitOf(i);
    default:
        return row.description;
    }
}

bool CUnknownLoadFactorResultDlg::MayWrite()
{
    constexpr const char* key = "IDS_QM_ULF_MISSES";
    const std::string misses = UlfMisses(m_result);
    return m_force || misses.empty() || AskYesNo(key, MMSGFunction::Format(key, {misses}));
}

int CUnknownLoadFactorResultDlg::OnExport(const std::string& path,
                                          const T_ULF_SHEET_SETTINGS& settings)
{
    T_SHEET sheet;
    if (!MakeUlfSheet(m_result, settings, sheet)) {
        ShowMessage("IDS_RPS_UNKNOWN_LOAD_EXCEED_COLUMN_ERROR");
        return 0;
    }
    if (!MayWrite()) return 0;
    T_FILE_ERROR error;
    if (WriteSheet(path, sheet, error)) return 1;
    ShowMessage("IDS_QM_ULF_SHEET_NOT_WRITTEN", error.text);
    return 0;
}

int CUnknownLoadFactorResultDlg::OnOpenSheet(const std::string& path)
{
    if (!OnExport(path)) return 0;
    if (OpenSheetFile(path)) return 1;
    ShowMessage("IDS_QM_ULF_NO_EXCEL");
    return 0;
}

int CUnknownLoadFactorResultDlg::CheckData()
{
    if (m_result.stage)
        return Refuse(MMSGFunction::Format("IDS_QM_ULSI_NO_COMBINATION", {m_result.item.name}));
    const auto found = CheckCombinationName(m_combinationName, 0, m_doc.Data().Model());
    return found.empty() ? 1 : Refuse(found.front().text);
}

int CUnknownLoadFactorResultDlg::OnMakeCombination()
{
    if (!CheckData() || !MayWrite()) return 0;
    const std::optional<T_LCOM_D> flat = FlatCombination(m_doc.Data(), m_result.item.combination);
    if (!flat)
        return Refuse(MMSGFunction::Format("IDS_RPS_UNKNOWN_LOAD_LCOM_FAIL", {m_combinationName}));
    std::map<int, double> factors;
    for (std::size_t i = 0; i < m_result.cases.size(); ++i)
        factors[m_result.cases[i].key] = m_result.factors[i];
    const int made = AddUlfCombinations(m_doc, m_combinationName,
                                        PlanUlfCombinations(m_combinationName, *flat, factors));
    m_outcome = MMSGFunction::Format(made ? "IDS_RPS_UNKNOWN_LOAD_LCOM_SUCCESS"
                                          : "IDS_RPS_UNKNOWN_LOAD_LCOM_FAIL",
                                     {m_combinationName});
    return made;
}
