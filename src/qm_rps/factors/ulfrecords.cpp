#include "qm_rps/factors/ulfrecords.h"

namespace {

/// Kind of the optimizer for each type of constraint.
constexpr std::array<int, 4> kKindOfType{2, 1, 3, 4};
constexpr int kBeamKind = 4;

T_OPT_RECORD RecordOf(const T_ULFC_D& c, double value, int relation, bool withValue)
{
    const int kind = kKindOfType.at(static_cast<std::size_t>(c.type));
    std::vector<double> entries{double(kind), double(c.id)};
    if (kind == kBeamKind) entries.push_back(c.position + 1);
    entries.insert(entries.end(), {double(c.component + 1), value, double(relation),
                                   withValue ? 1.0 : 0.0, double(c.otherId)});
    T_OPT_RECORD record{};
    std::copy(entries.begin(), entries.end(), record.begin());
    return record;
}

} // namespace

T_OPT_ITEM UlfItemRecord(const T_ULF_CASE& c)
{
    return {double(c.key), c.unknown ? 0.0 : c.factor, c.unknown ? c.weight : 1.0, 0.0};
}

std::vector<T_OPT_RECORD> UlfConstraintRecords(const T_ULFC_D& c)
{
    if (!c.inequality) return {RecordOf(c, c.value, 0, c.compareWithValue)};
    std::vector<T_OPT_RECORD> records;
    if (c.upper) records.push_back(RecordOf(c, *c.upper, -1, true));
    if (c.lower) records.push_back(RecordOf(c, *c.lower, 1, true));
    return records;
}

T_ULF_FORMED FormUlfProblem(const T_ULFI_D& item, std::span<const T_ULF_CASE> cases,
                            std::span<const T_ULFC_D> constraints)
{
    T_ULF_FORMED formed;
    T_OPT_PROBLEM& p = formed.problem;
    for (std::size_t i = 0; i < cases.size(); ++i) {
        const T_OPT_ITEM record = UlfItemRecord(cases[i]);
        if (!cases[i].unknown && IsUnknownItem(record)) continue;
        p.items.push_back(record);
        if (cases[i].unknown) formed.unknowns.push_back(i);
    }
    for (std::size_t i = 0; i < constraints.size(); ++i)
        for (const T_OPT_RECORD& record : UlfConstraintRecords(constraints[i])) {
            p.constraints.push_back(record);
            formed.owner.push_back(i);
        }
    p.nvar = static_cast<int>(formed.unknowns.size());
    p.iobj = item.objective + 1;
    p.isign = item.sign - 1;
    p.solveByEquations = item.solveByEquations;
    return formed;
}

int ReadUlfInfluence(std::span<const T_ULF_CASE> cases, std::span<const T_ULFC_D> constraints,
                     IUlfResponse& source, std::vector<std::vector<double>>& influence)
{
    std::vector<T_OPT_ITEM> items;
    for (const T_ULF_CASE& c : cases)
        items.push_back(UlfItemRecord(c));
    std::vector<T_OPT_RECORD> records;
    for (const T_ULFC_D& c : constraints)
        records.push_back(RecordOf(c, 0.0, 0, c.inequality || c.compareWithValue));
    std::vector<T_OPT_ROW> rows;
    return BuildRows(items, records, source, rows, influence);
}
