#include "qm_rps/unknownstageitemdlg.h"

#include "qm_base/msgfunction.h"
#include "qm_base/textformat.h"
#include "qm_rps/factors/checks/ulfitemchecks.h"
#include "qm_rps/factors/checks/ulfstagechecks.h"
#include "qm_rps/factors/ulfstageplace.h"
#include "qm_rps/factors/ulfstageresults.h"
#include "qm_rps/factors/ulfstore.h"
#include "qm_rps/ulfcalculation.h"
#include "qm_rps/ulfiterationrundlg.h"

#include <algorithm>
#include <tuple>

using zql::lib::MMSGFunction;

namespace {

std::string CaseName(const T_MODEL& model, int key)
{
    const auto it = model.loadCases.find(key);
    return it == model.loadCases.end() ? std::string() : it->second.name;
}

} // namespace

CUnknownStageItemDlg::CUnknownStageItemDlg(CDBDoc& doc, int key) : CUlfItemDialog(doc), m_key(key)
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
    m_sumStageLoads = item.sumStageLoads;
    m_rows = item.rows;
    // The item's own ones first, in its order, so that a calculation keeps that order.
    SetChecks(item.constraints, true);
}

T_ULSI_D CUnknownStageItemDlg::Record() const
{
    return {m_name,         m_rows,         m_objective, m_sign, m_solveByEquations,
            CheckedNames(), m_sumStageLoads};
}

int CUnknownStageItemDlg::Dlg2Data(T_ULSI_D& item)
{
    if (!CheckData()) return 0;
    item = Record();
    return 1;
}

/// What a row of a load group reads: groups 0 and 1 the same.
std::string CUnknownStageItemDlg::GroupText(int group) const
{
    const char* const key = group == kLoadGroupRest ? "IDS_QM_ULSI_READS_OWN"
                            : m_sumStageLoads       ? "IDS_QM_ULSI_READS_ALL"
                                                    : "IDS_QM_ULSI_READS_DEAD";
    return MMSGFunction::Format(key, {std::to_string(group)});
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
    return r.loadGroup >= kLoadGroupDead && r.loadGroup <= kLoadGroupRest ? GroupText(r.loadGroup)
                                                                          : std::string();
}

std::vector<std::string> CUnknownStageItemDlg::Choices(COLUMN column) const
{
    const T_MODEL& model = m_doc.Data().Model();
    std::vector<std::string> texts;
    if (column == Stage)
        for (const auto& [stage, step] : UlfPlaces(model))
            texts.push_back(UlfPlaceText(m_doc.Data(), stage, step));
    if (column == LoadCase)
        for (const auto& entry : model.loadCases)
            texts.push_back(entry.second.name);
    if (column == Group)
        for (int group = kLoadGroupDead; group <= kLoadGroupRest; ++group)
            texts.push_back(GroupText(group));
    return texts;
}

int CUnknownStageItemDlg::SetChoice(T_ULSI_ROW& row, COLUMN column, const std::string& text) const
{
    const std::vector<std::string> texts = Choices(column);
    const auto index = std::ranges::find(texts, text) - texts.begin();
    if (index == std::ssize(texts)) return 0;
    if (column == Stage)
        std::tie(row.stage, row.step) =
            UlfPlaces(m_doc.Data().Model())[static_cast<std::size_t>(index)];
    if (column == LoadCase)
        row.loadCase = std::next(m_doc.Data().Model().loadCases.begin(), index)->first;
    if (column == Group) row.loadGroup = static_cast<int>(index);
    return 1;
}

void CUnknownStageItemDlg::OnAddRow()
{
    const T_MODEL& model = m_doc.Data().Model();
    T_ULSI_ROW row;
    if (!m_rows.empty()) {
        row.stage = m_rows.back().stage;
        row.step = m_rows.back().step;
        row.loadGroup = m_rows.back().loadGroup;
    } else if (!model.stages.empty()) {
        row.stage = model.stages.begin()->first;
    }
    const auto stands = [&](int loadCase) {
        return std::ranges::any_of(m_rows, [&](const T_ULSI_ROW& r) {
            return r.loadCase == loadCase && r.stage == row.stage && r.step == row.step;
        });
    };
    for (const auto& entry : model.loadCases)
        if (row.loadCase == 0 && !stands(entry.first)) row.loadCase = entry.first;
    m_rows.push_back(row);
}

int CUnknownStageItemDlg::OnDeleteRow(std::size_t row)
{
    if (row >= m_rows.size()) return 0;
    m_rows.erase(m_rows.begin() + static_cast<std::ptrdiff_t>(row));
    return 1;
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
    if (column == Stage || column == LoadCase || column == Group) return SetChoice(r, column, text);
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

std::vector<T_FINDING> CUnknownStageItemDlg::Warnings() const
{
    return UlfStageItemWarnings(Record(), m_doc.Data());
}

int CUnknownStageItemDlg::OnOK()
{
    T_ULSI_D item;
    return Dlg2Data(item) ? StoreRecord(m_doc, m_key, item) : 0;
}

std::array<CUnknownStageItemDlg::T_SUMMARY, 3> CUnknownStageItemDlg::Summary() const
{
    std::array<T_SUMMARY, 3> summary{{{"IDS_RPS_DL"}, {"IDS_RPS_ER"}, {"IDS_RPS_SUM"}}};
    const auto count = [](T_SUMMARY& s, const T_ULSI_ROW& row) {
        ++s.rows;
        s.unknowns += row.unknown ? 1 : 0;
    };
    for (const T_ULSI_ROW& row : m_rows) {
        T_STLD_D load;
        const bool isThere = m_doc.Attr().GetStld(row.loadCase, load) != 0;
        if (isThere && load.group == kLoadGroupDead) count(summary[0], row);
        if (isThere && load.group == kLoadGroupErection) count(summary[1], row);
        count(summary[2], row);
    }
    return summary;
}

std::optional<T_ANALYSIS_OPTIONS> CUnknownStageItemDlg::MissingResults() const
{
    T_ANALYSIS_OPTIONS options;
    options.allCases = false;
    return m_doc.Post().CheckStagedResult() ? std::nullopt : std::optional(options);
}

T_ULF_CALCULATION CUnknownStageItemDlg::Calculated()
{
    CUlfStageResults results(m_doc);
    CUlfStageResponse source(results);
    return CalculateUlfStages(m_doc, Record(), source, Dump());
}

void CUnknownStageItemDlg::OnIterateWindow()
{
    if (!CheckData()) return;
    CUlfIterationRunDlg run(m_doc, {m_key, Record()});
    run.SetView(View());
    (void)run.DoModal();
}
