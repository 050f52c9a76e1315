#include "qm_rps/desk/selection.h"

const CSelection::T_KEYS& CSelection::Chosen(EXPLORER_TABLE table) const
{
    static const T_KEYS kNone;
    const auto it = m_chosen.find(table);
    return it == m_chosen.end() ? kNone : it->second;
}

void CSelection::Choose(EXPLORER_TABLE table, T_KEYS keys)
{
    std::map<EXPLORER_TABLE, T_KEYS> chosen;
    if (!keys.empty()) chosen.emplace(table, std::move(keys));
    if (chosen == m_chosen) return;
    m_chosen = std::move(chosen);
    Tell();
}

void CSelection::Add(EXPLORER_TABLE table, const T_KEYS& keys)
{
    if (keys.empty()) return;
    m_chosen[table].insert(keys.begin(), keys.end());
    Tell();
}

void CSelection::Toggle(EXPLORER_TABLE table, const T_KEYS& keys)
{
    if (keys.empty()) return;
    T_KEYS& chosen = m_chosen[table];
    for (const int key : keys)
        if (chosen.erase(key) == 0) chosen.insert(key);
    if (chosen.empty()) m_chosen.erase(table);
    Tell();
}

void CSelection::Clear()
{
    if (m_chosen.empty()) return;
    m_chosen.clear();
    Tell();
}

void CSelection::Hide(const T_KEYS& elements)
{
    if (elements.empty()) return;
    m_hidden.insert(elements.begin(), elements.end());
    Tell();
}

void CSelection::ShowOnly(const T_MODEL& model, const T_KEYS& elements)
{
    m_hidden.clear();
    for (const auto& [id, element] : model.elements)
        if (!elements.contains(id)) m_hidden.insert(id);
    Tell();
}

void CSelection::ShowAll()
{
    if (m_hidden.empty()) return;
    m_hidden.clear();
    Tell();
}

void CSelection::KeepExisting(const CDBDoc& doc)
{
    bool changed = std::erase_if(m_hidden, [&](int id) {
                       return !doc.Data().Model().elements.contains(id);
                   }) > 0;
    for (auto& [table, keys] : m_chosen)
        changed |= std::erase_if(keys, [&](int key) { return !RecordExists(doc, table, key); }) > 0;
    std::erase_if(m_chosen, [](const auto& entry) { return entry.second.empty(); });
    if (changed) Tell();
}

void CSelection::Watch(const void* watcher, WATCH_FN told)
{
    m_watchers[watcher] = std::move(told);
}

void CSelection::Unwatch(const void* watcher)
{
    m_watchers.erase(watcher);
}

void CSelection::Tell()
{
    const auto watchers = m_watchers; // one may stop while it is told
    for (const auto& [watcher, told] : watchers)
        if (m_watchers.contains(watcher)) told();
}
