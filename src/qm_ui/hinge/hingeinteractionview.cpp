#include "qm_base/msgfunction.h"
#include "qm_rps/po_hingeyieldpropdlgnew.h"
#include "qm_rps/po_hingeyieldpropgrid.h"
#include "qm_rps/pushoverpmminteractiondlg.h"
#include "qm_rps/pushoverpmminteractiongrid.h"
#include "qm_ui/hinge/hingefieldsview.h"
#include "qm_ui/hinge/hingeplot.h"
#include "qm_ui/hinge/hingeviews.h"

namespace {

using zql::lib::MMSGFunction;
using SURFACE = CPO_HingeYieldPropDlgNew;
constexpr int kNumber = 70; // width of an edit field

/// The findings of the form, kept for the cells of its grids.
template <class DLG>
T_FINDINGS_OF_PASS KeepFindings(CFormView& form, DLG& dlg)
{
    auto kept = std::make_shared<std::vector<T_FINDING>>();
    form.SetFindings([kept, &dlg] {
        *kept = dlg.Findings();
        return *kept;
    });
    return kept;
}

/// Strengths and moments of a level, named as its rules name them.
void AddStrengths(CFormView& form, SURFACE& dlg, const SURFACE::T_LEVEL& level)
{
    const std::string prefix = level.names.prefix;
    const T_UNITS units = dlg.m_owner.units;
    const auto wide = [](CFormField& field) -> CFormField& {
        field.widget->setMinimumWidth(kNumber);
        return field;
    };
    const auto force = [&](const char* name, const char* field, double& value) {
        form.Note([=] { return HeadWithUnit(name, kDimForce, units); });
        wide(form.Number(PlainLabel(name), Ref(value))).name = prefix + field;
        form.Note(PlainLabel(""));
    };
    const auto moments = [&](bool aboutY, bool largest) {
        T_YIELD_AXIS& axis = aboutY ? level.level->y : level.level->z;
        T_SIDES<double>& m = largest ? axis.momentMax : axis.moment;
        const std::string name = std::string(largest ? level.names.momentMax : level.names.moment) +
                                 (aboutY ? "y" : "z") + (largest ? ",max" : "");
        const std::string field =
            prefix + (aboutY ? "y." : "z.") + (largest ? "momentMax." : "moment.");
        const auto used = [&dlg, aboutY] { return dlg.IsAxisUsed(aboutY); };
        Set(form.Note([=] { return HeadWithUnit(name, kDimMoment, units); }), "", used);
        Set(wide(form.Number(PlainLabel(name + "(+)"), Ref(m.pos))), field + "pos", used);
        Set(wide(form.Number(PlainLabel(name + "(-)"), Ref(m.neg))), field + "neg", used);
    };
    form.Cells({{}, PlainLabel("(+)"), PlainLabel("(-)")});
    force(level.names.tension, "tension", level.level->tension);
    force("Pmax(c)", "compression", level.level->compression);
    for (const bool aboutY : {true, false})
        for (const bool largest : {false, true})
            moments(aboutY, largest);
    form.EndCells();
    if (dlg.IsEurocode()) form.Note(PlainLabel(SURFACE::kMomentNormaliserText));
}

/// Points of the curves of an axis, as a page.
void AddGrid(CFormView& form, SURFACE& dlg, const SURFACE::T_LEVEL& level, bool aboutY,
             const T_FINDINGS_OF_PASS& findings)
{
    const auto grid = std::make_shared<CPO_HingeYieldPropGrid>(*level.level, aboutY);
    grid->SetView(dlg.View());
    form.Page(PlainLabel(aboutY ? "My" : "Mz"));
    Set(form.Note([&dlg, aboutY, grid] {
        grid->m_showValue = dlg.m_showValue; // asked before the grid, which follows
        return MMSGFunction::GetValue(dlg.AxisNoteKey(aboutY));
    }),
        "", {}, [&dlg, aboutY, grid] {
            grid->m_showValue = dlg.m_showValue;
            return !dlg.IsAxisUsed(aboutY);
        });
    Set(MarkedGrid(form, grid, findings, level.names.prefix),
        std::string(level.names.prefix) + (aboutY ? "y." : "z.") + "curves",
        [&dlg, aboutY] { return dlg.IsAxisUsed(aboutY); });
}

void AddLevel(CFormView& form, SURFACE& dlg, const SURFACE::T_LEVEL& level,
              const T_FINDINGS_OF_PASS& findings)
{
    form.Page(KeyText(level.titleKey));
    form.Columns();
    AddStrengths(form, dlg, level);
    AddGrid(form, dlg, level, true, findings);
    AddGrid(form, dlg, level, false, findings);
    form.EndPages();
    form.NextColumn(1);
    LeaveWidth(form.Picture([&dlg, level] {
        return HingeInteractionPlot(
            dlg.m_owner.type, *level.level, MMSGFunction::GetValue(level.titleKey),
            dlg.LinesOf(*level.level),
            dlg.m_showValue ? std::optional(dlg.m_owner.units) : std::nullopt);
    }));
    form.EndColumns();
}

void BuildSurface(CFormView& form, SURFACE& dlg)
{
    const T_FINDINGS_OF_PASS findings = KeepFindings(form, dlg);
    form.Columns();
    form.Choice(KeyText("IDS_RPS_Interaction_Curves"),
                {[&dlg] { return dlg.m_showValue ? 1 : 0; },
                 [&dlg](const int& i) { dlg.m_showValue = i == 1; }},
                KeyTexts({"IDS_RPS_Show_Ratio", "IDS_RPS_Show_Value"}));
    for (const bool aboutY : {true, false}) {
        form.NextColumn();
        form.Flag(KeyText(aboutY ? "IDS_QM_UI_HINGE_USE_Y" : "IDS_QM_UI_HINGE_USE_Z"),
                  {[&dlg, aboutY] { return dlg.IsAxisUsed(aboutY); },
                   [&dlg, aboutY](const bool& on) { dlg.OnAxisChk(aboutY, on); }})
            .name = aboutY ? "useY" : "useZ";
    }
    form.NextColumn();
    Set(form.Button(KeyText("IDS_QM_UI_HINGE_CALCULATE"), [&dlg] { (void)dlg.OnCalculateBtn(); }),
        "calculate", [&dlg] { return dlg.m_calculated.has_value(); });
    form.EndColumns();
    for (const SURFACE::T_LEVEL& level : dlg.Levels())
        AddLevel(form, dlg, level, findings);
    form.EndPages();
}

void BuildUserInteraction(CFormView& form, CPushOverPMMInteractionDlg& dlg)
{
    const T_FINDINGS_OF_PASS findings = KeepFindings(form, dlg);
    const auto grid = std::make_shared<CPushoverPMMInteractionGrid>(dlg.m_table);
    grid->SetView(dlg.View());
    form.Columns();
    form.Number([&dlg] { return HeadWithUnit("Pmax", kDimForce, dlg.m_owner.units); },
                Ref(dlg.m_table.Pmax))
        .name = "Pmax";
    form.Choice(
        KeyText("IDS_QM_UI_HINGE_PM_CURVE"),
        {[grid] { return static_cast<int>(grid->Curve()); },
         [grid](const int& i) { (void)grid->SelectCurve(static_cast<std::size_t>(i)); }},
        [] { return std::vector<std::string>(kPmmCurveNames.begin(), kPmmCurveNames.end()); });
    form.Flag(KeyText("IDS_QM_UI_HINGE_PM_SAME"),
              {[&dlg] { return dlg.IsSameSides(); },
               [&dlg](const bool& same) { dlg.OnSameSidesChk(same); }})
        .name = "sameSides";
    form.Flag(KeyText("IDS_QM_UI_HINGE_PM_BALANCED"), Ref(dlg.m_table.balanced)).name = "balanced";
    MarkedGrid(form, grid, findings, "").name = "curves";
    form.Note(KeyText("IDS_QM_UI_HINGE_PMM_NOTE"));
    form.NextColumn(1);
    LeaveWidth(form.Picture([&dlg] { return UserInteractionPlot(dlg.m_owner.type, dlg.m_table); }));
    form.EndColumns();
}

} // namespace

void RegisterHingeInteractionViews(CViewFactory& factory)
{
    factory.Register<SURFACE>(KeyText("IDS_QM_UI_HINGE_SURFACE_TITLE"), BuildSurface,
                              {.size = {1100, 720}});
    factory.Register<CPushOverPMMInteractionDlg>(KeyText("IDS_QM_UI_HINGE_PMM_TITLE"),
                                                 BuildUserInteraction, {.size = {1000, 560}});
}
