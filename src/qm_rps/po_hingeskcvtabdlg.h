// Model of the editor of bilinear, trilinear, slip and compression-only skeleton curves.
// Both sides hold magnitudes; units as the caller's.
#pragma once

#include "qm_base/checkeddialog.h"
#include "qm_rps/hinge/hingefindings.h"
#include "qm_rps/hinge/pageyield.h"

class CPO_HingeSkcvTabDlg : public CCheckedDialog {
public:
    T_HINGE_OWNER m_owner; // for titles and units

    /// 1 done; 0 the component has other curves.
    [[nodiscard]] int Data2Dlg(HINGE_COMPONENT c, const T_HINGE_COMPONENT& data);
    /// Checks, then writes back, symmetric curves copied to the negative side. 0: `data` as it was.
    [[nodiscard]] int Dlg2Data(T_HINGE_COMPONENT& data);

    T_HINGE_COMPONENT& Component() { return m_data; }
    HINGE_COMPONENT Which() const { return m_component; }
    /// After each edit: automatic pages show what is calculated, the negative side of a symmetric
    /// curve follows the positive one.
    void OnEdited();
    /// Strengths of a page from section and material, which are shown where they are known, or
    /// entered.
    void OnUserAutoRdo(HINGE_END end, bool automatic);
    /// What an automatic page calculates from the type's own section; see CalculatedPage.
    T_PAGE_VALUES Calculated(HINGE_END end);
    /// The curve of a page, or null before Data2Dlg.
    T_SKEL_MULTI* Curve(HINGE_END end);

    T_SIDES<double> m_alpha1, m_alpha2; // defaults of the model
    /// The button of the default ratios of a page.
    void OnDefaultAlphaBtn(HINGE_END end) { SetDefaultAlpha(end, m_alpha1, m_alpha2); }
    /// Default stiffness reduction ratios: alpha1 and alpha2 for the positive and negative side.
    void SetDefaultAlpha(HINGE_END end, const T_SIDES<double>& alpha1,
                         const T_SIDES<double>& alpha2);
    /// Initial stiffness option; user stiffness values stay.
    void ChangeInitStiff(HINGE_END end, INIT_STIFFNESS option);
    /// Which sides have an initial gap; gaps of the others stay as entered and are not checked.
    void OnChangeSlipInitGap(HINGE_END end, GAP_SIDES sides);

    std::vector<T_FINDING> Findings() const override;

private:
    HINGE_COMPONENT m_component = HINGE_COMPONENT::Fx;
    T_HINGE_COMPONENT m_data;
};
