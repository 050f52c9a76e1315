#include "qm_rps/pushoverincrementfunctiondlg.h"

#include "qm_base/say.h"
#include "qm_db/recordfacts.h"

#include <algorithm>

namespace {

T_FINDING NameFinding(const char* key)
{
    T_FINDING finding;
    finding.field = "name";
    finding.messageKey = key;
    finding.text = Say(key);
    return finding;
}

} // namespace

void CPushOverIncrementFunctionDlg::SetDoc(CDBDoc* doc)
{
    CRPSDlgBase::SetDoc(doc);
    if (!doc) return;
    m_functions = doc->Data().Model().incrementFunctions;
    m_selected = m_functions.empty() ? 0 : m_functions.begin()->first;
}

T_POFC_D* CPushOverIncrementFunctionDlg::Selected()
{
    const auto at = m_functions.find(m_selected);
    return at == m_functions.end() ? nullptr : &at->second;
}

int CPushOverIncrementFunctionDlg::Select(const std::string& name)
{
    const auto at =
        std::ranges::find_if(m_functions, [&](const auto& f) { return f.second.name == name; });
    if (at == m_functions.end()) return 0;
    m_selected = at->first;
    return 1;
}

void CPushOverIncrementFunctionDlg::OnAdd()
{
    T_POFC_D fresh{{}, {1.0}, {1.0}};
    const auto isTaken = [&](const auto& f) { return f.second.name == fresh.name; };
    int number = 1;
    do
        fresh.name = Say("IDS_QM_UI_NEW_NAME", std::to_string(number++));
    while (std::ranges::any_of(m_functions, isTaken));
    // Not the key of one that was taken off here: what names that one must not follow the new one.
    int key = NextKey(m_functions);
    if (Doc()) key = std::max(key, NextKey(Doc()->Data().Model().incrementFunctions));
    m_functions[key] = std::move(fresh);
    m_selected = key;
}

int CPushOverIncrementFunctionDlg::OnDelete()
{
    if (!Selected()) {
        ShowMessage("IDS_QM_UI_POFC_NONE_CHOSEN");
        return 0;
    }
    std::string users;
    if (Doc())
        for (const auto& [key, push] : Doc()->Data().Model().pushovers)
            if (push.control && push.control->incrementFunction == m_selected &&
                push.control->incrementOption == 2)
                users += (users.empty() ? "" : ", ") + push.name;
    if (!users.empty()) {
        constexpr const char* kUsed = "IDS_QM_UI_POFC_USED";
        ShowMessage(kUsed, Say(kUsed, Selected()->name, users));
        return 0;
    }
    m_functions.erase(m_selected);
    m_selected = m_functions.empty() ? 0 : m_functions.begin()->first;
    return 1;
}

std::vector<T_FINDING> CPushOverIncrementFunctionDlg::FindingsOf(int key,
                                                                 const T_POFC_D& function) const
{
    std::vector<T_FINDING> out;
    if (function.name.empty()) out.push_back(NameFinding("IDS_QM_UI_POFC_NO_NAME"));
    for (const auto& [other, record] : m_functions)
        if (other < key && record.name == function.name)
            out.push_back(NameFinding("IDS_QM_UI_POFC_NAME_TAKEN"));
    for (T_FINDING& finding : IncrementFunctionFindings(function))
        out.push_back(std::move(finding));
    for (T_FINDING& finding : out) {
        if (key == m_selected) continue;
        finding.field.clear(); // no field of the chosen one
        finding.text = "\"" + function.name + "\": " + finding.text;
    }
    return out;
}

std::vector<T_FINDING> CPushOverIncrementFunctionDlg::Findings() const
{
    std::vector<T_FINDING> out;
    for (const auto& [key, function] : m_functions)
        for (T_FINDING& finding : FindingsOf(key, function))
            out.push_back(std::move(finding));
    return out;
}

int CPushOverIncrementFunctionDlg::OnOK()
{
    if (!CheckData()) return 0;
    if (!Doc()) return 1;
    const T_TABLE<T_POFC_D> before = Doc()->Data().Model().incrementFunctions;
    if (before == m_functions) return 1;
    return Edit("IDS_QM_UI_POFC_TITLE", [&](CEditScope& edit) {
        for (const auto& [key, function] : before)
            if (!m_functions.contains(key) && !edit.Erase<T_POFC_D>(key)) return false;
        for (const auto& [key, function] : m_functions) {
            const auto at = before.find(key);
            if ((at == before.end() || at->second != function) && !edit.Put(key, function))
                return false;
        }
        return true;
    });
}
