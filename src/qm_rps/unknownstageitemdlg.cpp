#include "qm_rps/unknownstageitemdlg.h"

#include "qm_base/msgfunction.h"
#include "qm_base/textformat.h"
#include "qm_rps/ulfstageplace.h"

#include <algorithm>

using zql::lib::MMSGFunction;

namespace {

std::string CaseName(const T_MODEL& model, int key)
{
    const auto it = model.loadCases.find(key);
    return it == model.loadCases.end() ? std::string() : it->second.name;
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
    // The item's own ones first, in its order, so that a calculation keeps that order.
    SetChecks(m_doc.Data().Model(), item.constraints, true);
}

T_ULSI_D CUnknownStageItemDlg::Record() const
{
    return {m_name, m_rows, m_objective, m_sign, m_solveByEquations, CheckedNames()};
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
        return UlfPlaceText(m_doc.Data(), r.stage, r.step);
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
    return CheckUlfStageItem(Record(), m_key, m_doc.Data());
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

std::array<CUnknownStageItemDlg::T_SUMMARY, 3> CUnknownStageItemDlg::Summary() const
{
    std::array<T_SUMMARY, 3> summary{{{"IDS_RPS_DL"}, {"IDS_RPS_ER"}, {"IDS_RPS_SUM"}}};
    const auto count = [](T_SUMMARY& s, const T_ULSI_ROW& row) {
        ++s.rows;
        s.unknowns += row.unknown ? 1 : 0;
    };
    for (const T_ULSI_ROW& row : m_rows) {
        if (row.loadGroup == kLoadGroupDead) count(summary[0], row);
        if (row.loadGroup == kLoadGroupErection) count(summary[1], row);
        count(summary[2], row);
    }
    return summary;
}

int CUnknownStageItemDlg::ReadRun(T_ULF_RUN& run, T_ULSI_D& item)
{
    item = Record();
    run.item.name = item.name;
    run.item.objective = item.objective;
    run.item.sign = item.sign;
    run.item.solveByEquations = item.solveByEquations;
    run.item.constraints = item.constraints;
    for (const T_ULSI_ROW& row : item.rows)
        run.cases.push_back({row.loadCase, UlfStageRowText(m_doc.Data(), row), row.factor,
                             row.unknown, row.weight});
    if (!ReadConstraints(m_doc, run)) return 0;
    for (const T_ULFC_D& c : run.constraints)
        run.places.push_back(c.stage ? UlfPlaceText(m_doc.Data(), c.stage, c.step) : std::string());
    return 1;
}

int CUnknownStageItemDlg::OnCalculate()
{
    Forget();
    T_ULF_RUN run;
    T_ULSI_D item;
    if (!CheckData() || !ReadRun(run, item)) return 0;
    T_ULF_STAGE_FORMED formed = FormUlfStageProblem(item, run.constraints);
    m_source.m_loads = formed.loads;
    m_source.m_sumStageLoads = m_sumStageLoads;
    run.formed = std::move(formed);
    COptDsgn optimizer(m_source, &m_source);
    const bool found = optimizer.Run(run.formed.problem, run.answer) != 0;
    const bool solved = ReadUlfStageInfluence(item, run.formed, m_source, run.influence) && found;
    return Finish(std::move(run), solved, m_source.Error());
}

std::vector<T_ULF_ITER_ROW> CUnknownStageItemDlg::SolvedRows() const
{
    std::vector<T_ULF_ITER_ROW> rows;
    for (std::size_t i = 0; Result() && i < LastRun()->formed.unknowns.size(); ++i) {
        const std::size_t row = RowOfUnknown(i);
        rows.push_back({CellText(row, Stage), LastRun()->answer.factors[i], m_rows[row].pretension,
                        CellText(row, LoadCase)});
    }
    return rows;
}

int CUnknownStageItemDlg::OnIterate(CUlfIteration& iteration)
{
    if (!CheckData()) return 0;
    iteration.SetView(View());
    return iteration.Run();
}
