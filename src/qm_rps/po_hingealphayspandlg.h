// Model of the editor of the span that the yield rotation is computed with.
#pragma once

#include "qm_base/mdialog.h"
#include "qm_rps/hinge/hingelabels.h"

class CPO_HingeAlphaYSpanDlg : public zql::frx::MDialog {
public:
    T_HINGE_OWNER m_owner; // for units
    bool m_auto = true;    // span from the member
    double m_span = 0.0;   // length

    void Data2Dlg(const T_HINGE_LENGTH& data);
    /// Automatic: the flag is stored and the span stays as it was; else flag and span.
    void Dlg2Data(T_HINGE_LENGTH& data) const;
};
