// Visitors of CaseFields that carry a record into its row of the model file and back: a member into
// the place that MemberPlaces() has for it, else into the column of its name, else into the text of
// the record. So a member that is new needs no column.
#pragma once

#include "qm_db/records/fieldwords.h"
#include "qm_db/store/modelschema.h"

#include <utility>

/// Owner in "arrays" of the texts of a table that has no column for them.
std::string TextOwner(const std::string& table);

/// The places of a table's members.
class CTablePlaces {
public:
    /// Of a table with columns; without them the record is packed, or text alone.
    CTablePlaces(const CSqliteDb& db, const std::string& table);
    explicit CTablePlaces(std::string_view table);

    bool HasColumn(const std::string& name) const { return m_columns.contains(name); }
    bool IsText(const std::string& column) const { return m_columns.at(column).isText; }
    bool IsRequired(const std::string& column) const { return m_columns.at(column).isRequired; }
    /// Of a record that is text alone.
    bool IsAlone() const { return m_columns.empty() && m_places.empty(); }
    /// Null when the member has no such place.
    const char* Find(std::string_view member, MEMBER_PLACE place) const;

private:
    struct T_COLUMN {
        bool isText = false, isRequired = false;
    };
    std::map<std::string, T_COLUMN> m_columns;
    std::vector<T_MEMBER_PLACE> m_places;
};

/// What both visitors do with the words: `Self` takes a member that has a place of its own (Cell,
/// CellOf, TakePart), the others go on to the text.
template <class Self>
class CRowWords {
public:
    template <class T>
    void Need(const char* key, T& value, T_DIM dim = kDimNone)
    {
        if (!Me().Cell(key, value)) Me().Body().Need(key, value, dim);
    }
    template <class T>
    void Opt(const char* key, T& value, const std::remove_const_t<T>& missing, T_DIM dim = kDimNone)
    {
        if (!Me().Cell(key, value)) Me().Body().Opt(key, value, missing, dim);
    }
    template <class T>
    const char* OptOr(const char* key, const char* old, T& value, double missing, T_DIM dim)
    {
        return Me().Body().OptOr(key, old, value, missing, dim);
    }
    template <class T>
    void OptIf(const char* key, T& value, T_DIM dim = kDimNone)
    {
        if (!Me().Cell(key, value)) Me().Body().OptIf(key, value, dim);
    }
    template <class T>
    void State(const char* key, T& value)
    {
        if (!Me().Cell(key, value)) Me().Body().State(key, value);
    }
    template <class T>
    void NeedFixed(const char* key, T& values, const T_DIMS_OF<T>& dims)
    {
        if (!Me().Cell(key, values)) Me().Body().NeedFixed(key, values, dims);
    }
    template <class T>
    void StateFixed(const char* key, T& values, const T_DIMS_OF<T>& dims)
    {
        if (!Me().Cell(key, values)) Me().Body().StateFixed(key, values, dims);
    }
    template <class T>
    void OptFixed(const char* key, T& values, const std::remove_const_t<T>& missing,
                  const T_DIMS_OF<T>& dims)
    {
        if (!Me().Cell(key, values)) Me().Body().OptFixed(key, values, missing, dims);
    }
    template <class T>
    void Padded(const char* key, T& values, T_DIM dim)
    {
        if (!Me().Cell(key, values)) Me().Body().Padded(key, values, dim);
    }
    template <class T>
    void Pairs(const char* key, T& points)
    {
        Me().Body().Pairs(key, points);
    }
    template <class T>
    void NodeTable(const char* key, T& values)
    {
        if (!Me().Cell(key, values)) Me().Body().NodeTable(key, values);
    }
    template <class T>
    void Texts(const char* key, T& values)
    {
        Me().Body().Texts(key, values);
    }
    template <class T>
    void Flags(const char* key, T& flags, const auto&... names)
    {
        Me().Body().Flags(key, flags, names...);
    }

    template <class T>
    void OptRef(const char* key, T& target, RECORD_KIND kind)
    {
        if (!Me().Cell(key, target)) Me().Body().OptRef(key, target, kind);
    }
    template <class T>
    void NeedRef(const char* key, T& target, RECORD_KIND kind)
    {
        if (!Me().Cell(key, target)) Me().Body().NeedRef(key, target, kind);
    }
    template <class T>
    void KeyRef(const char* key, T& target, RECORD_KIND kind)
    {
        if (!Me().Cell(key, target)) Me().Body().KeyRef(key, target, kind);
    }
    template <class T>
    void OptKeyRef(const char* key, T& target, RECORD_KIND kind)
    {
        if (!Me().Cell(key, target)) Me().Body().OptKeyRef(key, target, kind);
    }
    template <class T>
    void NameRef(const char* key, T& target, RECORD_KIND kind)
    {
        if (!Me().Cell(key, target)) Me().Body().NameRef(key, target, kind);
    }
    template <class T>
    void OptNameRef(const char* key, T& target, RECORD_KIND kind)
    {
        if (!Me().Cell(key, target)) Me().Body().OptNameRef(key, target, kind);
    }
    template <class T>
    void Refs(const char* key, T& targets, RECORD_KIND kind)
    {
        if (!Me().Cell(key, targets)) Me().Body().Refs(key, targets, kind);
    }
    template <class T>
    void NameRefs(const char* key, T& targets, RECORD_KIND kind)
    {
        Me().Body().NameRefs(key, targets, kind);
    }
    template <class T>
    void NodePair(const char* key, T& nodeI, T& nodeJ, std::size_t count, const char* reason)
    {
        if (!Me().Cell(key, nodeI)) Me().Body().NodePair(key, nodeI, nodeJ, count, reason);
    }
    template <class T>
    void NodeList(const char* key, T& ids)
    {
        if (!Me().Cell(key, ids)) Me().Body().NodeList(key, ids);
    }
    template <class T>
    void OptNodes(const char* key, T& ids)
    {
        if (!Me().Cell(key, ids)) Me().Body().OptNodes(key, ids);
    }
    template <class T>
    void StageStep(const char* key, T& step, int missing)
    {
        Me().Body().StageStep(key, step, missing);
    }

    template <int kFirst = 0, class E>
    void Enum(const char* key, E& value, std::span<const char* const> names, const char* what)
    {
        if (!Me().template CellOf<kFirst>(key, value, names))
            Me().Body().template Enum<kFirst>(key, value, names, what);
    }
    template <int kFirst = 0, class E>
    void EnumOpt(const char* key, E& value, std::remove_const_t<E> missing,
                 std::span<const char* const> names, const char* what)
    {
        if (!Me().template CellOf<kFirst>(key, value, names))
            Me().Body().template EnumOpt<kFirst>(key, value, missing, names, what);
    }
    template <class E>
    void EnumIf(const char* key, E& value, std::span<const char* const> names, const char* what)
    {
        if (!Me().template CellOf<0>(key, value, names))
            Me().Body().EnumIf(key, value, names, what);
    }
    template <class E>
    void Code(const char* key, E& value, std::span<const char* const> names, const char* what)
    {
        Me().Body().Code(key, value, names, what);
    }
    template <class T>
    void Letter(const char* key, T& value, std::span<const char* const> names, const char* what)
    {
        if (!Me().Cell(key, value)) Me().Body().Letter(key, value, names, what);
    }
    template <class T>
    void LetterIf(const char* key, T& value, std::span<const char* const> names, const char* what)
    {
        if (!Me().Cell(key, value)) Me().Body().LetterIf(key, value, names, what);
    }
    template <class T>
    void WordIf(const char* key, T& value, std::span<const char* const> names, const char* what)
    {
        if (!Me().Cell(key, value)) Me().Body().WordIf(key, value, names, what);
    }

    template <class R, class... C>
    void Part(const char* key, R& r, const C&... context)
    {
        if (!Me().Cell(key, r)) Me().Body().Part(key, r, context...);
    }
    template <class R, class... C>
    void PartIf(const char* key, R& r, const C&... context)
    {
        if (!Me().places.Find(key, MEMBER_PLACE::Part))
            return Me().Body().PartIf(key, r, context...);
        const std::string outer = std::exchange(m_prefix, std::string(key) + '_');
        if (Me().TakePart("has_" + std::string(key), r)) CaseFields(Me(), *r, context...);
        m_prefix = outer;
    }
    template <class R, class... C>
    void List(const char* key, R& all, const C&... context)
    {
        Me().Body().List(key, all, context...);
    }
    template <class R, class... C>
    void ListIf(const char* key, R& all, const C&... context)
    {
        Me().Body().ListIf(key, all, context...);
    }
    template <class F>
    void Group(const char* key, const F& members)
    {
        const bool isPart = Me().places.Find(key, MEMBER_PLACE::Part) != nullptr;
        const std::string outer = std::exchange(m_prefix, isPart ? std::string(key) + '_' : "");
        members(Me());
        m_prefix = outer;
    }
    template <class F>
    void NeedGroup(const char* key, const F& members)
    {
        Group(key, members);
    }

    // The rules of a case file are asked of the whole model (modelfault.h).
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
    void Rule(const char* key, bool ok, const char* reason) { Me().Body().Rule(key, ok, reason); }

protected:
    /// Column of a member; empty when it has none.
    std::string ColumnOf(const char* key)
    {
        const char* const other = Me().places.Find(key, MEMBER_PLACE::Column);
        const std::string column = m_prefix + (other ? other : key);
        return Me().places.HasColumn(column) ? column : std::string();
    }
    std::string m_prefix; // of the columns of a part

private:
    Self& Me() { return static_cast<Self&>(*this); }
};
