// Model of the list of pushover load cases: add, modify, copy, delete.
#pragma once

#include "qm_rps/pushover/loadcaserows.h"
#include "qm_rps/rpsdlgbase.h"

class CPO_LoadCaseListDlg : public CRPSDlgBase {
public:
    std::vector<T_LOADCASE_ROW> Rows() const;
    /// Key of the chosen load case; 0: none.
    int m_selected = 0;

    // Each is 1 done, as one edit that can be undone; 0 cancelled or refused with a message (none
    // chosen, used by evaluations: they are named), the document as it was.

    /// Runs the load case dialog on a new case, which is then the chosen one.
    [[nodiscard]] int OnAdd() { return RunItem(0); }
    /// Runs it on the chosen one.
    [[nodiscard]] int OnModify() { return CheckChoice() ? RunItem(m_selected) : 0; }
    /// A copy of the chosen one under a name of its own, without results; it is then chosen. One
    /// from another solver gets control data, whose values have to be entered yet.
    [[nodiscard]] int OnCopy();
    [[nodiscard]] int OnDelete();
    /// Runs the dialog that makes load cases at once, and shows what they were made with.
    [[nodiscard]] int OnGenerate();

private:
    int RunItem(int key);
    bool CheckChoice();
};
