// Prints a table of records with names and keys into a case file.
#pragma once

#include "qm_db/casefile/caseput.h"
#include "qm_db/casefile/casewriter.h"

#include <set>

template <class R>
constexpr bool kWritesName = requires(R& r)
{
    r.name;
};

/// Records that stand on one line.
template <class R>
constexpr bool kIsSmall = std::is_same_v<R, T_ELEM_D> || std::is_same_v<R, T_MATL_D> ||
                          std::is_same_v<R, T_EQDS_D> || std::is_same_v<R, T_ULFC_D>;

/// Prints a table, or nothing when it is empty. Keys are stated where they do not run 1, 2, 3, ...
/// With `names` the references are names.
template <class R>
void WriteTable(CJsonWriter& out, const CCaseNames* names, const char* member,
                const T_TABLE<R>& table)
{
    if (table.empty()) return;
    out.Key(member);
    out.BeginArray();
    int next = 1;
    std::set<std::string> taken;
    for (const auto& [key, record] : table) {
        out.BeginObject(kIsSmall<R>);
        if (key != next && !std::is_same_v<R, T_ELEM_D>) out.Member("key", key);
        next = key + 1;
        if constexpr (kWritesName<R>) {
            out.Member("name", record.name);
            if (record.name.empty()) out.Fail("a name can't be empty");
            if (!taken.insert(record.name).second) out.Fail("the name appears twice");
        }
        CCasePut put(out, names);
        CaseFields(put, record);
        out.EndObject();
    }
    out.EndArray();
}
