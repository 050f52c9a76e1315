// Model of the dialog of one unknown load factor item of construction stages: its loads with stage
// and step, objective, sign and constraints, and the calculation of its factors.
#pragma once

#include "qm_db/dbdoc.h"
#include "qm_rps/hingedialog.h"
#include "qm_rps/ulfiteration.h"
#include "qm_rps/ulfresult.h"
#include "qm_rps/ulfstageproblem.h"
#include "qm_rps/ulfstageresponse.h"

class CUnknownStageItemDlg : public CHingeDialog {
public:
    /// Columns of the grid; flags are "1" and "0".
    enum COLUMN { Stage, LoadCase, Unknown, Known, Factor, Weight, Pretension, Group };
    static constexpr std::array<const char*, 8> kHeads{
        "IDS_RPS_GXGRID_Stage",        "IDS_RPS_GXGRID_LCase",  "IDS_RPS_GXGRID_Unknown",
        "IDS_RPS_GXGRID_known",        "IDS_RPS_GXGRID_Factor", "IDS_RPS_GXGRID_Weighted_Factor",
        "IDS_QM_ULSI_HEAD_PRETENSION", "IDS_QM_ULSI_HEAD_GROUP"};
    /// Texts of the load groups, and of the sum of the stage loads.
    static constexpr std::array<const char*, 3> kGroupKeys{"IDS_RPS_DL", "IDS_RPS_ER",
                                                           "IDS_QM_ULSI_OWN"};
    static constexpr const char* kSumKey = "IDS_RPS_SUM";

    struct T_CHECK {
        std::string name; // of a constraint of the model
        bool checked = false;
        bool operator==(const T_CHECK&) const = default;
    };

    /// Document and results must outlive the dialog. key: of the item to edit, 0 for a new one.
    CUnknownStageItemDlg(CDBDoc& doc, IUlfStageResults& results, int key = 0);

    void Data2Dlg(const T_ULSI_D& item);
    /// The item as edited, unchecked.
    T_ULSI_D Record() const;
    /// Checks, then writes. 0: a message was shown, `item` as it was.
    [[nodiscard]] int Dlg2Data(T_ULSI_D& item);

    std::string m_name;
    int m_objective = 0; // index as in CUnknownLoadFactorItemDlg
    int m_sign = 1;      // likewise
    bool m_solveByEquations = false;
    bool m_sumStageLoads = false;   // load groups 0 and 1 read the sum of all stage loads
    std::vector<T_CHECK> m_checks;  // all constraints of the model
    std::vector<T_ULSI_ROW> m_rows; // of the grid

    /// Text of a cell: factors as "%.3f", weights as "%.6f", the stage as "S1/First Step".
    std::string CellText(std::size_t row, COLUMN column) const;
    /// Takes an edited cell: unknown or pretension flag, factor or weight. 0: no such cell, or not
    /// a finite number; the cell as it was.
    [[nodiscard]] int SetCell(std::size_t row, COLUMN column, const std::string& text);

    std::vector<T_FINDING> Findings() const override;
    /// Checks, then stores the item as one edit that can be undone. 0: refused, nothing stored.
    int OnOK() override;
    int Key() const { return m_key; }

    /// One calculation with the stage results at hand. 1: Result() has the factors; 0: refused or
    /// not solved, with a message, and no result kept. Either outcome goes to the history.
    [[nodiscard]] int OnCalculate();
    const std::optional<T_ULF_RESULT>& Result() const { return m_result; }
    const T_OPT_ANSWER& Answer() const { return m_answer; }
    /// The unknowns with their factors of the latest solution, in the order of the problem.
    std::vector<T_ULF_ITER_ROW> SolvedRows() const;
    /// Grid row of an unknown of the problem.
    std::size_t RowOfUnknown(std::size_t unknown) const { return m_formed.unknowns[unknown]; }

    /// The calculation button: checks the input, then runs the iteration on the host. 1 see
    /// CUlfIteration::Run; 0 refused with a message, or as there.
    [[nodiscard]] int OnIterate(CUlfIteration& iteration);

private:
    int ReadConstraints(const T_ULSI_D& item);
    T_ULF_RESULT MakeResult(const T_ULSI_D& item) const;
    std::string FailureText() const;

    CDBDoc& m_doc;
    int m_key = 0;
    std::vector<std::string> m_missing; // constraints that the item names and the model lacks
    CUlfStageResponse m_source;
    std::vector<T_ULFC_D> m_constraints; // that take part, of the latest calculation
    T_ULF_STAGE_FORMED m_formed;
    T_OPT_ANSWER m_answer;
    std::optional<T_ULF_RESULT> m_result;
};
