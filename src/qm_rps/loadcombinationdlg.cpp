#include "qm_rps/loadcombinationdlg.h"

#include "qm_base/msgfunction.h"
#include "qm_base/textformat.h"
#include "qm_db/editscope.h"
#include "qm_rps/factors/checks/ulfcombinationchecks.h"

#include <algorithm>

using zql::lib::MMSGFunction;

namespace {

bool Same(const T_LCOM_ITEM& a, const T_LCOM_ITEM& b)
{
    return a.combination == b.combination && a.key == b.key;
}

} // namespace

CLoadCombinationDlg::CLoadCombinationDlg(CDBDoc& doc, int key) : m_doc(doc)
{
    if (m_doc.Attr().GetLcom(key, m_combination)) m_key = key;
}

std::vector<CLoadCombinationDlg::T_PART> CLoadCombinationDlg::Parts() const
{
    const T_MODEL& model = m_doc.Data().Model();
    std::vector<T_PART> parts;
    for (const auto& [key, record] : model.loadCases)
        parts.push_back({{false, key, 1.0}, record.name});
    for (const auto& [key, record] : model.combinations)
        if (key != m_key)
            parts.push_back(
                {{true, key, 1.0}, MMSGFunction::Format("IDS_QM_UI_LCOM_OTHER", {record.name})});
    return parts;
}

std::vector<std::string> CLoadCombinationDlg::PartTexts() const
{
    std::vector<std::string> texts;
    for (T_PART& part : Parts())
        texts.push_back(std::move(part.text));
    return texts;
}

std::string CLoadCombinationDlg::CellText(std::size_t row, COLUMN column) const
{
    if (row >= m_combination.items.size()) return {};
    const T_LCOM_ITEM& item = m_combination.items[row];
    if (column == Factor) return ShortestText(item.factor);
    for (const T_PART& part : Parts())
        if (Same(part.item, item)) return part.text;
    return {};
}

int CLoadCombinationDlg::SetCell(std::size_t row, COLUMN column, const std::string& text)
{
    if (row >= m_combination.items.size()) return 0;
    T_LCOM_ITEM& item = m_combination.items[row];
    if (column == Factor) {
        const std::optional<double> number = ParseFinite(text);
        if (number) item.factor = *number;
        return number ? 1 : 0;
    }
    for (const T_PART& part : Parts()) {
        if (part.text != text) continue;
        item.combination = part.item.combination;
        item.key = part.item.key;
        return 1;
    }
    return 0;
}

void CLoadCombinationDlg::OnAddRow()
{
    const std::vector<T_PART> parts = Parts();
    if (parts.empty()) return;
    const auto isFree = [&](const T_PART& part) {
        return std::ranges::none_of(m_combination.items,
                                    [&](const T_LCOM_ITEM& item) { return Same(item, part.item); });
    };
    const auto it = std::ranges::find_if(parts, isFree);
    m_combination.items.push_back(it == parts.end() ? parts.front().item : it->item);
}

int CLoadCombinationDlg::OnDeleteRow(std::size_t row)
{
    if (row >= m_combination.items.size()) return 0;
    m_combination.items.erase(m_combination.items.begin() + static_cast<std::ptrdiff_t>(row));
    return 1;
}

std::string CLoadCombinationDlg::FlatText() const
{
    T_LCOM_D flat;
    std::string error, text;
    if (!m_doc.Attr().NormalizeLcom(m_combination, flat, error)) return error;
    for (const T_LCOM_ITEM& item : flat.items) {
        const auto it = m_doc.Data().Model().loadCases.find(item.key);
        text += (text.empty() ? "" : " + ") + FormatText("%.6g ", item.factor) +
                (it == m_doc.Data().Model().loadCases.end() ? "" : it->second.name);
    }
    return text;
}

std::vector<T_FINDING> CLoadCombinationDlg::Findings() const
{
    return CheckCombination(m_combination, m_key, m_doc.Data());
}

int CLoadCombinationDlg::OnOK()
{
    if (!CheckData()) return 0;
    const int key = m_key ? m_key : NextKey(m_doc.Data().Model().combinations);
    {
        CEditScope edit(m_doc, m_combination.name);
        if (!edit.IsOpen()) return 0;
        if (edit.Put(key, m_combination) && edit.Commit()) {
            m_key = key;
            return 1;
        }
    }
    // What the check could not see: another combination contains this one.
    constexpr const char* kCycle = "IDS_QM_DB_LCOM_CYCLE";
    ShowMessage(kCycle, MMSGFunction::Format(kCycle, {m_combination.name}));
    return 0;
}
