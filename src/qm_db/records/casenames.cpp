#include "qm_db/records/casenames.h"

const std::string* CCaseNames::NameOf(RECORD_KIND kind, int key) const
{
    const std::string* name = nullptr;
    WithKind(kind, [&]<class R>(const T_RECORD_ROW<R>& row) {
        if constexpr (kHasName<R>) {
            const T_TABLE<R>& table = m_model.*row.table;
            if (const auto it = table.find(key); it != table.end()) name = &it->second.name;
        }
    });
    return name;
}

bool CCaseNames::HasKey(RECORD_KIND kind, int key) const
{
    bool has = false;
    WithKind(kind, [&](const auto& row) { has = (m_model.*row.table).contains(key); });
    return has;
}

std::optional<int> CCaseNames::KeyOf(RECORD_KIND kind, const std::string& name) const
{
    const auto keys = m_keys.find(kind);
    if (keys == m_keys.end()) return std::nullopt;
    const auto it = keys->second.find(name);
    return it == keys->second.end() ? std::nullopt : std::optional(it->second);
}
