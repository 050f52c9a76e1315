// Names of the records of a table, and texts of the catalogue, for lists of choices.
#pragma once

#include "qm_base/msgfunction.h"
#include "qm_db/records.h"

#include <algorithm>
#include <span>

/// In the order of the keys.
template <class T>
std::vector<std::string> NamesOf(const T_TABLE<T>& table)
{
    std::vector<std::string> names;
    for (const auto& [key, record] : table)
        names.push_back(record.name);
    return names;
}

/// Texts of catalogue keys.
inline std::vector<std::string> TextsOf(std::span<const char* const> keys)
{
    std::vector<std::string> texts;
    for (const char* const key : keys)
        texts.push_back(zql::lib::MMSGFunction::GetValue(key));
    return texts;
}

inline bool Contains(const std::vector<std::string>& names, const std::string& name)
{
    return std::ranges::find(names, name) != names.end();
}

/// The value where it is a name of the list, or else the first one; "" of an empty list.
inline void TakeOneOf(const std::vector<std::string>& names, std::string& value)
{
    if (!Contains(names, value)) value = names.empty() ? std::string() : names.front();
}
