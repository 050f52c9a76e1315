// Model of the dialog of one unknown load factor item of construction stages: its loads with stage
// and step, objective, sign and constraints, and the calculation of its factors.
#pragma once

#include "qm_rps/factors/ulfstageproblem.h"
#include "qm_rps/ulfitemdialog.h"

class CUnknownStageItemDlg : public CUlfItemDialog {
public:
    /// Columns of the grid; flags are "1" and "0".
    enum COLUMN { Stage, LoadCase, Unknown, Known, Factor, Weight, Pretension, Group };
    static constexpr std::array<const char*, 8> kHeads{
        "IDS_RPS_GXGRID_Stage",        "IDS_RPS_GXGRID_LCase",  "IDS_RPS_GXGRID_Unknown",
        "IDS_RPS_GXGRID_known",        "IDS_RPS_GXGRID_Factor", "IDS_RPS_GXGRID_Weighted_Factor",
        "IDS_QM_ULSI_HEAD_PRETENSION", "IDS_QM_ULSI_HEAD_GROUP"};
    /// A row below the grid: how many rows are of dead load cases, of erection load cases, and in
    /// all.
    struct T_SUMMARY {
        std::string_view key; // of its text
        std::size_t rows = 0, unknowns = 0;
        bool operator==(const T_SUMMARY&) const = default;
    };

    /// The document must outlive the dialog. key: of the item to edit, 0 for a new one.
    explicit CUnknownStageItemDlg(CDBDoc& doc, int key = 0);

    void Data2Dlg(const T_ULSI_D& item);
    /// The item as edited, unchecked.
    T_ULSI_D Record() const;
    /// Checks, then writes. 0: a message was shown, `item` as it was.
    [[nodiscard]] int Dlg2Data(T_ULSI_D& item);

    bool m_sumStageLoads = false; // load groups 0 and 1 read the sum of all stage loads
    /// Of the grid, in the order in which a person gave them. A stored item has its unknown rows
    /// before its known ones (FitRecord).
    std::vector<T_ULSI_ROW> m_rows;

    /// Text of a cell: factors as "%.3f", weights as "%.6f", the stage as "S1/First Step".
    std::string CellText(std::size_t row, COLUMN column) const;
    /// Takes an edited cell: a text of Choices, unknown or pretension flag, factor or weight. 0: no
    /// such cell, not a finite number or none of the choices; the cell as it was.
    [[nodiscard]] int SetCell(std::size_t row, COLUMN column, const std::string& text);
    /// What the cells of stage and step, load case or load group may hold; empty of the others.
    std::vector<std::string> Choices(COLUMN column) const;
    /// Adds a row at the end: place and load group of the row before (else the first step of the
    /// first stage), with the first load case that does not stand there yet.
    void OnAddRow();
    /// 0: no such row.
    [[nodiscard]] int OnDeleteRow(std::size_t row);

    /// By the groups of the rows' load cases, whatever the rows read.
    std::array<T_SUMMARY, 3> Summary() const;

    /// Rules that are not kept; of a row each is told with its number, stage/step and load case.
    std::vector<T_FINDING> Findings() const override;
    std::vector<T_FINDING> Warnings() const override;
    /// Checks, then stores the item as one edit that can be undone. 0: refused, nothing stored.
    int OnOK() override;
    int Key() const { return m_key; }

    /// Opens the window of the iterative analysis on the item as it is edited, once the input
    /// passes its check.
    void OnIterateWindow();

private:
    std::string GroupText(int group) const;
    [[nodiscard]] int SetChoice(T_ULSI_ROW& row, COLUMN column, const std::string& text) const;
    /// With the stage results at hand.
    T_ULF_CALCULATION Calculated() override;
    std::optional<T_ANALYSIS_OPTIONS> MissingResults() const override;

    int m_key = 0;
};
