// Model of the choice of one pushover load case.
#pragma once

#include "qm_rps/pushover/loadcaserows.h"
#include "qm_rps/rpsdlgbase.h"

class CPO_SelectLoadCaseDlg : public CRPSDlgBase {
public:
    std::vector<T_LOADCASE_ROW> Rows() const;
    /// Key of the chosen load case; 0: none.
    int Selected() const { return m_selected; }
    void SetSelected(int key) { m_selected = key; }

    /// The chosen load case exists; 0 with a message otherwise.
    int CheckData() override;

private:
    int m_selected = 0;
};
