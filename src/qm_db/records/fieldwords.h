// A record's one list of members is a function CaseFields(visitor, record): each member with its
// key and its dimension, once. The visitor reads a case file (CCaseGet), prints one (CCasePut),
// carries the record into the model file and back (CRowPut, CRowGet), or looks at members
// (CFieldLook: quantities, references). Names of records stand outside. The words of the lists:
//
// Need: a member that must be there. Opt: left out when it has the given default; OptOr: with an
// older key that is still read. OptIf: as the optional is. State: always written, may be left out
// when read. Fixed: exactly so many numbers, each with its dimension. Padded: up to so many. Pairs,
// Texts: as their types say. NodeTable: numbers by node. Flags: the names of the flags that are
// set. Enum, EnumOpt, EnumIf: a name out of a list. Code: the same, other numbers stay numbers.
// Letter, LetterIf, WordIf: a text out of a list. Variant: the name of the alternative. Part: a
// nested record, left out when it has nothing to say; NeedPart, PartIf, List, ListIf: as they say;
// ListIf: an empty list says something, too. Group:
// members that stand together in the case file; NeedGroup: even when none is there. NeedRef,
// OptRef: another record, by name in a case file and by key in the model file. KeyRef, OptKeyRef:
// by key in both; FreeKeyRef: to one that may be missing. NameRef, OptNameRef, NameRefs: by name in
// both. Refs: a list of other records, by name and by key. Node, Element, NodePair, NodeList,
// OptNodes, OptElements: ids that must be there. StageStep: a step of a stage. Check, CheckEach: a
// rule of the case file for a member; SameCount: a list is as long as another. They are asked of a
// whole model, too (modelfault.h). Rule: one of every file. What a rule says when it is broken, and
// what a list offers, are keys of the message catalogue.
#pragma once

#include "qm_db/records/evalnames.h"
#include "qm_db/records/hingenames.h"
#include "qm_db/records/structnames.h"
#include "qm_db/records/tables.h"

#include <span>

/// T& for a visitor that reads or converts, const T& for one that writes.
template <class V, class T>
using T_FIELD_REF = typename V::template Ref<T>;

/// As many dimensions as an array has numbers.
template <class T>
using T_DIMS_OF = std::array<T_DIM, std::tuple_size_v<std::remove_const_t<T>>>;

/// A visitor that looks at the members that are there. `Self` takes what it is interested in:
/// Key(key), Number(value, dim), Reference(kind, key) or Reference(kind, name).
template <class Self>
class CFieldLook {
public:
    static constexpr bool kReads = false;
    static constexpr bool kWrites = false;

    template <class T>
    void Need(const char* key, T& value, T_DIM dim = kDimNone)
    {
        Me().Key(key);
        if constexpr (std::is_same_v<std::remove_const_t<T>, double>) Me().Number(value, dim);
        if constexpr (std::is_same_v<std::remove_const_t<T>, std::vector<double>>)
            for (auto& number : value)
                Me().Number(number, dim);
    }
    template <class T>
    void Opt(const char* key, T& value, const std::remove_const_t<T>&, T_DIM dim = kDimNone)
    {
        Need(key, value, dim);
    }
    template <class T>
    const char* OptOr(const char* key, const char*, T& value, double, T_DIM dim)
    {
        Need(key, value, dim);
        return key;
    }
    template <class T>
    void OptIf(const char* key, T& value, T_DIM dim = kDimNone)
    {
        Me().Key(key);
        if (value) Need(key, *value, dim);
    }
    template <class T>
    void NeedFixed(const char* key, T& values, const T_DIMS_OF<T>& dims)
    {
        for (std::size_t i = 0; i < dims.size(); ++i)
            Need(key, values[i], dims[i]);
    }
    template <class T>
    void StateFixed(const char* key, T& values, const T_DIMS_OF<T>& dims)
    {
        NeedFixed(key, values, dims);
    }
    template <class T>
    void OptFixed(const char* key, T& values, const std::remove_const_t<T>&,
                  const T_DIMS_OF<T>& dims)
    {
        NeedFixed(key, values, dims);
    }
    template <class T>
    void Padded(const char* key, T& values, T_DIM dim)
    {
        for (auto& value : values)
            Need(key, value, dim);
    }

    void OptRef(const char* key, int target, RECORD_KIND kind) { NeedRef(key, target, kind); }
    void NeedRef(const char* key, int target, RECORD_KIND kind)
    {
        Me().Key(key);
        Me().Reference(kind, target);
    }
    void KeyRef(const char* key, int target, RECORD_KIND kind) { NeedRef(key, target, kind); }
    void OptKeyRef(const char* key, int target, RECORD_KIND kind) { NeedRef(key, target, kind); }
    void FreeKeyRef(const char* key, int target, RECORD_KIND kind) { NeedRef(key, target, kind); }
    void Refs(const char* key, const std::vector<int>& targets, RECORD_KIND kind)
    {
        Me().Key(key);
        for (const int target : targets)
            NeedRef(key, target, kind);
    }
    void NameRef(const char* key, const std::string& target, RECORD_KIND kind)
    {
        Me().Key(key);
        Me().Reference(kind, target);
    }
    void OptNameRef(const char* key, const std::string& target, RECORD_KIND kind)
    {
        Me().Key(key);
        if (!target.empty()) NameRef(key, target, kind);
    }
    void NameRefs(const char* key, const std::vector<std::string>& targets, RECORD_KIND kind)
    {
        Me().Key(key);
        for (const std::string& target : targets)
            NameRef(key, target, kind);
    }
    void Node(const char* key, int id) { NeedRef(key, id, KindOf<T_NODE_D>()); }
    void Element(const char* key, int id) { NeedRef(key, id, KindOf<T_ELEM_D>()); }
    void NodePair(const char* key, int nodeI, int nodeJ, std::size_t count, const char*)
    {
        Node(key, nodeI);
        if (count > 1) Node(key, nodeJ);
    }
    void NodeList(const char* key, const std::vector<int>& ids) { OptNodes(key, ids); }
    void OptNodes(const char* key, const std::vector<int>& ids)
    {
        Me().Key(key);
        for (const int id : ids)
            Node(key, id);
    }
    void OptElements(const char* key, const std::vector<int>& ids)
    {
        Me().Key(key);
        for (const int id : ids)
            Element(key, id);
    }

    template <class R, class... C>
    void Part(const char* key, R& r, const C&... context)
    {
        Me().Key(key);
        CaseFields(Me(), r, context...);
    }
    template <class R, class... C>
    void NeedPart(const char* key, R& r, const C&... context)
    {
        Me().Key(key);
        CaseFields(Me(), r, context...);
    }
    template <class R, class... C>
    void PartIf(const char* key, R& r, const C&... context)
    {
        Me().Key(key);
        if (r) CaseFields(Me(), *r, context...);
    }
    template <class R, class... C>
    void List(const char* key, R& all, const C&... context)
    {
        Me().Key(key);
        for (auto& r : all)
            CaseFields(Me(), r, context...);
    }
    template <class R, class... C>
    void ListIf(const char* key, R& all, const C&... context)
    {
        Me().Key(key);
        if (all) List(key, *all, context...);
    }
    template <class F>
    void Group(const char* key, const F& members)
    {
        Me().Key(key);
        members(Me());
    }
    template <class F>
    void NeedGroup(const char* key, const F& members)
    {
        Me().Key(key);
        members(Me());
    }

    // What is neither a number with a dimension nor a reference.
    template <class... A>
    void State(const char* key, const A&...)
    {
        Me().Key(key);
    }
    template <class... A>
    void Pairs(const char* key, const A&...)
    {
        Me().Key(key);
    }
    template <class... A>
    void Texts(const char* key, const A&...)
    {
        Me().Key(key);
    }
    template <class... A>
    void NodeTable(const char* key, const A&...)
    {
        Me().Key(key);
    }
    template <class... A>
    void Flags(const char* key, const A&...)
    {
        Me().Key(key);
    }
    template <int kFirst = 0, class... A>
    void Enum(const char* key, const A&...)
    {
        Me().Key(key);
    }
    template <int kFirst = 0, class... A>
    void EnumOpt(const char* key, const A&...)
    {
        Me().Key(key);
    }
    template <class... A>
    void EnumIf(const char* key, const A&...)
    {
        Me().Key(key);
    }
    template <class... A>
    void Code(const char* key, const A&...)
    {
        Me().Key(key);
    }
    template <class... A>
    void Letter(const char* key, const A&...)
    {
        Me().Key(key);
    }
    template <class... A>
    void LetterIf(const char* key, const A&...)
    {
        Me().Key(key);
    }
    template <class... A>
    void WordIf(const char* key, const A&...)
    {
        Me().Key(key);
    }
    template <class... A>
    void Variant(const char* key, const A&...)
    {
        Me().Key(key);
    }
    template <class... A>
    void StageStep(const char* key, const A&...)
    {
        Me().Key(key);
    }
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

protected:
    // Nothing of these interests, unless Self says so.
    void Key(const char*) const {}
    template <class T>
    void Number(T&, T_DIM) const
    {
    }
    template <class T>
    void Reference(RECORD_KIND, const T&) const
    {
    }

private:
    Self& Me() { return static_cast<Self&>(*this); }
};
