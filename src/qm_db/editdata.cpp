#include "qm_db/editdata.h"

#include <ranges>
#include <set>
#include <utility>

int CEditData::Begin(std::string title)
{
    if (m_open) return 0;
    m_step = {std::move(title), {}};
    m_open = true;
    return 1;
}

int CEditData::Commit()
{
    if (!m_open) return 0;
    m_open = false;
    if (!m_step.changes.empty()) m_undo.Push(std::exchange(m_step, {}));
    return 1;
}

void CEditData::Rollback()
{
    if (!m_open) return;
    m_open = false;
    T_MODEL& model = m_data.ModelForEdit();
    for (const T_CHANGE_ANY& change : m_step.changes | std::views::reverse)
        CUndoCtrl::Apply(model, change, false);
    m_step = {};
}

int CEditData::PutStyp(T_STYP_D styp)
{
    if (!m_open) return 0;
    RecordToSi(styp, styp.units);
    return Record(T_CHANGE<T_STYP_D>{0, std::make_shared<const T_STYP_D>(m_data.Model().styp),
                                     std::make_shared<const T_STYP_D>(std::move(styp))});
}

int CEditData::ErasePhgt(int key, std::vector<int>& users)
{
    users = ElementsWithHingeType(m_data.Model(), key);
    return users.empty() ? Erase<T_PHGT_D>(key) : 0;
}

bool CEditData::ContainsItself(int key, const T_LCOM_D& record) const
{
    const auto& table = m_data.Model().combinations;
    std::set<int> seen;
    std::vector<const T_LCOM_D*> open{&record};
    while (!open.empty()) {
        const T_LCOM_D& at = *open.back();
        open.pop_back();
        for (const T_LCOM_ITEM& item : at.items) {
            if (!item.combination) continue;
            if (item.key == key) return true;
            const auto it = table.find(item.key);
            if (it != table.end() && seen.insert(item.key).second) open.push_back(&it->second);
        }
    }
    return false;
}

int CEditData::Record(T_CHANGE_ANY change)
{
    CUndoCtrl::Apply(m_data.ModelForEdit(), change, true);
    m_step.changes.push_back(std::move(change));
    return 1;
}
