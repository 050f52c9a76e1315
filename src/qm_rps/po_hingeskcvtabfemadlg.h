// Model of the editor of FEMA skeleton curves (ASCE 41 generalised force-deformation relation)
// with their acceptance criteria.
// Units: as the caller's; nothing here depends on them. Signs: the negative side holds negative
// deformations, strengths and criteria; yield strengths and yield deformations are magnitudes.
// State: a working copy of up to six components. A hinge type gives one, a time-history property
// all that it has. Nothing leaves the editor before CheckData passes.
#pragma once

#include "qm_base/checkeddialog.h"
#include "qm_rps/hinge/axialforcelist.h"
#include "qm_rps/hinge/hingefindings.h"
#include "qm_rps/hinge/pageyield.h"

#include <array>
#include <optional>
#include <vector>

class CPO_HingeSkcvTabFemaDlg : public CCheckedDialog {
public:
    using T_ROW = std::array<double, 9>; // -E, -D, -C, -B, A, B, C, D, E

    T_HINGE_OWNER m_owner; // for titles and units
    /// Axial forces of the list; empty: every finite one.
    std::optional<CAxialForceList::T_RANGE> m_axialRange;

    /// Takes a component that has FEMA curves. 1 done; 0 it has other curves.
    [[nodiscard]] int Data2Dlg(HINGE_COMPONENT c, const T_HINGE_COMPONENT& data);
    /// Checks, then writes the component back, symmetric curves mirrored. 0: `data` as it was.
    [[nodiscard]] int Dlg2Data(HINGE_COMPONENT c, T_HINGE_COMPONENT& data);

    /// The component as edited, or null.
    T_HINGE_COMPONENT* Component(HINGE_COMPONENT c);
    /// The curve of a page (end I or Both: first page), or null. Views bind to it.
    T_SKEL_FEMA* Curve(HINGE_COMPONENT c, HINGE_END end);

    /// Every rule that is not kept; CheckData shows the first one.
    std::vector<T_FINDING> Findings() const override;

    /// Despite its name, D/Dy ratio to plastic deformation: (value - 1) * thetaY.
    /// 0 where |thetaY| < 1e-7.
    static double ConvertParamPR2DDy(double value, double thetaY);
    /// Plastic deformation to D/Dy ratio: 1 + value / thetaY. 0 where |thetaY| < 1e-7.
    static double ConvertParamDDy2PR(double value, double thetaY);

    /// Row conversions of the table editor, in place. Positions 2 and 8 take their values from
    /// positions 3 and 7, and every output reads the row as it stands then: this is meant. For a
    /// true conversion of a curve use ConvertHingeParam....
    static void ConvertPR2DDy(double thetaNeg, double thetaPos, T_ROW& row);
    static void ConvertDDy2PR(double thetaNeg, double thetaPos, T_ROW& row);

    /// Whole curve, all points, both signs, acceptance criteria, all axial forces: D/Dy ratios to
    /// plastic deformations. 1 done; 0 the curve is not in D/Dy, nothing changed.
    [[nodiscard]] static int ConvertHingeParamPR2DDy(T_SKEL_FEMA& curve);
    /// Plastic deformations to D/Dy ratios. 0: the curve is not in plastic deformations.
    [[nodiscard]] static int ConvertHingeParamDDy2PR(T_SKEL_FEMA& curve);

    /// Switches the measure of a page. Values that were not edited since the last switch come back
    /// digit by digit, even where a yield deformation of 0 has made them 0 meanwhile.
    [[nodiscard]] int OnMeasureRdo(HINGE_COMPONENT c, HINGE_END end, SKEL_MEASURE measure);

    /// Time-history mode (1): the moment-rotation options are open for components 3 and 4 alone.
    void SetTimeHistory(int on) { m_timeHistory = on != 0; }
    bool IsTimeHistory() const { return m_timeHistory; }
    bool IsMomentRotationEnabled(HINGE_COMPONENT c) const;

    /// Separate pages for I-end and J-end.
    bool IsNeedIJTab(HINGE_COMPONENT c) const;

    /// Strengths of a page from section and material, which are shown where they are known, or
    /// entered.
    void OnUserAutoRdo(HINGE_COMPONENT c, HINGE_END end, bool automatic);
    /// Yield strengths from section and material: taken only while they are automatic.
    void SetAutoCalcValue(HINGE_COMPONENT c, HINGE_END end, const T_SIDES<double>& yield);

    /// The switch "IDS_RPS_PO_FEMA_Compliance_Criteria". Off: the criteria keep their values, but
    /// are not checked and shown as inactive. 0: no such page.
    [[nodiscard]] int OnComplianceChk(HINGE_COMPONENT c, HINGE_END end, bool on);

    /// Infill panel as a strut: the curve has its own labels.
    bool IsInfillStrutMode(HINGE_COMPONENT c, HINGE_END end);
    void SetInfillStrutMode(HINGE_COMPONENT c, HINGE_END end, bool on);
    /// Keys of the labels of strengths, deformations, yield strength, criteria and drift ratio.
    static std::array<const char*, 5> InfillLabels(bool general);

    /// Runs the table of energy-dissipation factors in the view and takes it when it was accepted.
    [[nodiscard]] int OnEnergyBtn(HINGE_COMPONENT c, HINGE_END end);
    /// Curves by axial force on or off.
    void OnMultiCurveChk(HINGE_COMPONENT c, HINGE_END end, bool on);
    /// Runs the list of axial forces in the view and takes it when it was accepted.
    [[nodiscard]] int OnAxialForceBtn(HINGE_COMPONENT c, HINGE_END end);
    /// The sides of the chosen axial force (index), or of the curve itself; null: no such curve.
    T_SIDES<T_SKEL_SIDE>* SidesOf(HINGE_COMPONENT c, HINGE_END end, int axialIndex);

    // What the page shows. The page must exist.
    /// Chooses an axial force of the list (index).
    void OnSelChangeAxialCombo(HINGE_COMPONENT c, HINGE_END end, int index);
    /// The chosen force; -1: the curve has no list in use.
    int AxialIndex(HINGE_COMPONENT c, HINGE_END end);
    /// The forces as texts.
    std::vector<std::string> AxialTexts(HINGE_COMPONENT c, HINGE_END end);
    /// The sides of the chosen force, or the curve's own.
    T_SIDES<T_SKEL_SIDE>& ShownSides(HINGE_COMPONENT c, HINGE_END end);
    /// The curve with these sides alone.
    T_SKEL_FEMA ShownCurve(HINGE_COMPONENT c, HINGE_END end);
    /// Limits of demand / capacity in use or not.
    void OnDcRatioChk(HINGE_COMPONENT c, HINGE_END end, bool on);
    /// After each edit: automatic pages show what is calculated, the negative side of a symmetric
    /// curve follows the positive one.
    void OnEdited();
    /// What an automatic page calculates from the type's own section; see CalculatedPage.
    T_PAGE_VALUES Calculated(HINGE_COMPONENT c, HINGE_END end);
    /// A finding's field on the page: of the chosen axial force as of the curve itself.
    std::string FieldOnPages(const T_FINDING& f);
    /// The first component that is edited.
    HINGE_COMPONENT First() const;

private:
    struct T_SWITCH {
        T_SKEL_FEMA before, after; // around the last switch of the measure
    };
    std::optional<T_SWITCH>& LastSwitch(HINGE_COMPONENT c, HINGE_END end);

    std::array<std::optional<T_HINGE_COMPONENT>, 6> m_components;
    std::array<std::array<std::optional<T_SWITCH>, 2>, 6> m_switches;
    std::array<std::array<int, 2>, 6> m_axial{}; // chosen force of a page
    bool m_timeHistory = false;
};
