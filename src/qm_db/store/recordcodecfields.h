// The two visitors of recordwords.h.
#pragma once

#include "qm_db/casefile/caseget.h"
#include "qm_db/casefile/caseput.h"
#include "qm_db/store/recordcodecarrays.h"
#include "qm_db/store/recordcodecrow.h"
#include "qm_db/store/recordwords.h"

#include <cmath>

class CRowPut : public CRowWords<CRowPut> {
public:
    template <class T>
    using Ref = const T&;
    static constexpr bool kReads = false;
    static constexpr bool kWrites = true;

    CRowPut(CRecordRow& row, CPackedArrays& arrays, const CTablePlaces& where)
        : places(where), m_row(row), m_arrays(arrays)
    {
        m_text.BeginObject(true);
    }
    CRowPut(CRecordRow&, CPackedArrays&, CTablePlaces&&) = delete; // the places are kept by name
    /// The text of the members that have no place of their own; the row has it where it can.
    void Finish();

    CCasePut& Body() { return m_body; }
    void Fail(const char* reason) { m_text.Fail(reason); }

    template <class T>
    bool Cell(const char* key, const T& value)
    {
        if (places.Find(key, MEMBER_PLACE::Packed)) return true;
        if (const char* const list = places.Find(key, MEMBER_PLACE::List)) {
            if constexpr (requires { PutList(list, value); }) return PutList(list, value), true;
        }
        const std::string column = ColumnOf(key);
        if constexpr (requires { Put(column, value); }) {
            if (!column.empty()) return Put(column, value), true;
        }
        return false;
    }
    template <int kFirst, class E>
    bool CellOf(const char* key, const E& value, std::span<const char* const> names)
    {
        const std::string column = ColumnOf(key);
        if (column.empty()) return places.Find(key, MEMBER_PLACE::Packed) != nullptr;
        const int code = static_cast<int>(value);
        if (places.IsText(column))
            m_row.Put(column, std::string(names[static_cast<std::size_t>(code - kFirst)]));
        else
            Put(column, code);
        return true;
    }
    template <int kFirst, class E>
    bool CellOf(const char* key, const std::optional<E>& value, std::span<const char* const> names)
    {
        return value ? CellOf<kFirst>(key, *value, names) : !ColumnOf(key).empty();
    }
    template <class... T>
    void Variant(const char* key, const std::variant<T...>& value,
                 std::span<const char* const> names, const char* what)
    {
        const std::string column = ColumnOf(key);
        if (column.empty()) return m_body.Variant(key, value, names, what);
        m_row.Put(column, std::string(names[value.index()]));
    }
    template <class R>
    bool TakePart(const std::string& flag, const std::optional<R>& part)
    {
        if (places.HasColumn(flag)) Put(flag, part.has_value());
        return part.has_value();
    }

    const CTablePlaces& places;

private:
    void Put(const std::string& column, int value) { m_row.Put(column, std::int64_t{value}); }
    void Put(const std::string& column, bool value) { Put(column, value ? 1 : 0); }
    void Put(const std::string& column, double value) { m_row.Put(column, value); }
    void Put(const std::string& column, char value) { m_row.Put(column, std::string(1, value)); }
    void Put(const std::string& column, const std::string& value) { m_row.Put(column, value); }
    template <class T>
    requires std::is_arithmetic_v<T> || std::is_same_v<T, std::string>
    void Put(const std::string& column, const std::optional<T>& value)
    {
        if (value) Put(column, *value);
    }
    template <class T>
    void PutList(const char* name, const std::vector<T>& values)
    {
        if (!values.empty()) PutNumbers(name, std::span<const T>(values));
    }
    template <class T, std::size_t N>
    void PutList(const char* name, const std::optional<std::array<T, N>>& values)
    {
        if (values) PutNumbers(name, std::span<const T>(*values));
    }
    /// Two lists: node ids, and six components per node.
    void PutList(const char* name, const std::map<int, T_DOF6>& byNode);
    template <class T>
    void PutNumbers(const char* name, std::span<const T> values)
    {
        m_arrays.Put(m_row.Table(), m_row.Key(), name, values);
    }

    CRecordRow& m_row;
    CPackedArrays& m_arrays;
    CJsonWriter m_text{kSiUnits};
    CCasePut m_body{m_text};
};

class CRowGet : public CRowWords<CRowGet> {
public:
    template <class T>
    using Ref = T&;
    static constexpr bool kReads = true;
    static constexpr bool kWrites = false;

    CRowGet(const CRecordRow& row, const CPackedArrays& arrays, const CTablePlaces& where);
    CRowGet(const CRecordRow&, const CPackedArrays&, CTablePlaces&&) = delete;
    void Finish();

    CCaseGet& Body() { return m_body; }
    bool Has(const char* key) { return m_body.Has(key); }
    void Must(const char* key) { m_body.Must(key); }

    template <class T>
    bool Cell(const char* key, T& value)
    {
        if (places.Find(key, MEMBER_PLACE::Packed)) return true;
        if (const char* const list = places.Find(key, MEMBER_PLACE::List)) {
            if constexpr (requires { GetList(list, value); }) return GetList(list, value), true;
        }
        const std::string column = ColumnOf(key);
        if constexpr (requires { Get(column, value); }) {
            if (!column.empty()) return Get(column, value), true;
        }
        return false;
    }
    template <int kFirst, class E>
    bool CellOf(const char* key, E& value, std::span<const char* const> names)
    {
        const std::string column = ColumnOf(key);
        if (column.empty()) return places.Find(key, MEMBER_PLACE::Packed) != nullptr;
        value = static_cast<E>(CodeOf(column, kFirst, names));
        return true;
    }
    template <int kFirst, class E>
    bool CellOf(const char* key, std::optional<E>& value, std::span<const char* const> names)
    {
        const std::string column = ColumnOf(key);
        if (column.empty()) return false;
        if (!IsNull(column)) (void)CellOf<kFirst>(key, value.emplace(), names);
        return true;
    }
    template <class... T>
    void Variant(const char* key, std::variant<T...>& value, std::span<const char* const> names,
                 const char* what)
    {
        static const std::array<std::variant<T...>, sizeof...(T)> kBlank{T{}...};
        const std::string column = ColumnOf(key);
        if (column.empty()) return m_body.Variant(key, value, names, what);
        value = kBlank[static_cast<std::size_t>(CodeOf(column, 0, names))];
    }
    template <class R>
    bool TakePart(const std::string& flag, std::optional<R>& part)
    {
        bool isThere = false;
        if (places.HasColumn(flag))
            Get(flag, isThere);
        else
            isThere = m_row.HasAny(m_prefix);
        if (isThere) part.emplace();
        return isThere;
    }

    const CTablePlaces& places;

private:
    void Get(const std::string& column, int& value) const;
    void Get(const std::string& column, bool& value) const;
    void Get(const std::string& column, char& value) const;
    void Get(const std::string& column, double& value) const
    {
        value = Take<double>(column);
        if (!std::isfinite(value)) m_row.ThrowBadCell(column);
    }
    void Get(const std::string& column, std::string& value) const
    {
        value = Take<std::string>(column);
    }
    template <class T>
    requires std::is_arithmetic_v<T> || std::is_same_v<T, std::string>
    void Get(const std::string& column, std::optional<T>& value) const
    {
        if (!IsNull(column)) Get(column, value.emplace());
    }
    void GetList(const char* name, std::vector<int>& values) const
    {
        values = m_arrays.Ints(m_row.Table(), m_row.Key(), name);
    }
    void GetList(const char* name, std::vector<double>& values) const
    {
        values = m_arrays.Doubles(m_row.Table(), m_row.Key(), name);
    }
    template <class T, std::size_t N>
    void GetList(const char* name, std::optional<std::array<T, N>>& values) const
    {
        if (!m_arrays.Has(m_row.Table(), m_row.Key(), name)) return;
        std::vector<T> list;
        GetList(name, list);
        if (list.size() != N) m_row.ThrowBadCell(name);
        std::copy(list.begin(), list.end(), values.emplace().begin());
    }
    void GetList(const char* name, std::map<int, T_DOF6>& byNode) const;
    /// A number or a name out of the list.
    int CodeOf(const std::string& column, int first, std::span<const char* const> names) const;
    bool IsNull(const std::string& column) const
    {
        return std::holds_alternative<std::monostate>(m_row.Get(column));
    }
    template <class T>
    const T& Take(const std::string& column) const
    {
        const T* const value = std::get_if<T>(&m_row.Get(column));
        if (!value) m_row.ThrowBadCell(column);
        return *value;
    }
    T_JSON TextOf() const;

    const CRecordRow& m_row;
    const CPackedArrays& m_arrays;
    T_FILE_ERROR m_error;
    T_JSON m_document;
    CJsonReader m_in{&m_document, {}, m_error};
    CCaseGet m_body{m_in, kSiUnits};
};

/// Name and members of a record.
template <class V, class R>
void RowFields(V& v, R& r)
{
    if constexpr (kHasName<R>) v.Need("name", r.name);
    CaseFields(v, r);
    v.Finish();
}
