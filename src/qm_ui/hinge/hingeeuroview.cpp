#include "qm_base/msgfunction.h"
#include "qm_rps/po_hingeskcvtabeurodlg.h"
#include "qm_ui/hinge/hingefieldsview.h"
#include "qm_ui/hinge/hingeplot.h"
#include "qm_ui/hinge/hingeviews.h"

namespace {

using DLG = CPO_HingeSkcvTabEuroDlg;

T_BACKBONE_PAGE PageOf(DLG& dlg, HINGE_END end, const std::string& prefix)
{
    const auto curve = [&dlg, end]() -> T_SKEL_EC8& { return *dlg.Curve(end); };
    T_BACKBONE_PAGE page;
    page.prefix = prefix;
    page.component = dlg.Which();
    page.owner = dlg.m_owner;
    page.sides = [curve]() -> T_SIDES<T_SKEL_SIDE>& { return curve().sides; };
    page.asymmetric = [curve] { return !curve().symmetric; };
    page.userYield = [curve] { return !curve().autoYield; };
    page.calculated = [&dlg, end] { return dlg.Calculated(end); };
    page.measure = [curve] { return curve().measure; };
    page.userStiffness = [curve] { return curve().initStiffness == INIT_STIFFNESS::User; };
    page.negativeStiffness = page.asymmetric;
    return page;
}

void AddPage(CFormView& form, DLG& dlg, HINGE_END end, const std::string& prefix)
{
    const T_BACKBONE_PAGE page = PageOf(dlg, end, prefix);
    const auto curve = [&dlg, end]() -> T_SKEL_EC8& { return *dlg.Curve(end); };
    AddModelNote(form, dlg.Which(), dlg.m_owner);
    form.Choice(KeyText("IDS_QM_UI_HINGE_MEASURE"),
                {[curve] { return static_cast<int>(curve().measure); },
                 [&dlg, end](const int& i) {
                     (void)dlg.OnMeasureRdo(end, static_cast<SKEL_MEASURE>(i));
                 }},
                KeyTexts({"IDS_RPS_PO_PHGT_FEMA_DDY", "IDS_RPS_PO_PHGT_FEMA_PLS"}))
        .name = prefix + "measure";
    AutoYieldChoice(form, {[curve] { return curve().autoYield; },
                           [&dlg, end](const bool& on) { dlg.OnUserAutoRdo(end, on); }})
        .name = prefix + "autoYield";
    StiffnessChoice(form, dlg.Which(),
                    {[curve] { return curve().initStiffness; },
                     [curve](const INIT_STIFFNESS& v) { curve().initStiffness = v; }});
    form.Columns();
    form.Flag(KeyText("IDS_QM_UI_HINGE_SYMMETRIC"),
              {[curve] { return curve().symmetric; },
               [curve](const bool& on) { curve().symmetric = on; }});
    form.NextColumn();
    form.Flag(KeyText("IDS_QM_UI_HINGE_LOSS"),
              {[curve] { return curve().strengthLoss; },
               [curve](const bool& on) { curve().strengthLoss = on; }});
    form.EndColumns();
    AddYieldCells(form, page);
    AddPointCells(form, page);
    AddCriteriaCells(form, page);
}

void BuildEuro(CFormView& form, DLG& dlg)
{
    dlg.OnEdited();
    form.m_onChange = [&dlg] { dlg.OnEdited(); };
    form.SetFindings([&dlg] {
        std::vector<T_FINDING> found = dlg.Findings();
        for (T_FINDING& f : found)
            f.field = PathOnPages(f);
        return found;
    });
    ForEachPage(dlg.Component(), [&](HINGE_END end, const T_SKEL_CURVE&) {
        const char* title = PageTitleKey(dlg.Component(), end);
        form.Page(KeyText(title));
        form.Columns();
        AddPage(form, dlg, end, end == HINGE_END::J ? "J." : "");
        form.NextColumn(1);
        AddBackbonePicture(form, [&dlg, end, title](bool box) {
            return HingeBackbonePlot(dlg.m_owner.type, dlg.Which(), *dlg.Curve(end),
                                     zql::lib::MMSGFunction::GetValue(title), box);
        }).name = std::string(end == HINGE_END::J ? "J." : "") + "picture";
        form.EndColumns();
    });
    form.EndPages();
}

} // namespace

void RegisterHingeEuroView(CViewFactory& factory)
{
    factory.Register<DLG>(KeyText("IDS_QM_UI_HINGE_EURO_TITLE"), BuildEuro, {.size = {1150, 0}});
}
