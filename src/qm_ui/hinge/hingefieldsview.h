// Fields that several hinge editors have: the two sides of a curve in a table, choices by key.
#pragma once

#include "qm_rps/hinge/pageyield.h"
#include "qm_rps/po_hingetypedlg.h"
#include "qm_ui/form/formview.h"

#include <memory>

/// Name and states of a field, in one go.
CFormField& Set(CFormField& field, std::string name, std::function<bool()> enabled = {},
                std::function<bool()> shown = {});

/// A choice among sections or materials, "none" first.
CFormField& RefChoice(CFormView& form, TextFn caption, T_BINDING<int> key,
                      std::function<CPO_HingeTypeDlg::T_REF_LIST()> list);

/// The initial stiffness option of a component.
CFormField& StiffnessChoice(CFormView& form, HINGE_COMPONENT c, T_BINDING<INIT_STIFFNESS> option);

/// Yes and no as a choice: yield strengths from section and material, or entered.
CFormField& AutoYieldChoice(CFormView& form, T_BINDING<bool> automatic);
/// The model of a moment component: rotation or curvature, "Moment - Rotation (M-Ry)".
void AddModelNote(CFormView& form, HINGE_COMPONENT c, const T_HINGE_OWNER& owner);

/// The value of one side, which `find` finds in it.
template <class SIDE, class FIND>
T_BINDING<double> SideValue(std::function<T_SIDES<SIDE>&()> sides, bool positive, FIND find)
{
    const auto side = [sides, positive]() -> SIDE& { return positive ? sides().pos : sides().neg; };
    return {[side, find] { return find(side()); },
            [side, find](const double& v) { find(side()) = v; }};
}

/// A row of a table over both sides: its name, the positive and the negative value. name: of the
/// fields, after "sides.pos." and "sides.neg."; prefix: before these.
struct T_SIDE_ROW {
    std::string prefix, name;
    TextFn text;
    std::function<bool()> negative{}; // the negative side has an entry of its own
    std::function<bool()> shown{};
    std::function<bool()> enabled{};
};
template <class SIDE, class FIND>
void AddSideRow(CFormView& form, const T_SIDE_ROW& row, std::function<T_SIDES<SIDE>&()> sides,
                FIND find)
{
    const auto positive = [e = row.enabled] { return !e || e(); };
    const auto negative = [positive, n = row.negative] { return positive() && (!n || n()); };
    Set(form.Note(row.text), "", row.enabled, row.shown);
    Set(form.Number(row.text, SideValue(sides, true, find)), row.prefix + "sides.pos." + row.name,
        positive, row.shown);
    Set(form.Number(row.text, SideValue(sides, false, find)), row.prefix + "sides.neg." + row.name,
        negative, row.shown);
}

/// What the tables of a backbone (FEMA, Eurocode) ask their page.
struct T_BACKBONE_PAGE {
    std::string prefix; // of the fields: "J." on the J-end's page
    HINGE_COMPONENT component = HINGE_COMPONENT::My;
    T_HINGE_OWNER owner{};
    std::function<T_SIDES<T_SKEL_SIDE>&()> sides{};
    std::function<bool()> asymmetric{};
    std::function<bool()> userYield{};
    std::function<T_PAGE_VALUES()> calculated{}; // where the strengths are automatic
    std::function<SKEL_MEASURE()> measure{};
    std::function<bool()> criteria{};          // are in use
    std::function<bool()> userStiffness{};     // is chosen
    std::function<bool()> negativeStiffness{}; // has an entry of its own
    /// Names in place of the usual ones: strength, deformation; empty: the usual ones.
    std::function<std::string()> strengthName{}, deformName{};
};
/// Says that automatic strengths are calculated for each element, where no value can be shown.
void AddByElementNote(CFormView& form, std::function<bool()> isYieldShown);

/// Points B to E: deformation and strength of both sides.
void AddPointCells(CFormView& form, const T_BACKBONE_PAGE& page);
/// IO, LS and CP of both sides.
void AddCriteriaCells(CFormView& form, const T_BACKBONE_PAGE& page);
/// Yield strengths, yield deformations and user stiffness of both sides.
void AddYieldCells(CFormView& form, const T_BACKBONE_PAGE& page);

/// On a small screen the fields beside a picture keep their width: it takes what is left.
void LeaveWidth(CFormField& picture);

/// The picture of a curve, with a choice between the whole curve and the small box.
CFormField& AddBackbonePicture(CFormView& form, std::function<T_PLOT(bool box)> plot);

/// A number grid whose cells are marked by the findings that name them. prefix: of their fields.
/// The findings are those of the form's last pass.
using T_FINDINGS_OF_PASS = std::shared_ptr<std::vector<T_FINDING>>;
CFormField& MarkedGrid(CFormView& form, std::shared_ptr<CNumberGrid> grid,
                       T_FINDINGS_OF_PASS findings, std::string prefix);
