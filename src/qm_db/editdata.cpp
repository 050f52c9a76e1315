#include "qm_db/editdata.h"

#include "qm_db/records/pushnames.h"

#include <algorithm>
#include <cmath>
#include <ranges>
#include <set>
#include <utility>

int CEditData::Begin(std::string title)
{
    if (m_open || m_data.IsLocked()) return 0;
    m_step = {std::move(title), {}};
    m_open = true;
    m_wasModified = m_data.IsModified();
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
    if (m_step.changes.empty()) return;
    T_MODEL& model = m_data.ModelForEdit();
    for (const T_CHANGE_ANY& change : m_step.changes | std::views::reverse)
        CUndoCtrl::Apply(model, change, false);
    m_data.SetModified(m_wasModified);
    m_step = {};
}

int CEditData::PutStyp(T_STYP_D styp)
{
    if (!m_open) return 0;
    RecordToSi(styp, styp.units);
    return Record(T_CHANGE<T_STYP_D>{0, std::make_shared<const T_STYP_D>(m_data.Model().styp),
                                     std::make_shared<const T_STYP_D>(std::move(styp))});
}

int CEditData::PutPogc(T_POGC_D control)
{
    if (!m_open) return 0;
    return Record(T_CHANGE<T_POGC_D>{0,
                                     std::make_shared<const T_POGC_D>(m_data.Model().pushControl),
                                     std::make_shared<const T_POGC_D>(std::move(control))});
}

int CEditData::RenamePush(int key, const std::string& name)
{
    const T_MODEL& model = m_data.Model();
    const auto it = model.pushovers.find(key);
    if (it == model.pushovers.end() || it->second.name == name) return 1;
    const std::string before = it->second.name;
    for (const auto& [other, stored] : model.evaluations) {
        if (stored.push != before && !IsTurnOf(stored.push, before)) continue;
        T_EVAL_D after = stored;
        after.push = name + stored.push.substr(before.size()); // with its direction
        if (!Change<T_EVAL_D>(other, std::make_shared<const T_EVAL_D>(std::move(after)))) return 0;
    }
    for (const auto& [other, stored] : model.pushovers) {
        if (other == key || before.empty() || stored.initialCase != before) continue;
        T_POLC_D after = stored;
        after.initialCase = name;
        if (!Change<T_POLC_D>(other, std::make_shared<const T_POLC_D>(std::move(after)))) return 0;
    }
    return 1;
}

int CEditData::ErasePhgt(int key, std::vector<int>& users)
{
    users = ElementsWithHingeType(m_data.Model(), key);
    return users.empty() ? Erase<T_PHGT_D>(key) : 0;
}

int CEditData::AddPtns(int loadCase, const T_PTNS_D& pretension)
{
    const T_MODEL& model = m_data.Model();
    const auto record = model.loadCases.find(loadCase);
    const auto element = model.elements.find(pretension.element);
    if (!m_open || record == model.loadCases.end() || element == model.elements.end()) return 0;
    const ELEM_KIND kind = element->second.kind;
    const T_PTNS_D load{pretension.element, ToSi(pretension.force, m_data.Units(), kDimForce)};
    if ((kind != ELEM_KIND::Beam && kind != ELEM_KIND::Truss) || !std::isfinite(load.force))
        return 0;
    T_STLD_D after = record->second;
    auto& all = after.pretension;
    const auto ofElement = [&](const T_PTNS_D& p) { return p.element == load.element; };
    const auto first = std::find_if(all.begin(), all.end(), ofElement);
    if (first == all.end()) {
        all.push_back(load);
    } else {
        *first = load;
        all.erase(std::remove_if(first + 1, all.end(), ofElement), all.end());
    }
    return Change<T_STLD_D>(loadCase, std::make_shared<const T_STLD_D>(std::move(after)));
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
    if (m_data.IsLocked()) return 0;
    CUndoCtrl::Apply(m_data.ModelForEdit(), change, true);
    m_step.changes.push_back(std::move(change));
    return 1;
}
