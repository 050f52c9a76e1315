// Model of the editor of the Eurocode 8 skeleton curve (EN 1998-3: chord rotation, limit states
// as acceptance criteria). Points follow the FEMA pattern; signs and units as there.
#pragma once

#include "qm_base/checkeddialog.h"
#include "qm_rps/hinge/hingefindings.h"
#include "qm_rps/hinge/pageyield.h"

#include <array>
#include <optional>

class CPO_HingeSkcvTabEuroDlg : public CCheckedDialog {
public:
    T_HINGE_OWNER m_owner; // for titles and units

    /// 1 done; 0 the component has other curves.
    [[nodiscard]] int Data2Dlg(HINGE_COMPONENT c, const T_HINGE_COMPONENT& data);
    /// Checks, then writes back, symmetric curves mirrored. 0: `data` as it was.
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
    T_SKEL_EC8* Curve(HINGE_END end);

    /// Switches the measure of a page: ratios D/Dy against plastic deformations, by the yield
    /// deformation of each side. Values that were not edited since the last switch come back digit
    /// by digit. 1 done; 0 no such page.
    [[nodiscard]] int OnMeasureRdo(HINGE_END end, SKEL_MEASURE measure);

    std::vector<T_FINDING> Findings() const override;

private:
    HINGE_COMPONENT m_component = HINGE_COMPONENT::Fx;
    T_HINGE_COMPONENT m_data;
    struct T_SWITCH {
        T_SKEL_EC8 before, after; // around the last switch of the measure
    };
    std::array<std::optional<T_SWITCH>, 2> m_switches; // by end
};
