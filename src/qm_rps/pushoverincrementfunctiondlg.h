// Model of the editor of increment functions: by which steps a push goes to its load or
// displacement.
#pragma once

#include "qm_rps/rpsdlgbase.h"

class CPushOverIncrementFunctionDlg : public CRPSDlgBase {
public:
    /// Takes the document, reads its functions and chooses the first.
    void SetDoc(CDBDoc* doc) override;

    /// As edited; stored by OnOK.
    T_TABLE<T_POFC_D> m_functions;
    int m_selected = 0; // key; 0: none

    /// The chosen function, or null.
    T_POFC_D* Selected();
    /// Chooses by name. 1 done; 0 there is none of it.
    [[nodiscard]] int Select(const std::string& name);

    /// A function of one row, of step 1 and factor 1, under a free name; it is then chosen.
    void OnAdd();
    /// Takes the chosen function off. 0 with a message: none is chosen, or load cases follow it
    /// (they are named).
    [[nodiscard]] int OnDelete();

    /// Rules that are not kept: those of each function ("step", "factor" where it is the chosen
    /// one), a name for each and each name once.
    std::vector<T_FINDING> Findings() const override;
    /// Checks, then stores all changes as one edit that can be undone.
    int OnOK() override;

private:
    std::vector<T_FINDING> FindingsOf(int key, const T_POFC_D& function) const;
};
