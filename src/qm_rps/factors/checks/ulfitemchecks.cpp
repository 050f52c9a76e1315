#include "qm_rps/factors/checks/ulfitemchecks.h"

#include "qm_base/msgfunction.h"
#include "qm_base/ruletable.h"
#include "qm_rps/factors/checks/ulfconstraintchecks.h"
#include "qm_rps/factors/checks/ulfstagechecks.h"
#include "qm_rps/factors/ulfcombination.h"
#include "qm_rps/factors/ulfstageplace.h"
#include "qm_rps/factors/ulfstageproblem.h"
#include "qm_rps/factors/ulfstanding.h"

#include <algorithm>
#include <cmath>
#include <functional>
#include <set>
#include <tuple>

using zql::lib::MMSGFunction;

namespace {

constexpr T_RULE_HEAD Says(const char* message, const char* field)
{
    return {.message = message, .field = field};
}
constexpr T_RULE_HEAD Wrong(const char* key, const char* field)
{
    return {.message = "IDS_RPS_UNKNOWN_LOAD_FACTOR_INPUT_ERROR", .key = key, .field = field};
}

template <class RANGE, class KEY>
bool AllDiffer(const RANGE& range, KEY key)
{
    std::set<std::decay_t<decltype(std::invoke(key, *range.begin()))>> seen;
    return std::ranges::all_of(
        range, [&](const auto& entry) { return seen.insert(std::invoke(key, entry)).second; });
}

// ---- what both kinds have in common -------------------------------------------------------------

struct T_COMMON_CHECK {
    const std::string& name;
    bool nameTaken;
    int objective, sign;
    const std::vector<std::string>& constraints;
    const T_MODEL& model;
};

/// Own: table of the items of its kind. Names are those of no item of the other kind either.
template <class ITEM, class OTHER>
T_COMMON_CHECK CommonOf(const ITEM& item, int ownKey, const T_MODEL& model,
                        const T_TABLE<ITEM>& own, const T_TABLE<OTHER>& others)
{
    const auto named = [&](const auto& entry) { return entry.second.name == item.name; };
    const bool taken = std::ranges::any_of(
        own, [&](const auto& entry) { return entry.first != ownKey && named(entry); });
    return {item.name,        taken || std::ranges::any_of(others, named),
            item.objective,   item.sign,
            item.constraints, model};
}

bool HasName(const T_COMMON_CHECK& c)
{
    return !c.name.empty();
}
bool NameIsFree(const T_COMMON_CHECK& c)
{
    return !c.nameTaken;
}
bool KnownObjective(const T_COMMON_CHECK& c)
{
    return c.objective >= 0 && c.objective <= 2;
}
bool KnownSign(const T_COMMON_CHECK& c)
{
    return c.sign >= 0 && c.sign <= 2;
}
bool HasConstraint(const T_COMMON_CHECK& c)
{
    return !c.constraints.empty();
}
bool ConstraintsExist(const T_COMMON_CHECK& c)
{
    return std::ranges::all_of(c.constraints, [&](const std::string& name) {
        return FindUlfConstraint(c.model, name) != 0;
    });
}
bool ConstraintsDiffer(const T_COMMON_CHECK& c)
{
    return AllDiffer(c.constraints, std::identity());
}

// clang-format off
constexpr T_RULE<T_COMMON_CHECK> kNameRules[] = {
    {Says("IDS_RPS_No_Item_Name_",     "name"), HasName},
    {Wrong("IDS_QM_ULFI_NAME_EXISTS",  "name"), NameIsFree, HasName},
};
constexpr T_RULE<T_COMMON_CHECK> kWayRules[] = {
    {Wrong("IDS_QM_ULFI_OBJECTIVE",    "objective"), KnownObjective},
    {Wrong("IDS_QM_ULFI_SIGN",         "sign"),      KnownSign},
};
constexpr T_RULE<T_COMMON_CHECK> kConstraintRules[] = {
    {Says("IDS_RPS_No_constraint_defined_for_the_unknowns_", "constraints"), HasConstraint},
    {Wrong("IDS_QM_ULFI_NO_SUCH_CONSTRAINT",                 "constraints"), ConstraintsExist},
    {Wrong("IDS_QM_ULFI_TWICE",                              "constraints"), ConstraintsDiffer},
};
// clang-format on

/// Appends what the item's constraints do not keep; one that is missing has its own rule.
void AddConstraintFindings(const std::vector<std::string>& names, const T_MODEL& model,
                           std::vector<T_FINDING>& out)
{
    for (const std::string& name : names) {
        const int key = FindUlfConstraint(model, name);
        if (key == 0) continue;
        for (T_FINDING& f : CheckUlfConstraint(model.ulfConstraints.at(key), key, model)) {
            f.field = "constraints[" + name + "]." + f.field;
            out.push_back(std::move(f));
        }
    }
}

// ---- static items -------------------------------------------------------------------------------

struct T_ITEM_CHECK {
    const T_ULFI_D& item;
    const T_MODEL& model;
    const std::optional<T_LCOM_D>& flat; // its combination as load cases; empty: can't be had
};

bool HasCombinations(const T_ITEM_CHECK& c)
{
    return !c.model.combinations.empty();
}
bool CombinationFlattens(const T_ITEM_CHECK& c)
{
    return c.flat.has_value();
}
bool HasUnknown(const T_ITEM_CHECK& c)
{
    return !c.item.unknowns.empty();
}
bool UnknownsAreInCombination(const T_ITEM_CHECK& c)
{
    return std::ranges::all_of(c.item.unknowns, [&](const T_ULFI_UNKNOWN& unknown) {
        return std::ranges::find(c.flat->items, unknown.loadCase, &T_LCOM_ITEM::key) !=
               c.flat->items.end();
    });
}
bool UnknownsDiffer(const T_ITEM_CHECK& c)
{
    return AllDiffer(c.item.unknowns, &T_ULFI_UNKNOWN::loadCase);
}
bool WeightsAreNumbers(const T_ITEM_CHECK& c)
{
    return std::ranges::all_of(c.item.unknowns, [](const T_ULFI_UNKNOWN& unknown) {
        return std::isfinite(unknown.weight) && unknown.weight >= 0;
    });
}

// clang-format off
constexpr T_RULE<T_ITEM_CHECK> kCombinationRules[] = {
    {Says("IDS_RPS_No_General_Load_Combination_exist_", "combination"), HasCombinations},
    {Wrong("IDS_QM_ULFI_COMBINATION", "combination"), CombinationFlattens, HasCombinations},
};
constexpr T_RULE<T_ITEM_CHECK> kUnknownRules[] = {
    {Says("IDS_RPS_No_Unknown_Load_Factor_defined_", "unknowns"), HasUnknown},
    {Wrong("IDS_QM_ULFI_NOT_IN_COMBINATION", "unknowns"),
     UnknownsAreInCombination, CombinationFlattens},
    {Wrong("IDS_QM_ULFI_TWICE",  "unknowns"), UnknownsDiffer},
    {Wrong("IDS_QM_ULFI_WEIGHT", "unknowns"), WeightsAreNumbers},
};
constexpr T_RULE<T_ULFC_D> kStaticPlaceRules[] = {
    {Wrong("IDS_QM_ULFI_STAGE_CONSTRAINT", "stage"),
     [](const T_ULFC_D& c) { return c.stage == 0; }},
};
// clang-format on

// ---- items of construction stages ---------------------------------------------------------------

struct T_ROW_CHECK {
    const T_ULSI_ROW& row;
    const T_MODEL& model;
    bool twice = false;   // a row before it is the same load at the same stage and step
    bool shared = false;  // a row before it scales some of its pretension loads
    bool inSum = true;    // its load is part of what it reads
    bool counted = false; // another row reads it too
};

bool PlaceExists(const T_ROW_CHECK& c)
{
    return UlfStepNumber(c.model, c.row.stage, c.row.step) != 0;
}
bool CaseExists(const T_ROW_CHECK& c)
{
    return c.model.loadCases.contains(c.row.loadCase);
}
bool KnownGroup(const T_ROW_CHECK& c)
{
    return c.row.loadGroup >= kLoadGroupDead && c.row.loadGroup <= kLoadGroupRest;
}
bool NumbersAreFinite(const T_ROW_CHECK& c)
{
    return c.row.unknown ? std::isfinite(c.row.weight) && c.row.weight >= 0
                         : std::isfinite(c.row.factor);
}
bool StandsOnce(const T_ROW_CHECK& c)
{
    return !c.twice;
}
bool HasPretension(const T_MODEL& model, int loadCase)
{
    const auto it = model.loadCases.find(loadCase);
    return it != model.loadCases.end() && !it->second.pretension.empty();
}
/// An unknown that is to scale pretension must find some, else it would never get to 1.
bool PretensionIsThere(const T_ROW_CHECK& c)
{
    return !c.row.unknown || !c.row.pretension ||
           std::ranges::any_of(LoadsScaledBy(c.model, c.row),
                               [&](int load) { return HasPretension(c.model, load); });
}
bool LoadIsRead(const T_ROW_CHECK& c)
{
    return c.inSum;
}
bool CountsOnce(const T_ROW_CHECK& c)
{
    return !c.counted;
}
/// Scaled by two unknowns, a load would get both factors.
bool ScalesAlone(const T_ROW_CHECK& c)
{
    return !c.shared;
}

struct T_STAGE_CHECK {
    const T_ULSI_D& item;
    const T_MODEL& model;
};

bool HasUnknownRow(const T_STAGE_CHECK& c)
{
    return std::ranges::any_of(c.item.rows, &T_ULSI_ROW::unknown);
}
// clang-format off
constexpr T_RULE<T_ROW_CHECK> kRowRules[] = {
    {Wrong("IDS_QM_ULSI_PLACE",         "step"),       PlaceExists},
    {Wrong("IDS_QM_ULSI_CASE",          "case"),       CaseExists},
    {Wrong("IDS_QM_ULSI_GROUP",         "load_group"), KnownGroup},
    {Wrong("IDS_QM_ULSI_NUMBER",        "factor"),     NumbersAreFinite},
    {Wrong("IDS_QM_ULSI_TWICE",         "case"),       StandsOnce},
    {Wrong("IDS_QM_ULSI_NOT_IN_SUM",    "load_group"), LoadIsRead},
    {Wrong("IDS_QM_ULSI_COUNTED_TWICE", "load_group"), CountsOnce, LoadIsRead},
    {Wrong("IDS_QM_ULSI_NO_PRETENSION", "pretension"), PretensionIsThere},
    {Wrong("IDS_QM_ULSI_SCALED_TWICE",  "pretension"), ScalesAlone},
};
constexpr T_RULE<T_STAGE_CHECK> kStageUnknownRules[] = {
    {Says("IDS_RPS_No_Unknown_Load_Factor_defined_", "rows"), HasUnknownRow},
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
        T_ROW_CHECK check{row, model};
        check.twice = step && !places.insert({row.stage, step, row.loadCase}).second;
        for (const int load : LoadsScaledBy(model, row))
            if (HasPretension(model, load)) check.shared |= !scaled.insert(load).second;
        check.inSum = !model.loadCases.contains(row.loadCase) || // a missing one has its own rule
                      ReadsCase(model, item, row, row.loadCase);
        check.counted = RowThatCounts(item, i, model) != 0;
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

} // namespace

std::vector<T_FINDING> CheckUlfItem(const T_ULFI_D& item, int ownKey, const CDataCtrl& data)
{
    const T_MODEL& model = data.Model();
    const T_RULE_PLACE place{.name = item.name};
    const std::optional<T_LCOM_D> flat = FlatCombination(data, item.combination);
    const T_COMMON_CHECK common =
        CommonOf(item, ownKey, model, model.ulfItems, model.ulfStageItems);
    const T_ITEM_CHECK own{item, model, flat};
    std::vector<T_FINDING> out;
    WalkRules(kNameRules, common, place, out);
    WalkRules(kCombinationRules, own, place, out);
    WalkRules(kWayRules, common, place, out);
    WalkRules(kUnknownRules, own, place, out);
    WalkRules(kConstraintRules, common, place, out);
    for (const std::string& name : item.constraints) {
        const int key = FindUlfConstraint(model, name);
        if (key == 0) continue;
        std::vector<T_FINDING> found;
        WalkRules(kStaticPlaceRules, model.ulfConstraints.at(key),
                  {.prefix = "constraints[" + name + "]."}, found);
        AppendNamed(item.name, name, std::move(found), out);
    }
    AddConstraintFindings(item.constraints, model, out);
    return out;
}

std::vector<T_FINDING> CheckUlfStageItem(const T_ULSI_D& item, int ownKey, const CDataCtrl& data)
{
    const T_MODEL& model = data.Model();
    const T_RULE_PLACE place{.name = item.name};
    const T_COMMON_CHECK common =
        CommonOf(item, ownKey, model, model.ulfStageItems, model.ulfItems);
    std::vector<T_FINDING> out;
    WalkRules(kNameRules, common, place, out);
    CheckRows(item, data, out);
    WalkRules(kWayRules, common, place, out);
    WalkRules(kStageUnknownRules, {item, model}, place, out);
    WalkRules(kConstraintRules, common, place, out);
    AddConstraintFindings(item.constraints, model, out);
    for (T_FINDING& f : CheckUlfConstraintPlaces(item, model))
        out.push_back(std::move(f));
    return out;
}
