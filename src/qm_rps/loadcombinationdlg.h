// Model of the dialog of one load combination: its name, its load cases and combinations with
// their factors.
#pragma once

#include "qm_base/checkeddialog.h"
#include "qm_db/dbdoc.h"

class CLoadCombinationDlg : public CCheckedDialog {
public:
    enum COLUMN { Part, Factor };
    static constexpr std::array<const char*, 2> kHeads{"IDS_QM_UI_LCOM_PART",
                                                       "IDS_RPS_GXGRID_Factor"};

    /// The document must outlive the dialog. key: of the combination to edit, 0 for a new one.
    explicit CLoadCombinationDlg(CDBDoc& doc, int key = 0);

    T_LCOM_D m_combination; // as edited

    std::string CellText(std::size_t row, COLUMN column) const;
    /// 0: no such row, none of PartTexts, or no finite number; the cell as it was.
    [[nodiscard]] int SetCell(std::size_t row, COLUMN column, const std::string& text);
    /// What a row may refer to: the load cases, then the other combinations.
    std::vector<std::string> PartTexts() const;
    /// Adds a row with the first load case that has none yet, else with the first one.
    void OnAddRow();
    /// 0: no such row.
    [[nodiscard]] int OnDeleteRow(std::size_t row);
    /// The combination as load cases and factors, "1.35 G + 1.5 Q"; or why that can't be had.
    std::string FlatText() const;

    /// Name given and free, rows that exist, no combination that contains itself.
    std::vector<T_FINDING> Findings() const override;
    /// Checks, then stores the combination as one edit that can be undone. 0: refused.
    int OnOK() override;

private:
    struct T_PART {
        T_LCOM_ITEM item;
        std::string text;
    };
    std::vector<T_PART> Parts() const;

    CDBDoc& m_doc;
    int m_key = 0;
};
