#include "qm_ui/section/structureviews.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_rps/dialog/unithead.h"
#include "qm_rps/materialdlg.h"
#include "qm_rps/sectiondlg.h"
#include "qm_ui/plot/plotwidget.h"
#include "qm_ui/section/sectionbarsplot.h"

#include <array>

namespace {

constexpr std::size_t kSizes = 4;

/// A caption with the unit of a length or of a stress.
template <class DLG>
TextFn Head(const DLG& d, const char* key, T_DIM dim)
{
    return [&d, key, dim] { return HeadWithUnit(Say(key), dim, d.Units()); };
}

/// The record that is edited, and a button for a new one.
template <class DLG>
void AddChoice(CFormView& form, DLG& d, const char* caption)
{
    form.Columns();
    form.Choice(KeyText(caption),
                {[&d] { return d.Index(); }, [&d](const int& index) { d.OnSelChange(index); }},
                [&d] { return d.Names(); })
        .name = "record";
    form.NextColumn();
    form.Button(KeyText("IDS_QM_UI_SECT_NEW"), [&d] { d.OnNew(); }).name = "new";
    form.EndColumns();
}

// ---- section ------------------------------------------------------------------------------------

/// What the dimensions of a shape are called; null: it has no such one.
const char* SizeKey(SECT_SHAPE shape, std::size_t i)
{
    constexpr const char *kHeight = "IDS_QM_UI_SECT_HEIGHT", *kWidth = "IDS_QM_UI_SECT_WIDTH",
                         *kDiameter = "IDS_QM_UI_SECT_OUTER", *kWall = "IDS_QM_UI_SECT_WALL",
                         *kWeb = "IDS_QM_UI_SECT_WEB", *kFlange = "IDS_QM_UI_SECT_FLANGE";
    constexpr std::array<std::array<const char*, kSizes>, 6> kKeys{
        {{},
         {kHeight, kWidth},
         {kDiameter},
         {kDiameter, kWall},
         {kHeight, kWidth, kWeb, kFlange},
         {kHeight, kWidth, kWeb, kFlange}}};
    return kKeys[static_cast<std::size_t>(shape)][i];
}

void AddDimensions(CFormView& form, CSectionDlg& d)
{
    form.Text(KeyText("IDS_QM_UI_HEAD_NAME"), Ref(d.m_section.name)).name = "name";
    form.Choice(KeyText("IDS_QM_UI_HEAD_SHAPE"), IndexRef(d.m_section.shape),
                KeyTexts({"IDS_QM_UI_SHAPE_VALUE", "IDS_QM_UI_SHAPE_RECTANGLE",
                          "IDS_QM_UI_SHAPE_CIRCLE", "IDS_QM_UI_SHAPE_PIPE", "IDS_QM_UI_SHAPE_BOX",
                          "IDS_QM_UI_SHAPE_I"}))
        .name = "shape";
    for (std::size_t i = 0; i < kSizes; ++i) {
        CFormField& field = form.Number(
            [&d, i] {
                const char* const key = SizeKey(d.m_section.shape, i);
                return key ? HeadWithUnit(Say(key), kDimLength, d.Units()) : std::string();
            },
            Ref(d.m_section.size[i]));
        field.name = "size" + std::to_string(i);
        field.shown = [&d, i] { return SizeKey(d.m_section.shape, i) != nullptr; };
    }
}

/// A member of the detailing, which may be switched off.
template <class T>
T_BINDING<T> Detail(CSectionDlg& d, T T_SECT_DETAIL::*member)
{
    return {[&d, member] { return d.HasDetailing() ? (*d.m_section.detailing).*member : T{}; },
            [&d, member](const T& value) {
                if (d.HasDetailing()) (*d.m_section.detailing).*member = value;
            }};
}

void AddDetailing(CFormView& form, CSectionDlg& d)
{
    form.Group(KeyText("IDS_QM_UI_SECT_DETAILING"));
    form.Flag(KeyText("IDS_QM_UI_SECT_HAS_DETAILING"),
              {[&d] { return d.HasDetailing(); }, [&d](const bool& on) { d.OnDetailing(on); }})
        .name = "detailing";
    const auto has = [&d] { return d.HasDetailing(); };
    const auto add = [&](CFormField& field, const char* name) {
        field.name = std::string("detailing.") + name;
        field.enabled = has;
    };
    using D = T_SECT_DETAIL;
    const std::tuple<const char*, double D::*, const char*> lengths[] = {
        {"IDS_QM_UI_SECT_COVER", &D::cover, "cover"},
        {"IDS_QM_UI_SECT_STIRRUP", &D::stirrupDiameter, "stirrup_diameter"},
        {"IDS_QM_UI_SECT_SPACING", &D::stirrupSpacing, "stirrup_spacing"},
        {"IDS_QM_UI_SECT_LAP", &D::lapLength, "lap_length"}};
    for (const auto& [key, member, name] : lengths)
        add(form.Number(Head(d, key, kDimLength), Detail(d, member)), name);
    add(form.Integer(KeyText("IDS_QM_UI_SECT_LEGS_Y"), Detail(d, &D::legsY)), "legs_y");
    add(form.Integer(KeyText("IDS_QM_UI_SECT_LEGS_Z"), Detail(d, &D::legsZ)), "legs_z");
    const T_BINDING<STIRRUP_HOOKS> hooks = Detail(d, &D::hooks);
    add(form.Choice(
            KeyText("IDS_QM_UI_SECT_HOOKS"),
            {[hooks] { return static_cast<int>(hooks.get()); },
             [hooks](const int& index) { hooks.set(static_cast<STIRRUP_HOOKS>(index)); }},
            KeyTexts({"IDS_QM_UI_HOOKS_135", "IDS_QM_UI_HOOKS_90", "IDS_QM_UI_HOOKS_NONE"})),
        "hooks");
    add(form.Flag(KeyText("IDS_QM_UI_SECT_IN_CORE"), Detail(d, &D::tiesInCore)), "ties_in_core");
    add(form.Flag(KeyText("IDS_QM_UI_SECT_SPLICE"), Detail(d, &D::poorSplice)), "poor_splice");
    form.EndGroup();
}

T_GRID_BINDING BarGrid(CSectionDlg& d)
{
    using C = CSectionDlg::COLUMN;
    T_GRID_BINDING b;
    for (int c = 0; c < C::Columns; ++c)
        b.columns.push_back(
            {[&d, c] { return d.ColumnHead(static_cast<C>(c)); }, CELL_KIND::Number, true});
    b.rows = [&d] { return d.m_section.bars.size(); };
    b.text = [&d](std::size_t row, std::size_t c) { return d.CellText(row, static_cast<C>(c)); };
    b.set = [&d](std::size_t row, std::size_t c, const std::string& text) {
        return d.SetCell(row, static_cast<C>(c), text);
    };
    b.select = [&d](int row) { d.m_bar = row; };
    b.selected = [&d] { return d.m_bar; };
    return b;
}

void AddBars(CFormView& form, CSectionDlg& d)
{
    form.Group(KeyText("IDS_QM_UI_SECT_LAY"));
    form.Columns();
    form.Choice(KeyText("IDS_QM_UI_SECT_PLACE"), IndexRef(d.m_group.place),
                KeyTexts({"IDS_QM_UI_BARS_CORNERS", "IDS_QM_UI_BARS_TOP", "IDS_QM_UI_BARS_BOTTOM",
                          "IDS_QM_UI_BARS_RIGHT", "IDS_QM_UI_BARS_LEFT", "IDS_QM_UI_BARS_AROUND"}))
        .name = "place";
    form.NextColumn();
    CFormField& count = form.Integer(KeyText("IDS_QM_UI_SECT_COUNT"), Ref(d.m_group.count));
    count.name = "count";
    count.enabled = [&d] { return d.m_group.place != BAR_PLACE::Corners; };
    form.NextColumn();
    form.Number(Head(d, "IDS_QM_UI_SECT_DIAMETER", kDimLength), Ref(d.m_group.diameter)).name =
        "diameter";
    form.EndColumns();
    form.Columns();
    const std::tuple<const char*, std::function<void()>, std::function<bool()>> buttons[] = {
        {"IDS_QM_UI_SECT_ADD", [&d] { (void)d.OnAddBars(); }, [] { return true; }},
        {"IDS_QM_UI_SECT_ONE", [&d] { d.OnNewBar(); }, [] { return true; }},
        {"IDS_QM_UI_SECT_DELETE", [&d] { d.OnDeleteBar(d.m_bar); }, [&d] { return d.m_bar >= 0; }},
        {"IDS_QM_UI_SECT_CLEAR", [&d] { d.OnClearBars(); },
         [&d] { return !d.m_section.bars.empty(); }}};
    bool first = true;
    for (const auto& [key, pressed, enabled] : buttons) {
        if (!first) form.NextColumn();
        first = false;
        CFormField& button = form.Button(KeyText(key), pressed);
        button.name = key;
        button.enabled = enabled;
    }
    form.EndColumns();
    form.EndGroup();
    CFormField& grid = form.Grid(BarGrid(d));
    grid.name = "bars";
    grid.widget->setMinimumSize(400, 160);
    grid.widget->setMaximumHeight(240); // the picture takes the room that is left
    form.Note([&d] { return d.BarsText(); });
}

void BuildSection(CFormView& form, CSectionDlg& d)
{
    AddChoice(form, d, "IDS_QM_UI_HEAD_SECTION");
    form.Columns();
    AddDimensions(form, d);
    AddDetailing(form, d);
    form.Space();
    form.NextColumn(1);
    CFormField& picture = form.Picture([&d] { return SectionBarsPlot(d.m_section, d.Units()); });
    picture.widget->setMinimumSize(420, 300);
    if (auto* view = dynamic_cast<CPlotWidget*>(picture.widget)) view->SetSizeHint({480, 340});
    AddBars(form, d);
    form.EndColumns();
    form.SetFindings([&d] { return d.Findings(); });
}

// ---- material -----------------------------------------------------------------------------------

/// A member of the mean strengths, which may be switched off.
T_BINDING<double> Mean(CMaterialDlg& d, double T_MATL_MEAN::*member)
{
    return {[&d, member] { return d.HasMean() ? (*d.m_material.mean).*member : 0.0; },
            [&d, member](const double& value) {
                if (d.HasMean()) (*d.m_material.mean).*member = value;
            }};
}

void AddKnown(CFormView& form, CMaterialDlg& d)
{
    form.Group(KeyText("IDS_QM_UI_MATL_EXISTING"));
    form.Flag(KeyText("IDS_QM_UI_MATL_HAS_MEAN"),
              {[&d] { return d.HasMean(); }, [&d](const bool& on) { d.OnMean(on); }})
        .name = "hasMean";
    const std::tuple<const char*, double T_MATL_MEAN::*, const char*> means[] = {
        {"IDS_QM_UI_MATL_FCM", &T_MATL_MEAN::fc, "mean.fc"},
        {"IDS_QM_UI_MATL_FYM", &T_MATL_MEAN::fy, "mean.fy"},
        {"IDS_QM_UI_MATL_FYWM", &T_MATL_MEAN::fyw, "mean.fyw"}};
    for (const auto& [key, member, name] : means) {
        CFormField& field = form.Number(Head(d, key, kDimStress), Mean(d, member));
        field.name = name;
        field.enabled = [&d] { return d.HasMean(); };
    }
    auto& knowledge = d.m_material.knowledge;
    form.Choice(KeyText("IDS_QM_UI_MATL_KNOWLEDGE"),
                {[&knowledge] { return knowledge ? static_cast<int>(*knowledge) + 1 : 0; },
                 [&knowledge](const int& index) {
                     knowledge.reset();
                     if (index > 0) knowledge = static_cast<MATL_KNOWLEDGE>(index - 1);
                 }},
                [] {
                    std::vector<std::string> texts{Say("IDS_QM_UI_MATL_UNKNOWN")};
                    for (const char* key :
                         {"IDS_QM_UI_MATL_KL1", "IDS_QM_UI_MATL_KL2", "IDS_QM_UI_MATL_KL3"})
                        texts.push_back(Say(key));
                    return texts;
                })
        .name = "knowledge";
    form.Optional(KeyText("IDS_QM_UI_MATL_CF"), Ref(d.m_material.confidence)).name =
        "confidence_factor";
    form.Note([&d] {
        const std::optional<double> factor = d.Confidence();
        return factor ? Say("IDS_QM_UI_MATL_CF_USED", FormatText("%.4g", *factor))
                      : Say("IDS_QM_UI_MATL_CF_NONE");
    });
    form.Note(KeyText("IDS_QM_UI_MATL_NOTE"));
    form.EndGroup();
}

void BuildMaterial(CFormView& form, CMaterialDlg& d)
{
    AddChoice(form, d, "IDS_QM_UI_HEAD_MATERIAL");
    T_MATL_D& m = d.m_material;
    form.Text(KeyText("IDS_QM_UI_HEAD_NAME"), Ref(m.name)).name = "name";
    form.Choice(KeyText("IDS_QM_UI_HEAD_CLASS"), IndexRef(m.type),
                KeyTexts({"IDS_QM_UI_MATL_CONCRETE", "IDS_QM_UI_MATL_STEEL",
                          "IDS_QM_UI_MATL_COMPOSITE", "IDS_QM_UI_MATL_MASONRY"}))
        .name = "type";
    const auto is = [&m](std::initializer_list<MATL_CLASS> classes) {
        return [&m, all = std::vector(classes)] {
            return std::ranges::find(all, m.type) != all.end();
        };
    };
    using C = MATL_CLASS;
    const auto bars = is({C::Concrete, C::Composite});
    form.Number(Head(d, "IDS_QM_UI_MATL_E", kDimStress), Ref(m.E)).name = "E";
    form.Number(KeyText("IDS_QM_UI_MATL_NU"), Ref(m.nu)).name = "nu";
    const std::tuple<const char*, double*, const char*, std::function<bool()>> strengths[] = {
        {"IDS_QM_UI_MATL_FY", &m.Fy, "fy", is({C::Steel, C::Composite})},
        {"IDS_QM_UI_MATL_FCK", &m.fck, "fck", is({C::Concrete, C::Composite, C::Masonry})},
        {"IDS_QM_UI_MATL_FYK", &m.fyk, "fyk", bars},
        {"IDS_QM_UI_MATL_ES", &m.Es, "Es", bars}};
    for (const auto& [key, value, name, shown] : strengths) {
        CFormField& field = form.Number(Head(d, key, kDimStress), Ref(*value));
        field.name = name;
        field.shown = shown;
    }
    AddKnown(form, d);
    form.SetFindings([&d] { return d.Findings(); });
}

} // namespace

void RegisterStructureForms(CViewFactory& factory)
{
    factory.Register<CSectionDlg>(KeyText("IDS_QM_UI_SECT_TITLE"), BuildSection,
                                  {.size = {980, 780}});
    factory.Register<CMaterialDlg>(KeyText("IDS_QM_UI_MATL_TITLE"), BuildMaterial,
                                   {.size = {560, 0}});
}
