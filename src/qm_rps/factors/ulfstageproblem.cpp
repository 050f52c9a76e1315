#include "qm_rps/factors/ulfstageproblem.h"

#include "qm_base/msgfunction.h"
#include "qm_rps/factors/ulfchecks.h"
#include "qm_rps/factors/ulfstageplace.h"

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
struct T_ROW_CHECK {
    const T_ULSI_ROW& row;
    const T_MODEL& model;
    bool twice;  // a row before it is the same load at the same stage and step
    bool shared; // a row before it scales some of its pretension loads
};
using I = T_ITEM_CHECK;
using R = T_ROW_CHECK;

bool NameIsFree(const I& k)
{
    const auto others = [&](const auto& table, int ownKey) {
        return std::ranges::any_of(table, [&](const auto& entry) {
            return entry.first != ownKey && entry.second.name == k.item.name;
        });
    };
    return !others(k.model.ulfStageItems, k.ownKey) && !others(k.model.ulfItems, 0);
}
bool NumbersAreFinite(const R& k)
{
    return k.row.unknown ? std::isfinite(k.row.weight) && k.row.weight >= 0
                         : std::isfinite(k.row.factor);
}
bool HasPretension(const T_MODEL& model, int loadCase)
{
    const auto it = model.loadCases.find(loadCase);
    return it != model.loadCases.end() && !it->second.pretension.empty();
}
/// An unknown that is to scale pretension must find some, else it would never get to 1.
bool PretensionIsThere(const R& k)
{
    return !k.row.unknown || !k.row.pretension ||
           std::ranges::any_of(LoadsScaledBy(k.model, k.row),
                               [&](int load) { return HasPretension(k.model, load); });
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
const T_RULE<I> kNameRules[] = {
    {{.message = "IDS_RPS_No_Item_Name_", .field = "name"}, [](const I& k) { return !k.item.name.empty(); }},
    {{.message = kUlfItemError, .key = "IDS_QM_ULFI_NAME_EXISTS", .field = "name"}, NameIsFree, [](const I& k) { return !k.item.name.empty(); }},
};
const T_RULE<R> kRowRules[] = {
    {{.message = kUlfItemError, .key = "IDS_QM_ULSI_PLACE", .field = "step"}, [](const R& k) { return UlfStepNumber(k.model, k.row.stage, k.row.step) != 0; }},
    {{.message = kUlfItemError, .key = "IDS_QM_ULSI_CASE", .field = "case"}, [](const R& k) { return k.model.loadCases.contains(k.row.loadCase); }},
    {{.message = kUlfItemError, .key = "IDS_QM_ULSI_GROUP", .field = "load_group"}, [](const R& k) { return k.row.loadGroup >= kLoadGroupDead && k.row.loadGroup <= kLoadGroupRest; }},
    {{.message = kUlfItemError, .key = "IDS_QM_ULSI_NUMBER", .field = "factor"}, NumbersAreFinite},
    {{.message = kUlfItemError, .key = "IDS_QM_ULSI_TWICE", .field = "case"}, [](const R& k) { return !k.twice; }},
    {{.message = kUlfItemError, .key = "IDS_QM_ULSI_NO_PRETENSION", .field = "pretension"}, PretensionIsThere},
    // Scaled by two unknowns, a load would get both factors.
    {{.message = kUlfItemError, .key = "IDS_QM_ULSI_SCALED_TWICE", .field = "pretension"}, [](const R& k) { return !k.shared; }},
};
const T_RULE<I> kRules[] = {
    {{.message = kUlfItemError, .key = "IDS_QM_ULFI_OBJECTIVE", .field = "objective"}, [](const I& k) { return k.item.objective >= 0 && k.item.objective <= 2; }},
    {{.message = kUlfItemError, .key = "IDS_QM_ULFI_SIGN", .field = "sign"}, [](const I& k) { return k.item.sign >= 0 && k.item.sign <= 2; }},
    {{.message = "IDS_RPS_No_Unknown_Load_Factor_defined_", .field = "rows"}, HasUnknown},
    {{.message = "IDS_RPS_No_constraint_defined_for_the_unknowns_", .field = "constraints"}, [](const I& k) { return !k.item.constraints.empty(); }},
    {{.message = kUlfItemError, .key = "IDS_QM_ULFI_NO_SUCH_CONSTRAINT", .field = "constraints"}, ConstraintsExist},
    {{.message = kUlfItemError, .key = "IDS_QM_ULFI_TWICE", .field = "constraints"}, ConstraintsDiffer},
    {{.message = kUlfItemError, .key = "IDS_QM_ULSI_CONSTRAINT_PLACE", .field = "constraints"}, ConstraintPlacesExist},
};
// clang-format on

/// What each row says, with what the rows before it have taken.
void CheckRows(const T_ULSI_D& item, const CDataCtrl& data, std::vector<T_FINDING>& out)
{
    const T_MODEL& model = data.Model();
    std::set<std::tuple<int, int, int>> places; // stage, step, case
    std::set<int> scaled;
    for (std::size_t i = 0; i < item.rows.size(); ++i) {
        const T_ULSI_ROW& row = item.rows[i];
        // The last step and its number are one place.
        const int step = UlfStepNumber(model, row.stage, row.step);
        R check{row, model, false, false};
        check.twice = step && !places.insert({row.stage, step, row.loadCase}).second;
        for (const int load : LoadsScaledBy(model, row))
            if (HasPretension(model, load)) check.shared |= !scaled.insert(load).second;
        const std::string number = std::to_string(i + 1);
        std::vector<T_FINDING> found;
        WalkRules(kRowRules, check, {.prefix = "rows[" + number + "]."}, found);
        for (T_FINDING& f : found) {
            const std::string rule =
                MMSGFunction::Format("IDS_QM_ULSI_ROW", {number, UlfStageRowText(data, row),
                                                         MMSGFunction::GetValue(f.ruleText)});
            f.text = MMSGFunction::Format(f.messageKey, {item.name, rule});
            out.push_back(std::move(f));
        }
    }
}

void CheckItem(std::span<const T_RULE<I>> rules, const I& check, std::vector<T_FINDING>& out)
{
    std::vector<T_FINDING> found;
    WalkRules(rules, check, {}, found);
    for (T_FINDING& f : found) {
        f.text = MMSGFunction::Format(f.messageKey,
                                      {check.item.name, MMSGFunction::GetValue(f.ruleText)});
        out.push_back(std::move(f));
    }
}

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

std::vector<T_FINDING> CheckUlfStageItem(const T_ULSI_D& item, int ownKey, const CDataCtrl& data)
{
    std::vector<T_FINDING> out;
    const I check{item, data.Model(), ownKey};
    CheckItem(kNameRules, check, out);
    CheckRows(item, data, out);
    CheckItem(kRules, check, out);
    for (const std::string& name : item.constraints)
        AddConstraintFindings(name, data.Model(), out);
    return out;
}
