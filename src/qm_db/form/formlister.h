// Visitor of CaseFields: the members of a record as rows, those that a case file leaves out too.
// What they hold is read from the record's object (nullptr: it is left out).
#pragma once

#include "qm_db/form/jsontree.h"
#include "qm_db/recordform.h"
#include "qm_db/records/casenames.h"
#include "qm_db/records/hingefields.h"
#include "qm_db/records/pushfields.h"
#include "qm_db/records/pushnames.h"
#include "qm_db/records/stagefields.h"

#include <algorithm>

class CFormLister {
public:
    template <class T>
    using Ref = const T&;
    static constexpr bool kReads = false;
    static constexpr bool kWrites = true; // the members that a case file has of this record

    struct T_SHARED {
        const T_MODEL& model;
        std::size_t mostItems = 0;
        std::vector<T_FIELD_ROW> rows{};
    };
    CFormLister(T_SHARED& shared, const T_JSON* at, std::string place, int depth)
        : m_to(shared), m_at(at), m_place(std::move(place)), m_depth(depth)
    {
    }

    void Name(const std::string&) { Scalar("name", FIELD_KIND::Text, false); }

    // ---- numbers, texts, flags --------------------------------------------------------------

    template <class T>
    void Need(const char* key, const T& value, T_DIM dim = kDimNone)
    {
        Value(key, value, dim, false);
    }
    template <class T>
    void Opt(const char* key, const T& value, const T&, T_DIM dim = kDimNone)
    {
        Value(key, value, dim, true);
    }
    const char* OptOr(const char* key, const char*, double value, double, T_DIM dim)
    {
        Value(key, value, dim, true);
        return key;
    }
    template <class T>
    void OptIf(const char* key, const std::optional<T>& value, T_DIM dim = kDimNone)
    {
        Value(key, value.value_or(T{}), dim, true);
    }
    template <class T>
    void State(const char* key, const T& value)
    {
        Value(key, value, kDimNone, true);
    }
    template <std::size_t N>
    void NeedFixed(const char* key, const std::array<double, N>&, const std::array<T_DIM, N>& dims)
    {
        Fixed(key, dims, false);
    }
    template <std::size_t N>
    void StateFixed(const char* key, const std::array<double, N>&, const std::array<T_DIM, N>& dims)
    {
        Fixed(key, dims, true);
    }
    template <std::size_t N>
    void OptFixed(const char* key, const std::array<double, N>&, const std::array<double, N>&,
                  const std::array<T_DIM, N>& dims)
    {
        Fixed(key, dims, true);
    }
    template <std::size_t N>
    void Padded(const char* key, const std::array<double, N>&, T_DIM dim)
    {
        std::array<T_DIM, N> dims;
        dims.fill(dim);
        Fixed(key, dims, true);
    }
    template <std::size_t N>
    void Pairs(const char* key, const std::array<T_PM_POINT, N>&)
    {
        Group(key, [](CFormLister& pairs) {
            pairs.Fixed("p", std::array<T_DIM, N>{}, false);
            pairs.Fixed("m", std::array<T_DIM, N>{}, false);
        });
    }
    void Texts(const char* key, const std::vector<std::string>&)
    {
        Items(key, {.kind = FIELD_KIND::Text}, true);
    }
    void NodeTable(const char* key, const std::map<int, T_DOF6>& values);

    // ---- choices ----------------------------------------------------------------------------

    template <std::size_t N>
    void Flags(const char* key, const std::array<bool, N>&, const std::array<const char*, N>& names,
               const char*)
    {
        Items(key, {.kind = FIELD_KIND::Choice, .choices = {names.begin(), names.end()}}, true);
    }
    template <int kFirst = 0, class E>
    void Enum(const char* key, const E&, std::span<const char* const> names, const char*)
    {
        Choice(key, names, false);
    }
    template <int kFirst = 0, class E>
    void EnumOpt(const char* key, const E&, const E&, std::span<const char* const> names,
                 const char*)
    {
        Choice(key, names, true);
    }
    template <class T>
    void EnumIf(const char* key, const T&, std::span<const char* const> names, const char*)
    {
        Choice(key, names, true);
    }
    template <class E>
    void Code(const char* key, const E&, std::span<const char* const> names, const char*)
    {
        Choice(key, names, false);
    }
    template <class T>
    void Letter(const char* key, const T&, std::span<const char* const> names, const char*)
    {
        Choice(key, names, false);
    }
    template <class T>
    void LetterIf(const char* key, const T&, std::span<const char* const> names, const char*)
    {
        Choice(key, names, true);
    }
    template <class T>
    void WordIf(const char* key, const T&, std::span<const char* const> names, const char*)
    {
        Choice(key, names, true);
    }
    template <class T>
    void Variant(const char* key, const T&, std::span<const char* const> names, const char*)
    {
        Choice(key, names, false);
    }
    void StageStep(const char* key, int, int)
    {
        T_FIELD_ROW& row = Scalar(key, FIELD_KIND::Text, true);
        row.choices.assign(kStageStepNames.begin(), kStageStepNames.end());
    }

    // ---- references -------------------------------------------------------------------------

    void OptRef(const char* key, int, RECORD_KIND kind) { Named(key, kind, true); }
    void NeedRef(const char* key, int, RECORD_KIND kind) { Named(key, kind, false); }
    void KeyRef(const char* key, int target, RECORD_KIND kind) { Keyed(key, target, kind, false); }
    void OptKeyRef(const char* key, int target, RECORD_KIND kind)
    {
        Keyed(key, target, kind, true);
    }
    void FreeKeyRef(const char* key, int target, RECORD_KIND kind)
    {
        Keyed(key, target, kind, false);
    }
    void Refs(const char* key, const std::vector<int>&, RECORD_KIND kind) { NamedItems(key, kind); }
    void NameRef(const char* key, const std::string&, RECORD_KIND kind) { Named(key, kind, false); }
    void OptNameRef(const char* key, const std::string&, RECORD_KIND kind)
    {
        Named(key, kind, true);
    }
    void NameRefs(const char* key, const std::vector<std::string>&, RECORD_KIND kind)
    {
        NamedItems(key, kind);
    }
    void NodePair(const char* key, int, int, std::size_t count, const char*);
    void Node(const char* key, int) { Id(key, KindOf<T_NODE_D>()); }
    void Element(const char* key, int) { Id(key, KindOf<T_ELEM_D>()); }
    void NodeList(const char* key, const std::vector<int>&) { Ids(key, KindOf<T_NODE_D>(), false); }
    void OptNodes(const char* key, const std::vector<int>&) { Ids(key, KindOf<T_NODE_D>(), true); }
    void OptElements(const char* key, const std::vector<int>&)
    {
        Ids(key, KindOf<T_ELEM_D>(), true);
    }

    // ---- what holds members -----------------------------------------------------------------

    template <class R, class... C>
    void Part(const char* key, const R& r, const C&... context)
    {
        CFormLister part = Open(key, true);
        CaseFields(part, r, context...);
        part.More(r);
    }
    template <class R, class... C>
    void NeedPart(const char* key, const R& r, const C&... context)
    {
        CFormLister part = Open(key, true);
        CaseFields(part, r, context...);
    }
    template <class R, class... C>
    void PartIf(const char* key, const std::optional<R>& r, const C&... context)
    {
        if (r) return Part(key, *r, context...);
        Scalar(key, FIELD_KIND::Group, true).canAdd = true;
    }
    template <class F>
    void Group(const char* key, const F& members)
    {
        CFormLister part = Open(key, true);
        members(part);
    }
    template <class F>
    void NeedGroup(const char* key, const F& members)
    {
        CFormLister part = Open(key, false);
        members(part);
    }
    template <class R, class... C>
    void List(const char* key, const std::vector<R>& all, const C&... context)
    {
        CFormLister list = Open(key, true, FIELD_KIND::List);
        for (std::size_t i = 0; i < std::min(all.size(), m_to.mostItems); ++i) {
            CFormLister item = list.Open(std::to_string(i), true);
            CaseFields(item, all[i], context...);
            item.More(all[i]);
        }
    }
    template <class R, class... C>
    void ListIf(const char* key, const std::optional<std::vector<R>>& all, const C&... context)
    {
        List(key, all.value_or(std::vector<R>{}), context...);
    }

    /// Members that stand in place of others, which a case file of this record does not have.
    template <class R>
    void More(const R&)
    {
    }
    void More(const T_LCOM_ITEM& item);
    void More(const T_ULFC_D& constraint);
    void More(const T_HINGE_COMPONENTS& components);

    // Rules are those of the reader.
    void Fail(const char*) const {}
    template <class... A>
    void Check(const A&...) const
    {
    }
    template <class... A>
    void CheckEach(const A&...) const
    {
    }
    template <class... A>
    void SameCount(const A&...) const
    {
    }
    template <class... A>
    void Rule(const A&...) const
    {
    }

private:
    template <class T>
    void Value(const char* key, const T&, T_DIM dim, bool optional)
    {
        if constexpr (std::is_same_v<T, double>)
            Scalar(key, FIELD_KIND::Number, optional, dim);
        else if constexpr (std::is_same_v<T, bool>)
            Scalar(key, FIELD_KIND::Flag, optional);
        else if constexpr (std::is_same_v<T, int>)
            Scalar(key, FIELD_KIND::Integer, optional);
        else if constexpr (std::is_same_v<T, std::string>)
            Scalar(key, FIELD_KIND::Text, optional);
        else
            Values(key, T{}, dim, optional);
    }
    template <std::size_t N>
    void Values(const char* key, const std::array<double, N>&, T_DIM dim, bool optional)
    {
        std::array<T_DIM, N> dims;
        dims.fill(dim);
        Fixed(key, dims, optional);
    }
    template <std::size_t N>
    void Values(const char* key, const std::array<int, N>&, T_DIM, bool optional)
    {
        CFormLister list = Open(key, optional, FIELD_KIND::List, false);
        m_to.rows.back().items = FIELD_KIND::Integer;
        for (std::size_t i = 0; i < N; ++i)
            list.Scalar(std::to_string(i), FIELD_KIND::Integer, false);
    }
    void Values(const char* key, const std::vector<double>&, T_DIM dim, bool optional)
    {
        Items(key, {.kind = FIELD_KIND::Number, .dim = dim}, optional);
    }
    void Values(const char* key, const std::vector<int>&, T_DIM, bool optional)
    {
        Items(key, {.kind = FIELD_KIND::Integer}, optional);
    }
    template <std::size_t N>
    void Fixed(const char* key, const std::array<T_DIM, N>& dims, bool optional)
    {
        CFormLister list = Open(key, optional, FIELD_KIND::List, false);
        m_to.rows.back().items = FIELD_KIND::Number;
        if (std::ranges::count(dims, dims[0]) == N) m_to.rows.back().dim = dims[0];
        for (std::size_t i = 0; i < N; ++i)
            list.Scalar(std::to_string(i), FIELD_KIND::Number, false, dims[i]);
    }

    /// A row without rows below it. The reference holds until the next row.
    T_FIELD_ROW& Scalar(const std::string& key, FIELD_KIND kind, bool optional,
                        T_DIM dim = kDimNone);
    /// A row with rows below it.
    CFormLister Open(const std::string& key, bool optional, FIELD_KIND kind = FIELD_KIND::Group,
                     bool takesItems = true);
    /// A list of values that are all like `item`.
    void Items(const char* key, T_FIELD_ROW item, bool optional);
    void Choice(const char* key, std::span<const char* const> names, bool optional);
    void Named(const char* key, RECORD_KIND kind, bool optional);
    void NamedItems(const char* key, RECORD_KIND kind);
    void Keyed(const char* key, int target, RECORD_KIND kind, bool optional);
    void Id(const char* key, RECORD_KIND kind);
    void Ids(const char* key, RECORD_KIND kind, bool optional);
    std::vector<std::string> NamesOfKind(RECORD_KIND kind) const;
    /// The member of the object, or the item of the array; null: it is left out.
    const T_JSON* Find(const std::string& key);

    T_SHARED& m_to;
    const T_JSON* m_at;
    std::string m_place;
    int m_depth;
    std::vector<T_JSON> m_numbers; // items of a packed array, while they are looked at
};
