// Names by which records of a case file refer to each other, and what they may refer to.
#pragma once

#include "qm_db/records.h"

#include <array>
#include <map>
#include <optional>
#include <string>

enum class CASE_REF { Material, Section, LoadCase, Combination, Stage };
inline constexpr std::array<const char*, 5> kCaseRefNames{"material", "section", "load case",
                                                          "combination", "stage"};

class CCaseNames {
public:
    explicit CCaseNames(const T_MODEL& model) : m_model(model) {}

    bool HasNode(int id) const { return m_model.nodes.contains(id); }
    bool HasElement(int id) const { return m_model.elements.contains(id); }
    /// Materials and sections may be referred to by key, as older files do.
    bool HasKey(CASE_REF kind, int key) const { return NameOf(kind, key) != nullptr; }

    /// Name of the record in the model; null when there is none.
    const std::string* NameOf(CASE_REF kind, int key) const;

    /// The key that goes with a name: what has been added, whether it is in the model yet or not.
    void Add(CASE_REF kind, const std::string& name, int key) { Table(kind).emplace(name, key); }
    std::optional<int> KeyOf(CASE_REF kind, const std::string& name) const;

private:
    using T_KEYS = std::map<std::string, int>;
    T_KEYS& Table(CASE_REF kind) { return m_keys[static_cast<std::size_t>(kind)]; }

    const T_MODEL& m_model;
    std::array<T_KEYS, kCaseRefNames.size()> m_keys;
};
