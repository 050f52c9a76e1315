#include "qm_db/records/loadcaserules.h"

#include "qm_base/msgfunction.h"
#include "qm_db/records/pushcontrol.h"
#include "qm_db/records/rulehead.h"

#include <algorithm>
#include <cmath>
#include <set>

namespace {

constexpr int kDisplacementControl = 1;
constexpr int kFollowsFunction = 2;
constexpr const char* kAngle = "IDS_PUSHOVER_STATIC_ANGLE_GEN";
constexpr const char* kSteps = "IDS_QM_PUSH_STEPS";
constexpr const char* kNoCase = "IDS_QM_PUSH_NO_INITIAL_CASE";
constexpr const char* kCircle = "IDS_QM_PUSH_CIRCLE";
constexpr const char* kDrift = "IDS_QM_PUSH_DRIFT";
constexpr const char* kPeak = "IDS_QM_PUSH_FRACTION_OF_PEAK";
constexpr const char* kEccentric = "IDS_QM_PUSH_ECCENTRICITY";
constexpr const char* kAdditional = "IDS_QM_PUSH_ADDITIONAL";

// ---- control and stop criteria ------------------------------------------------------------------

struct T_CHECK {
    const T_POLC_D& record;
    const T_POLC_CONTROL& c;
    const T_MODEL& model;
    int key; // of the record as it is in the model
};
using C = T_CHECK;

bool ByForce(const C& c)
{
    return c.record.control && c.c.incrementMethod != kDisplacementControl;
}
bool ByDispl(const C& c)
{
    return c.record.control && c.c.incrementMethod == kDisplacementControl;
}
bool IsAbove0(double v)
{
    return std::isfinite(v) && v > 0.0;
}

const T_POLC_D* FindByName(const C& c, const std::string& name)
{
    for (const auto& [key, other] : c.model.pushovers)
        if (other.name == name) return &other;
    return nullptr;
}
bool IsItself(const C& c, const std::string& name)
{
    const auto before = c.model.pushovers.find(c.key);
    return name == c.record.name ||
           (before != c.model.pushovers.end() && name == before->second.name);
}
bool StartsFromOther(const C& c)
{
    return !c.record.initialCase.empty();
}
/// From case to case along their starts.
bool HasNoCircle(const C& c)
{
    std::set<std::string> seen;
    std::string name = c.record.initialCase;
    while (!name.empty() && !IsItself(c, name) && seen.insert(name).second) {
        const T_POLC_D* const other = FindByName(c, name);
        name = other ? other->initialCase : std::string();
    }
    return name.empty() || !IsItself(c, name); // a circle of others is theirs
}

constexpr T_RECORD_RULE<C> kRules[] = {
    {{.message = "IDS_PUSHOVER_Error___Loadcase_name_is_not_input_", .field = "name"},
     [](const C& c) { return !c.record.name.empty(); }},
    {{.message = "IDS_RPS_PO_Error_No_Increment_Function", .field = "control.incrementFunction"},
     [](const C& c) { return c.model.incrementFunctions.contains(c.c.incrementFunction); },
     [](const C& c) { return ByForce(c) && c.c.incrementOption == kFollowsFunction; }},
    {{.message = "IDS_RPS_PO_POLC_Current_Stif_Ratio_0", .field = "control.stiffnessRatioLimit"},
     [](const C& c) {
         return std::isfinite(c.c.stiffnessRatioLimit) && c.c.stiffnessRatioLimit >= 0.0;
     },
     ByForce},
    {{.message = kAngle, .field = "control.staticAngle"},
     [](const C& c) { return IsAbove0(c.c.staticAngle); },
     [](const C& c) { return ByForce(c) && c.c.generateStaticAngle; }},
    // exactly 0 alone is refused: the sign gives the direction of the push
    {{.message = "IDS_PUSHOVER_Error___Master_Max_Displ__must_be_grea",
      .field = "control.masterMaxDispl"},
     [](const C& c) { return std::isfinite(c.c.masterMaxDispl) && c.c.masterMaxDispl != 0.0; },
     [](const C& c) { return ByDispl(c) && c.c.masterNodeControl; }},
    {{.message = "IDS_PUSHOVER_Error___Max__Translational_Displ__must",
      .field = "control.maxTransDispl"},
     [](const C& c) { return IsAbove0(c.c.maxTransDispl); },
     [](const C& c) { return ByDispl(c) && !c.c.masterNodeControl; }},
    {{.message = "IDS_RPS_PO_Error_No_Increment_Function", .field = "control.incrementFunction"},
     [](const C& c) { return c.model.incrementFunctions.contains(c.c.incrementFunction); },
     [](const C& c) { return ByDispl(c) && c.c.incrementOption == kFollowsFunction; }},
    {{.message = kSteps, .field = "steps", .caseKey = "steps", .reason = kSteps},
     [](const C& c) { return *c.record.steps >= 1 && *c.record.steps <= kMostPushSteps; },
     [](const C& c) { return c.record.steps.has_value(); }},
    {{.message = kNoCase, .field = "initialCase", .caseKey = "initial_case", .reason = kNoCase},
     [](const C& c) {
         return IsItself(c, c.record.initialCase) || FindByName(c, c.record.initialCase);
     },
     StartsFromOther},
    {{.message = kCircle, .field = "initialCase", .caseKey = "initial_case", .reason = kCircle},
     HasNoCircle,
     StartsFromOther},
    {{.message = kDrift, .field = "stops.drift", .caseKey = "drift", .reason = kDrift},
     [](const C& c) { return IsAbove0(c.record.stops.drift.value_or(1.0)); }},
    {{.message = kPeak,
      .field = "stops.fractionOfPeak",
      .caseKey = "fraction_of_peak",
      .reason = kPeak},
     [](const C& c) {
         const double fraction = c.record.stops.fractionOfPeak.value_or(0.5);
         return fraction > 0.0 && fraction < 1.0;
     }},
    {{.message = kEccentric,
      .field = "eccentricity",
      .caseKey = "eccentricity",
      .reason = kEccentric},
     [](const C& c) { return std::fabs(c.record.eccentricity) < 0.5; }},
    {{.message = kAdditional, .field = "additionalDisplacements"},
     [](const C& c) {
         return std::ranges::all_of(c.record.additionalDisplacements,
                                    [&](double d) { return IsOnTheWay(c.record, d); });
     }},
};

// ---- pattern rows -------------------------------------------------------------------------------

constexpr T_RECORD_RULE<T_POLC_PATTERN> kRowRules[] = {
    {{.message = "IDS_PUSHOVER_the_Scale_Factor_can_not_be_zero"},
     [](const T_POLC_PATTERN& r) { return std::isfinite(r.factor) && r.factor != 0.0; }},
    {{.message = "IDS_PUSHOVER_Error___Mode_must_be_greater_than_0"},
     [](const T_POLC_PATTERN& r) { return r.number > 0; },
     [](const T_POLC_PATTERN& r) { return IsModePattern(r.kind); }},
};

struct T_IN_MODEL {
    const T_MODEL& model;
    const T_POLC_PATTERN& row;
};
constexpr int kStatic = 0;
constexpr T_RECORD_RULE<T_IN_MODEL> kModelRules[] = {
    {{.message = "IDS_QM_UI_POLC_NO_MODE"},
     [](const T_IN_MODEL& r) { return r.model.modes.contains(r.row.number); },
     [](const T_IN_MODEL& r) { return IsModePattern(r.row.kind) && !r.model.modes.empty(); }},
    {{.message = "IDS_QM_UI_POLC_NO_CASE"},
     [](const T_IN_MODEL& r) { return r.model.loadCases.contains(r.row.number); },
     [](const T_IN_MODEL& r) { return r.row.kind == kStatic && !r.model.loadCases.empty(); }},
};

struct T_ROW_PLACE {
    const T_POLC_PATTERN& row;
    std::span<const T_POLC_PATTERN> before;
};
constexpr T_RECORD_RULE<T_ROW_PLACE> kPlaceRules[] = {
    {{.message = "IDS_PUSHOVER_The_Load_Pattern_of_Mode_Shape_can_hav"},
     [](const T_ROW_PLACE& p) { return p.before.empty(); },
     [](const T_ROW_PLACE& p) { return IsModePattern(p.row.kind); }},
    // The number alone counts, whatever the kinds of the rows: this is meant.
    {{.message = "IDS_PUSHOVER_Error___The_data_already_exist_"},
     [](const T_ROW_PLACE& p) {
         return std::ranges::none_of(
             p.before, [&](const T_POLC_PATTERN& r) { return r.number == p.row.number; });
     }},
};

} // namespace

void TakeMasterPattern(T_POLC_D& record)
{
    if (record.patterns.empty()) return;
    record.patternKind = record.patterns.front().kind;
    record.modes.clear();
    for (const T_POLC_PATTERN& row : record.patterns)
        if (IsModePattern(row.kind)) record.modes.push_back(row.number);
}

std::vector<T_FINDING> LoadCaseFindings(const T_POLC_D& record, const T_MODEL& model, int key)
{
    const T_POLC_CONTROL none;
    std::vector<T_FINDING> out;
    WalkRules(kRules, {record, record.control ? *record.control : none, model, key}, {}, out);
    for (T_FINDING& f : out)
        if (f.messageKey == kAngle) f.ruleText = f.text += " >0"; // "%s >0"
    if (!record.initialLoads) return out;
    const auto loads = InitialLoadFindings(*record.initialLoads, model);
    out.insert(out.end(), loads.begin(), loads.end());
    return out;
}

const char* LoadCaseFault(const T_POLC_D& record, const T_MODEL& model, std::string_view caseKey)
{
    const T_POLC_CONTROL none;
    return FaultOf<C>(kRules, {record, record.control ? *record.control : none, model, 0}, caseKey);
}

bool IsOnTheWay(const T_POLC_D& record, double displacement)
{
    if (!std::isfinite(displacement) || displacement == 0.0) return false;
    if (!record.control || record.control->incrementMethod != kDisplacementControl ||
        !record.control->masterNodeControl)
        return true;
    const double share = displacement / record.control->masterMaxDispl;
    return share > 0.0 && share <= 1.0;
}

std::vector<T_FINDING> PatternRowFindings(const T_POLC_PATTERN& row, const std::string& prefix)
{
    std::vector<T_FINDING> out;
    WalkRules(kRowRules, row, {.prefix = prefix}, out);
    return out;
}

std::vector<T_FINDING> PatternPlaceFindings(const T_POLC_PATTERN& row,
                                            std::span<const T_POLC_PATTERN> before,
                                            const std::string& prefix)
{
    std::vector<T_FINDING> out;
    WalkRules(kPlaceRules, {row, before}, {.prefix = prefix}, out);
    return out;
}

std::vector<T_FINDING> PatternFindings(std::span<const T_POLC_PATTERN> rows)
{
    std::vector<T_FINDING> out;
    for (std::size_t i = 0; i < rows.size(); ++i) {
        for (const auto& found : {PatternRowFindings(rows[i], PatternField(i)),
                                  PatternPlaceFindings(rows[i], rows.first(i), PatternField(i))})
            out.insert(out.end(), found.begin(), found.end());
    }
    return out;
}

std::vector<T_FINDING> PatternDocFindings(const T_MODEL& model,
                                          std::span<const T_POLC_PATTERN> rows)
{
    std::vector<T_FINDING> out;
    for (std::size_t i = 0; i < rows.size(); ++i)
        WalkRules(kModelRules, {model, rows[i]}, {.prefix = PatternField(i)}, out);
    return out;
}

std::string PatternField(std::size_t row)
{
    return "patterns[" + std::to_string(row) + "]";
}
