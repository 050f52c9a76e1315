#include "qm_ui/hinge/hingefieldsview.h"

#include "qm_base/msgfunction.h"
#include "qm_ui/plot/plotwidget.h"

#include <algorithm>

namespace {

using zql::lib::MMSGFunction;

struct T_POINT_ROW {
    const char* name;
    T_SKEL_POINT T_SKEL_SIDE::*point;
};
constexpr T_POINT_ROW kPoints[] = {
    {"B", &T_SKEL_SIDE::B}, {"C", &T_SKEL_SIDE::C}, {"D", &T_SKEL_SIDE::D}, {"E", &T_SKEL_SIDE::E}};

/// "D/DY" or the plastic deformation with its unit.
std::string DeformName(const T_BACKBONE_PAGE& page)
{
    if (page.deformName && !page.deformName().empty()) return page.deformName();
    if (page.measure() == SKEL_MEASURE::DDy)
        return MMSGFunction::GetValue("IDS_RPS_PO_PHGT_FEMA_DDY");
    return DeformHead("IDS_RPS_PO_PHGT_FEMA_PLS", page.component, page.owner);
}

std::string StrengthName(const T_BACKBONE_PAGE& page)
{
    if (page.strengthName && !page.strengthName().empty()) return page.strengthName();
    return page.component >= HINGE_COMPONENT::Mx ? "M/MY" : "F/FY";
}

void AddPoint(CFormView& form, const T_BACKBONE_PAGE& page, const T_POINT_ROW& row, bool positive)
{
    const std::string name = page.prefix + (positive ? "sides.pos." : "sides.neg.") + row.name;
    const TextFn caption = PlainLabel(row.name);
    const auto enabled = positive ? std::function<bool()>() : page.asymmetric;
    Set(form.Number(caption, SideValue(page.sides, positive,
                                       [p = row.point](T_SKEL_SIDE& s) -> double& {
                                           return (s.*p).deform;
                                       })),
        name + ".deform", enabled);
    Set(form.Number(caption, SideValue(page.sides, positive,
                                       [p = row.point](T_SKEL_SIDE& s) -> double& {
                                           return (s.*p).strength;
                                       })),
        name + ".strength", enabled);
}

auto Member(double T_SKEL_SIDE::*m)
{
    return [m](T_SKEL_SIDE& s) -> double& { return s.*m; };
}

} // namespace

CFormField& Set(CFormField& field, std::string name, std::function<bool()> enabled,
                std::function<bool()> shown)
{
    field.name = std::move(name);
    field.enabled = std::move(enabled);
    field.shown = std::move(shown);
    return field;
}

CFormField& RefChoice(CFormView& form, TextFn caption, T_BINDING<int> key,
                      std::function<CPO_HingeTypeDlg::T_REF_LIST()> list)
{
    const auto position = [key, list] {
        const auto entries = list();
        const auto at = std::ranges::find(entries, key.get(), &CPO_HingeTypeDlg::T_REF_ENTRY::key);
        if (key.get() == 0) return 0;
        return at == entries.end() ? -1 : static_cast<int>(at - entries.begin()) + 1;
    };
    const auto choose = [key, list](const int& index) {
        const auto entries = list();
        if (index <= static_cast<int>(entries.size()))
            key.set(index <= 0 ? 0 : entries[static_cast<std::size_t>(index - 1)].key);
    };
    const auto texts = [list] {
        std::vector<std::string> out{MMSGFunction::GetValue("IDS_QM_UI_HINGE_NONE")};
        for (const auto& entry : list())
            out.push_back(entry.text);
        return out;
    };
    return form.Choice(std::move(caption), {position, choose}, texts);
}

CFormField& StiffnessChoice(CFormView& form, HINGE_COMPONENT c, T_BINDING<INIT_STIFFNESS> option)
{
    return form.Choice(KeyText("IDS_RPS_PO_PHGT_Initial_Stiffness"),
                       {[c, option] { return StiffnessPosition(c, option.get()); },
                        [c, option](const int& index) {
                            option.set(StiffnessOptions(c).at(static_cast<std::size_t>(index)));
                        }},
                       [c] { return StiffnessTexts(c); });
}

void AddModelNote(CFormView& form, HINGE_COMPONENT c, const T_HINGE_OWNER& owner)
{
    const std::string label = HingeModelLabel(owner.type.definition, c);
    if (!label.empty()) form.Note(PlainLabel(label)).name = "model";
}

CFormField& AutoYieldChoice(CFormView& form, T_BINDING<bool> automatic)
{
    return form.Choice(KeyText("IDS_QM_UI_HINGE_YIELD_FROM"),
                       {[automatic] { return automatic.get() ? 0 : 1; },
                        [automatic](const int& index) { automatic.set(index == 0); }},
                       KeyTexts({"IDS_QM_UI_HINGE_AUTOMATIC", "IDS_QM_UI_HINGE_ENTERED"}));
}

void AddPointCells(CFormView& form, const T_BACKBONE_PAGE& page)
{
    const auto head = [page](bool strength, const char* side) -> TextFn {
        return [page, strength, side] {
            return (strength ? StrengthName(page) : DeformName(page)) + " " + side;
        };
    };
    form.Cells({KeyText("IDS_QM_UI_HINGE_POINT"), head(false, "(+)"), head(true, "(+)"),
                head(false, "(-)"), head(true, "(-)")});
    for (const T_POINT_ROW& row : kPoints) {
        form.Note(PlainLabel(row.name));
        AddPoint(form, page, row, true);
        AddPoint(form, page, row, false);
    }
    form.EndCells();
}

void AddCriteriaCells(CFormView& form, const T_BACKBONE_PAGE& page)
{
    const auto head = [page] {
        return MMSGFunction::GetValue(page.measure() == SKEL_MEASURE::DDy
                                          ? "IDS_RPS_PO_PHGT_FEMA_ACCPT_DDY"
                                          : "IDS_RPS_PO_PHGT_FEMA_ACCPT_PLS");
    };
    form.Group(head);
    Set(form.Note([] { return CriterionText(false, 0.0); }), "inactive", {},
        [page] { return page.criteria && !page.criteria(); });
    form.Cells({{}, PlainLabel("(+)"), PlainLabel("(-)")});
    const std::pair<const char*, double T_SKEL_SIDE::*> rows[] = {
        {"IO", &T_SKEL_SIDE::IO}, {"LS", &T_SKEL_SIDE::LS}, {"CP", &T_SKEL_SIDE::CP}};
    for (const auto& [name, member] : rows)
        AddSideRow(form, {page.prefix, name, PlainLabel(name), page.asymmetric, {}, page.criteria},
                   page.sides, Member(member));
    form.EndCells();
    form.EndGroup();
}

void AddByElementNote(CFormView& form, std::function<bool()> isYieldShown)
{
    Set(form.Note(KeyText("IDS_QM_UI_HINGE_BY_ELEMENT")), "byElement", {},
        [isYieldShown] { return !isYieldShown(); });
}

void AddYieldCells(CFormView& form, const T_BACKBONE_PAGE& page)
{
    const bool moment = page.component >= HINGE_COMPONENT::Mx;
    const auto stiffness = [page] {
        return StiffnessHead("IDS_QM_UI_HINGE_USER_STIFFNESS", page.component, page.owner);
    };
    const auto yieldShown = [page] { return page.userYield() || page.calculated().yield.pos; };
    AddByElementNote(form, yieldShown);
    form.Cells({{}, PlainLabel("(+)"), PlainLabel("(-)")});
    AddSideRow(form,
               {page.prefix, "yield",
                [page, moment] {
                    return StrengthHead(moment ? "IDS_RPS_PUSHOVER_YIELD_MOMENT"
                                               : "IDS_RPS_PUSHOVER_YIELD_FROCE",
                                        page.component, page.owner);
                },
                page.asymmetric, yieldShown, page.userYield},
               page.sides, Member(&T_SKEL_SIDE::yield));
    AddSideRow(form,
               {page.prefix,
                "yieldDeform",
                [page] {
                    return DeformHead(YieldDeformKey(page.component, page.owner.type.definition),
                                      page.component, page.owner);
                },
                page.asymmetric,
                {},
                [page] { return !page.calculated().deform.pos; }},
               page.sides, Member(&T_SKEL_SIDE::yieldDeform));
    AddSideRow(
        form,
        {page.prefix, "userStiffness", stiffness, page.negativeStiffness, {}, page.userStiffness},
        page.sides, Member(&T_SKEL_SIDE::userStiffness));
    form.EndCells();
}

CFormField& MarkedGrid(CFormView& form, std::shared_ptr<CNumberGrid> grid,
                       T_FINDINGS_OF_PASS findings, std::string prefix)
{
    T_GRID_BINDING b = GridOf(*grid);
    b.mark = [grid, findings, prefix](std::size_t row, std::size_t column) {
        const std::string field = prefix + grid->CellField(row, column);
        const auto at = std::ranges::find(*findings, field, &T_FINDING::field);
        return at == findings->end() ? std::string() : at->text;
    };
    return form.Grid(std::move(b));
}

void LeaveWidth(CFormField& picture)
{
    constexpr int kLeast = 380; // its legend is readable
    picture.widget->setMinimumWidth(kLeast);
    if (auto* view = dynamic_cast<CPlotWidget*>(picture.widget)) view->SetSizeHint({kLeast, 480});
}

CFormField& AddBackbonePicture(CFormView& form, std::function<T_PLOT(bool box)> plot)
{
    const auto box = std::make_shared<bool>(false);
    form.Choice(KeyText("IDS_QM_UI_HINGE_PREVIEW"),
                {[box] { return *box ? 1 : 0; }, [box](const int& i) { *box = i == 1; }},
                KeyTexts({"IDS_QM_UI_HINGE_PREVIEW_WHOLE", "IDS_QM_UI_HINGE_PREVIEW_BOX"}))
        .name = "box";
    CFormField& picture = form.Picture([box, plot] { return plot(*box); });
    LeaveWidth(picture);
    return picture;
}
