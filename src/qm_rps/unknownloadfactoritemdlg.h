// Model of the dialog of one unknown load factor item: its load cases, objective, sign and
// constraints, and the calculation of its factors.
#pragma once

#include "qm_rps/factors/ulfinfluencecache.h"
#include "qm_rps/factors/ulfstaticresponse.h"
#include "qm_rps/ulfitemdialog.h"

class CUnknownLoadFactorItemDlg : public CUlfItemDialog {
public:
    /// Columns of the load case grid; flags are "1" and "0".
    enum COLUMN { LoadCase, Unknown, Known, Factor, Weight };
    static constexpr std::array<const char*, 5> kHeads{
        "IDS_RPS_GXGRID_LCase", "IDS_RPS_GXGRID_Unknown", "IDS_RPS_GXGRID_known",
        "IDS_RPS_GXGRID_Factor", "IDS_RPS_GXGRID_Weighted_Factor"};

    /// The document must outlive the dialog. key: of the item to edit, 0 for a new one, which
    /// starts with the model's first combination.
    explicit CUnknownLoadFactorItemDlg(CDBDoc& doc, int key = 0);

    void Data2Dlg(const T_ULFI_D& item);
    /// The item as edited, unchecked.
    T_ULFI_D Record() const;
    /// Checks, then writes. 0: a message was shown, `item` as it was.
    [[nodiscard]] int Dlg2Data(T_ULFI_D& item);

    /// Another combination: its load cases; flags and weights of cases that both have stay.
    void OnSelChangeCombination(int key);
    /// The combinations of the model as a list: names, the chosen one (-1: it is gone), a choice.
    std::vector<std::string> CombinationTexts() const;
    int CombinationIndex() const;
    void OnSelChangeCombinationIndex(int index);

    const std::vector<T_ULF_CASE>& Cases() const { return m_cases; }
    /// Text of a cell: factors as "%.3f", weights as "%.6f".
    std::string CellText(std::size_t row, COLUMN column) const;
    /// Takes an edited cell: the unknown flag or the weight. 0: no such cell, or not a finite
    /// number; the cell as it was.
    [[nodiscard]] int SetCell(std::size_t row, COLUMN column, const std::string& text);

    /// Rules that are not kept, in the order of the check; CheckData shows the first.
    std::vector<T_FINDING> Findings() const override;
    /// Checks, then stores the item as one edit that can be undone. 0: refused, nothing stored.
    int OnOK() override;
    int Key() const { return m_key; }

private:
    T_ULF_CALCULATION Calculated() override;
    std::optional<T_ANALYSIS_OPTIONS> MissingResults() const override;

    int m_key = 0;
    int m_combination = 0;
    std::vector<T_ULF_CASE> m_cases;
    std::vector<T_ULFI_UNKNOWN> m_strangers; // unknown cases that the combination does not have
    CUlfStaticResponse m_source;
    CUlfInfluenceCache m_cache;
};
