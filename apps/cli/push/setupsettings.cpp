#include "push/setupsettings.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_db/recordfacts.h"

#include <algorithm>
#include <charconv>

namespace {

using E = T_SETUP_EDIT;
using W = SETTING_WORDS;

// Words of every setting that has another state than a value.
constexpr const char* kGlobal = "global"; // as the global control says
constexpr const char* kNone = "none";
constexpr int kFollowsFunction = 2; // increment option
constexpr int kByForce = 0, kByDisplacement = 1;

// ---- one word -----------------------------------------------------------------------------------

std::string Refusal(const char* key, const std::string& word, const std::string& more = {})
{
    return Say(key, word, more);
}

std::string TakeNumber(const std::string& word, double& out)
{
    const std::optional<double> value = ParseFinite(word);
    if (!value) return Refusal("IDS_QM_CLI_SETUP_NUMBER", word);
    out = *value;
    return {};
}

std::string TakeWhole(const std::string& word, int& out)
{
    int value = 0;
    const char* const end = word.data() + word.size();
    const auto read = std::from_chars(word.data(), end, value);
    if (word.empty() || read.ec != std::errc() || read.ptr != end)
        return Refusal("IDS_QM_CLI_SETUP_WHOLE", word);
    out = value;
    return {};
}

std::string TakeIndex(std::span<const char* const> names, const std::string& word, int& out)
{
    std::string all;
    for (std::size_t i = 0; i < names.size(); ++i) {
        if (word == names[i]) {
            out = static_cast<int>(i);
            return {};
        }
        all += (i ? ", " : "") + std::string(names[i]);
    }
    return Refusal("IDS_QM_CLI_SETUP_WORD", word, all);
}

template <class T>
std::string TakeWord(std::span<const char* const> names, const std::string& word, T& out)
{
    int index = 0;
    std::string why = TakeIndex(names, word, index);
    if (why.empty()) out = static_cast<T>(index);
    return why;
}

std::string TakeOnOff(const std::string& word, bool& out)
{
    constexpr const char* kOffOn[] = {"off", "on"};
    return TakeWord(kOffOn, word, out);
}

/// A value that the reset word takes back.
template <class T, class TAKE>
std::string TakeUnless(const char* reset, const std::string& word, std::optional<T>& out, TAKE take)
{
    if (word == reset) {
        out.reset();
        return {};
    }
    T value{};
    std::string why = take(word, value);
    if (why.empty()) out = value;
    return why;
}

/// Key of a record by its name, or by its key.
template <class R>
std::string TakeRecord(const T_TABLE<R>& table, const std::string& word, int& out)
{
    for (const auto& [key, record] : table)
        if (record.name == word) {
            out = key;
            return {};
        }
    int key = 0;
    if (!TakeWhole(word, key).empty() || !table.contains(key))
        return Refusal("IDS_QM_CLI_SETUP_NO_RECORD", word);
    out = key;
    return {};
}

/// Numbers; the word "none" alone is an empty list.
bool IsNone(const W& words)
{
    return words.size() == 1 && words[0] == kNone;
}

T_POLC_CONTROL& Control(E& e)
{
    return e.record->control ? *e.record->control : e.record->control.emplace();
}

// ---- lists --------------------------------------------------------------------------------------

std::string TakeInitialLoads(E& e, const W& words)
{
    std::vector<T_PUSH_INITIAL_LOAD> loads;
    if (e.record && words == W{kGlobal}) {
        e.record->initialLoads.reset();
        return {};
    }
    if (!IsNone(words))
        for (const std::string& word : words) {
            T_PUSH_INITIAL_LOAD& load = loads.emplace_back();
            const std::string name = SplitFactor(word, load.factor);
            std::string why = TakeRecord(e.model.loadCases, name, load.loadCase);
            if (!why.empty()) return why;
        }
    if (e.record)
        e.record->initialLoads = std::move(loads);
    else
        e.control.initialLoads = std::move(loads);
    return {};
}

std::string TakeHingeTypes(E& e, const W& words)
{
    std::vector<int> types;
    if (words != W{"all"})
        for (const std::string& word : words) {
            std::string why = TakeRecord(e.model.hingeTypes, word, types.emplace_back());
            if (!why.empty()) return why;
        }
    e.control.hingeTypes = std::move(types);
    return {};
}

std::string TakeAdditional(E& e, const W& words)
{
    std::vector<double> values;
    if (!IsNone(words))
        for (const std::string& word : words) {
            std::string why = TakeNumber(word, values.emplace_back());
            if (!why.empty()) return why;
        }
    e.record->additionalDisplacements = std::move(values);
    return {};
}

/// "KIND:WHAT=FACTOR"
std::string TakePattern(const E& e, const std::string& word, T_POLC_PATTERN& row)
{
    const std::size_t colon = word.find(':');
    if (colon == std::string::npos) return Refusal("IDS_QM_CLI_SETUP_PATTERN", word);
    std::string why = TakeWord(kPatternNames, word.substr(0, colon), row.kind);
    if (!why.empty()) return why;
    const std::string what = SplitFactor(word.substr(colon + 1), row.factor);
    if (row.kind == 0) return TakeRecord(e.model.loadCases, what, row.number);
    if (IsModePattern(row.kind)) return TakeWhole(what, row.number);
    why = TakeIndex(std::span(kDirectionNames).first(3), what, row.number);
    ++row.number;
    return why;
}

std::string TakePatterns(E& e, const W& words)
{
    std::vector<T_POLC_PATTERN> rows;
    if (!IsNone(words))
        for (const std::string& word : words) {
            std::string why = TakePattern(e, word, rows.emplace_back());
            if (!why.empty()) return why;
        }
    const std::vector<T_FINDING> findings = PatternFindings(rows);
    if (!findings.empty()) return findings.front().field + ": " + findings.front().text;
    e.record->patterns = std::move(rows);
    return {};
}

// ---- control of a load case ---------------------------------------------------------------------

std::string TakeMethod(E& e, const W& words)
{
    return TakeWord(kIncrementNames, words[0], Control(e).incrementMethod);
}

std::string TakeTarget(E& e, const W& words)
{
    Control(e).incrementMethod = kByDisplacement;
    Control(e).masterNodeControl = true;
    return TakeNumber(words[0], Control(e).masterMaxDispl);
}

std::string TakeLargest(E& e, const W& words)
{
    Control(e).incrementMethod = kByDisplacement;
    Control(e).masterNodeControl = false;
    return TakeNumber(words[0], Control(e).maxTransDispl);
}

std::string TakeFunction(E& e, const W& words)
{
    Control(e).incrementOption = words[0] == kNone ? 0 : kFollowsFunction;
    if (words[0] == kNone) return {};
    return TakeRecord(e.model.incrementFunctions, words[0], Control(e).incrementFunction);
}

std::string TakeAngle(E& e, const W& words)
{
    Control(e).generateStaticAngle = words[0] != kNone;
    return words[0] == kNone ? std::string() : TakeNumber(words[0], Control(e).staticAngle);
}

std::string TakeFollows(E& e, const W& words)
{
    constexpr const char* kNames[] = {"named", "largest"};
    std::string why = TakeIndex(kNames, words[0], e.record->controlOption);
    ++e.record->controlOption;
    return why;
}

std::string TakePDelta(E& e, const W& words)
{
    const auto take = [](const std::string& word, PUSH_P_DELTA& out) {
        return TakeWord(kPDeltaNames, word, out);
    };
    return e.record ? TakeUnless(kGlobal, words[0], e.record->pDelta, take)
                    : take(words[0], e.control.pDelta);
}

std::string TakeFailure(E& e, const W& words)
{
    const auto take = [](const std::string& word, PUSH_FAILURE& out) {
        return TakeWord(kPushFailureNames, word, out);
    };
    return e.record ? TakeUnless(kGlobal, words[0], e.record->onFailure, take)
                    : take(words[0], e.control.onFailure);
}

std::string TakeState(E& e, const W& words)
{
    return TakeUnless(kNone, words[0], e.record->stops.state,
                      [](const std::string& word, PUSH_STATE_STOP& out) {
                          return TakeWord(kStateStopNames, word, out);
                      });
}

using S = SETTING_SCOPE;
// In the order in which they are taken: the record's type before what depends on it.
constexpr T_SETTING kSettings[] = {
    {"--initial-loads", S::Both, true, "IDS_QM_HELP_SETUP_INITIAL", TakeInitialLoads},
    {"--p-delta", S::Both, false, "IDS_QM_HELP_SETUP_P_DELTA", TakePDelta},
    {"--steps", S::Both, false, "IDS_QM_HELP_SETUP_STEPS",
     [](E& e, const W& w) {
         return e.record ? TakeUnless(kGlobal, w[0], e.record->steps, TakeWhole)
                         : TakeWhole(w[0], e.control.steps);
     }},
    {"--on-failure", S::Both, false, "IDS_QM_HELP_SETUP_FAILURE", TakeFailure},
    {"--flow", S::Global, false, "IDS_QM_HELP_SETUP_FLOW",
     [](E& e, const W& w) { return TakeWord(kPushFlowNames, w[0], e.control.flow); }},
    {"--hinge-types", S::Global, true, "IDS_QM_HELP_SETUP_TYPES", TakeHingeTypes},
    {"--most-events", S::Global, false, "IDS_QM_HELP_SETUP_EVENTS",
     [](E& e, const W& w) { return TakeWhole(w[0], e.control.mostEvents); }},
    {"--most-steps", S::Global, false, "IDS_QM_HELP_SETUP_MOST_STEPS",
     [](E& e, const W& w) { return TakeWhole(w[0], e.control.mostSteps); }},
    {"--rename", S::Case, false, "IDS_QM_HELP_SETUP_RENAME",
     [](E& e, const W& w) {
         e.record->name = w[0];
         return std::string();
     }},
    {"--control-node", S::Case, false, "IDS_QM_HELP_SETUP_NODE",
     [](E& e, const W& w) { return TakeWhole(w[0], e.record->controlNode); }},
    {"--direction", S::Case, false, "IDS_QM_HELP_SETUP_DIRECTION",
     [](E& e, const W& w) {
         int index = e.record->direction - 1;
         std::string why = TakeIndex(kDirectionNames, w[0], index);
         e.record->direction = index + 1;
         return why;
     }},
    {"--follow", S::Case, false, "IDS_QM_HELP_SETUP_FOLLOW", TakeFollows},
    {"--patterns", S::Case, true, "IDS_QM_HELP_SETUP_PATTERNS", TakePatterns},
    {"--eccentricity", S::Case, false, "IDS_QM_HELP_SETUP_ECCENTRICITY",
     [](E& e, const W& w) { return TakeNumber(w[0], e.record->eccentricity); }},
    {"--method", S::Case, false, "IDS_QM_HELP_SETUP_METHOD", TakeMethod},
    {"--target", S::Case, false, "IDS_QM_HELP_SETUP_TARGET", TakeTarget},
    {"--largest", S::Case, false, "IDS_QM_HELP_SETUP_LARGEST", TakeLargest},
    {"--function", S::Case, false, "IDS_QM_HELP_SETUP_FUNCTION", TakeFunction},
    {"--stiffness-ratio", S::Case, false, "IDS_QM_HELP_SETUP_RATIO",
     [](E& e, const W& w) { return TakeNumber(w[0], Control(e).stiffnessRatioLimit); }},
    {"--angle", S::Case, false, "IDS_QM_HELP_SETUP_ANGLE", TakeAngle},
    {"--initial-case", S::Case, false, "IDS_QM_HELP_SETUP_INITIAL_CASE",
     [](E& e, const W& w) {
         e.record->initialCase = w[0] == kNone ? std::string() : w[0];
         return std::string();
     }},
    {"--drift", S::Case, false, "IDS_QM_HELP_SETUP_DRIFT",
     [](E& e, const W& w) { return TakeUnless(kNone, w[0], e.record->stops.drift, TakeNumber); }},
    {"--state", S::Case, false, "IDS_QM_HELP_SETUP_STATE", TakeState},
    {"--fraction-of-peak", S::Case, false, "IDS_QM_HELP_SETUP_PEAK",
     [](E& e, const W& w) {
         return TakeUnless(kNone, w[0], e.record->stops.fractionOfPeak, TakeNumber);
     }},
    {"--additional", S::Case, true, "IDS_QM_HELP_SETUP_ADDITIONAL", TakeAdditional},
    {"--additional-evaluations", S::Case, false, "IDS_QM_HELP_SETUP_EVALUATIONS",
     [](E& e, const W& w) { return TakeOnOff(w[0], e.record->additionalEvaluations); }},
};

/// Settings that contradict each other, or that belong elsewhere; empty: none.
std::string Contradiction(const std::map<std::string, W>& given, const T_SETUP_EDIT& edit)
{
    for (const T_SETTING& s : kSettings) {
        if (!given.contains(s.option)) continue;
        if (edit.record && s.scope == S::Global)
            return Say("IDS_QM_CLI_SETUP_GLOBAL_ONLY", s.option);
        if (!edit.record && s.scope == S::Case) return Say("IDS_QM_CLI_SETUP_CASE_ONLY", s.option);
    }
    const auto has = [&](const char* option) { return given.contains(option); };
    const auto method = given.find("--method");
    const bool byForce = method != given.end() && method->second == W{kIncrementNames[kByForce]};
    const char* const first = byForce ? "--method force" : "--target";
    const char* const second = byForce && has("--target") ? "--target" : "--largest";
    return (byForce || has("--target")) && has(second) ? Say("IDS_QM_CLI_SETUP_BOTH", first, second)
                                                       : std::string();
}

} // namespace

std::string SplitFactor(const std::string& word, double& factor)
{
    const std::size_t at = word.rfind('=');
    factor = 1.0;
    if (at == std::string::npos) return word;
    const std::optional<double> value = ParseFinite(std::string_view(word).substr(at + 1));
    if (!value) return word;
    factor = *value;
    return word.substr(0, at);
}

std::span<const T_SETTING> Settings()
{
    return kSettings;
}

std::string TakeSettings(const std::map<std::string, SETTING_WORDS>& given, T_SETUP_EDIT& edit)
{
    if (std::string why = Contradiction(given, edit); !why.empty()) return why;
    for (const T_SETTING& setting : kSettings) {
        const auto at = given.find(setting.option);
        if (at == given.end()) continue;
        const std::string why = setting.take(edit, at->second);
        if (!why.empty()) return setting.option + std::string(": ") + why;
    }
    return {};
}
