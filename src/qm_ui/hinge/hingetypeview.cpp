#include "qm_base/msgfunction.h"
#include "qm_base/textformat.h"
#include "qm_rps/hinge/hingetypefindings.h"
#include "qm_rps/po_hingetypelistdlg.h"
#include "qm_rps/pushoverhingelistdlg.h"
#include "qm_ui/hinge/hingefieldsview.h"
#include "qm_ui/hinge/hingeplot.h"
#include "qm_ui/hinge/hingeviews.h"

namespace {

using zql::lib::MMSGFunction;
using DLG = CPO_HingeTypeDlg;
using PART = HINGE_PART;

std::function<bool()> Shown(const DLG& dlg, PART part)
{
    return [&dlg, part] { return dlg.CustomizeDlgByMode()[static_cast<std::size_t>(part)].shown; };
}
std::function<bool()> Enabled(const DLG& dlg, PART part)
{
    return
        [&dlg, part] { return dlg.CustomizeDlgByMode()[static_cast<std::size_t>(part)].enabled; };
}

/// An enumeration of the type, changed by a handler of the model.
template <class E>
T_BINDING<int> Enumeration(DLG& dlg, E T_PHGT_D::*member, void (DLG::*change)(E))
{
    return {[&dlg, member] { return static_cast<int>(dlg.Type().*member); },
            [&dlg, change](const int& i) { (dlg.*change)(static_cast<E>(i)); }};
}

void AddGeneral(CFormView& form, DLG& dlg)
{
    form.Group(KeyText("IDS_QM_UI_HINGE_GENERAL"));
    form.Text(KeyText("IDS_RPS_PO_Hinge_Name"),
              {[&dlg] { return dlg.Type().name; },
               [&dlg](const std::string& t) { dlg.Edited().name = t; }})
        .name = "name";
    form.Choice(KeyText("IDS_RPS_PO_Element_Type"),
                Enumeration(dlg, &T_PHGT_D::element, &DLG::OnSelChangeElement),
                [] {
                    std::vector<std::string> texts;
                    for (int i = 0; i < 5; ++i)
                        texts.push_back(
                            CPO_HingeTypeListDlg::DataToStr(static_cast<HINGE_ELEMENT>(i)));
                    return texts;
                })
        .name = "element";
    form.Choice(KeyText("IDS_QM_UI_HINGE_DEFINITION"),
                Enumeration(dlg, &T_PHGT_D::definition, &DLG::OnSelChangeDefinition),
                KeyTexts({"IDS_QM_UI_HINGE_DEF_ROTATION", "IDS_QM_UI_HINGE_DEF_LUMPED",
                          "IDS_QM_UI_HINGE_DEF_DISTRIBUTED"}))
        .name = "definition";
    form.Choice(KeyText("IDS_QM_UI_HINGE_MATERIAL_CLASS"),
                Enumeration(dlg, &T_PHGT_D::material, &DLG::OnSelChangeMaterial),
                KeyTexts({"IDS_QM_UI_MATL_CONCRETE", "IDS_QM_UI_MATL_STEEL",
                          "IDS_QM_UI_MATL_COMPOSITE", "IDS_QM_UI_MATL_MASONRY"}))
        .name = "material";
    form.Note([&dlg] {
            return MMSGFunction::Format("IDS_QM_UI_HINGE_STRENGTH_OF", {dlg.StrengthMaterials()});
        })
        .name = "strengthOf";
    form.Button(KeyText("IDS_QM_UI_HINGE_OPTIONS_CMD"), [&dlg] { (void)dlg.OnBtnOptions(); }).name =
        "options";
    form.EndGroup();
}

void AddReferences(CFormView& form, DLG& dlg)
{
    const auto& type = dlg.Type();
    form.Group(KeyText("IDS_QM_UI_HINGE_REFERENCES"));
    Set(RefChoice(form, KeyText("IDS_CMD_IEHP_SECT_TXT"),
                  {[&type] { return type.section; },
                   [&dlg](const int& key) { dlg.Edited().section = key; }},
                  [&dlg] { return dlg.InitPropCombo_Sect(); }),
        "section", {}, Shown(dlg, PART::Section));
    Set(RefChoice(form, KeyText("IDS_QM_UI_HINGE_MATERIAL"),
                  {[&type] { return type.sectionMaterial; },
                   [&dlg](const int& key) { dlg.Edited().sectionMaterial = key; }},
                  [&dlg] { return dlg.InitPropCombo_Matl(); }),
        "sectionMaterial", {}, Shown(dlg, PART::Section));
    Set(RefChoice(form, KeyText("IDS_CMD_IEHP_THIK_TXT"),
                  {[&type] { return type.thicknessSection; },
                   [&dlg](const int& key) { dlg.Edited().thicknessSection = key; }},
                  [&dlg] { return dlg.InitPropCombo_Thik(); }),
        "thicknessSection", {}, Shown(dlg, PART::Thickness));
    const auto wall = [&dlg] { return dlg.Type().element == HINGE_ELEMENT::Wall; };
    Set(RefChoice(form, KeyText("IDS_QM_UI_HINGE_FIBRES"),
                  {[&type] { return type.fibreSection; },
                   [&dlg](const int& key) { dlg.Edited().fibreSection = key; }},
                  [&dlg, wall] {
                      return wall() ? dlg.InitFiberCombo_Fibw() : dlg.InitFiberCombo_Fibr();
                  }),
        "fibreSection", {},
        [frame = Shown(dlg, PART::FibreFrame), fibw = Shown(dlg, PART::FibreWall)] {
            return frame() || fibw();
        });
    form.EndGroup();
}

/// Names of the curve types that a component offers; one that is disabled says why.
std::vector<std::string> CurveTexts(const DLG& dlg, HINGE_COMPONENT c)
{
    std::vector<std::string> texts;
    for (const T_SKCV_ENTRY& e : dlg.CustomizeSkcvCmb(c)) {
        const std::string why =
            e.enabled ? "" : " " + MMSGFunction::GetValue("IDS_QM_UI_HINGE_NEEDS_CODES");
        texts.push_back(MMSGFunction::GetValue(e.key) + why);
    }
    return texts;
}

void AddComponent(CFormView& form, DLG& dlg, HINGE_COMPONENT c)
{
    const auto i = static_cast<std::size_t>(c);
    const std::string name = kComponentNames[i];
    const auto component = [&dlg, i]() -> const T_HINGE_COMPONENT& {
        return dlg.Type().components[i];
    };
    const auto has = [&dlg, c] { return HasComponent(dlg.Type().element, c); };
    const auto active = [component] { return component().active; };
    const auto located = [active, on = Enabled(dlg, PART::Location)] { return active() && on(); };
    Set(form.Flag(PlainLabel(name), {active,
                                     [&dlg, c](const bool& on) {
                                         dlg.OnComponentCtrl(c, on);
                                         if (on) dlg.Preview().ShowFirstOf(c);
                                     }}),
        name + ".active", has);
    Set(form.Choice(PlainLabel(name),
                    {[&dlg, c] { return dlg.SelectedSkcv(c); },
                     [&dlg, c](const int& k) {
                         (void)dlg.OnSelChangeSkcv(c, k);
                         dlg.Preview().ShowFirstOf(c);
                     }},
                    [&dlg, c] { return CurveTexts(dlg, c); }),
        name + ".type", active);
    Set(form.Button(KeyText("IDS_QM_UI_HINGE_EDIT_CURVE"),
                    [&dlg, c] {
                        dlg.Preview().ShowFirstOf(c);
                        (void)dlg.OnBtnSkcvProp(c);
                    }),
        name + ".curve", active);
    Set(form.Choice(PlainLabel(name),
                    {[component] { return static_cast<int>(component().location) - 1; },
                     [&dlg, c](const int& k) {
                         dlg.OnLocationCtrl(c, static_cast<HINGE_LOCATION>(k + 1));
                     }},
                    KeyTexts({"IDS_RPS_PO_LOCATION_I_end", "IDS_RPS_PO_LOCATION_J_end",
                              "IDS_RPS_PO_LOCATION_IJ_end", "IDS_RPS_PO_LOCATION_Center"})),
        name + ".location", located);
    Set(form.Flag(KeyText("IDS_QM_UI_HINGE_SAME_ENDS"),
                  {[component] { return component().sameEnds; },
                   [&dlg, c](const bool& same) { dlg.OnIJSymmetryRdo(c, same); }}),
        name + ".sameEnds", [located, component] {
            return located() && component().location == HINGE_LOCATION::BothEnds;
        });
}

void AddComponents(CFormView& form, DLG& dlg)
{
    form.Group(KeyText("IDS_QM_UI_HEAD_COMPONENTS"));
    form.Cells({{},
                KeyText("IDS_QM_UI_HINGE_CURVE"),
                {},
                KeyText("IDS_QM_UI_HINGE_LOCATION"),
                KeyText("IDS_QM_UI_HINGE_ENDS")});
    for (int c = 0; c < 6; ++c)
        AddComponent(form, dlg, static_cast<HINGE_COMPONENT>(c));
    form.EndCells();
    form.Button(KeyText("IDS_QM_UI_HINGE_DEFAULTS"), [&dlg] { (void)dlg.OnBtnDefaults(); }).name =
        "defaults";
    form.EndGroup();
}

/// The interaction of My (and of Fy and Fz) or of Mz.
void AddInteraction(CFormView& form, DLG& dlg, HINGE_COMPONENT c)
{
    const bool mz = c == HINGE_COMPONENT::Mz;
    const auto usable = [&dlg, mz, on = Enabled(dlg, PART::Interaction)] {
        return on() && (!mz || At(dlg.Type(), HINGE_COMPONENT::Mz).active);
    };
    Set(form.Choice(
            [mz] {
                return MMSGFunction::GetValue("IDS_QM_UI_HINGE_INTERACTION") + (mz ? " Mz" : " My");
            },
            {[&dlg, c] { return DLG::ConvertInteraction(InteractionOf(dlg.Type(), c)); },
             [&dlg, c](const int& i) { (void)dlg.OnSelChangeInteraction(c, i); }},
            [&dlg, c] {
                std::vector<std::string> texts;
                for (std::size_t i = 0; i < OfferedInteractions(dlg.Type(), c); ++i)
                    texts.push_back(
                        CPushOverHingeListDlg::InteractionText(static_cast<int>(kInteractions[i])));
                return texts;
            }),
        mz ? "interactionMz" : "interaction", usable, Shown(dlg, PART::Interaction));
}

/// A button that opens the editor of a part.
CFormField& AddPart(CFormView& form, DLG& dlg, PART part, const char* key, const char* name,
                    int (DLG::*open)())
{
    return Set(form.Button(KeyText(key), [&dlg, open] { (void)(dlg.*open)(); }), name,
               Enabled(dlg, part), Shown(dlg, part));
}

void AddParts(CFormView& form, DLG& dlg)
{
    form.Group(KeyText("IDS_QM_UI_HINGE_PARTS"));
    form.Columns();
    AddInteraction(form, dlg, HINGE_COMPONENT::My);
    form.NextColumn();
    AddInteraction(form, dlg, HINGE_COMPONENT::Mz);
    form.EndColumns();
    form.Columns();
    AddPart(form, dlg, PART::YieldSurface, "IDS_QM_UI_HINGE_SURFACE_BTN", "yieldSurface",
            &DLG::OnYieldSurfaceDlgDlg);
    AddPart(form, dlg, PART::HingeLength, "IDS_QM_UI_HINGE_LENGTH_BTN", "length",
            &DLG::OnBtnHingeLength);
    // The span is that of the initial stiffness too, so it can be had without hinge lengths.
    AddPart(form, dlg, PART::HingeLength, "IDS_QM_UI_HINGE_SPAN_BTN", "span", &DLG::OnBtnAlphaYSpan)
        .enabled = {};
    form.NextColumn();
    AddPart(form, dlg, PART::UserInteraction, "IDS_QM_UI_HINGE_PMM_BTN", "pmm",
            &DLG::OnUserInteractionDlg);
    AddPart(form, dlg, PART::IntegrationPoints, "IDS_QM_UI_HINGE_POINTS_BTN", "integrationPoints",
            &DLG::OnBtnIntegrationPoint);
    AddPart(form, dlg, PART::Masonry, "IDS_QM_UI_HINGE_MASONRY_BTN", "masonry.",
            &DLG::OnMasonryPropDlg);
    form.EndColumns();
    Set(form.Note([&dlg] {
        return MMSGFunction::GetValue(dlg.HingeLengthCaption()) + ": " + dlg.HingeLengthsText();
    }),
        "lengths", {}, Shown(dlg, PART::HingeLength));
    Set(
        form.Flag(KeyText("IDS_QM_UI_HINGE_EXACT_SURFACE"),
                  {[&dlg] { return dlg.Type().exactSurface; },
                   [&dlg](const bool& on) { dlg.Edited().exactSurface = on; }}),
        "exactSurface", [&dlg] { return dlg.Type().exactSurface || SharesMoments(dlg.Type()); },
        Shown(dlg, PART::YieldSurface));
    Set(form.Flag(KeyText("IDS_QM_UI_HINGE_WITHHOLD"),
                  {[&dlg] { return dlg.Type().withholdMzLength; },
                   [&dlg](const bool& on) { dlg.Edited().withholdMzLength = on; }}),
        "withholdMzLength", {}, Shown(dlg, PART::HingeLength));
    Set(form.Flag(KeyText("IDS_QM_UI_HINGE_MASONRY_ON"),
                  {[&dlg] { return dlg.Type().masonry.has_value(); },
                   [&dlg](const bool& on) { dlg.OnMasonryChk(on); }}),
        "masonry", {}, Shown(dlg, PART::Masonry));
    Set(form.Flag(KeyText("IDS_RPS_PO_PHGT_SKCV_FEMA_IFST"),
                  {[&dlg] { return dlg.IsInfillStrut(); },
                   [&dlg](const bool& on) { dlg.OnInfillStrutChk(on); }}),
        "infillStrut", Enabled(dlg, PART::InfillStrut), Shown(dlg, PART::InfillStrut));
    form.EndGroup();
}

void AddPreview(CFormView& form, DLG& dlg)
{
    form.Choice(KeyText("IDS_QM_UI_HINGE_PREVIEW"),
                {[&dlg] { return dlg.Preview().Shown(); },
                 [&dlg](const int& i) { dlg.Preview().Show(i); }},
                [&dlg] {
                    std::vector<std::string> texts;
                    for (const CHingePages::T_PAGE& page : dlg.Preview().All())
                        texts.push_back(page.text);
                    return texts;
                })
        .name = "preview";
    form.Picture([&dlg] {
        T_PLOT none;
        none.notes.push_back(MMSGFunction::GetValue("IDS_QM_UI_HINGE_NO_COMPONENT"));
        const T_SKEL_CURVE* curve = dlg.Preview().Curve();
        if (!curve) return none;
        const CHingePages& pages = dlg.Preview();
        const CHingePages::T_PAGE page = pages.All()[static_cast<std::size_t>(pages.Shown())];
        return HingeBackbonePlot(dlg.Type(), page.component, *curve, page.text);
    });
}

/// All findings; a double click opens the editor of the component that one is about.
void AddFindings(CFormView& form, DLG& dlg)
{
    const auto found = std::make_shared<std::vector<T_FINDING>>(dlg.Findings());
    form.SetFindings([found, &dlg] {
        std::vector<T_FINDING> named = *found;
        for (T_FINDING& f : named)
            f.field = dlg.FieldOf(f);
        return named;
    });
    T_GRID_BINDING b;
    b.columns = {{KeyText("IDS_QM_UI_HINGE_WHERE")}, {KeyText("IDS_QM_UI_HINGE_WRONG")}};
    b.rows = [found, &dlg] {
        *found = dlg.Findings();
        return found->size();
    };
    b.text = [found](std::size_t row, std::size_t c) {
        return c == 0 ? PathInType((*found)[row]) : (*found)[row].text;
    };
    b.mark = [found](std::size_t row, std::size_t) { return (*found)[row].text; };
    b.open = [found, &form, &dlg](std::size_t row) {
        (void)dlg.OnFinding(T_FINDING((*found)[row]));
        form.Refresh();
    };
    form.Note([&dlg] {
        const std::size_t broken = dlg.Findings().size();
        return broken == 0
                   ? MMSGFunction::GetValue("IDS_QM_UI_HINGE_ALL_RULES")
                   : MMSGFunction::Format("IDS_QM_UI_HINGE_BROKEN_RULES", {std::to_string(broken)});
    });
    form.Grid(std::move(b)).name = "findings";
}

/// Initial stiffness of every page, with the length of the first element that uses the type.
void AddStiffness(CFormView& form, DLG& dlg)
{
    T_GRID_BINDING b;
    b.columns = {{KeyText("IDS_QM_UI_HINGE_COMPONENT")},
                 {KeyText("IDS_QM_UI_HINGE_ENDS")},
                 {KeyText("IDS_RPS_PO_PHGT_Initial_Stiffness")},
                 {PlainLabel("K(+)")},
                 {PlainLabel("K(-)")}};
    const auto rows = std::make_shared<std::vector<T_STIFFNESS_ROW>>();
    b.rows = [rows, &dlg] {
        *rows = dlg.UpdateInitialStiffness();
        return rows->size();
    };
    b.text = [rows, &dlg](std::size_t row, std::size_t c) {
        return dlg.StiffnessCells((*rows)[row])[c];
    };
    form.Grid(std::move(b)).name = "stiffness";
    form.Note([&dlg] {
        return dlg.m_memberLength > 0.0
                   ? HeadWithUnit("IDS_QM_UI_HINGE_MEMBER_LENGTH", kDimLength, dlg.Owner().units) +
                         ": " + ShortestText(dlg.m_memberLength)
                   : MMSGFunction::GetValue("IDS_QM_UI_HINGE_NO_MEMBER");
    });
}

void BuildType(CFormView& form, DLG& dlg)
{
    form.Columns();
    AddGeneral(form, dlg);
    AddReferences(form, dlg);
    AddComponents(form, dlg);
    AddParts(form, dlg);
    form.NextColumn();
    AddPreview(form, dlg);
    form.Page(KeyText("IDS_QM_UI_HINGE_RULES"));
    AddFindings(form, dlg);
    form.Page(KeyText("IDS_RPS_PO_PHGT_Initial_Stiffness"));
    AddStiffness(form, dlg);
    form.EndPages();
    form.EndColumns();
}

} // namespace

void RegisterHingeTypeView(CViewFactory& factory)
{
    factory.Register<DLG>(KeyText("IDS_QM_UI_HINGE_TYPE_TITLE"), BuildType, {.size = {1180, 760}});
}
