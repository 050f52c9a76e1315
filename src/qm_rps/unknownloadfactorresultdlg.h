// Model of the result dialog of a solved unknown load factor item: factors, constrained
// quantities, spreadsheet, load combination.
#pragma once

#include "qm_base/mdialog.h"
#include "qm_db/dbdoc.h"
#include "qm_rps/ulfsheet.h"

class CUnknownLoadFactorResultDlg : public zql::frx::MDialog {
public:
    /// Heads of the table of load cases and of that of constraints.
    static constexpr std::array<const char*, 2> kFactorHeads{
        "IDS_RPS_GXGRID_LCase", "IDS_RPS_UNKNOWN_LOAD_GXRESULT_Factor"};
    /// The former of construction stages, whose rows read "stage/step case".
    static constexpr std::array<const char*, 2> kStageFactorHeads{
        "IDS_RPS_GXGRID_Stage", "IDS_RPS_UNKNOWN_LOAD_GXRESULT_Factor"};
    static constexpr std::array<const char*, 6> kConstraintHeads{
        "IDS_RPS_UNKNOWN_LOAD_GXRESULT_Constraint",
        "IDS_RPS_UNKNOWN_LOAD_GXRESULT_Value",
        "IDS_RPS_UNKNOWN_LOAD_GXRESULT_Upper_Bound",
        "IDS_RPS_UNKNOWN_LOAD_GXRESULT_Lower_Bound",
        "IDS_QM_ULF_RESIDUAL",
        "IDS_QM_ULF_ACTIVE"};

    /// The document must outlive the dialog.
    CUnknownLoadFactorResultDlg(CDBDoc& doc, T_ULF_RESULT result);

    const T_ULF_RESULT& Result() const { return m_result; }
    const std::array<const char*, 2>& FactorHeads() const
    {
        return m_result.stage ? kStageFactorHeads : kFactorHeads;
    }
    std::vector<T_ULF_RESULT_ROW> Rows() const { return UlfResultRows(m_result); }

    /// Writes the spreadsheet. 1 done; 0 with a message: too many constraints, or the file can't
    /// be written (then it is as it was).
    [[nodiscard]] int OnExport(const std::string& path, const T_ULF_SHEET_SETTINGS& settings);

    std::string m_combinationName; // of the combination to make
    /// The name is given and free, and the item is no construction-stage one: of loads at stages
    /// there are no combinations. 0: the reason went to the message history.
    int CheckData() override;
    /// Makes the combination, see AddUlfCombinations. 0: refused (the dialog stays open), or not
    /// all of them could be added; the message history says what happened.
    [[nodiscard]] int OnMakeCombination();

private:
    CDBDoc& m_doc;
    T_ULF_RESULT m_result;
};
