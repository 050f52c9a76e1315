#include "qm_db/records/casenames.h"

namespace {

template <class T>
const std::string* NameIn(const T_TABLE<T>& table, int key)
{
    const auto it = table.find(key);
    return it == table.end() ? nullptr : &it->second.name;
}

} // namespace

const std::string* CCaseNames::NameOf(CASE_REF kind, int key) const
{
    switch (kind) {
    case CASE_REF::Material:
        return NameIn(m_model.materials, key);
    case CASE_REF::Section:
        return NameIn(m_model.sections, key);
    case CASE_REF::LoadCase:
        return NameIn(m_model.loadCases, key);
    case CASE_REF::Combination:
        return NameIn(m_model.combinations, key);
    case CASE_REF::Stage:
        return NameIn(m_model.stages, key);
    }
    return nullptr;
}

std::optional<int> CCaseNames::KeyOf(CASE_REF kind, const std::string& name) const
{
    const T_KEYS& keys = m_keys[static_cast<std::size_t>(kind)];
    const auto it = keys.find(name);
    return it == keys.end() ? std::nullopt : std::optional(it->second);
}
