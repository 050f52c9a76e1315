#include "qm_ui/loadcase/loadcaseview.h"

#include "qm_base/textformat.h"
#include "qm_db/recordfacts.h"
#include "qm_rps/po_loadcasedlg.h"
#include "qm_rps/po_loadcaselistdlg.h"
#include "qm_rps/po_selectloadcasedlg.h"
#include "qm_ui/loadcase/loadcasepages.h"

#include <algorithm>

namespace {

using D = CPO_LoadCaseDlg;
constexpr QSize kItemSize{640, 0}, kListSize{720, 380};
constexpr int kByDisplacement = 1, kByForce = 2; // increment methods
constexpr int kFollowsFunction = 2;              // increment option

// ---- control ------------------------------------------------------------------------------------

/// A member of the control data, where the case has any.
template <class T>
T_BINDING<T> Control(D& d, T T_POLC_CONTROL::*member)
{
    return {[&d, member] { return d.m_case.control.value_or(T_POLC_CONTROL()).*member; },
            [&d, member](const T& value) {
                if (d.m_case.control) (*d.m_case.control).*member = value;
            }};
}

bool HasControl(const D& d)
{
    return d.m_case.control.has_value();
}
bool ByDisplacement(const D& d)
{
    return HasControl(d) && d.m_case.control->incrementMethod == kByDisplacement;
}
/// Index in a list of keys; -1: not there.
int IndexOf(const std::vector<int>& keys, int key)
{
    const auto it = std::ranges::find(keys, key);
    return it == keys.end() ? -1 : static_cast<int>(it - keys.begin());
}

std::function<std::vector<std::string>()> Directions(std::size_t count)
{
    return [count] {
        return std::vector<std::string>(
            kDirectionNames.begin(), kDirectionNames.begin() + static_cast<std::ptrdiff_t>(count));
    };
}

/// With the unit in the caption, which is hidden with its field.
TextFn DisplacementCaption(const D& d, const char* key)
{
    return [&d, key] { return LoadCaseDisplacement(d).Head(key); };
}

/// What both methods have.
void BuildIncrements(CFormView& form, D& d)
{
    const auto has = [&d] { return HasControl(d); };
    const auto follows = [&d] {
        return HasControl(d) && d.m_case.control->incrementOption == kFollowsFunction;
    };
    const T_BINDING<int> option = Control(d, &T_POLC_CONTROL::incrementOption);
    const T_BINDING<int> function = Control(d, &T_POLC_CONTROL::incrementFunction);
    form.Flag(KeyText("IDS_QM_UI_POLC_BY_FUNCTION"),
              {[option] { return option.get() == kFollowsFunction; },
               [option](bool on) { option.set(on ? kFollowsFunction : 0); }})
        .shown = has;
    CFormField& list =
        form.Choice(KeyText("IDS_QM_UI_POLC_FUNCTION"),
                    {[&d, function] { return IndexOf(d.FunctionKeys(), function.get()); },
                     [&d, function](const int& i) {
                         function.set(d.FunctionKeys().at(static_cast<std::size_t>(i)));
                     }},
                    [&d] { return d.FunctionNames(); });
    list.name = "control.incrementFunction";
    list.shown = follows;
    CFormField& ratio = form.Number(KeyText("IDS_QM_UI_POLC_RATIO"),
                                    Control(d, &T_POLC_CONTROL::stiffnessRatioLimit));
    ratio.name = "control.stiffnessRatioLimit";
    ratio.shown = has;
    form.Flag(KeyText("IDS_QM_UI_POLC_ANGLE_ON"), Control(d, &T_POLC_CONTROL::generateStaticAngle))
        .shown = has;
    CFormField& angle =
        form.Number(KeyText("IDS_QM_UI_POLC_ANGLE"), Control(d, &T_POLC_CONTROL::staticAngle));
    angle.name = "control.staticAngle";
    angle.shown = has;
    angle.enabled = [&d] { return HasControl(d) && d.m_case.control->generateStaticAngle; };
}

void BuildDisplacement(CFormView& form, D& d)
{
    CFormField& on = form.Flag(KeyText("IDS_QM_UI_POLC_MASTER_ON"),
                               Control(d, &T_POLC_CONTROL::masterNodeControl));
    on.name = "masterOn";
    on.shown = [&d] { return ByDisplacement(d); };
    const auto isMaster = [&d] { return HasControl(d) && d.m_case.control->masterNodeControl; };
    CFormField& master = form.Number(DisplacementCaption(d, "IDS_QM_UI_POLC_MASTER"),
                                     Control(d, &T_POLC_CONTROL::masterMaxDispl));
    master.name = "control.masterMaxDispl";
    master.shown = [&d] { return ByDisplacement(d); };
    master.enabled = isMaster;
    CFormField& trans = form.Number(DisplacementCaption(d, "IDS_QM_UI_POLC_TRANS"),
                                    Control(d, &T_POLC_CONTROL::maxTransDispl));
    trans.name = "control.maxTransDispl";
    trans.shown = [&d] { return ByDisplacement(d); };
    trans.enabled = [isMaster] { return !isMaster(); };
}

void BuildControl(CFormView& form, D& d)
{
    form.Choice(KeyText("IDS_QM_UI_POLC_CONTROL_NODE"),
                {[&d] { return d.m_case.controlOption == 1 ? 0 : 1; },
                 [&d](const int& i) { d.m_case.controlOption = i == 0 ? 1 : 2; }},
                KeyTexts({"IDS_QM_UI_POLC_NODE_NAMED", "IDS_QM_UI_POLC_NODE_FOUND"}))
        .name = "controlOption";
    CFormField& has =
        form.Flag(KeyText("IDS_QM_UI_POLC_HAS_CONTROL"), {[&d] { return HasControl(d); },
                                                          [&d](bool on) {
                                                              if (!on)
                                                                  d.m_case.control.reset();
                                                              else if (!d.m_case.control)
                                                                  d.m_case.control.emplace();
                                                          }});
    has.name = "hasControl";
    has.enabled = [&d] { return d.HasResults() || !HasControl(d); };
    const T_BINDING<int> method = Control(d, &T_POLC_CONTROL::incrementMethod);
    CFormField& choice =
        form.Choice(KeyText("IDS_QM_UI_POLC_METHOD"),
                    {[method] { return method.get() == kByDisplacement ? 0 : 1; },
                     [method](const int& i) { method.set(i == 0 ? kByDisplacement : kByForce); }},
                    KeyTexts({"IDS_RPS_PUSHOVER_DISP_CTRL", "IDS_RPS_PUSHOVER_FORCE_CTRL"}));
    choice.name = "method";
    choice.enabled = [&d] { return HasControl(d); };
    BuildDisplacement(form, d);
    BuildIncrements(form, d);
}

void BuildGeneral(CFormView& form, D& d)
{
    form.Text(KeyText("IDS_QM_UI_POLC_NAME"), Ref(d.m_case.name)).name = "name";
    form.Integer(KeyText("IDS_QM_UI_POLC_NODE"), Ref(d.m_case.controlNode)).name = "controlNode";
    CFormField& direction = form.Choice(KeyText("IDS_QM_UI_POLC_DIRECTION"),
                                        {[&d] { return d.m_case.direction - 1; },
                                         [&d](const int& i) { d.m_case.direction = i + 1; }},
                                        Directions(kDirectionNames.size()));
    direction.name = "direction";
    direction.enabled = [&d] { return !d.HasResults(); };
    form.Note(KeyText("IDS_QM_UI_POLC_RESULTS")).shown = [&d] { return d.HasResults(); };
}

// ---- pattern ------------------------------------------------------------------------------------

/// What the rules say of a row: those of the document, and those of rows that are stored.
std::string RowFault(const D& d, std::size_t row)
{
    const std::string field = "patterns[" + std::to_string(row) + "]";
    for (const auto& all : {d.Findings(), PatternFindings(d.m_case.patterns)})
        for (const T_FINDING& f : all)
            if (f.field == field) return f.text;
    return {};
}

T_GRID_BINDING PatternGrid(D& d)
{
    T_GRID_BINDING grid;
    grid.columns = {{KeyText("IDS_QM_UI_POLC_KIND")},
                    {KeyText("IDS_QM_UI_POLC_WHAT")},
                    {KeyText("IDS_QM_UI_POLC_FACTOR"), CELL_KIND::Number}};
    grid.rows = [&d] { return d.m_case.patterns.size(); };
    grid.text = [&d](std::size_t r, std::size_t c) {
        const T_POLC_PATTERN& row = d.m_case.patterns.at(r);
        return c == 0   ? PatternKindText(row.kind)
               : c == 1 ? d.NumberText(row)
                        : ShortestText(row.factor);
    };
    grid.select = [&d](int row) { d.SelectPattern(row); };
    grid.selected = [&d] { return d.m_selected; };
    grid.mark = [&d](std::size_t r, std::size_t) { return RowFault(d, r); };
    return grid;
}

void BuildPatternInput(CFormView& form, D& d)
{
    const auto ofKind = [&d](int low, int high) {
        return [&d, low, high] { return low <= d.m_input.kind && d.m_input.kind <= high; };
    };
    form.Choice(KeyText("IDS_QM_UI_POLC_KIND"), Ref(d.m_input.kind),
                [] {
                    return std::vector<std::string>{PatternKindText(0), PatternKindText(1),
                                                    PatternKindText(2), PatternKindText(3)};
                })
        .name = "input.kind";
    CFormField& load = form.Choice(KeyText("IDS_QM_UI_POLC_LOAD"),
                                   {[&d] { return IndexOf(d.LoadCaseKeys(), d.m_input.loadCase); },
                                    [&d](const int& i) {
                                        d.m_input.loadCase =
                                            d.LoadCaseKeys().at(static_cast<std::size_t>(i));
                                    }},
                                   [&d] { return d.LoadCaseNames(); });
    load.name = "input.load";
    load.shown = ofKind(0, 0);
    CFormField& direction =
        form.Choice(KeyText("IDS_QM_UI_POLC_DIR"), Ref(d.m_input.directionIndex), Directions(3));
    direction.name = "input.direction";
    direction.shown = ofKind(1, 1);
    CFormField& mode = form.Number(KeyText("IDS_QM_UI_POLC_MODE"), Ref(d.m_input.mode));
    mode.name = "input.mode";
    mode.shown = ofKind(2, 3);
    form.Number(KeyText("IDS_QM_UI_POLC_FACTOR"), Ref(d.m_input.factor)).name = "input.factor";
}

void BuildPatterns(CFormView& form, D& d)
{
    form.Grid(PatternGrid(d)).name = "patterns";
    BuildPatternInput(form, d);
    const auto chosen = [&d] { return d.m_selected >= 0; };
    form.Columns();
    form.Button(KeyText("IDS_QM_UI_POLC_ADD_ROW"), [&d] { (void)d.OnAddPattern(d.m_input); }).name =
        "row.add";
    form.NextColumn();
    CFormField& modify = form.Button(KeyText("IDS_QM_UI_POLC_MODIFY_ROW"),
                                     [&d] { (void)d.OnModifyPattern(d.m_input); });
    modify.name = "row.modify";
    modify.enabled = chosen;
    form.NextColumn();
    CFormField& erase =
        form.Button(KeyText("IDS_QM_UI_POLC_DELETE_ROW"), [&d] { (void)d.OnDeletePattern(); });
    erase.name = "row.delete";
    erase.enabled = chosen;
    form.EndColumns();
}

void BuildItem(CFormView& form, D& d)
{
    form.Page(KeyText("IDS_QM_UI_POLC_TITLE"));
    BuildGeneral(form, d);
    form.Group(KeyText("IDS_QM_UI_POLC_CONTROL"));
    BuildControl(form, d);
    form.EndGroup();
    form.Page(KeyText("IDS_QM_UI_POLC_PATTERNS"));
    BuildPatterns(form, d);
    form.Number(KeyText("IDS_QM_UI_POLC_ECCENTRICITY"), Ref(d.m_case.eccentricity)).name =
        "eccentricity";
    form.Page(KeyText("IDS_QM_UI_POLC_PAGE_START"));
    BuildLoadCaseStart(form, d);
    form.Page(KeyText("IDS_QM_UI_POLC_PAGE_STOPS"));
    BuildLoadCaseStops(form, d);
    form.EndPages();
}

// ---- list and selection -------------------------------------------------------------------------

/// Rows are read once for each time that the table is filled.
template <class MODEL>
T_GRID_BINDING RowGrid(MODEL& d, std::function<int()> get, std::function<void(int)> set)
{
    const auto rows = std::make_shared<std::vector<T_LOADCASE_ROW>>();
    T_GRID_BINDING grid;
    for (const char* head : kLoadCaseHeads)
        grid.columns.push_back({KeyText(head)});
    grid.rows = [&d, rows] {
        *rows = d.Rows();
        return rows->size();
    };
    grid.text = [rows](std::size_t r, std::size_t c) {
        return r < rows->size() ? (*rows)[r].cells.at(c) : std::string();
    };
    grid.select = [rows, set](int row) {
        const auto r = static_cast<std::size_t>(row);
        set(row >= 0 && r < rows->size() ? (*rows)[r].key : 0);
    };
    grid.selected = [rows, get] { return RowOfLoadCase(*rows, get()); };
    grid.rowHead = [](std::size_t) { return std::string(" "); };
    return grid;
}

void BuildList(CFormView& form, CPO_LoadCaseListDlg& d)
{
    struct T_BUTTON {
        const char* key;
        int (CPO_LoadCaseListDlg::*press)();
        bool needsChoice;
    };
    constexpr T_BUTTON kButtons[] = {
        {"IDS_QM_UI_POLC_ADD", &CPO_LoadCaseListDlg::OnAdd, false},
        {"IDS_QM_UI_POLC_MODIFY", &CPO_LoadCaseListDlg::OnModify, true},
        {"IDS_QM_UI_POLC_COPY", &CPO_LoadCaseListDlg::OnCopy, true},
        {"IDS_QM_UI_POLC_DELETE", &CPO_LoadCaseListDlg::OnDelete, true},
        {"IDS_QM_UI_POLC_EIGHT_BUTTON", &CPO_LoadCaseListDlg::OnGenerate, false}};
    T_GRID_BINDING grid = RowGrid(
        d, [&d] { return d.m_selected; }, [&d](int key) { d.m_selected = key; });
    grid.open = [&d](std::size_t) { (void)d.OnModify(); };
    form.Grid(std::move(grid)).name = "rows";
    form.Columns();
    for (const T_BUTTON& button : kButtons) {
        if (&button != kButtons) form.NextColumn();
        CFormField& field =
            form.Button(KeyText(button.key), [&d, press = button.press] { (void)(d.*press)(); });
        field.name = button.key;
        if (button.needsChoice) field.enabled = [&d] { return d.m_selected != 0; };
    }
    form.EndColumns();
}

void BuildSelection(CFormView& form, CPO_SelectLoadCaseDlg& d)
{
    form.Grid(RowGrid(
                  d, [&d] { return d.Selected(); }, [&d](int key) { d.SetSelected(key); }))
        .name = "rows";
}

} // namespace

void RegisterLoadCaseForms(CViewFactory& factory)
{
    T_VIEW item, list, selection;
    item.size = kItemSize;
    list.size = selection.size = kListSize;
    list.showsOnly = true;
    factory.Register<CPO_LoadCaseDlg>(KeyText("IDS_QM_UI_POLC_TITLE"), BuildItem, item);
    factory.Register<CPO_LoadCaseListDlg>(KeyText("IDS_QM_UI_POLC_TITLE_LIST"), BuildList, list);
    factory.Register<CPO_SelectLoadCaseDlg>(KeyText("IDS_QM_UI_POLC_TITLE_SELECT"), BuildSelection,
                                            selection);
}
