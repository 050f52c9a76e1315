// Reads a table of records out of a case file.
#pragma once

#include "qm_db/casefile/caseget.h"
#include "qm_db/casefile/casereader.h"

#include <limits>

/// The keys of a record's members.
class CKeysOf : public CFieldLook<CKeysOf> {
public:
    template <class T>
    using Ref = const T&;
    void Key(const char* key) { m_keys.emplace_back(key); }
    // Not those of what is inside a member.
    template <class... A>
    void Part(const char* key, const A&...)
    {
        Key(key);
    }
    template <class... A>
    void PartIf(const char* key, const A&...)
    {
        Key(key);
    }
    template <class... A>
    void List(const char* key, const A&...)
    {
        Key(key);
    }
    template <class... A>
    void ListIf(const char* key, const A&...)
    {
        Key(key);
    }
    template <class... A>
    void Group(const char* key, const A&...)
    {
        Key(key);
    }

    std::vector<std::string_view> m_keys;
};

/// Key of the next record: one more than the last, or a higher one that it states.
inline int ReadKey(CJsonReader& item, int last)
{
    constexpr int kLargest = std::numeric_limits<int>::max();
    int key = last < kLargest ? last + 1 : last; // no key is left behind the largest
    item.GetIf("key", key);
    if (key <= last) item.FailAt("key", "IDS_QM_CASE_KEYS_RISE");
    return key;
}

/// One record without its key; `more`: what stands beside its members. References are names, and
/// the rules of a case file hold.
template <class R>
void ReadRecord(CJsonReader& item, const CCaseNames& names, const T_UNITS& units,
                const T_RECORD_ROW<R>& row, std::span<const char* const> more,
                std::set<std::string>& taken, R& record)
{
    // An unknown key is told before anything else, a number out of range after everything.
    constexpr bool kWhole =
        std::is_same_v<R, T_NODE_D> || std::is_same_v<R, T_STOR_D> || std::is_same_v<R, T_EIGV_D>;
    CCaseGet get(item, kWhole ? kSiUnits : units, {}, &names);
    for (const char* const key : more)
        (void)get.Has(key);
    if (row.key == CASE_KEY::Stated) (void)get.Has("key");
    if (kHasName<R>) (void)get.Has("name");
    if constexpr (kWhole) {
        CKeysOf known;
        if (kHasName<R>) known.Key("name");
        CaseFields(known, record);
        item.Keys(known.m_keys);
    }
    CaseFields(get, record);
    get.Finish();
    if constexpr (kHasName<R>) item.GetName("name", record.name, taken);
    if constexpr (kWhole) RecordToSiChecked(item, record, units);
}

/// check(item, key, record) judges what the list of members leaves open.
template <class R, class F>
void ReadTable(CJsonReader& root, const CCaseNames& names, const T_RECORD_ROW<R>& row,
               T_MODEL& model, std::span<const char* const> more, F check)
{
    T_TABLE<R>& table = model.*row.table;
    std::set<std::string> taken;
    const auto read = [&](CJsonReader& item, std::size_t) {
        R record;
        ReadRecord(item, names, model.styp.units, row, more, taken, record);
        const int last = table.empty() ? 0 : table.rbegin()->first;
        int key = 0;
        if constexpr (RowOf<R>().key == CASE_KEY::Member)
            key = record.id;
        else
            key = row.key == CASE_KEY::Stated ? ReadKey(item, last) : last + 1;
        check(item, key, record);
        if (!table.try_emplace(key, std::move(record)).second && row.key == CASE_KEY::Member)
            item.FailAt("id", "IDS_QM_CASE_RECORD_TWICE", Say(row.noun), std::to_string(key));
    };
    if (std::is_same_v<R, T_NODE_D>)
        root.Member(row.member).ForEachItem(read); // a model has nodes
    else
        ForEachRecord(root, row.member, read);
}
