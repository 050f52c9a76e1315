// Model of the result dialog of a solved unknown load factor item: factors, constrained
// quantities, spreadsheet, load combination.
#pragma once

#include "qm_base/mdialog.h"
#include "qm_db/dbdoc.h"
#include "qm_rps/factors/ulfanalysed.h"
#include "qm_rps/factors/ulfsheet.h"

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

    enum class STATE { Within, Active, NotMet };
    static constexpr std::array<const char*, 3> kStateKeys{
        "IDS_QM_UI_ULF_WITHIN", "IDS_QM_UI_ULF_AT_BOUND", "IDS_QM_UI_ULF_NOT_MET"};
    /// Texts of the tables: numbers with nine digits, what rounding has left of a zero as 0.
    /// Columns of the factors: name, factor, whether it is unknown.
    std::string FactorText(std::size_t row, std::size_t column) const;
    /// Columns: name with its place, value, upper and lower bound, by how much they are missed,
    /// state (kConstraintHeads); then the unit, and the constraint in words.
    std::string ConstraintText(std::size_t row, std::size_t column) const;
    STATE StateOf(std::size_t constraint) const;
    /// Unit of a constraint's value.
    std::string UnitOf(std::size_t constraint) const;
    /// Elements with initial tensions in the unknown load cases: the tension as it stands in the
    /// case, times the factor, and of a static item the axial force under all cases.
    std::vector<T_ULF_STAY> Stays() const;
    std::string ForceUnit() const { return std::string(NameOf(m_doc.Data().Units().force)); }
    /// What is to be said about the values, if anything.
    std::string Notice() const;
    /// Title of the model.
    std::string ModelTitle() const;

    /// For OnExport(path); the file name is that of the model. The date is the caller's to set.
    T_ULF_SHEET_SETTINGS m_sheet;
    [[nodiscard]] int OnExport(const std::string& path) { return OnExport(path, m_sheet); }
    /// Writes the spreadsheet, factors that miss constraints only when the person wants it. 1 done;
    /// 0 not wanted, or with a message: too many constraints, or the file can't be written (then it
    /// is as it was).
    [[nodiscard]] int OnExport(const std::string& path, const T_ULF_SHEET_SETTINGS& settings);

    /// Writes it and opens it in the spreadsheet program. 0: as OnExport, or the program could not
    /// be started, with a message.
    [[nodiscard]] int OnOpenSheet(const std::string& path);

    /// Factors that miss constraints are written without a question.
    bool m_force = false;
    std::string m_combinationName; // of the combination to make
    /// The name is given and free, and the item is no construction-stage one: of loads at stages
    /// there are no combinations. 0: the reason went to the message history.
    int CheckData() override;
    /// Makes the combination, see AddUlfCombinations, of factors that miss constraints only when
    /// the person wants it. 0: refused (the dialog stays open), or not all of them could be added;
    /// the message history says what happened.
    [[nodiscard]] int OnMakeCombination();
    /// What the latest making of a combination has come to, in words; empty before it.
    const std::string& Outcome() const { return m_outcome; }

private:
    bool MayWrite();
    const T_ULF_RESULT_ROW& RowAt(std::size_t constraint) const;
    int Refuse(std::string reason);

    CDBDoc& m_doc;
    T_ULF_RESULT m_result;
    mutable std::vector<T_ULF_RESULT_ROW> m_rows; // made for the first cell that is shown
    std::string m_outcome;
};
