// Visitor of CaseFields: reads the members of one object of a case file into a record in SI.
#pragma once

#include "qm_db/hingefields.h"
#include "qm_db/jsonreader.h"

#include <cmath>
#include <type_traits>

class CCaseGet {
public:
    template <class T>
    using Ref = T&;
    static constexpr bool kReads = true;
    static constexpr bool kWrites = false;

    /// `more`: keys of the object that the record's fields do not have.
    CCaseGet(CJsonReader& in, const T_UNITS& units,
             std::initializer_list<std::string_view> more = {})
        : m_in(in), m_units(units), m_keys(more)
    {
    }

    /// Reads a whole object; other keys and missing members are faults.
    template <class R, class... C>
    static void Record(CJsonReader& in, const T_UNITS& units,
                       std::initializer_list<std::string_view> more, R& r, const C&... context)
    {
        CCaseGet get(in, units, more);
        CaseFields(get, r, context...);
        get.Finish();
    }
    /// For a caller that calls the fields itself: judges the keys.
    void Finish()
    {
        m_in.Keys(std::span<const std::string_view>(m_keys));
        if (m_missing) (void)m_in.Member(m_missing);
    }

    /// The key is known, whether it is there or not.
    bool Has(const char* key)
    {
        m_keys.emplace_back(key);
        return m_in.Has(key);
    }

    /// A fault at once when the member is missing.
    void Must(const char* key)
    {
        if (!m_in.Has(key)) (void)m_in.Member(key);
    }

    template <class T>
    void Need(const char* key, T& out, T_DIM dim = kDimNone)
    {
        if (!Take(key)) return;
        CJsonReader member = m_in.Member(key);
        Read(member, out, dim);
    }
    template <class T>
    void Opt(const char* key, T& out, const T& missing, T_DIM dim = kDimNone)
    {
        if (!Has(key)) {
            out = missing;
            return;
        }
        CJsonReader member = m_in.Member(key);
        Read(member, out, dim);
    }
    template <class T>
    void OptIf(const char* key, std::optional<T>& out)
    {
        if (Has(key)) m_in.Get(key, out.emplace());
    }
    template <class E>
    void Enum(const char* key, E& out, std::span<const char* const> names, const char* what)
    {
        if (Take(key)) out = static_cast<E>(m_in.Choice(key, names, what));
    }
    template <int kFirst = 0, class E>
    void EnumOpt(const char* key, E& out, E missing, std::span<const char* const> names,
                 const char* what)
    {
        out = missing;
        if (Has(key)) out = static_cast<E>(kFirst + m_in.Choice(key, names, what));
    }
    template <class E>
    void Code(const char* key, E& out, std::span<const char* const> names, const char* what)
    {
        if (!Take(key)) return;
        int code = 0;
        if (m_in.Member(key).IsText())
            code = m_in.Choice(key, names, what);
        else
            m_in.Get(key, code);
        out = static_cast<E>(code);
    }
    template <class R, class... C>
    void Part(const char* key, R& r, const C&... context)
    {
        if (!Has(key)) return;
        CJsonReader member = m_in.Member(key);
        Record(member, m_units, {}, r, context...);
    }
    template <class R, class... C>
    void NeedPart(const char* key, R& r, const C&... context)
    {
        if (!Take(key)) return;
        CJsonReader member = m_in.Member(key);
        Record(member, m_units, {}, r, context...);
    }
    template <class R, class... C>
    void PartIf(const char* key, std::optional<R>& r, const C&... context)
    {
        if (m_in.Has(key)) r.emplace();
        if (r) return Part(key, *r, context...);
        m_keys.emplace_back(key);
    }
    template <class R, class... C>
    void List(const char* key, std::vector<R>& all, const C&... context)
    {
        if (!Has(key)) return;
        m_in.Member(key).ForEachItem([&](CJsonReader& item, std::size_t) {
            Record(item, m_units, {}, all.emplace_back(), context...);
        });
    }
    /// Up to N numbers; the rest is 0.
    template <std::size_t N>
    void Padded(const char* key, std::array<double, N>& out, T_DIM dim)
    {
        std::vector<double> values;
        if (!Has(key)) return;
        CJsonReader member = m_in.Member(key);
        Read(member, values, dim);
        if (values.size() > N)
            return member.Fail(std::to_string(values.size()) + " values, expected up to " +
                               std::to_string(N));
        std::copy(values.begin(), values.end(), out.begin());
    }
    /// {"p": [...], "m": [...]}, N ratios each.
    template <std::size_t N>
    void Pairs(const char* key, std::array<T_PM_POINT, N>& out)
    {
        if (!Has(key)) return;
        std::array<double, N> p{}, m{};
        CJsonReader member = m_in.Member(key);
        member.Keys({"p", "m"});
        member.Get("p", p);
        member.Get("m", m);
        for (std::size_t i = 0; i < N; ++i)
            out[i] = {p[i], m[i]};
    }

private:
    /// A missing member becomes a fault at the end: a wrong spelling is told first.
    bool Take(const char* key)
    {
        if (Has(key)) return true;
        if (!m_missing) m_missing = key;
        return false;
    }

    template <class T>
    void Read(CJsonReader& in, T& out, T_DIM dim) const
    {
        in.Read(out);
        if (dim == kDimNone || in.Failed()) return;
        const double factor = SiFactor(m_units, dim);
        if constexpr (std::is_same_v<T, double>)
            Convert(in, out, factor);
        else if constexpr (std::is_same_v<T, std::vector<double>>)
            for (double& value : out)
                Convert(in, value, factor);
    }
    static void Convert(CJsonReader& in, double& value, double factor)
    {
        value *= factor;
        if (!std::isfinite(value)) in.Fail("a value is too large");
    }

    CJsonReader& m_in;
    const T_UNITS& m_units;
    std::vector<std::string_view> m_keys;
    const char* m_missing = nullptr;
};
