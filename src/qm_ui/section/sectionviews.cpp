#include "qm_ui/section/sectionviews.h"

#include "qm_base/say.h"
#include "qm_rps/dialog/unithead.h"
#include "qm_rps/sectioncurvesdlg.h"
#include "qm_ui/push/stepfield.h"
#include "qm_ui/section/sectionplot.h"

#include <QLabel>

namespace {

using DLG = CSectionCurvesDlg;
constexpr QSize kPicture{720, 440};
constexpr int kCaption = 145, kField = 250; // widths: the pictures take the room that is left

/// A member of the options as a position in a list; a change calculates anew.
template <class E>
T_BINDING<int> Option(DLG& d, E T_SECTION_OPTIONS::*member)
{
    return {[&d, member] { return static_cast<int>(d.m_options.*member); },
            [&d, member](const int& index) {
                d.m_options.*member = static_cast<E>(index);
                d.OnChanged();
            }};
}

template <class T>
T_BINDING<T> Member(DLG& d, T& value)
{
    return {[&value] { return value; },
            [&d, &value](const T& v) {
                value = v;
                d.OnChanged();
            }};
}

void AddOptions(CFormView& form, DLG& d)
{
    const auto narrow = [](CFormField& field, const char* name) {
        field.name = name;
        field.label->setWordWrap(true);
        field.label->setFixedWidth(kCaption);
        field.widget->setFixedWidth(kField);
    };
    narrow(
        form.Choice(KeyText("IDS_QM_UI_HEAD_SECTION"),
                    {[&d] { return d.PairIndex(); }, [&d](const int& i) { d.OnSelChangePair(i); }},
                    [&d] { return d.PairTexts(); }),
        "section");
    narrow(form.Choice(
               KeyText("IDS_QM_UI_SECC_VALUES"), Option(d, &T_SECTION_OPTIONS::values),
               KeyTexts({"IDS_QM_SECC_CHARACTERISTIC", "IDS_QM_SECC_MEAN", "IDS_QM_SECC_EXPECTED",
                         "IDS_QM_SECC_LOWER", "IDS_QM_SECC_DESIGN", "IDS_QM_SECC_ASSESSED"})),
           "values");
    narrow(form.Choice(KeyText("IDS_QM_UI_SECC_LAW"), Option(d, &T_SECTION_OPTIONS::law),
                       KeyTexts({"IDS_QM_SECC_LAW_EUROCODE", "IDS_QM_SECC_LAW_ACI"})),
           "law");
    narrow(form.Choice(KeyText("IDS_QM_UI_SECC_CORE"), Option(d, &T_SECTION_OPTIONS::core),
                       KeyTexts({"IDS_QM_UI_SECC_CORE_PLAIN", "IDS_QM_SECC_CORE_MANDER",
                                 "IDS_QM_SECC_CORE_EUROCODE", "IDS_QM_SECC_CORE_NTC",
                                 "IDS_QM_SECC_CORE_EN1998"})),
           "core");
    narrow(form.Number(KeyText("IDS_QM_UI_SECC_DIRECTION"), Member(d, d.m_directionDeg)),
           "direction");
    narrow(form.Text([&d] { return Say("IDS_QM_UI_SECC_AXIAL", NameOf(d.Units().force)); },
                     Member(d, d.m_axial)),
           "axial");
    narrow(form.Number(KeyText("IDS_QM_UI_SECC_ALPHA"), Member(d, d.m_options.alphaCc)), "alphaCc");
    narrow(form.Number(KeyText("IDS_QM_UI_SECC_STEEL_STRAIN"), Member(d, d.m_options.steelStrain)),
           "steelStrain");
    narrow(form.Number(KeyText("IDS_QM_UI_SECC_HARDENING"), Member(d, d.m_options.hardening)),
           "hardening");
    narrow(form.Number(KeyText("IDS_QM_UI_SECC_HOOP"), Member(d, d.m_options.hoopStrain)),
           "hoopStrain");
    form.Note(KeyText("IDS_QM_SECC_SIGNS"));
    form.Space();
}

void AddPage(CFormView& form, DLG& d, SECTION_TASK task, const char* title)
{
    const std::string name = kSectionTaskNames[static_cast<std::size_t>(task)];
    form.Page(KeyText(title));
    CFormField& picture = AddPlot(
        form,
        [&d, task] {
            const T_SECTION_ANSWER* const answer = d.Answer(task);
            return answer ? SectionPlot(*answer, d.Units()) : T_PLOT();
        },
        kPicture);
    picture.name = name + ".picture";
    form.Note([&d, task] { return d.ReasonOf(task); }).name = name + ".reason";
    CFormField& grid = form.Grid(GridOf([&d, task] { return d.Table(task); }));
    grid.name = name + ".table";
    grid.widget->setMinimumHeight(120);
    grid.widget->setMaximumHeight(220);
    form.Button(KeyText("IDS_QM_UI_SECC_EXPORT"), [&d, task] { (void)d.OnExport(task); }).name =
        name + ".export";
}

T_GRID_BINDING SetGrid(DLG& d)
{
    T_GRID_BINDING b;
    for (std::size_t c = 0; c < DLG::kSetColumns; ++c)
        b.columns.push_back(
            {[&d, c] { return d.SetHead(c); }, c == 0 ? CELL_KIND::Text : CELL_KIND::Number, true});
    b.rows = [&d] { return d.m_sets.size(); };
    b.text = [&d](std::size_t row, std::size_t c) { return d.SetText(row, c); };
    b.set = [&d](std::size_t row, std::size_t c, const std::string& text) {
        return d.SetCell(row, c, text);
    };
    b.select = [&d](int row) { d.m_set = row; };
    b.selected = [&d] { return d.m_set; };
    return b;
}

void AddForces(CFormView& form, DLG& d)
{
    CFormField& sets = form.Grid(SetGrid(d));
    sets.name = "check.sets";
    sets.widget->setMinimumHeight(90);
    sets.widget->setMaximumHeight(150);
    form.Columns();
    const auto button = [&form](const char* key, const std::function<void()>& pressed) {
        form.Button(KeyText(key), pressed).name = key;
    };
    button("IDS_QM_UI_SECK_NEW", [&d] { d.OnNewSet(); });
    form.NextColumn();
    button("IDS_QM_UI_SECK_DELETE", [&d] { d.OnDeleteSet(); });
    form.NextColumn();
    button("IDS_QM_UI_SECK_READ", [&d] { (void)d.OnReadSets(); });
    form.EndColumns();
    form.Columns();
    form.Choice(KeyText("IDS_QM_UI_SECK_CASE"), Ref(d.m_loadCase), [&d] { return d.LoadCases(); })
        .name = "check.case";
    form.NextColumn();
    form.Text(KeyText("IDS_QM_UI_SECK_ELEMENTS"), Ref(d.m_elements)).name = "check.elements";
    form.NextColumn();
    button("IDS_QM_UI_SECK_TAKE", [&d] { (void)d.OnTakeResults(); });
    form.EndColumns();
    form.Columns();
    form.Choice(KeyText("IDS_QM_UI_SECK_CODE"), Member(d, d.m_checkCode),
                [] {
                    std::vector<std::string> texts{Say("IDS_QM_UI_SECK_ALL")};
                    texts.insert(texts.end(), kSectionCheckCodeNames.begin(),
                                 kSectionCheckCodeNames.end());
                    return texts;
                })
        .name = "check.code";
    form.NextColumn();
    CFormField& cot = form.Number(KeyText("IDS_QM_UI_SECK_COT"), Member(d, d.m_cotTheta));
    cot.name = "check.cotTheta";
    cot.shown = [&d] { return d.IsConcrete(); };
    form.NextColumn();
    form.Flag(KeyText("IDS_QM_UI_SECK_BY_RATIO"), Member(d, d.m_byRatio)).name = "check.byRatio";
    form.EndColumns();
}

/// The ways by their verdicts, then every number of the chosen one.
void AddCheckPage(CFormView& form, DLG& d)
{
    form.Page(KeyText("IDS_QM_UI_SECK_PAGE"));
    AddForces(form, d);
    T_GRID_BINDING ways = GridOf([&d] { return d.Ways(); });
    ways.select = [&d](int row) {
        if (row != d.Way()) d.OnWay(row);
    };
    ways.selected = [&d] { return d.Way(); };
    ways.tone = [&d](std::size_t row, std::size_t) {
        const T_SECTION_WAY* const way = d.WayAt(row);
        if (!way || (way->ratio && !way->IsExceeded())) return CELL_TONE::Plain;
        return way->ratio ? CELL_TONE::Fault : CELL_TONE::Notice;
    };
    CFormField& table = form.Grid(std::move(ways));
    table.name = "check.table";
    table.widget->setMinimumHeight(150);
    form.Note([&d] { return d.CheckText(); }).name = "check.text";
    CFormField& trace = form.Grid(GridOf([&d] { return d.WayTrace(); }));
    trace.name = "check.trace";
    trace.widget->setMinimumHeight(120);
    form.Note(KeyText("IDS_QM_SECK_SIGNS"));
    form.Note(KeyText("IDS_QM_UI_SECK_NOTE"));
    form.Button(KeyText("IDS_QM_UI_SECK_EXPORT"), [&d] { (void)d.OnExportCheck(); }).name =
        "check.export";
}

void BuildCurves(CFormView& form, DLG& d)
{
    form.Columns();
    AddOptions(form, d);
    form.NextColumn(1);
    AddPage(form, d, SECTION_TASK::Curvature, "IDS_QM_PLOT_SECC_CURVATURE");
    AddPage(form, d, SECTION_TASK::Interaction, "IDS_QM_UI_SECC_INTERACTION");
    AddPage(form, d, SECTION_TASK::Surface, "IDS_QM_UI_SECC_SURFACE");
    AddPage(form, d, SECTION_TASK::Capacity, "IDS_QM_PLOT_SECC_CAPACITY");
    AddCheckPage(form, d);
    form.EndPages();
    form.EndColumns();
}

} // namespace

void RegisterSectionViews(CViewFactory& factory)
{
    T_VIEW view;
    view.showsOnly = true;
    view.size = {1180, 780};
    factory.Register<DLG>(KeyText("IDS_QM_UI_SECC_TITLE"), BuildCurves, view);
}
