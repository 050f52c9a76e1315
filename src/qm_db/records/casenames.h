// Names by which records of a case file refer to each other, and what they may refer to.
#pragma once

#include "qm_db/records/tables.h"

#include <map>
#include <optional>
#include <string>

class CCaseNames {
public:
    explicit CCaseNames(const T_MODEL& model) : m_model(model) {}

    bool HasNode(int id) const { return m_model.nodes.contains(id); }
    bool HasElement(int id) const { return m_model.elements.contains(id); }
    bool HasKey(RECORD_KIND kind, int key) const;

    /// Name of the record in the model; null when there is none.
    const std::string* NameOf(RECORD_KIND kind, int key) const;

    /// The key that goes with a name: what has been added, whether it is in the model yet or not.
    void Add(RECORD_KIND kind, const std::string& name, int key)
    {
        m_keys[kind].emplace(name, key);
    }
    std::optional<int> KeyOf(RECORD_KIND kind, const std::string& name) const;

private:
    const T_MODEL& m_model;
    std::map<RECORD_KIND, std::map<std::string, int>> m_keys;
};
