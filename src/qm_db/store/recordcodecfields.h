// Visitors that carry the fields of a record into a row and its arrays, and back.
#pragma once

#include "qm_db/file/storefault.h"
#include "qm_db/records.h"
#include "qm_db/store/recordbody.h"
#include "qm_db/store/recordcodecarrays.h"
#include "qm_db/store/recordcodecrow.h"

#include <limits>

/// Names of the spectrum kinds in the order of T_SPFC_D's alternatives.
inline constexpr std::array<const char*, 5> kSpectrumKinds{"atc40", "ec8-2004", "ec8-1994", "ntc",
                                                           "user"};

class CFieldPut {
public:
    template <class T>
    using Ref = const T&;
    CFieldPut(CRecordRow& row, CPackedArrays& arrays) : m_row(row), m_arrays(arrays) {}

    void operator()(const std::string& column, int value)
    {
        m_row.Put(column, std::int64_t{value});
    }
    void operator()(const std::string& column, bool value) { (*this)(column, value ? 1 : 0); }
    void operator()(const std::string& column, double value) { m_row.Put(column, value); }
    void operator()(const std::string& column, char value)
    {
        m_row.Put(column, std::string(1, value));
    }
    void operator()(const std::string& column, const std::string& value)
    {
        m_row.Put(column, value);
    }
    void operator()(const std::string& column, FORCE_UNIT value)
    {
        m_row.Put(column, std::string(NameOf(value)));
    }
    void operator()(const std::string& column, LENGTH_UNIT value)
    {
        m_row.Put(column, std::string(NameOf(value)));
    }
    void operator()(const std::string& column, PUSH_METHOD value)
    {
        (*this)(column, static_cast<int>(value));
    }
    void operator()(const std::string& column, MODEL_PLANE value)
    {
        (*this)(column, static_cast<int>(value));
    }
    template <class T>
    void operator()(const std::string& column, const std::optional<T>& value)
    {
        if (value) (*this)(column, *value);
    }

    CRecordRow& Row() const { return m_row; }
    CPackedArrays& Arrays() const { return m_arrays; }
    /// Whether an optional part without a required column of its own is there, as 0 or 1.
    template <class T>
    void Flag(const std::string& column, const std::optional<T>& part)
    {
        (*this)(column, part.has_value());
    }
    /// True when the optional part is there; `column` is the one that tells.
    template <class T>
    bool Part(const std::string&, const std::optional<T>& part) const
    {
        return part.has_value();
    }
    template <class T>
    void Array(const char* name, const std::vector<T>& values)
    {
        if (!values.empty()) PutArray(name, std::span<const T>(values));
    }
    template <class T, std::size_t N>
    void Array(const char* name, const std::optional<std::array<T, N>>& values)
    {
        if (values) PutArray(name, std::span<const T>(*values));
    }
    /// The nested members of a record as text.
    template <class R>
    void Body(const R& record)
    {
        std::string text;
        T_FILE_ERROR error;
        if (!PrintBody(record, text, error)) {
            throw CStoreFault(FILE_FAULT::BadInput, "IDS_QM_DB_FILE_BAD_RECORD",
                              m_row.Table() + ' ' + std::to_string(m_row.Key()) + ' ' + error.text);
        }
        m_row.Put("body", std::move(text));
    }
    template <class R>
    void BodyIf(const R& record, bool isThere)
    {
        if (isThere) Body(record);
    }
    void Kind(const T_SPFC_D& spectrum)
    {
        m_row.Put("kind", std::string(kSpectrumKinds[spectrum.data.index()]));
    }

private:
    template <class T>
    void PutArray(const char* name, std::span<const T> values)
    {
        m_arrays.Put(m_row.Table(), m_row.Key(), name, values);
    }

    CRecordRow& m_row;
    CPackedArrays& m_arrays;
};

class CFieldGet {
public:
    template <class T>
    using Ref = T&;
    CFieldGet(const CRecordRow& row, const CPackedArrays& arrays) : m_row(row), m_arrays(arrays) {}

    void operator()(const std::string& column, int& value) const
    {
        const auto whole = Need<std::int64_t>(column);
        if (whole < std::numeric_limits<int>::min() || whole > std::numeric_limits<int>::max())
            m_row.ThrowBadCell(column);
        value = static_cast<int>(whole);
    }
    void operator()(const std::string& column, bool& value) const
    {
        const auto whole = Need<std::int64_t>(column);
        if (whole != 0 && whole != 1) m_row.ThrowBadCell(column);
        value = whole == 1;
    }
    void operator()(const std::string& column, double& value) const
    {
        value = Need<double>(column);
    }
    void operator()(const std::string& column, char& value) const
    {
        const auto& text = Need<std::string>(column);
        if (text.size() != 1) m_row.ThrowBadCell(column);
        value = text.front();
    }
    void operator()(const std::string& column, std::string& value) const
    {
        value = Need<std::string>(column);
    }
    void operator()(const std::string& column, FORCE_UNIT& value) const
    {
        TakeUnit(column, ForceUnitFromName(Need<std::string>(column)), value);
    }
    void operator()(const std::string& column, LENGTH_UNIT& value) const
    {
        TakeUnit(column, LengthUnitFromName(Need<std::string>(column)), value);
    }
    void operator()(const std::string& column, PUSH_METHOD& value) const
    {
        int code = 0;
        (*this)(column, code);
        value = static_cast<PUSH_METHOD>(code);
        if (value < PUSH_METHOD::Fema440 || value > PUSH_METHOD::Ntc2018)
            m_row.ThrowBadCell(column);
    }
    void operator()(const std::string& column, MODEL_PLANE& value) const
    {
        int code = 0;
        (*this)(column, code);
        value = static_cast<MODEL_PLANE>(code);
        if (value < MODEL_PLANE::XY || value > MODEL_PLANE::YZ) m_row.ThrowBadCell(column);
    }
    template <class T>
    void operator()(const std::string& column, std::optional<T>& value) const
    {
        if (!IsNull(column)) (*this)(column, value.emplace());
    }

    const CRecordRow& Row() const { return m_row; }
    const CPackedArrays& Arrays() const { return m_arrays; }
    template <class T>
    void Flag(const std::string& column, std::optional<T>& part) const
    {
        bool isThere = false;
        (*this)(column, isThere);
        if (isThere) part.emplace();
    }
    template <class T>
    bool Part(const std::string& column, std::optional<T>& part) const
    {
        if (!IsNull(column)) part.emplace();
        return part.has_value();
    }
    void Array(const char* name, std::vector<int>& values) const
    {
        values = m_arrays.Ints(m_row.Table(), m_row.Key(), name);
    }
    void Array(const char* name, std::vector<double>& values) const
    {
        values = m_arrays.Doubles(m_row.Table(), m_row.Key(), name);
    }
    template <class T, std::size_t N>
    void Array(const char* name, std::optional<std::array<T, N>>& values) const
    {
        if (!m_arrays.Has(m_row.Table(), m_row.Key(), name)) return;
        std::vector<T> list;
        Array(name, list);
        if (list.size() != N) m_row.ThrowBadCell(name);
        std::copy(list.begin(), list.end(), values.emplace().begin());
    }
    template <class R>
    void Body(R& record) const
    {
        T_FILE_ERROR error;
        if (!ParseBody(Need<std::string>("body"), record, error)) m_row.ThrowBadCell("body");
    }
    template <class R>
    void BodyIf(R& record, bool) const
    {
        if (!IsNull("body")) Body(record);
    }
    void Kind(T_SPFC_D& spectrum) const
    {
        static const std::array<decltype(T_SPFC_D::data), kSpectrumKinds.size()> kBlank{
            T_SPFC_ATC40{}, T_SPFC_EURO2003{}, T_SPFC_EURO1996{}, T_SPFC_NTC{}, T_SPFC_USER{}};
        const auto& name = Need<std::string>("kind");
        for (std::size_t i = 0; i < kBlank.size(); ++i) {
            if (name == kSpectrumKinds[i]) {
                spectrum.data = kBlank[i];
                return;
            }
        }
        m_row.ThrowBadCell("kind");
    }

private:
    bool IsNull(const std::string& column) const
    {
        return std::holds_alternative<std::monostate>(m_row.Get(column));
    }
    template <class T>
    const T& Need(const std::string& column) const
    {
        const T* const value = std::get_if<T>(&m_row.Get(column));
        if (!value) m_row.ThrowBadCell(column);
        return *value;
    }
    template <class U>
    void TakeUnit(const std::string& column, const std::optional<U>& unit, U& value) const
    {
        if (!unit) m_row.ThrowBadCell(column);
        value = *unit;
    }

    const CRecordRow& m_row;
    const CPackedArrays& m_arrays;
};
