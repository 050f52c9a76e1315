// The load case dialog on a document: which case it edits, what the document asks of it, storing.
#include "qm_base/msgfunction.h"
#include "qm_rps/po_loadcasedlg.h"
#include "qm_rps/push/stopwarnings.h"
#include "qm_rps/pushover/loadcasedocrules.h"

#include <algorithm>

using zql::lib::MMSGFunction;

namespace {

// Kinds of pattern rows.
constexpr int kStatic = 0, kAcceleration = 1;

template <class T>
std::vector<std::string> NamesOf(const T_TABLE<T>& table)
{
    std::vector<std::string> names;
    for (const auto& [key, record] : table)
        names.push_back(std::to_string(key) + " : " + record.name);
    return names;
}

/// The first node of the top storey, else the node at the top.
int TopNode(const T_MODEL& model)
{
    for (auto it = model.storeys.rbegin(); it != model.storeys.rend(); ++it)
        if (!it->second.nodes.empty()) return it->second.nodes.front();
    const auto top =
        std::ranges::max_element(model.nodes, {}, [](const auto& n) { return n.second.xyz[2]; });
    return top == model.nodes.end() ? 0 : top->first;
}

} // namespace

void CPO_LoadCaseDlg::SetDoc(CDBDoc* doc)
{
    CRPSDlgBase::SetDoc(doc);
    if (!doc) return;
    const auto& cases = doc->Data().Model().pushovers;
    (void)SetKey(cases.empty() ? 0 : cases.begin()->first); // there is such one
}

int CPO_LoadCaseDlg::SetKey(int key)
{
    T_POLC_D record;
    if (!Doc()) return 0;
    if (key == 0)
        record = MakeNew(*Doc());
    else if (!Doc()->Attr().GetPolc(key, record))
        return 0;
    m_key = key;
    KeepRead();
    Data2Dlg(record);
    m_input = {};
    const std::vector<int> keys = LoadCaseKeys();
    if (!keys.empty()) m_input.loadCase = keys.front();
    return 1;
}

void CPO_LoadCaseDlg::ExternalSetting(int key)
{
    if (SetKey(key)) RefreshWindow();
}

T_POLC_D CPO_LoadCaseDlg::MakeNew(CDBDoc& doc)
{
    T_POLC_D record;
    int number = 1, taken = 0;
    do
        record.name = MMSGFunction::Format("IDS_QM_UI_NEW_NAME", {std::to_string(number++)});
    while (doc.Attr().FindPolc(record.name, taken));
    record.controlNode = TopNode(doc.Data().Model());
    record.control.emplace();
    return record;
}

int CPO_LoadCaseDlg::NextKey(const CDBDoc& doc)
{
    const T_MODEL_CONTENT& content = doc.Data().Content();
    const auto last = [](const auto& table) { return table.empty() ? 0 : table.rbegin()->first; };
    const int turned =
        content.turnedResults.empty() ? 0 : content.turnedResults.rbegin()->first.first;
    return 1 + std::max({last(content.model.pushovers), last(content.model.poverSteps),
                         last(content.results), turned});
}

bool CPO_LoadCaseDlg::HasResults() const
{
    return Doc() && HasPushResults(*Doc(), m_key);
}

bool CPO_LoadCaseDlg::Store(CEditScope& edit, const T_POLC_D& record)
{
    const int key = m_key != 0 ? m_key : NextKey(*Doc());
    if (!edit.Put(key, record)) return false;
    m_key = key;
    return true;
}

void CPO_LoadCaseDlg::KeepRead()
{
    m_read = m_key == 0 ? T_POLC_D() : Doc()->Data().Model().pushovers.at(m_key);
    m_units = Doc()->Unit().Units();
}

bool CPO_LoadCaseDlg::IsAsRead()
{
    const auto& cases = Doc()->Data().Model().pushovers;
    const auto it = cases.find(m_key);
    if (m_key != 0 && it == cases.end()) {
        ShowMessage("IDS_QM_UI_POLC_GONE");
        return false;
    }
    if (m_units == Doc()->Unit().Units() && (m_key == 0 || it->second == m_read)) return true;
    ShowMessage("IDS_QM_UI_POLC_CHANGED");
    return false;
}

int CPO_LoadCaseDlg::OnOK()
{
    if (!Doc()) return CheckData();
    if (!IsAsRead()) return 0;
    T_POLC_D record;
    if (!Dlg2Data(record)) return 0;
    const int before = m_key;
    if (Edit("IDS_QM_UI_TABLE_PUSHOVERS", [&](CEditScope& edit) { return Store(edit, record); })) {
        KeepRead();
        for (const T_FINDING& warning : StopWarnings(*Doc(), record))
            ShowMessage(warning.messageKey, warning.text);
        return 1;
    }
    m_key = before;
    return 0;
}

void CPO_LoadCaseDlg::SelectPattern(int row)
{
    m_selected = row >= 0 && row < static_cast<int>(m_case.patterns.size()) ? row : -1;
    if (m_selected < 0) return;
    const T_POLC_PATTERN& chosen = m_case.patterns[static_cast<std::size_t>(row)];
    m_input.kind = chosen.kind;
    m_input.factor = chosen.factor;
    if (chosen.kind == kStatic)
        m_input.loadCase = chosen.number;
    else if (chosen.kind == kAcceleration)
        m_input.directionIndex = chosen.number - 1;
    else
        m_input.mode = chosen.number;
}

// ---- texts --------------------------------------------------------------------------------------

std::string CPO_LoadCaseDlg::NumberText(const T_POLC_PATTERN& row) const
{
    const std::string number = std::to_string(row.number);
    if (row.kind == kAcceleration) {
        const auto d = static_cast<std::size_t>(row.number - 1);
        return d < kDirectionNames.size() ? kDirectionNames[d] : number;
    }
    if (row.kind != kStatic) return MMSGFunction::Format("IDS_PUSHOVER_Mode__d", {number});
    T_STLD_D load;
    return Doc() && Doc()->Attr().GetStld(row.number, load) ? number + " : " + load.name : number;
}

std::vector<std::string> CPO_LoadCaseDlg::LoadCaseNames() const
{
    return Doc() ? NamesOf(Doc()->Data().Model().loadCases) : std::vector<std::string>();
}
std::vector<std::string> CPO_LoadCaseDlg::FunctionNames() const
{
    return Doc() ? NamesOf(Doc()->Data().Model().incrementFunctions) : std::vector<std::string>();
}
std::vector<std::string> CPO_LoadCaseDlg::OtherCases() const
{
    std::vector<std::string> names;
    if (Doc())
        for (const auto& [key, record] : Doc()->Data().Model().pushovers)
            if (key != m_key) names.push_back(record.name);
    return names;
}
T_POGC_D CPO_LoadCaseDlg::GlobalControl() const
{
    return Doc() ? Doc()->Data().Model().pushControl : T_POGC_D();
}
std::vector<int> CPO_LoadCaseDlg::LoadCaseKeys() const
{
    return Doc() ? Doc()->Attr().GetStldKeys() : std::vector<int>();
}
std::vector<int> CPO_LoadCaseDlg::FunctionKeys() const
{
    return Doc() ? Doc()->Attr().GetKeys<T_POFC_D>() : std::vector<int>();
}
