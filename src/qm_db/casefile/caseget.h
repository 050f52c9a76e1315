// Visitor of CaseFields: reads the members of one object of a case file into a record in SI.
#pragma once

#include "qm_db/casefile/jsonreader.h"
#include "qm_db/records/casenames.h"
#include "qm_db/records/hingefields.h"
#include "qm_db/records/inputlimits.h"
#include "qm_db/records/pushfields.h"
#include "qm_db/records/stagefields.h"

#include <type_traits>

class CCaseGet {
public:
    template <class T>
    using Ref = T&;
    static constexpr bool kReads = true;
    static constexpr bool kWrites = false;

    /// `more`: keys of the object that the record's fields do not have. `names`: of a case file;
    /// without them (in the model file) references are keys and nothing is checked.
    CCaseGet(CJsonReader& in, const T_UNITS& units,
             std::initializer_list<std::string_view> more = {}, const CCaseNames* names = nullptr)
        : m_in(in), m_units(units), m_names(names), m_keys(more)
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
    /// The same in a case file.
    template <class R>
    static void Record(CJsonReader& in, const T_UNITS& units, const CCaseNames& names,
                       std::initializer_list<std::string_view> more, R& r)
    {
        CCaseGet get(in, units, more, &names);
        CaseFields(get, r);
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

    /// The text of the member; "" where it has another type.
    std::string TextOf(const char* key)
    {
        std::string text;
        if (m_in.Member(key).IsText()) m_in.Member(key).Read(text);
        return text;
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
    /// Returns the key that is there, `key` when neither is.
    const char* OptOr(const char* key, const char* old, double& out, double missing, T_DIM dim);
    template <class T>
    void OptIf(const char* key, std::optional<T>& out, T_DIM dim = kDimNone)
    {
        if (Has(key)) Need(key, out.emplace(), dim);
    }
    template <class T>
    void State(const char* key, T& out)
    {
        if (Has(key)) Need(key, out);
    }
    template <std::size_t N>
    void StateFixed(const char* key, std::array<double, N>& out, const std::array<T_DIM, N>& dims)
    {
        if (Has(key)) NeedFixed(key, out, dims);
    }
    template <std::size_t N>
    void NeedFixed(const char* key, std::array<double, N>& out, const std::array<T_DIM, N>& dims)
    {
        if (!Take(key)) return;
        CJsonReader member = m_in.Member(key);
        member.Read(out);
        for (std::size_t i = 0; i < N && !member.Failed(); ++i)
            Convert(member, out[i], SiFactor(m_units, dims[i]));
    }
    template <std::size_t N>
    void OptFixed(const char* key, std::array<double, N>& out, const std::array<double, N>& missing,
                  const std::array<T_DIM, N>& dims)
    {
        out = missing;
        if (Has(key)) NeedFixed(key, out, dims);
    }
    template <std::size_t N>
    void Flags(const char* key, std::array<bool, N>& out, const std::array<const char*, N>& names,
               const char* what)
    {
        out = {};
        if (!Has(key)) return;
        m_in.Member(key).ForEachItem([&](CJsonReader& item, std::size_t) {
            out[static_cast<std::size_t>(item.Choice(names, what))] = true;
        });
    }
    void Texts(const char* key, std::vector<std::string>& out);
    /// 0 when it is left out.
    void OptRef(const char* key, int& out, RECORD_KIND kind)
    {
        out = 0;
        if (Has(key)) NeedRef(key, out, kind);
    }
    void NeedRef(const char* key, int& out, RECORD_KIND kind);
    void KeyRef(const char* key, int& out, RECORD_KIND kind);
    void OptKeyRef(const char* key, int& out, RECORD_KIND kind)
    {
        Opt(key, out, 0);
        if (out != 0) KeyRef(key, out, kind);
    }
    void FreeKeyRef(const char* key, int& out, RECORD_KIND) { Need(key, out); }
    /// Names or keys; in the model file keys.
    void Refs(const char* key, std::vector<int>& out, RECORD_KIND kind);
    void NameRef(const char* key, std::string& out, RECORD_KIND) { Need(key, out); }
    void OptNameRef(const char* key, std::string& out, RECORD_KIND) { Opt(key, out, {}); }
    void NameRefs(const char* key, std::vector<std::string>& out, RECORD_KIND) { Texts(key, out); }
    /// One node or two; `reason` when there are others.
    void NodePair(const char* key, int& nodeI, int& nodeJ, std::size_t count, const char* reason);
    void Node(const char* key, int& id)
    {
        Need(key, id);
        if (m_names) m_in.Check(key, m_names->HasNode(id), "IDS_QM_CASE_NO_NODE");
    }
    void Element(const char* key, int& id)
    {
        Need(key, id);
        if (m_names) m_in.Check(key, m_names->HasElement(id), "IDS_QM_CASE_NO_ELEMENT");
    }
    void NodeList(const char* key, std::vector<int>& ids)
    {
        Need(key, ids);
        CheckIds(
            key, ids, [&](int id) { return m_names->HasNode(id); }, "IDS_QM_CASE_NO_NODE",
            "IDS_QM_CASE_NODE_TWICE");
    }
    void OptNodes(const char* key, std::vector<int>& ids)
    {
        ids.clear();
        if (Has(key)) NodeList(key, ids);
    }
    void OptElements(const char* key, std::vector<int>& ids);
    /// "first", "last" or a number from 1.
    void StageStep(const char* key, int& step, int missing);
    /// A fault of a case file unless `ok`; a member that is left out is not judged.
    void Check(const char* key, bool ok, const char* reason)
    {
        if (m_names) m_in.Check(key, ok, reason);
    }
    /// Refuses a member in words of the message catalogue; `args` take their places.
    template <class... ARGS>
    void Refuse(const char* key, const char* reason, const ARGS&... args)
    {
        m_in.FailAt(key, reason, args...);
    }
    template <class R, class F>
    void CheckEach(const char* key, const R& values, F ok, const char* reason)
    {
        if (m_names && m_in.Has(key)) m_in.CheckEach(key, values, ok, reason);
    }
    void SameCount(const char* key, std::size_t count, std::size_t expected)
    {
        if (m_names && count != expected && m_in.Has(key))
            m_in.FailAt(key, "IDS_QM_JSON_COUNT", std::to_string(count), std::to_string(expected));
    }
    /// A fault of the member, or of the whole object, in every file.
    void Rule(const char* key, bool ok, const char* reason)
    {
        if (ok || (key && !m_in.Has(key))) return;
        if (key)
            m_in.FailAt(key, reason);
        else
            m_in.Fail(reason);
    }
    template <int kFirst = 0, class E>
    void Enum(const char* key, E& out, std::span<const char* const> names, const char* what)
    {
        if (Take(key)) out = static_cast<E>(kFirst + m_in.Choice(key, names, what));
    }
    template <class E>
    void EnumIf(const char* key, std::optional<E>& out, std::span<const char* const> names,
                const char* what)
    {
        if (Has(key)) Enum(key, out.emplace(), names, what);
    }
    void Letter(const char* key, char& out, std::span<const char* const> names, const char* what)
    {
        if (Take(key)) out = *Word(key, names, what);
    }
    void LetterIf(const char* key, std::optional<char>& out, std::span<const char* const> names,
                  const char* what)
    {
        if (Has(key)) out = *Word(key, names, what);
    }
    void WordIf(const char* key, std::optional<std::string>& out,
                std::span<const char* const> names, const char* what)
    {
        if (Has(key)) out = Word(key, names, what);
    }
    template <class... T>
    void Variant(const char* key, std::variant<T...>& out, std::span<const char* const> names,
                 const char* what)
    {
        static const std::array<std::variant<T...>, sizeof...(T)> kBlank{T{}...};
        std::size_t index = 0;
        Must(key); // before what depends on it
        Enum(key, index, names, what);
        out = kBlank[index];
    }
    /// {"12": [...]}, six components by node.
    void NodeTable(const char* key, std::map<int, T_DOF6>& out);
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
        Nested(member, r, context...);
    }
    template <class R, class... C>
    void NeedPart(const char* key, R& r, const C&... context)
    {
        if (!Take(key)) return;
        CJsonReader member = m_in.Member(key);
        Nested(member, r, context...);
    }
    template <class R, class... C>
    void PartIf(const char* key, std::optional<R>& r, const C&... context)
    {
        if (m_in.Has(key)) r.emplace();
        if (r) return Part(key, *r, context...);
        m_keys.emplace_back(key);
    }
    template <class F>
    void Group(const char* key, const F& members)
    {
        if (Has(key)) NeedGroup(key, members);
    }
    template <class F>
    void NeedGroup(const char* key, const F& members)
    {
        if (!Take(key)) return;
        CJsonReader member = m_in.Member(key);
        CCaseGet group(member, m_units, {}, m_names);
        members(group);
        group.Finish();
    }
    template <class R, class... C>
    void List(const char* key, std::vector<R>& all, const C&... context)
    {
        if (!Has(key)) return;
        m_in.Member(key).ForEachItem(
            [&](CJsonReader& item, std::size_t) { Nested(item, all.emplace_back(), context...); });
    }
    template <class R, class... C>
    void ListIf(const char* key, std::optional<std::vector<R>>& all, const C&... context)
    {
        if (m_in.Has(key)) all.emplace();
        if (all) return List(key, *all, context...);
        m_keys.emplace_back(key);
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
            return member.Fail("IDS_QM_JSON_COUNT_UP_TO", std::to_string(values.size()),
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
    const char* Word(const char* key, std::span<const char* const> names, const char* what)
    {
        return names[static_cast<std::size_t>(m_in.Choice(key, names, what))];
    }
    template <class R, class... C>
    void Nested(CJsonReader& in, R& r, const C&... context)
    {
        CCaseGet get(in, m_units, {}, m_names);
        CaseFields(get, r, context...);
        get.Finish();
    }
    template <class F>
    void CheckIds(const char* key, const std::vector<int>& ids, F exists, const char* missing,
                  const char* twice)
    {
        if (!m_names || !m_in.Has(key)) return;
        std::set<int> seen;
        m_in.CheckEach(key, ids, exists, missing);
        m_in.CheckEach(
            key, ids, [&](int id) { return seen.insert(id).second; }, twice);
    }
    static void FailRef(CJsonReader& in, RECORD_KIND kind);
    /// A name, or where it may be one, a key.
    void ReadRef(CJsonReader& in, int& out, RECORD_KIND kind, bool mayBeKey) const;

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
        if (in.Failed()) return;
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
        if (!IsUsableNumber(value)) in.Fail("IDS_QM_CASE_TOO_LARGE");
    }

    CJsonReader& m_in;
    const T_UNITS& m_units;
    const CCaseNames* m_names; // null in the model file
    std::vector<std::string_view> m_keys;
    const char* m_missing = nullptr;
};
