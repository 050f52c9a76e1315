#include "qm_rps/po_loadcasedlg.h"

#include "qm_db/recordfacts.h"
#include "qm_rps/pushover/loadcasedocrules.h"
#include "qm_rps/pushover/releaseassert.h"

#include <limits>

namespace {

constexpr int kLastPatternKind = static_cast<int>(kPatternNames.size()) - 1;

/// The typed mode number truncated, or 0.
int ModeOf(double typed)
{
    constexpr double most = std::numeric_limits<int>::max();
    return typed >= 1.0 && typed <= most ? static_cast<int>(typed) : 0;
}

} // namespace

void CPO_LoadCaseDlg::Data2Dlg(const T_POLC_D& data)
{
    m_case = data;
    m_selected = -1;
    m_patternsEdited = false;
}

void CPO_LoadCaseDlg::TakeCase(T_POLC_D record)
{
    m_patternsEdited = m_patternsEdited || record.patterns != m_case.patterns;
    m_selected = -1;
    m_case = std::move(record);
}

CPO_LoadCaseDlg::START CPO_LoadCaseDlg::Start() const
{
    if (!m_case.initialCase.empty()) return START::OtherCase;
    return m_case.initialLoads ? START::Own : START::Global;
}

void CPO_LoadCaseDlg::SetStart(START start)
{
    if (start == Start()) return;
    const std::vector<std::string> others = OtherCases();
    if (start == START::OtherCase && others.empty()) return;
    m_case.initialCase = start == START::OtherCase ? others.front() : std::string();
    if (start == START::Own)
        m_case.initialLoads = GlobalControl().initialLoads;
    else
        m_case.initialLoads.reset();
}

int CPO_LoadCaseDlg::Dlg2Data(T_POLC_D& data)
{
    if (!CheckData()) return 0;
    T_POLC_D result = m_case;
    if (m_patternsEdited) TakeMasterPattern(result);
    data = std::move(result);
    return 1;
}

std::vector<T_FINDING> CPO_LoadCaseDlg::Findings() const
{
    static const T_MODEL none;
    std::vector<T_FINDING> out =
        LoadCaseFindings(m_case, Doc() ? Doc()->Data().Model() : none, m_key);
    const auto append = [&out](const std::vector<T_FINDING>& found) {
        out.insert(out.end(), found.begin(), found.end());
    };
    if (Doc()) append(LoadCaseDocFindings(*Doc(), m_key, m_case));
    if (Doc() && m_patternsEdited)
        append(PatternDocFindings(Doc()->Data().Model(), m_case.patterns));
    return out;
}

bool CPO_LoadCaseDlg::IsKept(const std::vector<T_FINDING>& findings)
{
    if (findings.empty()) return true;
    ShowMessage(findings.front().messageKey, findings.front().text);
    return false;
}

int CPO_LoadCaseDlg::CheckPattern(const T_PATTERN_INPUT& input, T_POLC_PATTERN& row)
{
    T_POLC_PATTERN r{input.kind, 0, input.factor};
    if (input.kind == 0)
        r.number = input.loadCase;
    else if (input.kind == 1)
        r.number = input.directionIndex + 1;
    else if (IsModePattern(input.kind))
        r.number = ModeOf(input.mode);
    if (!IsKept(PatternRowFindings(r))) return 0;
    if (input.kind < 0 || input.kind > kLastPatternKind)
        ReleaseAssert("src/qm_rps/po_loadcasedlg", __LINE__);
    row = r;
    return 1;
}

int CPO_LoadCaseDlg::OnAddPattern(const T_PATTERN_INPUT& input)
{
    T_POLC_PATTERN row;
    if (!CheckPattern(input, row) || !IsKept(PatternPlaceFindings(row, m_case.patterns))) return 0;
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
