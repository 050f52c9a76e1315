#include "qm_base/msgfunction.h"
#include "qm_base/textformat.h"
#include "qm_rps/po_hingetypelistdlg.h"
#include "qm_rps/pushoverhingedatatype.h"
#include "qm_rps/pushoverhingelistdlg.h"
#include "qm_ui/hinge/hingefieldsview.h"
#include "qm_ui/hinge/hingeplot.h"
#include "qm_ui/hinge/hingeviews.h"

#include <algorithm>

namespace {

using zql::lib::MMSGFunction;

/// Choosing a row of a list of records by key.
template <class DLG>
void BindSelection(T_GRID_BINDING& b, DLG& dlg, std::function<std::vector<int>()> keys)
{
    b.select = [&dlg, keys](int row) {
        const std::vector<int> all = keys();
        const bool inside = row >= 0 && row < static_cast<int>(all.size());
        dlg.m_selected = inside ? all[static_cast<std::size_t>(row)] : 0;
    };
    b.selected = [&dlg, keys] {
        const std::vector<int> all = keys();
        const auto at = std::ranges::find(all, dlg.m_selected);
        return at == all.end() ? -1 : static_cast<int>(at - all.begin());
    };
}

void BuildTypeList(CFormView& form, CPO_HingeTypeListDlg& dlg)
{
    T_GRID_BINDING b;
    for (const char* head : CPO_HingeTypeListDlg::kHeads)
        b.columns.push_back({KeyText(head)});
    b.rows = [&dlg] { return dlg.Rows().size(); };
    b.text = [&dlg](std::size_t row, std::size_t c) {
        const CPO_HingeTypeListDlg::T_ROW r = dlg.Rows().at(row);
        return c == 0 ? r.name : c == 1 ? r.element : r.code;
    };
    b.mark = [&dlg](std::size_t row, std::size_t) { return dlg.Rows().at(row).fault; };
    BindSelection(b, dlg, [&dlg] {
        std::vector<int> keys;
        for (const auto& row : dlg.Rows())
            keys.push_back(row.key);
        return keys;
    });
    b.open = [&form, &dlg](std::size_t) {
        (void)dlg.OnModify();
        form.Refresh();
    };
    form.Columns(1);
    form.Grid(std::move(b)).name = "types";
    form.Note([&dlg] { return dlg.Description(); });
    form.NextColumn();
    const std::pair<const char*, int (CPO_HingeTypeListDlg::*)()> buttons[] = {
        {"IDS_QM_UI_HINGE_ADD", &CPO_HingeTypeListDlg::OnAdd},
        {"IDS_QM_UI_HINGE_MODIFY", &CPO_HingeTypeListDlg::OnModify},
        {"IDS_QM_UI_HINGE_COPY", &CPO_HingeTypeListDlg::OnCopy},
        {"IDS_QM_UI_HINGE_DELETE", &CPO_HingeTypeListDlg::OnDelete}};
    for (const auto& [key, run] : buttons)
        form.Button(KeyText(key), [&dlg, r = run] { (void)(dlg.*r)(); }).name = key;
    form.EndColumns();
}

/// The types of a document as a choice.
T_BINDING<int> TypeOf(CDBDoc& doc, std::function<int()> key, std::function<void(int)> choose)
{
    return {[&doc, key] {
                const auto& all = doc.Data().Model().hingeTypes;
                const auto at = all.find(key());
                return at == all.end() ? -1 : static_cast<int>(std::distance(all.begin(), at));
            },
            [&doc, choose](const int& index) {
                const auto& all = doc.Data().Model().hingeTypes;
                if (index < static_cast<int>(all.size()))
                    choose(std::next(all.begin(), index)->first);
            }};
}

std::function<std::vector<std::string>()> TypeTexts(CDBDoc& doc)
{
    return [&doc] {
        std::vector<std::string> texts;
        for (const auto& [key, type] : doc.Data().Model().hingeTypes)
            texts.push_back(CPO_HingeTypeListDlg::NameOf(key, type.name));
        return texts;
    };
}

T_GRID_BINDING HingeGrid(CPushOverHingeListDlg& dlg)
{
    T_GRID_BINDING b;
    constexpr std::size_t kFirst = 3; // columns before the strengths
    b.columns = {{KeyText("IDS_QM_UI_HEAD_KEY"), CELL_KIND::Number},
                 {KeyText("IDS_QM_UI_HEAD_ELEMENT"), CELL_KIND::Number},
                 {KeyText("IDS_QM_UI_HEAD_HINGE_TYPE")}};
    const std::vector<std::string> heads = CPushOverHingeListDlg::Heads();
    for (std::size_t i = 0; i < heads.size(); ++i)
        b.columns.push_back({[&dlg, head = heads[i], i] {
                                 return HeadWithUnit(head, i < 6 ? kDimForce : kDimMoment,
                                                     dlg.Doc().Unit().Units());
                             },
                             CELL_KIND::Number});
    const auto rows = std::make_shared<std::vector<CPushOverHingeListDlg::T_ROW>>();
    b.rows = [&dlg, rows] {
        *rows = dlg.Rows(dlg.m_crack);
        return rows->size();
    };
    b.mark = [rows](std::size_t row, std::size_t) {
        const CPushOverHingeListDlg::T_ROW& r = rows->at(row);
        return r.stale.empty() ? r.fault : MMSGFunction::Format("IDS_QM_HINGE_STALE", {r.stale});
    };
    b.text = [rows](std::size_t row, std::size_t c) {
        const CPushOverHingeListDlg::T_ROW& r = rows->at(row);
        if (c == 0) return std::to_string(r.key);
        if (c == 1) return std::to_string(r.element);
        if (c == 2) return r.type;
        const T_SIDES<double>& s = r.strengths[(c - kFirst) / 2];
        const double v = (c - kFirst) % 2 == 0 ? s.pos : s.neg;
        return v == 0.0 ? std::string("-") : ShortestText(v);
    };
    BindSelection(b, dlg, [rows] {
        std::vector<int> keys;
        for (const auto& row : *rows)
            keys.push_back(row.key);
        return keys;
    });
    return b;
}

void BuildHingeList(CFormView& form, CPushOverHingeListDlg& dlg)
{
    form.Choice(
        KeyText("IDS_QM_UI_HINGE_STRENGTHS"),
        {[&dlg] { return dlg.m_crack ? 1 : 0; }, [&dlg](const int& i) { dlg.m_crack = i == 1; }},
        [] {
            std::vector<std::string> texts;
            for (const bool crack : {false, true})
                texts.push_back(CPushOverHingeListDlg::StrengthText(HINGE_COMPONENT::Fx, crack) +
                                ", " +
                                CPushOverHingeListDlg::StrengthText(HINGE_COMPONENT::My, crack));
            return texts;
        });
    form.Grid(HingeGrid(dlg)).name = "hinges";
    form.Button(KeyText("IDS_QM_UI_HINGE_DELETE"), [&dlg] { (void)dlg.OnDelete(); }).name =
        "delete";
    form.Group(KeyText("IDS_QM_UI_HINGE_GENERATE_GROUP"));
    form.Choice(KeyText("IDS_QM_UI_HEAD_HINGE_TYPE"),
                TypeOf(
                    dlg.Doc(), [&dlg] { return dlg.m_type; },
                    [&dlg](int key) { dlg.OnSelChangeType(key); }),
                TypeTexts(dlg.Doc()))
        .name = "type";
    form.Note([&dlg] { return dlg.TypeKind(); }).name = "kind";
    form.Note([&dlg] {
        return MMSGFunction::Format("IDS_QM_UI_HINGE_FOR_ELEMENTS",
                                    {std::to_string(dlg.Elements().size())});
    });
    form.Columns();
    form.Button(KeyText("IDS_QM_UI_HINGE_OPTION_BTN"), [&dlg] { (void)dlg.OnOptionBtn(); }).name =
        "options";
    form.NextColumn();
    form.Button(KeyText("IDS_QM_UI_HINGE_GENERATE"), [&dlg] { (void)dlg.OnGenerate(); }).name =
        "generate";
    form.EndColumns();
    form.EndGroup();
}

using TABLE = CPushOverHingeDataType;

/// A value of the table; 0 where nothing is shown.
T_BINDING<double> Cell(std::function<double*()> at)
{
    return {[at] { return at() ? *at() : 0.0; },
            [at](const double& v) {
                if (at()) *at() = v;
            }};
}

void AddDiagram(CFormView& form, TABLE& dlg)
{
    form.Group(KeyText("IDS_QM_UI_HINGE_DIAGRAM"));
    const auto head = [&dlg](bool strength) {
        if (strength)
            return std::string(dlg.ComponentOnShow() >= HINGE_COMPONENT::Mx ? "M/MY" : "F/FY");
        const T_SKEL_FEMA* curve = dlg.Shown();
        const bool plastic = curve && curve->measure == SKEL_MEASURE::Plastic;
        return plastic ? DeformHead("IDS_RPS_PO_PHGT_FEMA_PLS", dlg.ComponentOnShow(), dlg.Owner())
                       : MMSGFunction::GetValue("IDS_RPS_PO_PHGT_FEMA_DDY");
    };
    form.Choice(KeyText("IDS_QM_UI_HINGE_MEASURE"),
                {[&dlg] { return dlg.Shown() ? static_cast<int>(dlg.Shown()->measure) : -1; },
                 [&dlg](const int& i) { (void)dlg.OnMeasureRdo(static_cast<SKEL_MEASURE>(i)); }},
                KeyTexts({"IDS_RPS_PO_PHGT_FEMA_DDY", "IDS_RPS_PO_PHGT_FEMA_PLS"}))
        .name = "measure";
    const auto other = [&dlg] {
        const bool plastic = dlg.Shown() && dlg.Shown()->measure == SKEL_MEASURE::Plastic;
        return plastic ? MMSGFunction::GetValue("IDS_RPS_PO_PHGT_FEMA_DDY")
                       : DeformHead("IDS_RPS_PO_PHGT_FEMA_PLS", dlg.ComponentOnShow(), dlg.Owner());
    };
    form.Cells({KeyText("IDS_QM_UI_HINGE_POINT"), [head] { return head(false); },
                [head] { return head(true); }, other});
    constexpr std::size_t kOrigin = 4;
    for (std::size_t row = 0; row < TABLE::kRows.size(); ++row) {
        const TextFn name = PlainLabel(TABLE::kRows[row]);
        const auto enabled = [&dlg, row] {
            return dlg.IsTaken() && row != kOrigin && (row > kOrigin || !dlg.IsSymmetric());
        };
        form.Note(name);
        for (const auto member : {&T_SKEL_POINT::deform, &T_SKEL_POINT::strength}) {
            const std::string field = TABLE::PointField(row);
            Set(form.Number(name, Cell([&dlg, row, member]() -> double* {
                                T_SKEL_POINT* p = dlg.Point(row);
                                return p ? &(p->*member) : nullptr;
                            })),
                field.empty() ? field
                              : field + (member == &T_SKEL_POINT::deform ? "deform" : "strength"),
                enabled);
        }
        form.Note([&dlg, row] { return dlg.OtherMeasureText(row); }).name =
            FormatText("other[%zu]", row);
    }
    form.EndCells();
    form.EndGroup();
}

void AddCriteria(CFormView& form, TABLE& dlg)
{
    form.Group(KeyText("IDS_QM_UI_HINGE_CRITERIA"));
    form.Cells({{}, PlainLabel("(+)"), PlainLabel("(-)")});
    for (std::size_t i = 0; i < TABLE::kCriteria.size(); ++i) {
        const TextFn name = PlainLabel(TABLE::kCriteria[i]);
        form.Note(name);
        for (const bool positive : {true, false})
            Set(form.Number(name, Cell([&dlg, i, positive] { return dlg.Criterion(i, positive); })),
                std::string(positive ? "sides.pos." : "sides.neg.") + TABLE::kCriteria[i],
                [&dlg, positive] { return dlg.IsTaken() && (positive || !dlg.IsSymmetric()); });
    }
    form.EndCells();
    form.EndGroup();
}

void BuildTable(CFormView& form, TABLE& dlg)
{
    form.m_onChange = [&dlg] { dlg.OnEdited(); };
    form.Columns();
    form.Choice(KeyText("IDS_QM_UI_HEAD_HINGE_TYPE"),
                TypeOf(
                    dlg.Doc(), [&dlg] { return dlg.Key(); },
                    [&dlg](int key) { dlg.OnSelChange(key, dlg.ComponentOnShow()); }),
                TypeTexts(dlg.Doc()))
        .name = "type";
    form.Choice(
            KeyText("IDS_QM_UI_HINGE_COMPONENT"),
            {[&dlg] { return static_cast<int>(dlg.ComponentOnShow()); },
             [&dlg](const int& i) { dlg.OnSelChange(dlg.Key(), static_cast<HINGE_COMPONENT>(i)); }},
            [] { return std::vector<std::string>(kComponentNames.begin(), kComponentNames.end()); })
        .name = "component";
    AddDiagram(form, dlg);
    AddCriteria(form, dlg);
    form.NextColumn();
    form.Picture([&dlg] {
        T_PLOT none;
        none.notes.push_back(MMSGFunction::GetValue("IDS_QM_UI_HINGE_NO_FEMA"));
        return dlg.Shown()
                   ? HingeBackbonePlot(dlg.Owner().type, dlg.ComponentOnShow(), *dlg.Shown(), "")
                   : none;
    });
    form.EndColumns();
}

} // namespace

void RegisterHingeListViews(CViewFactory& factory)
{
    factory.Register<CPO_HingeTypeListDlg>(KeyText("IDS_QM_UI_HINGE_LIST_TITLE"), BuildTypeList,
                                           {.showsOnly = true, .size = {620, 380}});
    factory.Register<CPushOverHingeListDlg>(KeyText("IDS_QM_UI_HINGE_GENERATED_TITLE"),
                                            BuildHingeList,
                                            {.showsOnly = true, .size = {1000, 520}});
    factory.Register<TABLE>(KeyText("IDS_QM_UI_HINGE_TABLE_TITLE"), BuildTable, {.size = {960, 0}});
}
