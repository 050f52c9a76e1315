#include "qm_rps/po_loadcasedlg.h"

#include "qm_base/appbase.h"
#include "qm_base/msgfunction.h"
#include "qm_base/ruletable.h"

#include <algorithm>
#include <cmath>
#include <limits>

using zql::lib::MMSGFunction;

namespace {

struct T_CHECK {
    const T_POLC_D& data;
    const T_POLC_CONTROL& c;
    const std::function<bool(int)>& hasFunction;
};
using C = T_CHECK;
constexpr int kDisplacementControl = 1;
constexpr int kFollowsFunction = 2;
constexpr const char* kZeroFactor = "IDS_PUSHOVER_the_Scale_Factor_can_not_be_zero";
constexpr const char* kZeroMode = "IDS_PUSHOVER_Error___Mode_must_be_greater_than_0";
constexpr const char* kModeNotFirst = "IDS_PUSHOVER_The_Load_Pattern_of_Mode_Shape_can_hav";
constexpr const char* kExists = "IDS_PUSHOVER_Error___The_data_already_exist_";
constexpr const char* kAngle = "IDS_PUSHOVER_STATIC_ANGLE_GEN";

bool Controlled(const C& c)
{
    return c.data.control.has_value();
}
bool ByForce(const C& c)
{
    return Controlled(c) && c.c.incrementMethod != kDisplacementControl;
}
bool ByDispl(const C& c)
{
    return Controlled(c) && c.c.incrementMethod == kDisplacementControl;
}
bool ByMaster(const C& c)
{
    return ByDispl(c) && c.c.masterNodeControl;
}
bool ByMaxDispl(const C& c)
{
    return ByDispl(c) && !c.c.masterNodeControl;
}

// clang-format off
const T_RULE<C> kRules[] = {
    {{.message = "IDS_PUSHOVER_Error___Loadcase_name_is_not_input_", .field = "name"}, [](const C& c) { return !c.data.name.empty(); }},
    {{.message = "IDS_RPS_PO_Error_No_Increment_Function", .field = "control.incrementFunction"},
     [](const C& c) { return c.hasFunction && c.hasFunction(c.c.incrementFunction); },
     [](const C& c) { return ByForce(c) && c.c.incrementOption == kFollowsFunction; }},
    {{.message = "IDS_RPS_PO_POLC_Current_Stif_Ratio_0", .field = "control.stiffnessRatioLimit"}, [](const C& c) { return NotAbove(0, c.c.stiffnessRatioLimit); }, ByForce},
    {{.message = kAngle, .field = "control.staticAngle"}, [](const C& c) { return Below(0, c.c.staticAngle); },
     [](const C& c) { return ByForce(c) && c.c.generateStaticAngle; }},
    // exactly 0 alone is refused: the sign gives the direction of the push
    {{.message = "IDS_PUSHOVER_Error___Master_Max_Displ__must_be_grea", .field = "control.masterMaxDispl"},
     [](const C& c) { return std::isfinite(c.c.masterMaxDispl) && c.c.masterMaxDispl != 0.0; }, ByMaster},
    {{.message = "IDS_PUSHOVER_Error___Max__Translational_Displ__must", .field = "control.maxTransDispl"}, [](const C& c) { return Below(0, c.c.maxTransDispl); }, ByMaxDispl},
};
// clang-format on

bool IsMode(int kind)
{
    return kind == 2 || kind == 3;
}
bool ValidFactor(double f)
{
    return std::isfinite(f) && f != 0.0;
}

/// The typed mode number truncated, or 0.
int ModeOf(double typed)
{
    constexpr double most = std::numeric_limits<int>::max();
    return typed >= 1.0 && typed <= most ? static_cast<int>(typed) : 0;
}

bool HasNumber(std::span<const T_POLC_PATTERN> rows, int number)
{
    // The number alone counts, whatever the kinds of the rows: this is meant.
    return std::any_of(rows.begin(), rows.end(),
                       [&](const T_POLC_PATTERN& r) { return r.number == number; });
}

} // namespace

CPO_LoadCaseDlg::CPO_LoadCaseDlg()
    : m_hasIncrementFunction([this](int key) {
          return Doc() && Doc()->Data().Model().incrementFunctions.contains(key);
      })
{
}

CPO_LoadCaseDlg::CPO_LoadCaseDlg(std::function<bool(int)> hasIncrementFunction)
    : m_hasIncrementFunction(std::move(hasIncrementFunction))
{
}

void CPO_LoadCaseDlg::Data2Dlg(const T_POLC_D& data)
{
    m_case = data;
    m_selected = -1;
    m_patternsEdited = false;
}

int CPO_LoadCaseDlg::Dlg2Data(T_POLC_D& data)
{
    if (!CheckData()) return 0;
    T_POLC_D result = m_case;
    if (m_patternsEdited && !result.patterns.empty()) {
        result.patternKind = result.patterns.front().kind;
        result.modes.clear();
        for (const T_POLC_PATTERN& r : result.patterns)
            if (IsMode(r.kind)) result.modes.push_back(r.number);
    }
    data = std::move(result);
    return 1;
}

std::vector<T_FINDING> CPO_LoadCaseDlg::Findings() const
{
    const T_POLC_CONTROL none;
    const T_CHECK check{m_case, m_case.control ? *m_case.control : none, m_hasIncrementFunction};
    std::vector<T_FINDING> out;
    WalkRules(kRules, check, {}, out);
    for (T_FINDING& f : out)
        if (f.messageKey == kAngle) f.ruleText = f.text += " >0"; // "%s >0"
    if (Doc()) DocFindings(out);
    return out;
}

std::vector<T_FINDING> CPO_LoadCaseDlg::PatternFindings(const std::vector<T_POLC_PATTERN>& rows)
{
    std::vector<T_FINDING> out;
    for (std::size_t i = 0; i < rows.size(); ++i) {
        const T_POLC_PATTERN& r = rows[i];
        const std::string field = "patterns[" + std::to_string(i) + "]";
        const auto report = [&](bool wrong, const char* key) {
            if (wrong) out.push_back(FindingOf({.message = key, .field = field.c_str()}, {}));
        };
        report(!ValidFactor(r.factor), kZeroFactor);
        report(IsMode(r.kind) && r.number <= 0, kZeroMode);
        report(IsMode(r.kind) && i > 0, kModeNotFirst);
        report(HasNumber(std::span(rows).first(i), r.number), kExists);
    }
    return out;
}

int CPO_LoadCaseDlg::CheckPattern(const T_PATTERN_INPUT& input, T_POLC_PATTERN& row)
{
    if (!ValidFactor(input.factor)) {
        ShowMessage(kZeroFactor);
        return 0;
    }
    T_POLC_PATTERN r{input.kind, 0, input.factor};
    if (input.kind == 0) {
        r.number = input.loadCase;
    } else if (input.kind == 1) {
        r.number = input.directionIndex + 1;
    } else if (IsMode(input.kind)) {
        r.number = ModeOf(input.mode);
        if (r.number == 0) {
            ShowMessage(kZeroMode);
            return 0;
        }
    } else if (CAppBase::IsReleaseAssert_ST()) {
        CAppBase::ReleaseAssertion_ST("src/qm_rps/po_loadcasedlg", __LINE__);
    }
    row = r;
    return 1;
}

int CPO_LoadCaseDlg::OnAddPattern(const T_PATTERN_INPUT& input)
{
    T_POLC_PATTERN row;
    if (!CheckPattern(input, row)) return 0;
    if (IsMode(row.kind) && !m_case.patterns.empty()) {
        ShowMessage(kModeNotFirst);
        return 0;
    }
    if (HasNumber(m_case.patterns, row.number)) {
        ShowMessage(kExists);
        return 0;
    }
    m_case.patterns.push_back(row);
    m_selected = static_cast<int>(m_case.patterns.size()) - 1;
    m_patternsEdited = true;
    return 1;
}

int CPO_LoadCaseDlg::OnModifyPattern(const T_PATTERN_INPUT& input)
{
    T_POLC_PATTERN row;
    if (!HasSelection() || !CheckPattern(input, row)) return 0;
    m_case.patterns[static_cast<std::size_t>(m_selected)] = row;
    m_patternsEdited = true;
    return 1;
}

int CPO_LoadCaseDlg::OnDeletePattern()
{
    if (!HasSelection()) return 0;
    m_case.patterns.erase(m_case.patterns.begin() + m_selected);
    m_selected = -1;
    m_patternsEdited = true;
    return 1;
}

bool CPO_LoadCaseDlg::HasSelection() const
{
    return m_selected >= 0 && m_selected < static_cast<int>(m_case.patterns.size());
}
