// Model of the editor of a masonry hinge: form 1 with the height Hp, form 2 with a distribution
// coefficient. Strengths are stresses, in the caller's units.
#pragma once

#include "qm_base/checkeddialog.h"
#include "qm_rps/hinge/hingelabels.h"

class CPO_HingeMasonryDlg : public CCheckedDialog {
public:
    T_HINGE_OWNER m_owner; // for titles and units

    T_MASONRY_HINGE m_masonry;

    void Data2Dlg(const T_MASONRY_HINGE& data) { m_masonry = data; }
    /// Checks, then writes. 0: `data` as it was.
    [[nodiscard]] int Dlg2Data(T_MASONRY_HINGE& data);

    std::vector<T_FINDING> Findings() const override;
};
