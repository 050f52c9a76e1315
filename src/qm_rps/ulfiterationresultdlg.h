// Model of the result dialog of a construction-stage problem: the factors, and whether to iterate.
#pragma once

#include "qm_base/mdialog.h"
#include "qm_rps/factors/ulfanalysed.h"
#include "qm_rps/factors/ulfiterationreport.h"

#include <array>

class CUlfIterationResultDlg : public zql::frx::MDialog {
public:
    /// Heads of the table of unknowns.
    static constexpr std::array<const char*, 4> kHeads{
        "IDS_RPS_GXGRID_Stage", "IDS_RPS_GXGRID_LCase", "IDS_RPS_GXGRID_Factor",
        "IDS_QM_ULSI_HEAD_PRETENSION"};

    explicit CUlfIterationResultDlg(T_ULF_ITER_STEP step) : m_step(std::move(step)) {}

    const T_ULF_ITER_STEP& Step() const { return m_step; }
    /// Number of the solution and its tolerance, in a sentence.
    std::string Summary() const;
    bool m_iterate = false; // iterative analysis, or one more iteration, is wanted
    bool m_dontAsk = false; // with it: the dialog is not shown again in this run

private:
    T_ULF_ITER_STEP m_step;
};

/// Text of a cell of the table of unknowns; factors with nine digits, the flag as "1" and "0".
std::string UlfIterCellText(const T_ULF_ITER_ROW& row, std::size_t column);

/// Heads of the table of stays, and its cells with seven digits.
inline constexpr std::array<const char*, 6> kUlfStayHeads{
    "IDS_QM_UI_ULF_ELEMENT", "IDS_RPS_GXGRID_LCase", "IDS_QM_CLI_STAY_START",
    "IDS_RPS_GXGRID_Factor", "IDS_QM_CLI_STAY_NOW",  "IDS_QM_CLI_STAY_FORCE"};
std::string UlfStayText(const T_ULF_STAY& stay, std::size_t column);
