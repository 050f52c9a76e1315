// Names of new records.
#pragma once

#include "qm_base/say.h"
#include "qm_db/records.h"

#include <algorithm>

/// "New 3", a name that no record of the table has.
template <class R>
std::string FreeName(const T_TABLE<R>& table, int key)
{
    for (int i = key;; ++i) {
        const std::string name = Say("IDS_QM_UI_NEW_NAME", std::to_string(i));
        const auto has = [&](const auto& entry) { return entry.second.name == name; };
        if (std::none_of(table.begin(), table.end(), has)) return name;
    }
}
