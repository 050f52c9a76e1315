#include "qm_ui/factors/ulfitemview.h"

#include "qm_base/msgfunction.h"
#include "qm_rps/unknownloadfactordlg.h"
#include "qm_rps/unknownloadfactoritemdlg.h"
#include "qm_rps/unknownstageitemdlg.h"

#include <algorithm>

using zql::lib::MMSGFunction;

namespace {

using STATIC = CUnknownLoadFactorItemDlg;
using STAGE = CUnknownStageItemDlg;
using LIST = CUnknownLoadFactorDlg;

constexpr CELL_KIND kText = CELL_KIND::Text, kNumber = CELL_KIND::Number, kFlag = CELL_KIND::Flag,
                    kChoice = CELL_KIND::Choice;

// ---- calculation --------------------------------------------------------------------------------

bool Analyse(CFormView& form, CUlfItemDialog& item, const T_ULF_HOOKS& hooks)
{
    std::string error;
    const int done =
        hooks.run(form.window(), UlfText("IDS_QM_UI_ANALYSING"),
                  [&](ULF_PROGRESS progress) { return item.OnAnalyse(progress, error); });
    if (!done && !error.empty() && item.View())
        item.View()->ShowMessage("IDS_QM_UI_FILE_REFUSED", error);
    return done != 0;
}

void Solve(CFormView& form, CUlfItemDialog& item, const T_ULF_HOOKS& hooks)
{
    if (Analyse(form, item, hooks) && !item.OnSolve()) form.ShowFirstMark();
}

void Explain(CFormView& form, CUlfItemDialog& item, const T_ULF_HOOKS& hooks)
{
    if (!Analyse(form, item, hooks)) return;
    (void)hooks.run(form.window(), UlfText("IDS_QM_UI_ULF_EXPLAINING"), [&](ULF_PROGRESS go) {
        return item.OnExplain([&](int tried, int members) {
            return go(static_cast<std::size_t>(tried), static_cast<std::size_t>(members));
        });
    });
    item.ShowExplanation();
}

// ---- parts of both kinds of items ---------------------------------------------------------------

/// The first finding whose field begins so.
std::string MarkOf(const std::vector<T_FINDING>& findings, const std::string& field)
{
    const auto it = std::ranges::find_if(
        findings, [&](const T_FINDING& f) { return f.field.starts_with(field); });
    return it == findings.end() ? std::string() : it->text;
}

void AddHead(CFormView& form, CUlfItemDialog& item)
{
    form.Text(KeyText("IDS_QM_UI_HEAD_NAME"), Ref(item.m_name)).name = "name";
}

void AddWay(CFormView& form, CUlfItemDialog& item)
{
    const auto add = [&form](const char* caption, const char* name, int& index, const auto& keys) {
        CFormField& field =
            form.Choice(KeyText(caption), IndexRef(index),
                        KeyTexts(std::vector<std::string>(keys.begin(), keys.end())));
        field.name = name;
        field.widget->setSizePolicy(QSizePolicy::MinimumExpanding, QSizePolicy::Fixed);
    };
    add("IDS_QM_UI_ULF_OBJECTIVE", "objective", item.m_objective, CUlfItemDialog::kObjectiveKeys);
    add("IDS_QM_UI_ULF_SIGN", "sign", item.m_sign, CUlfItemDialog::kSignKeys);
    form.Flag(KeyText("IDS_QM_UI_ULF_EQUATIONS"), Ref(item.m_solveByEquations));
}

/// The check list of the constraints of the model.
void AddChecks(CFormView& form, CUlfItemDialog& item, QSize least)
{
    static constexpr std::array<const char*, 3> kHeads{
        "IDS_QM_UI_ULF_USED", "IDS_RPS_UNKNOWN_LOAD_GXRESULT_Constraint", "IDS_QM_UI_ULF_QUANTITY"};
    const auto findings = std::make_shared<std::vector<T_FINDING>>();
    T_GRID_BINDING b;
    b.columns = UlfColumns(kHeads, {kFlag, kText, kText});
    b.columns[0].edit = true;
    b.rows = [&item, findings] {
        *findings = item.Findings();
        return item.m_checks.size();
    };
    b.text = [&item](std::size_t row, std::size_t column) {
        const CUlfItemDialog::T_CHECK& check = item.m_checks.at(row);
        if (column == 0) return std::string(check.checked ? "1" : "0");
        return column == 1 ? check.name : item.CheckText(row);
    };
    b.set = [&item](std::size_t row, std::size_t, const std::string& text) {
        item.m_checks.at(row).checked = text == "1";
        item.m_checks.at(row).times = 1;
        return 1;
    };
    b.mark = [&item, findings](std::size_t row, std::size_t) {
        return MarkOf(*findings, "constraints[" + item.m_checks.at(row).name + "]");
    };
    form.Group(KeyText("IDS_QM_UI_TABLE_CONSTRAINTS"));
    AddUlfGrid(form, std::move(b), least).name = "constraints";
    form.EndGroup();
}

// ---- the static item ----------------------------------------------------------------------------

T_GRID_BINDING CaseGrid(STATIC& item)
{
    T_GRID_BINDING b;
    b.columns = UlfColumns(STATIC::kHeads, {kText, kFlag, kFlag, kNumber, kNumber});
    b.columns[STATIC::Unknown].edit = b.columns[STATIC::Weight].edit = true;
    b.rows = [&item] { return item.Cases().size(); };
    b.text = [&item](std::size_t row, std::size_t column) {
        return item.CellText(row, static_cast<STATIC::COLUMN>(column));
    };
    b.set = [&item](std::size_t row, std::size_t column, const std::string& text) {
        return item.SetCell(row, static_cast<STATIC::COLUMN>(column), text);
    };
    return b;
}

void BuildStatic(CFormView& form, STATIC& item, const T_ULF_HOOKS& hooks)
{
    form.Columns();
    AddHead(form, item);
    form.Choice(KeyText("IDS_QM_UI_ULF_COMBINATION"),
                {[&item] { return item.CombinationIndex(); },
                 [&item](const int& index) { item.OnSelChangeCombinationIndex(index); }},
                [&item] { return item.CombinationTexts(); })
        .name = "combination";
    AddWay(form, item);
    form.Group(KeyText("IDS_QM_UI_TABLE_LOADS"));
    AddUlfGrid(form, CaseGrid(item), {420, 220}).name = "unknowns";
    form.EndGroup();
    form.NextColumn();
    AddChecks(form, item, {520, 380});
    form.EndColumns();
    AddUlfButtons(
        form, {{"IDS_QM_UI_ULF_SOLVE", [&form, &item, hooks] { Solve(form, item, hooks); }},
               {"IDS_QM_UI_ULF_EXPLAIN", [&form, &item, hooks] { Explain(form, item, hooks); }}});
}

// ---- the item of construction stages ------------------------------------------------------------

/// The column that a finding of a row, "rows[1].case", is about.
bool IsOfColumn(const std::string& member, std::size_t column)
{
    struct T_MEMBER {
        const char* name;
        std::size_t column;
    };
    static constexpr T_MEMBER kMembers[] = {
        {"stage", STAGE::Stage},          {"step", STAGE::Stage},    {"case", STAGE::LoadCase},
        {"load_group", STAGE::Group},     {"factor", STAGE::Factor}, {"factor", STAGE::Weight},
        {"pretension", STAGE::Pretension}};
    return std::ranges::any_of(
        kMembers, [&](const T_MEMBER& m) { return member == m.name && column == m.column; });
}

std::string RowMark(const std::vector<T_FINDING>& findings, std::size_t row, std::size_t column)
{
    const std::string prefix = "rows[" + std::to_string(row + 1) + "].";
    for (const T_FINDING& f : findings)
        if (f.field.starts_with(prefix) && IsOfColumn(f.field.substr(prefix.size()), column))
            return f.text;
    return {};
}

T_GRID_BINDING RowGrid(STAGE& item, const std::shared_ptr<int>& chosen)
{
    const auto findings = std::make_shared<std::vector<T_FINDING>>();
    T_GRID_BINDING b;
    b.columns = UlfColumns(STAGE::kHeads,
                           {kChoice, kChoice, kFlag, kFlag, kNumber, kNumber, kFlag, kChoice});
    for (std::size_t c = 0; c < b.columns.size(); ++c) {
        b.columns[c].edit = c != STAGE::Known;
        if (b.columns[c].kind == kChoice)
            b.columns[c].choices = [&item, c] {
                return item.Choices(static_cast<STAGE::COLUMN>(c));
            };
    }
    b.rows = [&item, findings] {
        *findings = item.Findings();
        return item.m_rows.size();
    };
    b.text = [&item](std::size_t row, std::size_t column) {
        return item.CellText(row, static_cast<STAGE::COLUMN>(column));
    };
    b.set = [&item](std::size_t row, std::size_t column, const std::string& text) {
        return item.SetCell(row, static_cast<STAGE::COLUMN>(column), text);
    };
    b.mark = [findings](std::size_t row, std::size_t column) {
        return RowMark(*findings, row, column);
    };
    b.select = [chosen](int row) { *chosen = row; };
    b.selected = [chosen] { return *chosen; };
    return b;
}

/// "Dead load: 1 of 3 unknown; ..."
std::string SummaryText(const STAGE& item)
{
    std::string text;
    for (const STAGE::T_SUMMARY& s : item.Summary())
        text += (text.empty() ? "" : "; ") +
                MMSGFunction::Format("IDS_QM_UI_ULF_SUMMARY",
                                     {MMSGFunction::GetValue(s.key), std::to_string(s.unknowns),
                                      std::to_string(s.rows)});
    return text;
}

/// A line for each warning.
std::string WarningText(const STAGE& item)
{
    std::string text;
    for (const T_FINDING& f : item.Warnings())
        text +=
            (text.empty() ? "" : "\n") + MMSGFunction::Format("IDS_QM_UI_ULF_WARNING", {f.text});
    return text;
}

void AddRows(CFormView& form, STAGE& item)
{
    const auto chosen = std::make_shared<int>(-1);
    form.Group(KeyText("IDS_QM_UI_ULF_LOADS_AT_STAGES"));
    AddUlfGrid(form, RowGrid(item, chosen), {700, 190}).name = "rows";
    AddUlfButtons(form, {{"IDS_QM_UI_ULF_ADD_ROW",
                          [&item, chosen] {
                              item.OnAddRow();
                              *chosen = static_cast<int>(item.m_rows.size()) - 1;
                          }},
                         {"IDS_QM_UI_ULF_DELETE_ROW",
                          [&item, chosen] {
                              if (!item.OnDeleteRow(static_cast<std::size_t>(*chosen))) return;
                              *chosen = std::min(*chosen, static_cast<int>(item.m_rows.size()) - 1);
                          },
                          [chosen] { return *chosen >= 0; }}});
    form.Note([&item] { return SummaryText(item); });
    form.Note([&item] { return WarningText(item); });
    form.EndGroup();
}

void BuildStage(CFormView& form, STAGE& item, const T_ULF_HOOKS& hooks)
{
    AddHead(form, item);
    AddRows(form, item);
    form.Columns();
    AddWay(form, item);
    form.Flag(KeyText("IDS_QM_UI_ULF_SUM_LOADS"), Ref(item.m_sumStageLoads));
    AddUlfFiller(form);
    form.NextColumn();
    AddChecks(form, item, {340, 130});
    form.EndColumns();
    AddUlfButtons(form,
                  {{"IDS_QM_UI_ULF_SOLVE", [&form, &item, hooks] { Solve(form, item, hooks); }},
                   {"IDS_QM_UI_ULF_EXPLAIN", [&form, &item, hooks] { Explain(form, item, hooks); }},
                   {"IDS_QM_UI_ULF_ITERATE_ITEM", [&item] { item.OnIterateWindow(); }}});
}

// ---- the list -----------------------------------------------------------------------------------

T_GRID_BINDING ItemGrid(LIST& list)
{
    static constexpr std::array<const char*, 3> kHeads{"IDS_QM_UI_HEAD_NAME", "IDS_QM_UI_HEAD_KIND",
                                                       "IDS_QM_UI_ULF_COMBINATION"};
    T_GRID_BINDING b;
    b.columns = UlfColumns(kHeads, {kText, kText, kText});
    b.rows = [&list] { return list.Rows().size(); };
    b.text = [&list](std::size_t row, std::size_t column) {
        const LIST::T_ROW item = list.Rows().at(row);
        if (column == 0) return item.name;
        if (column == 2) return item.combination;
        return MMSGFunction::GetValue(item.stage ? "IDS_QM_UI_ULF_OF_STAGES"
                                                 : "IDS_QM_UI_ULF_STATIC");
    };
    b.select = [&list](int row) {
        const auto rows = list.Rows();
        const auto at = static_cast<std::size_t>(row);
        list.m_selected = at < rows.size() ? rows[at].key : 0;
        list.m_stage = at < rows.size() && rows[at].stage;
    };
    b.selected = [&list] {
        const auto rows = list.Rows();
        const auto it = std::ranges::find_if(rows, [&](const LIST::T_ROW& row) {
            return row.key == list.m_selected && row.stage == list.m_stage;
        });
        return it == rows.end() ? -1 : static_cast<int>(it - rows.begin());
    };
    b.open = [&list](std::size_t) { (void)list.OnModify(); };
    return b;
}

void BuildList(CFormView& form, LIST& list, const T_ULF_HOOKS& hooks)
{
    AddUlfGrid(form, ItemGrid(list), {560, 240});
    const auto chosen = [&list] { return list.m_selected != 0; };
    const auto on = [&form, &list, hooks](auto work) {
        return [&form, &list, hooks, work] {
            if (const auto item = list.ChosenItem()) work(form, *item, hooks);
        };
    };
    AddUlfButtons(form, {{"IDS_QM_UI_ULF_ADD", [&list] { (void)list.OnAdd(); }},
                         {"IDS_QM_UI_ULF_ADD_STAGE", [&list] { (void)list.OnAddStage(); }},
                         {"IDS_QM_UI_ULF_MODIFY", [&list] { (void)list.OnModify(); }, chosen},
                         {"IDS_QM_UI_ULF_DELETE", [&list] { (void)list.OnDelete(); }, chosen}});
    AddUlfButtons(form, {{"IDS_QM_UI_ULF_SOLVE", on(Solve), chosen},
                         {"IDS_QM_UI_ULF_EXPLAIN", on(Explain), chosen}});
}

} // namespace

void RegisterUlfItemViews(CViewFactory& factory, const T_ULF_HOOKS& hooks)
{
    T_VIEW shows;
    shows.showsOnly = true;
    factory.Register<LIST>(
        KeyText("IDS_QM_UI_ULF_ITEMS_TITLE"),
        [hooks](CFormView& form, LIST& list) { BuildList(form, list, hooks); }, shows);
    factory.Register<STATIC>(
        KeyText("IDS_QM_UI_ULF_ITEM_TITLE"),
        [hooks](CFormView& form, STATIC& item) { BuildStatic(form, item, hooks); });
    factory.Register<STAGE>(
        KeyText("IDS_QM_UI_ULF_STAGE_ITEM_TITLE"),
        [hooks](CFormView& form, STAGE& item) { BuildStage(form, item, hooks); });
}
