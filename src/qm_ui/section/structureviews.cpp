#include "qm_ui/section/structureviews.h"

#include "qm_rps/sectiondlg.h"
#include "qm_ui/plot/plotwidget.h"
#include "qm_ui/section/sectionbarsplot.h"
#include "qm_ui/section/structurefields.h"

#include <array>

namespace {

constexpr std::size_t kSizes = 4;

// ---- section ------------------------------------------------------------------------------------

/// What the dimensions of a shape are called; null: it has no such one.
const char* SizeKey(SECT_SHAPE shape, std::size_t i)
{
    constexpr const char *kHeight = "IDS_QM_UI_SECT_HEIGHT", *kWidth = "IDS_QM_UI_SECT_WIDTH",
                         *kDiameter = "IDS_QM_UI_SECT_OUTER", *kWall = "IDS_QM_UI_SECT_WALL",
                         *kWeb = "IDS_QM_UI_SECT_WEB", *kFlange = "IDS_QM_UI_SECT_FLANGE";
    constexpr std::array<std::array<const char*, kSizes>, 7> kKeys{
        {{},
         {kHeight, kWidth},
         {kDiameter},
         {kDiameter, kWall},
         {kHeight, kWidth, kWeb, kFlange},
         {kHeight, kWidth, kWeb, kFlange},
         {kHeight, kWidth, kWeb, kFlange}}};
    return kKeys[static_cast<std::size_t>(shape)][i];
}

void AddDimensions(CFormView& form, CSectionDlg& d)
{
    form.Page(KeyText("IDS_QM_UI_SECT_DIMENSIONS"));
    form.Choice(KeyText("IDS_QM_UI_HEAD_SHAPE"),
                {[&d] { return static_cast<int>(d.m_section.shape); },
                 [&d](const int& index) { d.OnShape(static_cast<SECT_SHAPE>(index)); }},
                KeyTexts({"IDS_QM_UI_SHAPE_VALUE", "IDS_QM_UI_SHAPE_RECTANGLE",
                          "IDS_QM_UI_SHAPE_CIRCLE", "IDS_QM_UI_SHAPE_PIPE", "IDS_QM_UI_SHAPE_BOX",
                          "IDS_QM_UI_SHAPE_I", "IDS_QM_UI_SHAPE_CHANNEL"}))
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
    CFormField& fillet =
        form.Number(Head(d, "IDS_QM_UI_SECT_FILLET", kDimLength), Ref(d.m_section.fillet));
    fillet.name = "fillet";
    fillet.shown = [&d] { return d.HasFillet(); };
    CFormField& taper = form.Number(KeyText("IDS_QM_UI_SECT_TAPER"), Ref(d.m_section.taper));
    taper.name = "taper";
    taper.shown = [&d] { return d.HasTaper(); };
    CFormField& note = form.Note([&d] { return d.ShearCentreText(); });
    note.shown = [&d] { return d.HasTaper(); };
    form.Group(KeyText("IDS_QM_UI_SECT_STOCK"));
    form.Choice(KeyText("IDS_QM_UI_SECT_STOCK_FAMILY"),
                {[&d] { return d.FamilyIndex(); }, [&d](const int& index) { d.OnFamily(index); }},
                [] { return CSectionDlg::FamilyTexts(); })
        .name = "family";
    form.Choice(KeyText("IDS_QM_UI_SECT_STOCK_ROLLED"),
                {[&d] { return d.StockIndex(); }, [&d](const int& index) { d.OnStock(index); }},
                [&d] { return d.StockTexts(); })
        .name = "stock";
    form.Text(KeyText("IDS_QM_UI_SECT_STOCK_NAME"),
              {[&d] { return d.StockName(); },
               [&d](const std::string& name) { (void)d.OnStockName(name); }})
        .name = "stockName";
    form.EndGroup();
    form.Space();
}

/// Values that belong to the dimensions; typed where the shape has none.
void AddProperties(CFormView& form, CSectionDlg& d)
{
    constexpr T_DIM kArea{0, 2}, kModulus{0, 3}, kInertia{0, 4};
    using R = T_SECT_D;
    const std::tuple<const char*, double R::*, T_DIM, const char*> rows[] = {
        {"IDS_QM_UI_SECT_A", &R::area, kArea, "A"},
        {"IDS_QM_UI_SECT_ASY", &R::Asy, kArea, "Asy"},
        {"IDS_QM_UI_SECT_ASZ", &R::Asz, kArea, "Asz"},
        {"IDS_QM_UI_SECT_J", &R::J, kInertia, "J"},
        {"IDS_QM_UI_SECT_IY", &R::Iyy, kInertia, "Iy"},
        {"IDS_QM_UI_SECT_IZ", &R::Izz, kInertia, "Iz"},
        {"IDS_QM_UI_SECT_ZY", &R::Zy, kModulus, "Zy"},
        {"IDS_QM_UI_SECT_ZZ", &R::Zz, kModulus, "Zz"}};
    form.Page(KeyText("IDS_QM_UI_SECT_PROPERTIES"));
    for (const auto& [key, member, dim, name] : rows) {
        CFormField& field =
            form.Number(Head(d, key, dim),
                        {[&d, member = member] { return d.Calculated().*member; },
                         [&d, member = member](const double& v) { d.m_section.*member = v; }});
        field.name = name;
        field.enabled = [&d] { return d.m_section.shape == SECT_SHAPE::Value; };
    }
    form.Note(KeyText("IDS_QM_UI_SECT_PROPERTIES_NOTE"));
    form.Space();
}

void AddFactors(CFormView& form, CSectionDlg& d)
{
    using F = T_SECT_FACTORS;
    constexpr std::pair<const char*, double F::*> kFactors[] = {
        {"area", &F::area}, {"Asy", &F::Asy}, {"Asz", &F::Asz},
        {"J", &F::J},       {"Iyy", &F::Iyy}, {"Izz", &F::Izz}};
    form.Page(KeyText("IDS_QM_UI_SECT_FACTORS"));
    form.Cells({[] { return std::string(); }, PlainLabel("I"), PlainLabel("J")});
    for (const auto& [text, member] : kFactors) {
        form.Note(PlainLabel(text));
        form.Number(PlainLabel(text), Ref(d.m_section.factorsI.*member)).name =
            std::string("factors_I.") + text;
        form.Number(PlainLabel(text), Ref(d.m_section.factorsJ.*member)).name =
            std::string("factors_J.") + text;
    }
    form.EndCells();
    form.Note(KeyText("IDS_QM_UI_SECT_FACTORS_NOTE"));
    form.Space();
}

void AddDetailing(CFormView& form, CSectionDlg& d)
{
    form.Page(KeyText("IDS_QM_UI_SECT_DETAILING"));
    form.Flag(KeyText("IDS_QM_UI_SECT_HAS_DETAILING"),
              {[&d] { return d.HasDetailing(); }, [&d](const bool& on) { d.OnDetailing(on); }})
        .name = "detailing";
    const auto has = [&d] { return d.HasDetailing(); };
    const auto add = [&](CFormField& field, const char* name) {
        field.name = std::string("detailing.") + name;
        field.enabled = has;
    };
    using D = T_SECT_DETAIL;
    const auto detail = [&d](auto member) { return PartRef(d.m_section.detailing, member); };
    const std::tuple<const char*, double D::*, const char*> lengths[] = {
        {"IDS_QM_UI_SECT_COVER", &D::cover, "cover"},
        {"IDS_QM_UI_SECT_STIRRUP", &D::stirrupDiameter, "stirrup_diameter"},
        {"IDS_QM_UI_SECT_SPACING", &D::stirrupSpacing, "stirrup_spacing"},
        {"IDS_QM_UI_SECT_LAP", &D::lapLength, "lap_length"}};
    for (const auto& [key, member, name] : lengths)
        add(form.Number(Head(d, key, kDimLength), detail(member)), name);
    add(form.Integer(KeyText("IDS_QM_UI_SECT_LEGS_Y"), detail(&D::legsY)), "legs_y");
    add(form.Integer(KeyText("IDS_QM_UI_SECT_LEGS_Z"), detail(&D::legsZ)), "legs_z");
    const T_BINDING<STIRRUP_HOOKS> hooks = detail(&D::hooks);
    add(form.Choice(
            KeyText("IDS_QM_UI_SECT_HOOKS"),
            {[hooks] { return static_cast<int>(hooks.get()); },
             [hooks](const int& index) { hooks.set(static_cast<STIRRUP_HOOKS>(index)); }},
            KeyTexts({"IDS_QM_UI_HOOKS_135", "IDS_QM_UI_HOOKS_90", "IDS_QM_UI_HOOKS_NONE"})),
        "hooks");
    add(form.Flag(KeyText("IDS_QM_UI_SECT_IN_CORE"), detail(&D::tiesInCore)), "ties_in_core");
    add(form.Flag(KeyText("IDS_QM_UI_SECT_SPLICE"), detail(&D::poorSplice)), "poor_splice");
    form.Space();
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
    form.Choice(KeyText("IDS_QM_UI_SECT_PLACE"), IndexRef(d.m_group.place),
                KeyTexts({"IDS_QM_UI_BARS_CORNERS", "IDS_QM_UI_BARS_TOP", "IDS_QM_UI_BARS_BOTTOM",
                          "IDS_QM_UI_BARS_RIGHT", "IDS_QM_UI_BARS_LEFT", "IDS_QM_UI_BARS_AROUND"}))
        .name = "place";
    form.Columns();
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
    grid.widget->setMinimumSize(340, 110);
    grid.widget->setMaximumHeight(240); // the picture takes the room that is left
    form.Note([&d] { return d.BarsText(); });
}

void BuildSection(CFormView& form, CSectionDlg& d)
{
    AddChoice(form, d, "IDS_QM_UI_HEAD_SECTION");
    form.Columns();
    form.Text(KeyText("IDS_QM_UI_HEAD_NAME"), Ref(d.m_section.name)).name = "name";
    AddDimensions(form, d);
    AddDetailing(form, d);
    AddProperties(form, d);
    AddFactors(form, d);
    form.EndPages();
    form.NextColumn(1);
    CFormField& picture = form.Picture([&d] { return SectionBarsPlot(d.m_section, d.Units()); });
    picture.widget->setMinimumSize(340, 200);
    if (auto* view = dynamic_cast<CPlotWidget*>(picture.widget)) view->SetSizeHint({480, 340});
    AddBars(form, d);
    form.EndColumns();
    form.SetFindings([&d] { return d.Findings(); });
    form.m_isChanged = [&d] { return d.IsChanged(); };
}

} // namespace

void RegisterStructureForms(CViewFactory& factory)
{
    factory.Register<CSectionDlg>(KeyText("IDS_QM_UI_SECT_TITLE"), BuildSection,
                                  {.size = {980, 720}});
    RegisterMaterialForm(factory);
}
