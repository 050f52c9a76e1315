#include "qm_rps/factors/ulfstageproblem.h"

#include "qm_rps/factors/ulfstageplace.h"

namespace {

T_OPT_ITEM RecordOf(const T_ULSI_ROW& row)
{
    return {double(UlfStageNumber(row.stage, row.step)), row.unknown ? 0.0 : row.factor,
            row.unknown ? row.weight : 1.0, double(row.loadGroup)};
}

} // namespace

T_ULF_STAGE_FORMED FormUlfStageProblem(const T_ULSI_D& item, std::span<const T_ULFC_D> constraints)
{
    T_ULF_STAGE_FORMED formed;
    T_OPT_PROBLEM& p = formed.problem;
    p.stage = true;
    for (std::size_t i = 0; i < item.rows.size(); ++i) {
        const T_ULSI_ROW& row = item.rows[i];
        const T_OPT_ITEM record = RecordOf(row);
        if (!row.unknown && IsUnknownItem(record)) continue;
        p.items.push_back(record);
        formed.loads.push_back(row.loadCase);
        if (row.unknown) formed.unknowns.push_back(i);
    }
    for (std::size_t i = 0; i < constraints.size(); ++i)
        for (T_OPT_RECORD record : UlfConstraintRecords(constraints[i])) {
            const T_ULFC_D& c = constraints[i];
            if (c.stage != 0) record.back() = UlfStageNumber(c.stage, c.step);
            p.constraints.push_back(record);
            formed.owner.push_back(i);
        }
    p.nvar = static_cast<int>(formed.unknowns.size());
    p.iobj = item.objective + 1;
    p.isign = item.sign - 1;
    p.solveByEquations = item.solveByEquations;
    return formed;
}

int ReadUlfStageInfluence(const T_ULSI_D& item, const T_ULF_FORMED& formed,
                          CUlfStageResponse& source, std::vector<std::vector<double>>& influence)
{
    std::vector<T_OPT_ITEM> items;
    source.m_loads.clear();
    for (const T_ULSI_ROW& row : item.rows) {
        items.push_back(RecordOf(row));
        source.m_loads.push_back(row.loadCase);
    }
    std::vector<T_OPT_ROW> rows;
    std::vector<std::vector<double>> read;
    if (!BuildRows(items, formed.problem.constraints, source, rows, read)) return 0;
    influence.resize(formed.owner.empty() ? 0 : formed.owner.back() + 1);
    for (std::size_t i = 0; i < read.size(); ++i) // two bounds have the same responses
        influence[formed.owner[i]] = std::move(read[i]);
    return 1;
}

std::vector<int> LoadsScaledBy(const T_MODEL& model, const T_ULSI_ROW& row)
{
    if (!row.unknown || !row.pretension) return {};
    if (row.loadGroup == kLoadGroupRest) return {row.loadCase};
    return LoadsActingAt(model, row.stage, row.step);
}
