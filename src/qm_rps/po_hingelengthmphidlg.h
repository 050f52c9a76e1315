// Model of the editor of hinge lengths of a moment-curvature hinge: a block of six lengths per
// end, one per component.
#pragma once

#include "qm_base/mdialog.h"
#include "qm_rps/hinge/hingelabels.h"

class CPO_HingeLengthMPhiDlg : public zql::frx::MDialog {
public:
    T_HINGE_OWNER m_owner; // for units
    using T_BLOCKS = T_ENDS<std::array<double, 6>>;

    bool m_relative = false; // the lengths are fractions of the member's length

    /// Both blocks, whole.
    void SetData(const T_BLOCKS& blocks) { m_blocks = blocks; }
    const T_BLOCKS& GetData() const { return m_blocks; }

    /// The length entered for My is the length of every component at that end.
    void OnEnChangeMy_I(double length);
    void OnEnChangeMy_J(double length);
    /// An entry of any component: that of My as above, another one for itself.
    void OnEnChange(HINGE_COMPONENT c, HINGE_LOCATION end, double length);

private:
    T_BLOCKS m_blocks;
};
