#include "qm_ui/push/pushsetupviews.h"

#include "qm_rps/dialog/unithead.h"
#include "qm_rps/push/pushlists.h"
#include "qm_rps/pushovercasegeneratordlg.h"
#include "qm_rps/pushoverglobalcontroldlg.h"
#include "qm_rps/pushoverincrementfunctiondlg.h"
#include "qm_ui/push/incrementfunctionplot.h"
#include "qm_ui/pushover/pushoverfields.h"

namespace {

// ---- global control -----------------------------------------------------------------------------

/// Hinge types with whether they act.
T_GRID_BINDING TypeGrid(CPushOverGlobalControlDlg& d)
{
    const auto types = [&d]() -> const T_TABLE<T_PHGT_D>& {
        return d.Doc()->Data().Model().hingeTypes;
    };
    const auto at = [types](std::size_t row) {
        return std::next(types().begin(), static_cast<std::ptrdiff_t>(row));
    };
    T_GRID_BINDING grid;
    grid.columns = {{KeyText("IDS_QM_UI_POGC_TYPE")},
                    {KeyText("IDS_QM_UI_POGC_ACTS"), CELL_KIND::Flag, true}};
    grid.rows = [types] { return types().size(); };
    grid.text = [&d, at](std::size_t row, std::size_t column) {
        if (column == 0) return at(row)->second.name;
        return std::string(HingeTypeActs(d.m_control.hingeTypes, at(row)->first) ? "1" : "0");
    };
    grid.set = [&d, at](std::size_t row, std::size_t, const std::string& text) {
        return SetHingeTypeActs(d.Doc()->Data().Model(), d.m_control.hingeTypes, at(row)->first,
                                text == "1");
    };
    return grid;
}

void BuildGlobal(CFormView& form, CPushOverGlobalControlDlg& d)
{
    T_POGC_D& c = d.m_control;
    form.Note(KeyText("IDS_QM_UI_POGC_NOTE"));
    form.Page(KeyText("IDS_QM_UI_POGC_ANALYSIS"));
    form.Group(KeyText("IDS_QM_UI_POGC_INITIAL"));
    form.Grid(InitialLoadGrid(d, [&c] { return &c.initialLoads; })).name = "initialLoads";
    form.Note(KeyText("IDS_QM_UI_POGC_ZERO")).shown = [&c] { return c.initialLoads.empty(); };
    form.EndGroup();
    form.Choice(KeyText("IDS_QM_UI_POGC_P_DELTA"), IndexRef(c.pDelta), PDeltaTexts).name = "pDelta";
    form.Integer(KeyText("IDS_QM_UI_POGC_STEPS"), Ref(c.steps)).name = "steps";
    form.Choice(KeyText("IDS_QM_UI_POGC_FAILURE"), IndexRef(c.onFailure), FailureTexts).name =
        "onFailure";
    form.Choice(KeyText("IDS_QM_UI_POGC_FLOW"), IndexRef(c.flow),
                KeyTexts({"IDS_QM_UI_FLOW_ROTATIONS", "IDS_QM_UI_FLOW_ASSOCIATED"}))
        .name = "flow";
    form.Integer(KeyText("IDS_QM_UI_POGC_EVENTS"), Ref(c.mostEvents)).name = "mostEvents";
    form.Integer(KeyText("IDS_QM_UI_POGC_MOST_STEPS"), Ref(c.mostSteps)).name = "mostSteps";
    form.Page(KeyText("IDS_QM_UI_POGC_TYPES"));
    form.Grid(TypeGrid(d)).name = "hingeTypes";
    form.EndPages();
}

// ---- increment functions ------------------------------------------------------------------------

using FUNCTIONS = CPushOverIncrementFunctionDlg;

int KeyAt(const FUNCTIONS& d, int row)
{
    if (row < 0 || static_cast<std::size_t>(row) >= d.m_functions.size()) return 0;
    return std::next(d.m_functions.begin(), row)->first;
}

T_GRID_BINDING FunctionGrid(FUNCTIONS& d)
{
    T_GRID_BINDING grid;
    grid.columns = {{KeyText("IDS_QM_UI_POFC_NAME")}};
    grid.rows = [&d] { return d.m_functions.size(); };
    grid.text = [&d](std::size_t row, std::size_t) {
        return d.m_functions.at(KeyAt(d, static_cast<int>(row))).name;
    };
    grid.rowHead = [&d](std::size_t row) {
        return std::to_string(KeyAt(d, static_cast<int>(row)));
    };
    grid.select = [&d](int row) { d.m_selected = KeyAt(d, row); };
    grid.selected = [&d] {
        const auto at = d.m_functions.find(d.m_selected);
        return at == d.m_functions.end()
                   ? -1
                   : static_cast<int>(std::distance(d.m_functions.begin(), at));
    };
    return grid;
}

/// What a rule says of a cell that is not above the one before it.
std::string RowMark(FUNCTIONS& d, std::size_t row, std::size_t column)
{
    const std::vector<double>& values = column == 0 ? d.Selected()->step : d.Selected()->factor;
    const bool rises = row >= values.size() || values[row] > (row ? values[row - 1] : 0.0);
    for (const T_FINDING& finding : d.Findings())
        if (!rises && finding.field == (column == 0 ? "step" : "factor")) return finding.text;
    return {};
}

T_GRID_BINDING RowsGrid(FUNCTIONS& d)
{
    T_GRID_BINDING grid;
    grid.columns = {{KeyText("IDS_QM_UI_POFC_STEP"), CELL_KIND::Number, true},
                    {KeyText("IDS_QM_UI_POFC_FACTOR"), CELL_KIND::Number, true}};
    grid.rows = [&d] { return d.Selected() ? d.Selected()->step.size() + 1 : 0; };
    grid.text = [&d](std::size_t row, std::size_t column) {
        return d.Selected() ? FunctionRowText(*d.Selected(), row, column) : std::string();
    };
    grid.set = [&d](std::size_t row, std::size_t column, const std::string& text) {
        return d.Selected() ? SetFunctionRow(*d.Selected(), row, column, text) : 0;
    };
    grid.mark = [&d](std::size_t row, std::size_t column) {
        return d.Selected() ? RowMark(d, row, column) : std::string();
    };
    grid.rowHead = [&d](std::size_t row) {
        return d.Selected() && row < d.Selected()->step.size() ? std::to_string(row + 1)
                                                               : std::string("+");
    };
    return grid;
}

void BuildFunctions(CFormView& form, FUNCTIONS& d)
{
    const auto chosen = [&d] { return d.Selected() != nullptr; };
    form.Note(KeyText("IDS_QM_UI_POFC_NOTE"));
    form.Columns();
    form.Grid(FunctionGrid(d)).name = "functions";
    form.Button(KeyText("IDS_QM_UI_POFC_ADD"), [&d] { d.OnAdd(); }).name = "add";
    CFormField& erase = form.Button(KeyText("IDS_QM_UI_POFC_DELETE"), [&d] { (void)d.OnDelete(); });
    erase.name = "delete";
    erase.enabled = chosen;
    form.NextColumn(1);
    CFormField& name =
        form.Text(KeyText("IDS_QM_UI_POFC_NAME"),
                  {[&d] { return d.Selected() ? d.Selected()->name : std::string(); },
                   [&d](const std::string& text) {
                       if (d.Selected()) d.Selected()->name = text;
                   }});
    name.name = "name";
    name.enabled = chosen;
    form.Grid(RowsGrid(d)).name = "rows";
    AddPicture(form,
               [&d] { return IncrementFunctionPlot(d.Selected() ? *d.Selected() : T_POFC_D()); },
               {480, 280})
        .name = "plot";
    form.EndColumns();
}

// ---- cases made at once -------------------------------------------------------------------------

using GENERATOR = CPushOverCaseGeneratorDlg;

/// The signs of the eccentricity as a choice: both, plus, minus.
T_BINDING<int> Signs(T_CASE_CHOICE& c)
{
    return {[&c] { return c.plus && c.minus ? 0
                          : c.plus          ? 1
                                            : 2; },
            [&c](const int& i) {
                c.plus = i != 2;
                c.minus = i != 1;
            }};
}

void BuildGenerator(CFormView& form, GENERATOR& d)
{
    T_CASE_CHOICE& c = d.m_choice;
    form.Note(KeyText("IDS_QM_UI_POLC_EIGHT_NOTE"));
    form.Columns();
    form.Flag(KeyText("IDS_QM_UI_GEN_X"), Ref(c.directions[0])).name = "x";
    form.Flag(KeyText("IDS_QM_UI_GEN_Y"), Ref(c.directions[1])).name = "y";
    form.NextColumn();
    form.Flag(KeyText("IDS_QM_UI_GEN_UNIFORM"), Ref(c.uniform)).name = "uniform";
    form.Flag(KeyText("IDS_QM_UI_GEN_MODE"), Ref(c.mode)).name = "mode";
    form.EndColumns();
    form.Number(KeyText("IDS_QM_UI_POLC_ECCENTRICITY"), Ref(c.eccentricity)).name = "eccentricity";
    CFormField& signs =
        form.Choice(KeyText("IDS_QM_UI_GEN_SIGNS"), Signs(c),
                    KeyTexts({"IDS_QM_UI_GEN_BOTH", "IDS_QM_UI_GEN_PLUS", "IDS_QM_UI_GEN_MINUS"}));
    signs.name = "signs";
    signs.enabled = [&c] { return c.eccentricity != 0.0; };
    form.Optional(
            [&d] {
                return HeadWithUnit("IDS_QM_UI_GEN_TARGET", kDimLength,
                                    d.Doc() ? d.Doc()->Unit().Units() : T_UNITS());
            },
            Ref(c.target))
        .name = "target";
    form.Integer(KeyText("IDS_QM_UI_GEN_NODE"), Ref(c.controlNode)).name = "node";
    T_GRID_BINDING names;
    names.columns = {{KeyText("IDS_QM_UI_GEN_NAMES")}};
    names.rows = [&c] { return CaseNames(c).size(); };
    names.text = [&c](std::size_t row, std::size_t) { return CaseNames(c).at(row); };
    form.Grid(std::move(names)).name = "names";
}

} // namespace

void RegisterPushSetupForms(CViewFactory& factory)
{
    T_VIEW global, functions, generator;
    global.size = {620, 520};
    functions.size = {720, 640};
    generator.size = {560, 560};
    factory.Register<CPushOverGlobalControlDlg>(KeyText("IDS_QM_UI_POGC_TITLE"), BuildGlobal,
                                                global);
    factory.Register<FUNCTIONS>(KeyText("IDS_QM_UI_POFC_TITLE"), BuildFunctions, functions);
    factory.Register<GENERATOR>(KeyText("IDS_QM_UI_POLC_EIGHT"), BuildGenerator, generator);
}
