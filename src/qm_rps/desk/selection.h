// What is chosen and what is hidden in the windows of one document: one for view, tree, grid and
// properties.
#pragma once

#include "qm_rps/desk/recordgrid.h"

#include <functional>
#include <map>
#include <set>

/// Records by table and key (ids of nodes and elements); those of several tables can be chosen at
/// once. Who watches is told after every change.
class CSelection {
public:
    using T_KEYS = std::set<int>;

    /// The keys of the table, none where nothing of it is chosen.
    const T_KEYS& Chosen(EXPLORER_TABLE table) const;
    bool IsEmpty() const { return m_chosen.empty(); }
    /// Only these are chosen afterwards.
    void Choose(EXPLORER_TABLE table, T_KEYS keys);
    /// The others stay chosen.
    void Add(EXPLORER_TABLE table, const T_KEYS& keys);
    /// Chosen ones are no longer, others are; the others stay.
    void Toggle(EXPLORER_TABLE table, const T_KEYS& keys);
    void Clear();

    /// Elements that are not drawn.
    const T_KEYS& Hidden() const { return m_hidden; }
    void Hide(const T_KEYS& elements);
    /// All others of the model are hidden.
    void ShowOnly(const T_MODEL& model, const T_KEYS& elements);
    void ShowAll();

    /// Drops what the model does not have any more.
    void KeepExisting(const CDBDoc& doc);

    using WATCH_FN = std::function<void()>;
    /// `watcher` is the key to stop with; one watches once.
    void Watch(const void* watcher, WATCH_FN told);
    void Unwatch(const void* watcher);

private:
    void Tell();

    std::map<EXPLORER_TABLE, T_KEYS> m_chosen; // without empty sets
    T_KEYS m_hidden;
    std::map<const void*, WATCH_FN> m_watchers;
};
