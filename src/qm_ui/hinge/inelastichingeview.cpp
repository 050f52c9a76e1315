#include "qm_ui/hinge/inelastichingeview.h"

#include "qm_rps/po_inelastichingedlg.h"
#include "qm_ui/pushover/pushoverfields.h"

namespace {

using DIALOG = CPO_InelasticHingeDlg;

void Build(CFormView& form, DIALOG& d)
{
    const auto names = [&d] { return d.Names(); };
    form.Choice(KeyText("IDS_QM_UI_IEHP_TITLE"), NameRef(d.m_name, names), names).name = "record";
    form.Button(KeyText("IDS_QM_UI_IEHP_NEW"), [&d] { (void)d.OnNew(); }).name = "new";
    form.Choice(KeyText("IDS_QM_UI_IEHP_COMPONENT"), Ref(d.m_component), DIALOG::Components).name =
        "component";
    form.Grid(GridOf([&d] { return d.Cells(); })).name = "cells";
    form.Columns();
    form.Button(KeyText("IDS_QM_UI_IEHP_EDIT_CURVE"), [&d] { (void)d.OnCurve(); }).name = "curve";
    form.NextColumn();
    form.Button(KeyText("IDS_QM_UI_IEHP_EDIT_FORCES"), [&d] { (void)d.OnAxialForces(); }).name =
        "forces";
    form.EndColumns();
}

} // namespace

void RegisterInelasticHingeView(CViewFactory& factory)
{
    T_VIEW more;
    more.showsOnly = true;
    more.size = QSize(520, 460);
    factory.Register<DIALOG>(KeyText("IDS_QM_UI_IEHP_TITLE"), Build, more);
}
