#include "qm_rps/factors/checks/ulfstagechecks.h"

#include "qm_base/msgfunction.h"
#include "qm_base/ruletable.h"
#include "qm_rps/factors/checks/ulfconstraintchecks.h"
#include "qm_rps/factors/ulfstageplace.h"
#include "qm_rps/factors/ulfstanding.h"

#include <algorithm>
#include <cmath>

using zql::lib::MMSGFunction;

namespace {

constexpr const char* kInputError = "IDS_RPS_UNKNOWN_LOAD_FACTOR_INPUT_ERROR";

constexpr T_RULE_HEAD Wrong(const char* key, const char* field)
{
    return {.message = kInputError, .key = key, .field = field};
}

// ---- where constraints are read -----------------------------------------------------------------

struct T_PLACE_CHECK {
    const T_ULFC_D& constraint;
    std::optional<std::pair<int, int>> place; // step 0: it does not exist
    T_STANDING standing{};
};

bool HasPlace(const T_PLACE_CHECK& c)
{
    return c.place.has_value();
}
bool PlaceExists(const T_PLACE_CHECK& c)
{
    return c.place->second != 0;
}
bool IsAt(const T_PLACE_CHECK& c)
{
    return HasPlace(c) && PlaceExists(c);
}
bool IsComparedAt(const T_PLACE_CHECK& c)
{
    return IsAt(c) && !c.constraint.inequality && !c.constraint.compareWithValue;
}
template <int T_ULFC_D::*ID>
bool Stands(const T_PLACE_CHECK& c)
{
    const int id = c.constraint.*ID;
    switch (c.constraint.type) {
    case ULFC_TYPE::Reaction:
        return c.standing.supports.contains(id);
    case ULFC_TYPE::Displacement:
        return c.standing.nodes.contains(id);
    default:
        return c.standing.elements.contains(id);
    }
}

// clang-format off
constexpr T_RULE<T_PLACE_CHECK> kPlaceRules[] = {
    {Wrong("IDS_QM_ULSI_NO_PLACE",         "stage"),   HasPlace},
    {Wrong("IDS_QM_ULSI_CONSTRAINT_PLACE", "stage"),   PlaceExists, HasPlace},
    {Wrong("IDS_QM_ULSI_NOT_STANDING",     "id"),      Stands<&T_ULFC_D::id>, IsAt},
    {Wrong("IDS_QM_ULSI_NOT_STANDING",     "otherId"), Stands<&T_ULFC_D::otherId>, IsComparedAt},
};
// clang-format on

// ---- warnings -----------------------------------------------------------------------------------

struct T_ROW_WARNING {
    const T_ULSI_ROW& row;
};

bool IsApplied(const T_ROW_WARNING& w)
{
    return !w.row.unknown || w.row.pretension;
}
bool IsAnalysedAsKnown(const T_ROW_WARNING& w)
{
    constexpr double kSame = 1e-12; // the factor that a file states as 1
    return w.row.unknown || std::fabs(w.row.factor - 1.0) <= kSame;
}

// clang-format off
constexpr T_RULE<T_ROW_WARNING> kRowWarnings[] = {
    {Wrong("IDS_QM_ULSI_NEVER_APPLIED", "pretension"), IsApplied},
    {Wrong("IDS_QM_ULSI_KNOWN_FACTOR",  "factor"),     IsAnalysedAsKnown},
};
// clang-format on

/// Load cases that act where a constraint of the item is read, or have acted, and that no row
/// reads.
std::set<int> Forgotten(const T_ULSI_D& item, const T_MODEL& model)
{
    std::set<int> forgotten;
    for (const std::string& name : item.constraints) {
        const int key = FindUlfConstraint(model, name);
        if (key == 0) continue;
        const auto place = ReadingPlace(model, item, model.ulfConstraints.at(key));
        if (!place || place->second == 0) continue;
        for (const int load : CasesBroughtBy(model, place->first, place->second))
            if (std::ranges::none_of(item.rows, [&](const T_ULSI_ROW& row) {
                    return ReadsCase(model, item, row, load);
                }))
                forgotten.insert(load);
    }
    return forgotten;
}

/// The finding with its row's or constraint's name in front of the rule.
void Name(T_FINDING& f, const std::string& item, const std::string& rule)
{
    f.text = MMSGFunction::Format(f.messageKey, {item, rule});
}

} // namespace

std::vector<T_FINDING> CheckUlfConstraintPlaces(const T_ULSI_D& item, const T_MODEL& model)
{
    std::vector<T_FINDING> out;
    for (const std::string& name : item.constraints) {
        const int key = FindUlfConstraint(model, name);
        if (key == 0) continue; // a missing one has its own rule
        const T_ULFC_D& constraint = model.ulfConstraints.at(key);
        // Records that are not there have their own rules, which come first.
        if (!CheckUlfConstraint(constraint, key, model).empty()) continue;
        T_PLACE_CHECK check{constraint, ReadingPlace(model, item, constraint)};
        if (check.place) check.standing = StandingAt(model, check.place->first);
        std::vector<T_FINDING> found;
        WalkRules(kPlaceRules, check, {.prefix = "constraints[" + name + "]."}, found);
        AppendNamed(item.name, name, std::move(found), out);
    }
    return out;
}

void AppendNamed(const std::string& item, const std::string& constraint,
                 std::vector<T_FINDING> found, std::vector<T_FINDING>& out)
{
    for (T_FINDING& f : found) {
        Name(f, item,
             MMSGFunction::Format("IDS_QM_ULSI_CONSTRAINT",
                                  {constraint, MMSGFunction::GetValue(f.ruleText)}));
        out.push_back(std::move(f));
    }
}

std::size_t RowThatCounts(const T_ULSI_D& item, std::size_t at, const T_MODEL& model)
{
    const T_ULSI_ROW& row = item.rows[at];
    const auto isIncrement = [](const T_ULSI_ROW& r) {
        return !ReadsSum(r) && r.unknown && !r.pretension;
    };
    if (isIncrement(row)) return 0;
    for (std::size_t i = 0; i < at; ++i) { // of its own case at another place
        const T_ULSI_ROW& before = item.rows[i];
        const bool owns = !ReadsSum(row) && !ReadsSum(before) && !isIncrement(before);
        if (owns && before.loadCase == row.loadCase) return i + 1;
    }
    for (std::size_t i = 0; i < item.rows.size(); ++i) {
        const bool other = ReadsSum(row) ? i < at : i != at;
        if (other && ReadsSum(item.rows[i]) &&
            (ReadsSum(row) || ReadsCase(model, item, item.rows[i], row.loadCase)))
            return i + 1;
    }
    return 0;
}

std::vector<T_FINDING> UlfStageItemWarnings(const T_ULSI_D& item, const CDataCtrl& data)
{
    std::vector<T_FINDING> out;
    for (std::size_t i = 0; i < item.rows.size(); ++i) {
        const std::string number = std::to_string(i + 1);
        std::vector<T_FINDING> found;
        WalkRules(kRowWarnings, {item.rows[i]}, {.prefix = "rows[" + number + "]."}, found);
        for (T_FINDING& f : found) {
            Name(f, item.name,
                 MMSGFunction::Format("IDS_QM_ULSI_ROW",
                                      {number, UlfStageRowText(data, item.rows[i]),
                                       MMSGFunction::GetValue(f.ruleText)}));
            out.push_back(std::move(f));
        }
    }
    const T_MODEL& model = data.Model();
    for (const int load : Forgotten(item, model)) {
        T_FINDING& f = out.emplace_back();
        f.field = "rows";
        f.ruleText = "IDS_QM_ULSI_FORGOTTEN";
        f.messageKey = kInputError;
        const auto it = model.loadCases.find(load);
        Name(f, item.name,
             MMSGFunction::Format(f.ruleText, {it == model.loadCases.end() ? std::to_string(load)
                                                                           : it->second.name}));
    }
    return out;
}
