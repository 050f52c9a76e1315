#include "qm_rps/unknownstageitemdlg.h"

#include "qm_base/messagehistory.h"
#include "qm_base/msgfunction.h"
#include "qm_base/textformat.h"
#include "qm_rps/ulfchecks.h"

#include <algorithm>

using zql::lib::MMSGFunction;

namespace {

std::string Flag(bool on)
{
    return on ? "1" : "0";
}

std::string CaseName(const T_MODEL& model, int key)
{
    const auto it = model.loadCases.find(key);
    return it == model.loadCases.end() ? std::string() : it->second.name;
}

/// "S1/First Step"; empty for a place that is gone.
std::string PlaceName(CDBDoc& doc, const T_ULSI_ROW& row)
{
    T_STAG_STEP_INFO info;
    return doc.Attr().GetStagStepInfo(row.stage, row.step, info) ? info.Text() : std::string();
}

} // namespace

CUnknownStageItemDlg::CUnknownStageItemDlg(CDBDoc& doc, IUlfStageResults& results, int key)
    : m_doc(doc), m_key(key), m_source(results)
{
    const auto& table = m_doc.Data().Model().ulfStageItems;
    const auto it = table.find(key);
    if (it == table.end()) m_key = 0;
    Data2Dlg(it == table.end() ? T_ULSI_D() : it->second);
}

void CUnknownStageItemDlg::Data2Dlg(const T_ULSI_D& item)
{
    m_name = item.name;
    m_objective = item.objective;
    m_sign = item.sign;
    m_solveByEquations = item.solveByEquations;
    m_rows = item.rows;
    m_checks.clear();
    m_missing.clear();
    const T_MODEL& model = m_doc.Data().Model();
    // The item's own ones first, in its order, so that a calculation keeps that order.
    for (const std::string& name : item.constraints) {
        if (FindUlfConstraint(model, name) == 0)
            m_missing.push_back(name);
        else
            m_checks.push_back({name, true});
    }
    for (const auto& [key, constraint] : model.ulfConstraints)
        if (std::ranges::find(item.constraints, constraint.name) == item.constraints.end())
            m_checks.push_back({constraint.name, false});
}

T_ULSI_D CUnknownStageItemDlg::Record() const
{
    T_ULSI_D item{m_name, m_rows, m_objective, m_sign, m_solveByEquations, {}};
    for (const T_CHECK& check : m_checks)
        if (check.checked) item.constraints.push_back(check.name);
    item.constraints.insert(item.constraints.end(), m_missing.begin(), m_missing.end());
    return item;
}

int CUnknownStageItemDlg::Dlg2Data(T_ULSI_D& item)
{
    if (!CheckData()) return 0;
    item = Record();
    return 1;
}

std::string CUnknownStageItemDlg::CellText(std::size_t row, COLUMN column) const
{
    if (row >= m_rows.size()) return {};
    const T_ULSI_ROW& r = m_rows[row];
    const T_MODEL& model = m_doc.Data().Model();
    switch (column) {
    case Stage:
        return PlaceName(m_doc, r);
    case LoadCase:
        return CaseName(model, r.loadCase);
    case Unknown:
        return Flag(r.unknown);
    case Known:
        return Flag(!r.unknown);
    case Factor:
        return FormatText("%.3f", r.factor);
    case Weight:
        return FormatText("%.6f", r.weight);
    case Pretension:
        return Flag(r.pretension);
    default:
        break;
    }
    const auto group = static_cast<std::size_t>(r.loadGroup);
    return group < kGroupKeys.size() ? MMSGFunction::GetValue(kGroupKeys[group]) : std::string();
}

int CUnknownStageItemDlg::SetCell(std::size_t row, COLUMN column, const std::string& text)
{
    if (row >= m_rows.size()) return 0;
    T_ULSI_ROW& r = m_rows[row];
    if (column == Unknown || column == Pretension) {
        if (text != "0" && text != "1") return 0;
        (column == Unknown ? r.unknown : r.pretension) = text == "1";
        return 1;
    }
    const std::optional<double> number = ParseFinite(text);
    if ((column != Weight && column != Factor) || !number) return 0;
    // The shown text handed back keeps the digits that it does not show.
    if (text != CellText(row, column)) (column == Weight ? r.weight : r.factor) = *number;
    return 1;
}

std::vector<T_FINDING> CUnknownStageItemDlg::Findings() const
{
    return CheckUlfStageItem(Record(), m_key, m_doc.Data().Model());
}

int CUnknownStageItemDlg::OnOK()
{
    T_ULSI_D item;
    if (!Dlg2Data(item)) return 0;
    const T_TABLE<T_ULSI_D>& table = m_doc.Data().Model().ulfStageItems;
    const int key = m_key ? m_key : table.empty() ? 1 : table.rbegin()->first + 1;
    CEditData& edit = m_doc.Edit();
    if (!edit.Begin(item.name)) return 0;
    if (!edit.Put(key, item) || !edit.Commit()) {
        edit.Rollback();
        return 0;
    }
    m_key = key;
    return 1;
}

int CUnknownStageItemDlg::ReadConstraints(const T_ULSI_D& item)
{
    m_constraints.clear();
    for (const std::string& name : item.constraints) {
        T_ULFC_D constraint;
        if (!m_doc.Attr().GetUlfc_(name, constraint)) return 0;
        m_constraints.push_back(std::move(constraint));
    }
    return 1;
}

int CUnknownStageItemDlg::OnCalculate()
{
    m_result.reset();
    m_answer = {};
    const T_ULSI_D item = Record();
    if (!CheckData() || !ReadConstraints(item)) return 0;
    m_formed = FormUlfStageProblem(item, m_constraints);
    m_source.m_loads = m_formed.loads;
    m_source.m_sumStageLoads = m_sumStageLoads;
    COptDsgn optimizer(m_source, &m_source);
    const bool found = optimizer.Run(m_formed.problem, m_answer) != 0;
    GSaveHistoryFormatNF(
        "%s", MMSGFunction::GetValue(found ? "IDS_RPS_Unknown_CAN_FIND_OPTIMIZED_SOLUTION"
                                           : "IDS_RPS_Unknown_CANNOT_FIND_OPTIMIZED_SOLUTION")
                  .c_str());
    if (!found) {
        constexpr const char* key = "IDS_RPS_Unknown_Load_Factor_Item_has_an_error";
        ShowMessage(key, MMSGFunction::Format(key, {m_name, FailureText()}));
        return 0;
    }
    m_result = MakeResult(item);
    return 1;
}

/// The optimizer's message with the name of the constraint or row that it numbers.
std::string CUnknownStageItemDlg::FailureText() const
{
    std::string name;
    if (m_answer.constraint > 0)
        name =
            m_constraints[m_formed.owner[static_cast<std::size_t>(m_answer.constraint - 1)]].name;
    else if (m_answer.factor > 0)
        name = CellText(RowOfUnknown(static_cast<std::size_t>(m_answer.factor - 1)), Stage);
    return name.empty() ? m_answer.message : m_answer.message + " (" + name + ")";
}

/// The optimizer's rows of responses, by grid row: what had no part in the problem is left out.
T_ULF_RESULT CUnknownStageItemDlg::MakeResult(const T_ULSI_D& item) const
{
    T_ULF_RESULT r;
    r.item.name = item.name;
    r.item.objective = item.objective;
    r.item.sign = item.sign;
    r.item.constraints = item.constraints;
    std::size_t unknown = 0;
    for (std::size_t i = 0; i < item.rows.size(); ++i) {
        const T_ULSI_ROW& row = item.rows[i];
        if (!row.unknown && IsUnknownItem({0.0, row.factor, 1.0, 0.0})) continue;
        r.cases.push_back({row.loadCase, CellText(i, Stage) + " " + CellText(i, LoadCase),
                           row.factor, row.unknown, row.weight});
        r.factors.push_back(row.unknown ? m_answer.factors[unknown++] : row.factor);
    }
    for (const T_ULFC_D& c : m_constraints)
        r.constraints.push_back(UlfResultConstraint(c));
    r.influence.resize(m_constraints.size());
    for (std::size_t i = 0; i < m_formed.owner.size(); ++i)
        r.influence[m_formed.owner[i]] = m_answer.coefficients[i];
    r.exact = m_answer.exact;
    r.code = m_answer.code;
    return r;
}

std::vector<T_ULF_ITER_ROW> CUnknownStageItemDlg::SolvedRows() const
{
    std::vector<T_ULF_ITER_ROW> rows;
    for (std::size_t i = 0; m_result && i < m_formed.unknowns.size(); ++i) {
        const std::size_t row = RowOfUnknown(i);
        rows.push_back({CellText(row, Stage), m_answer.factors[i], m_rows[row].pretension});
    }
    return rows;
}

int CUnknownStageItemDlg::OnIterate(CUlfIteration& iteration)
{
    if (!CheckData()) return 0;
    iteration.SetView(View());
    return iteration.Run();
}
