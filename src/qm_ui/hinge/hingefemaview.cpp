#include "qm_base/msgfunction.h"
#include "qm_base/textformat.h"
#include "qm_rps/po_hingefemaenrgdsptgrid.h"
#include "qm_rps/po_hingeskcvtabfemaaxialgrid.h"
#include "qm_rps/po_hingeskcvtabfemadlg.h"
#include "qm_ui/hinge/hingefieldsview.h"
#include "qm_ui/hinge/hingeplot.h"
#include "qm_ui/hinge/hingeviews.h"

namespace {

using zql::lib::MMSGFunction;
using DLG = CPO_HingeSkcvTabFemaDlg;

/// One page of the editor. It keeps no data: everything is asked for again.
struct T_FEMA_PAGE {
    DLG& dlg;
    HINGE_COMPONENT c;
    HINGE_END end;
    std::string prefix;
    T_SKEL_FEMA& Curve() const { return *dlg.Curve(c, end); }
    T_SIDES<T_SKEL_SIDE>& Sides() const { return dlg.ShownSides(c, end); }

    /// A flag, a number or another member of the curve.
    template <class T>
    T_BINDING<T> Of(T T_SKEL_FEMA::*member) const
    {
        return {[p = *this, member] { return p.Curve().*member; },
                [p = *this, member](const T& v) { p.Curve().*member = v; }};
    }
    std::function<bool()> Is(bool T_SKEL_FEMA::*member, bool value = true) const
    {
        return [p = *this, member, value] { return p.Curve().*member == value; };
    }
};

T_BACKBONE_PAGE BackboneOf(const T_FEMA_PAGE& p)
{
    const auto infillName = [p](std::size_t label) {
        if (!p.dlg.IsInfillStrutMode(p.c, p.end)) return std::string();
        return MMSGFunction::GetValue(DLG::InfillLabels(p.Curve().infillGeneral)[label]);
    };
    T_BACKBONE_PAGE page;
    page.prefix = p.prefix;
    page.component = p.c;
    page.owner = p.dlg.m_owner;
    page.sides = [p]() -> T_SIDES<T_SKEL_SIDE>& { return p.Sides(); };
    page.asymmetric = p.Is(&T_SKEL_FEMA::symmetric, false);
    page.userYield = p.Is(&T_SKEL_FEMA::autoYield, false);
    page.calculated = [p] { return p.dlg.Calculated(p.c, p.end); };
    page.measure = [p] { return p.Curve().measure; };
    page.criteria = p.Is(&T_SKEL_FEMA::compliance);
    page.userStiffness = [p] { return p.Curve().initStiffness == INIT_STIFFNESS::User; };
    page.negativeStiffness = p.Is(&T_SKEL_FEMA::asymStiffness);
    page.strengthName = [infillName] { return infillName(0); };
    page.deformName = [infillName, p] {
        return p.Curve().measure == SKEL_MEASURE::DDy ? infillName(1) : std::string();
    };
    return page;
}

void AddAxialForces(CFormView& form, const T_FEMA_PAGE& p)
{
    form.Group(KeyText("IDS_QM_UI_HINGE_AXIAL"));
    form.Flag(KeyText("IDS_QM_UI_HINGE_MULTI"),
              {[p] { return p.Curve().multiCurve; },
               [p](const bool& on) { p.dlg.OnMultiCurveChk(p.c, p.end, on); }});
    Set(form.Choice(
            [p] {
                return StrengthHead("IDS_QM_UI_HINGE_AXIAL_FORCE", HINGE_COMPONENT::Fx,
                                    p.dlg.m_owner);
            },
            {[p] { return p.dlg.AxialIndex(p.c, p.end); },
             [p](const int& i) { p.dlg.OnSelChangeAxialCombo(p.c, p.end, i); }},
            [p] { return p.dlg.AxialTexts(p.c, p.end); }),
        p.prefix + "curves", p.Is(&T_SKEL_FEMA::multiCurve));
    Set(form.Button(KeyText("IDS_QM_UI_HINGE_AXIAL_LIST"),
                    [p] { (void)p.dlg.OnAxialForceBtn(p.c, p.end); }),
        p.prefix + "axialList", p.Is(&T_SKEL_FEMA::multiCurve));
    form.EndGroup();
}

void AddBackbonePage(CFormView& form, const T_FEMA_PAGE& p)
{
    const T_BACKBONE_PAGE page = BackboneOf(p);
    form.Page(KeyText("IDS_QM_UI_HINGE_BACKBONE"));
    AddModelNote(form, p.c, p.dlg.m_owner);
    form.Choice(KeyText("IDS_QM_UI_HINGE_MEASURE"),
                {[p] { return static_cast<int>(p.Curve().measure); },
                 [p](const int& i) {
                     (void)p.dlg.OnMeasureRdo(p.c, p.end, static_cast<SKEL_MEASURE>(i));
                 }},
                KeyTexts({"IDS_RPS_PO_PHGT_FEMA_DDY", "IDS_RPS_PO_PHGT_FEMA_PLS"}))
        .name = p.prefix + "measure";
    AutoYieldChoice(form, {[p] { return p.Curve().autoYield; },
                           [p](const bool& on) { p.dlg.OnUserAutoRdo(p.c, p.end, on); }})
        .name = p.prefix + "autoYield";
    StiffnessChoice(form, p.c, p.Of(&T_SKEL_FEMA::initStiffness));
    form.Columns();
    form.Flag(KeyText("IDS_QM_UI_HINGE_SYMMETRIC"), p.Of(&T_SKEL_FEMA::symmetric));
    form.Flag(KeyText("IDS_QM_UI_HINGE_LOSS"), p.Of(&T_SKEL_FEMA::strengthLoss));
    form.NextColumn();
    form.Flag(KeyText("IDS_RPS_PO_FEMA_Compliance_Criteria"),
              {[p] { return p.Curve().compliance; },
               [p](const bool& on) { (void)p.dlg.OnComplianceChk(p.c, p.end, on); }});
    form.Flag(KeyText("IDS_QM_UI_HINGE_ASYM_STIFFNESS"), p.Of(&T_SKEL_FEMA::asymStiffness));
    form.EndColumns();
    AddYieldCells(form, page);
    AddPointCells(form, page);
    AddCriteriaCells(form, page);
}

void AddUnloading(CFormView& form, const T_FEMA_PAGE& p)
{
    form.Group(KeyText("IDS_QM_UI_HINGE_UNLOADING"));
    form.Choice(
        KeyText("IDS_QM_UI_HINGE_UNLOAD_TYPE"),
        {[p] { return static_cast<int>(p.Curve().unloadType); },
         [p](const int& i) { p.Curve().unloadType = static_cast<UNLOAD_TYPE>(i); }},
        KeyTexts({"IDS_RPS_PO_FEMA_INFILL_UNLD_TYPE_ORIGIN",
                  "IDS_RPS_PO_FEMA_INFILL_UNLD_TYPE_NELA", "IDS_RPS_PO_FEMA_INFILL_UNLD_TYPE_NBIL",
                  "IDS_RPS_PO_FEMA_INFILL_UNLD_TYPE_STIF_DEGARD",
                  "IDS_RPS_PO_FEMA_INFILL_UNLD_TYPE_STIF_DGSLIP"}));
    form.Number(KeyText("IDS_QM_UI_HINGE_UNLOAD_FACTOR"), p.Of(&T_SKEL_FEMA::unloadFactor)).name =
        p.prefix + "unloadFactor";
    form.Number(KeyText("IDS_RPS_PO_PHGT_UNLOADING_EXP"), p.Of(&T_SKEL_FEMA::unloadExponent)).name =
        p.prefix + "unloadExponent";
    form.Number(KeyText("IDS_RPS_PO_PHGT_UNLOADING_PRF"), p.Of(&T_SKEL_FEMA::unloadProportion))
        .name = p.prefix + "unloadProportion";
    form.EndGroup();
}

void AddEnergy(CFormView& form, const T_FEMA_PAGE& p)
{
    form.Group(KeyText("IDS_QM_UI_HINGE_ENERGY"));
    form.Flag(KeyText("IDS_QM_UI_HINGE_ENERGY_BASED"), p.Of(&T_SKEL_FEMA::energyBased));
    form.Cells({{}, PlainLabel("(+)"), PlainLabel("(-)")});
    constexpr const char* kRows[] = {"IDS_QM_UI_HINGE_ENERGY_AB", "IDS_QM_UI_HINGE_ENERGY_C",
                                     "IDS_QM_UI_HINGE_ENERGY_D", "IDS_QM_UI_HINGE_ENERGY_E"};
    const std::function<T_SIDES<T_SKEL_SIDE>&()> sides = [p]() -> auto&
    {
        return p.Sides();
    };
    for (std::size_t i = 0; i < std::size(kRows); ++i)
        AddSideRow(form,
                   {p.prefix,
                    FormatText("energy[%zu]", i),
                    KeyText(kRows[i]),
                    {},
                    {},
                    p.Is(&T_SKEL_FEMA::energyBased)},
                   sides, [i](T_SKEL_SIDE& s) -> double& { return s.energy[i]; });
    form.EndCells();
    Set(form.Button(KeyText("IDS_QM_UI_HINGE_ENERGY_BTN"),
                    [p] { (void)p.dlg.OnEnergyBtn(p.c, p.end); }),
        p.prefix + "energyTable", p.Is(&T_SKEL_FEMA::energyBased));
    form.EndGroup();
}

void AddDcRatio(CFormView& form, const T_FEMA_PAGE& p)
{
    const auto limit = [p](bool positive) -> T_BINDING<double> {
        const auto at = [p, positive]() -> double& {
            T_SIDES<double>& r = *p.Curve().dcRatio;
            return positive ? r.pos : r.neg;
        };
        return {[p, at] { return p.Curve().dcRatio ? at() : 0.0; },
                [p, at](const double& v) {
                    if (p.Curve().dcRatio) at() = v;
                }};
    };
    const auto on = [p] { return p.Curve().dcRatio.has_value(); };
    form.Group(KeyText("IDS_QM_UI_HINGE_DC"));
    form.Flag(KeyText("IDS_QM_UI_HINGE_DC_ON"),
              {on, [p](const bool& v) { p.dlg.OnDcRatioChk(p.c, p.end, v); }});
    form.Cells({{}, PlainLabel("(+)"), PlainLabel("(-)")});
    form.Note(KeyText("IDS_QM_UI_HINGE_DC_LIMIT"));
    Set(form.Number(KeyText("IDS_QM_UI_HINGE_DC_LIMIT"), limit(true)), p.prefix + "dcRatio.pos",
        on);
    Set(form.Number(KeyText("IDS_QM_UI_HINGE_DC_LIMIT"), limit(false)), p.prefix + "dcRatio.neg",
        on);
    form.EndCells();
    form.EndGroup();
}

void AddOptionsPage(CFormView& form, const T_FEMA_PAGE& p)
{
    form.Page(KeyText("IDS_QM_UI_HINGE_OPTIONS"));
    AddAxialForces(form, p);
    AddUnloading(form, p);
    AddEnergy(form, p);
    AddDcRatio(form, p);
    const bool strut = p.dlg.m_owner.type.element == HINGE_ELEMENT::Truss;
    if (!strut) return;
    form.Flag(KeyText("IDS_RPS_PO_PHGT_SKCV_FEMA_IFST"),
              {[p] { return p.dlg.IsInfillStrutMode(p.c, p.end); },
               [p](const bool& on) { p.dlg.SetInfillStrutMode(p.c, p.end, on); }});
    Set(form.Flag(KeyText("IDS_QM_UI_HINGE_INFILL_GENERAL"), p.Of(&T_SKEL_FEMA::infillGeneral)), "",
        p.Is(&T_SKEL_FEMA::infillStrut));
}

T_PLOT Preview(const T_FEMA_PAGE& p, bool box)
{
    return HingeBackbonePlot(p.dlg.m_owner.type, p.c, p.dlg.ShownCurve(p.c, p.end),
                             MMSGFunction::GetValue(PageTitleKey(*p.dlg.Component(p.c), p.end)),
                             box);
}

void BuildFema(CFormView& form, DLG& dlg)
{
    const HINGE_COMPONENT c = dlg.First();
    dlg.OnEdited();
    form.m_onChange = [&dlg] { dlg.OnEdited(); };
    form.SetFindings([&dlg] {
        std::vector<T_FINDING> found = dlg.Findings();
        for (T_FINDING& f : found)
            f.field = dlg.FieldOnPages(f);
        return found;
    });
    ForEachPage(*dlg.Component(c), [&](HINGE_END end, const T_SKEL_CURVE&) {
        const bool ofJ = dlg.IsNeedIJTab(c) && end == HINGE_END::J;
        const T_FEMA_PAGE page{dlg, c, end, ofJ ? "J." : ""};
        form.Page(KeyText(PageTitleKey(*dlg.Component(c), end)));
        form.Columns();
        AddBackbonePage(form, page);
        AddOptionsPage(form, page);
        form.EndPages();
        form.NextColumn(1);
        AddBackbonePicture(form, [page](bool box) { return Preview(page, box); }).name =
            page.prefix + "picture";
        form.EndColumns();
    });
    form.EndPages();
}

/// A row for each side under the heads of the factors.
void BuildEnergyGrid(CFormView& form, CPO_HingeFEMAEnrgDsptGrid& dlg)
{
    std::vector<TextFn> heads{TextFn()};
    for (const char* head : CPO_HingeFEMAEnrgDsptGrid::kHeads)
        heads.push_back(PlainLabel(head));
    form.Cells(std::move(heads));
    for (std::size_t side = 0; side < 2; ++side) {
        const TextFn name = PlainLabel(side == 0 ? "(+)" : "(-)");
        form.Note(name);
        for (std::size_t i = 0; i < CPO_HingeFEMAEnrgDsptGrid::kHeads.size(); ++i)
            form.Number(name, Ref(dlg.m_factors[side][i])).name =
                FormatText("factors[%zu][%zu]", side, i);
    }
    form.EndCells();
}

void BuildAxialGrid(CFormView& form, CPO_HingeSkcvTabFemaAxialGrid& dlg)
{
    const auto head = [&dlg] {
        return StrengthHead("IDS_QM_UI_HINGE_AXIAL_FORCE", HINGE_COMPONENT::Fx, dlg.m_owner);
    };
    T_GRID_BINDING b;
    b.columns = {{head, CELL_KIND::Number, true}};
    b.rows = [&dlg] { return dlg.Rows().size(); };
    b.text = [&dlg](std::size_t row, std::size_t) { return ShortestText(dlg.Rows()[row].axial); };
    b.set = [&dlg](std::size_t row, std::size_t, const std::string& text) {
        const std::optional<double> force = ParseFinite(text);
        return force ? dlg.ChangeForce(dlg.Rows()[row].axial, *force) : 0;
    };
    b.select = [&dlg](int row) { dlg.m_selected = row; };
    form.Grid(std::move(b)).name = "axial";
    form.Number(head, Ref(dlg.m_entry)).name = "entry";
    form.Columns();
    form.Button(KeyText("IDS_QM_UI_ADD"), [&dlg] { (void)dlg.OnAdd(); }).name = "add";
    form.NextColumn();
    form.Button(KeyText("IDS_QM_UI_DELETE"), [&dlg] { (void)dlg.OnRemove(); }).name = "remove";
    form.EndColumns();
}

} // namespace

void RegisterHingeFemaViews(CViewFactory& factory)
{
    factory.Register<DLG>(KeyText("IDS_QM_UI_HINGE_FEMA_TITLE"), BuildFema, {.size = {1150, 0}});
    factory.Register<CPO_HingeFEMAEnrgDsptGrid>(KeyText("IDS_QM_UI_HINGE_ENERGY"), BuildEnergyGrid);
    factory.Register<CPO_HingeSkcvTabFemaAxialGrid>(KeyText("IDS_QM_UI_HINGE_AXIAL"),
                                                    BuildAxialGrid);
}
