#include "qm_rps/ulfstageproblem.h"

#include "qm_base/msgfunction.h"
#include "qm_rps/ulfchecks.h"
#include "qm_rps/ulfrecords.h"
#include "qm_rps/ulfstageplace.h"

#include <algorithm>
#include <cmath>
#include <set>
#include <tuple>

using zql::lib::MMSGFunction;

namespace {

struct T_ITEM_CHECK {
    const T_ULSI_D& item;
    const T_MODEL& model;
    int ownKey;
};
using I = T_ITEM_CHECK;
constexpr auto kKey = RULE_TEXT::Key;
constexpr auto kLit = RULE_TEXT::Literal;

template <class F>
bool EveryRow(const I& k, F holds)
{
    return std::ranges::all_of(k.item.rows, holds);
}

bool NameIsFree(const I& k)
{
    return std::ranges::none_of(k.model.ulfStageItems, [&](const auto& entry) {
        return entry.first != k.ownKey && entry.second.name == k.item.name;
    });
}
bool PlacesExist(const I& k)
{
    return EveryRow(k, [&](const auto& r) { return UlfStepNumber(k.model, r.stage, r.step) != 0; });
}
bool CasesExist(const I& k)
{
    return EveryRow(k, [&](const auto& r) { return k.model.loadCases.contains(r.loadCase); });
}
bool GroupsExist(const I& k)
{
    return EveryRow(k, [](const auto& r) {
        return r.loadGroup >= kLoadGroupDead && r.loadGroup <= kLoadGroupRest;
    });
}
bool NumbersAreFinite(const I& k)
{
    return EveryRow(k, [](const auto& r) {
        return r.unknown ? std::isfinite(r.weight) && r.weight >= 0 : std::isfinite(r.factor);
    });
}
bool RowsDiffer(const I& k)
{
    std::set<std::tuple<int, int, int>> seen;
    return EveryRow(k, [&](const auto& r) {
        return seen.insert({r.stage, r.step, r.loadCase}).second;
    });
}
bool HasPretension(const I& k, int loadCase)
{
    const auto it = k.model.loadCases.find(loadCase);
    return it != k.model.loadCases.end() && !it->second.pretension.empty();
}
/// An unknown that is to scale pretension must find some, else it would never get to 1.
bool PretensionIsThere(const I& k)
{
    return EveryRow(k, [&](const T_ULSI_ROW& r) {
        return !r.unknown || !r.pretension ||
               std::ranges::any_of(LoadsScaledBy(k.model, r),
                                   [&](int load) { return HasPretension(k, load); });
    });
}
/// Scaled by two unknowns, a load would get both factors.
bool ScaledOnce(const I& k)
{
    std::set<int> seen;
    return EveryRow(k, [&](const T_ULSI_ROW& r) {
        return std::ranges::all_of(LoadsScaledBy(k.model, r), [&](int load) {
            return !HasPretension(k, load) || seen.insert(load).second;
        });
    });
}
bool HasUnknown(const I& k)
{
    return std::ranges::any_of(k.item.rows, &T_ULSI_ROW::unknown);
}
bool ConstraintsExist(const I& k)
{
    return std::ranges::all_of(k.item.constraints, [&](const std::string& n) {
        return FindUlfConstraint(k.model, n) != 0;
    });
}
bool ConstraintsDiffer(const I& k)
{
    return std::set<std::string>(k.item.constraints.begin(), k.item.constraints.end()).size() ==
           k.item.constraints.size();
}
bool ConstraintPlacesExist(const I& k)
{
    return std::ranges::all_of(k.item.constraints, [&](const std::string& n) {
        const int key = FindUlfConstraint(k.model, n);
        if (key == 0) return true; // a missing one has its own rule
        const T_ULFC_D& c = k.model.ulfConstraints.at(key);
        return c.stage == 0 || UlfStepNumber(k.model, c.stage, c.step) != 0;
    });
}

// clang-format off
const T_RULE<I> kRules[] = {
    {{"IDS_RPS_No_Item_Name_", kLit, nullptr, nullptr, "name"}, [](const I& k) { return !k.item.name.empty(); }},
    {{kUlfItemError, kKey, "IDS_QM_ULFI_NAME_EXISTS", nullptr, "name"}, NameIsFree, [](const I& k) { return !k.item.name.empty(); }},
    {{kUlfItemError, kKey, "IDS_QM_ULSI_PLACE", nullptr, "rows"}, PlacesExist},
    {{kUlfItemError, kKey, "IDS_QM_ULSI_CASE", nullptr, "rows"}, CasesExist},
    {{kUlfItemError, kKey, "IDS_QM_ULSI_GROUP", nullptr, "rows"}, GroupsExist},
    {{kUlfItemError, kKey, "IDS_QM_ULSI_NUMBER", nullptr, "rows"}, NumbersAreFinite},
    {{kUlfItemError, kKey, "IDS_QM_ULSI_TWICE", nullptr, "rows"}, RowsDiffer},
    {{kUlfItemError, kKey, "IDS_QM_ULFI_OBJECTIVE", nullptr, "objective"}, [](const I& k) { return k.item.objective >= 0 && k.item.objective <= 2; }},
    {{kUlfItemError, kKey, "IDS_QM_ULFI_SIGN", nullptr, "sign"}, [](const I& k) { return k.item.sign >= 0 && k.item.sign <= 2; }},
    {{"IDS_RPS_No_Unknown_Load_Factor_defined_", kLit, nullptr, nullptr, "rows"}, HasUnknown},
    {{kUlfItemError, kKey, "IDS_QM_ULSI_NO_PRETENSION", nullptr, "rows"}, PretensionIsThere},
    {{kUlfItemError, kKey, "IDS_QM_ULSI_SCALED_TWICE", nullptr, "rows"}, ScaledOnce},
    {{"IDS_RPS_No_constraint_defined_for_the_unknowns_", kLit, nullptr, nullptr, "constraints"}, [](const I& k) { return !k.item.constraints.empty(); }},
    {{kUlfItemError, kKey, "IDS_QM_ULFI_NO_SUCH_CONSTRAINT", nullptr, "constraints"}, ConstraintsExist},
    {{kUlfItemError, kKey, "IDS_QM_ULFI_TWICE", nullptr, "constraints"}, ConstraintsDiffer},
    {{kUlfItemError, kKey, "IDS_QM_ULSI_CONSTRAINT_PLACE", nullptr, "constraints"}, ConstraintPlacesExist},
};
// clang-format on

} // namespace

T_ULF_STAGE_FORMED FormUlfStageProblem(const T_ULSI_D& item, std::span<const T_ULFC_D> constraints)
{
    T_ULF_STAGE_FORMED formed;
    T_OPT_PROBLEM& p = formed.problem;
    p.stage = true;
    for (std::size_t i = 0; i < item.rows.size(); ++i) {
        const T_ULSI_ROW& row = item.rows[i];
        const T_OPT_ITEM record{double(UlfStageNumber(row.stage, row.step)),
                                row.unknown ? 0.0 : row.factor, row.unknown ? row.weight : 1.0,
                                double(row.loadGroup)};
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

std::vector<int> LoadsScaledBy(const T_MODEL& model, const T_ULSI_ROW& row)
{
    if (!row.unknown || !row.pretension) return {};
    if (row.loadGroup == kLoadGroupRest) return {row.loadCase};
    return LoadsActingAt(model, row.stage, row.step);
}

std::vector<T_FINDING> CheckUlfStageItem(const T_ULSI_D& item, int ownKey, const T_MODEL& model)
{
    std::vector<T_FINDING> out;
    WalkRules(std::span<const T_RULE<I>>(kRules), {item, model, ownKey}, {}, out);
    for (T_FINDING& f : out)
        f.text =
            MMSGFunction::Format(f.messageKey, {item.name, MMSGFunction::GetValue(f.ruleText)});
    for (const std::string& name : item.constraints)
        AddConstraintFindings(name, model, out);
    return out;
}
