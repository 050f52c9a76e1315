// Model of the editor of hinge lengths of a moment-rotation hinge: I-end and J-end per axis.
#pragma once

#include "qm_base/mdialog.h"
#include "qm_rps/hinge/hingelabels.h"

class CPO_HingeLengthMThetaDlg : public zql::frx::MDialog {
public:
    T_HINGE_OWNER m_owner;     // for units
    T_ENDS<double> m_My, m_Mz; // length, or fraction of the member's length
    bool m_relative = false;

    void Data2Dlg(const T_HINGE_LENGTH& data);
    void Dlg2Data(T_HINGE_LENGTH& data) const;
    void OnBtnRelativeLength(bool relative) { m_relative = relative; }
    /// The fields of absolute lengths are hidden while lengths are relative.
    bool AbsoluteFieldsHidden() const { return m_relative; }
};
