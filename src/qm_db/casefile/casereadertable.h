// Reads a table of records with names and keys out of a case file.
#pragma once

#include "qm_db/casefile/caseget.h"
#include "qm_db/casefile/casereader.h"

template <class R>
constexpr bool kHasName = requires(R& r)
{
    r.name;
};

/// Key of the next record: one more than the last, or a higher one that it states.
inline int NextKey(CJsonReader& item, int last)
{
    int key = last + 1;
    item.GetIf("key", key);
    item.Check("key", key > last, "keys must rise, from 1");
    return key;
}

/// Reads a table. Keys run 1, 2, 3, ... unless a record states a higher one. With `names` the
/// references are names and the rules of a case file hold. check(item, record) judges the rest.
template <class R, class F>
void ReadTable(CJsonReader& root, std::string_view member, const T_UNITS& units,
               const CCaseNames* names, T_TABLE<R>& out, F check)
{
    std::set<std::string> taken;
    ForEachRecord(root, member, [&](CJsonReader& item, std::size_t) {
        R record;
        CCaseGet get(item, units, {"key"}, names);
        if constexpr (kHasName<R>) {
            (void)get.Has("name");
            CaseFields(get, record);
            get.Finish();
            item.GetName("name", record.name, taken);
        } else {
            CaseFields(get, record);
            get.Finish();
        }
        const int key = NextKey(item, out.empty() ? 0 : out.rbegin()->first);
        check(item, record);
        out.insert_or_assign(out.end(), key, std::move(record));
    });
}

constexpr auto kNoReferences = [](CJsonReader&, const auto&) {};

inline void CheckReference(CJsonReader& in, const char* key, bool exists, const char* what)
{
    if (!exists) in.FailAt(key, std::string("there is no such ") + what);
}
