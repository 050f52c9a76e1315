// Visitor of CaseFields: prints the members of a record in SI as one object of a case file.
#pragma once

#include "qm_db/casefile/jsonwriter.h"
#include "qm_db/records/casenames.h"
#include "qm_db/records/hingefields.h"
#include "qm_db/records/pushfields.h"
#include "qm_db/records/stagefields.h"

#include <algorithm>
#include <bit>
#include <cstdint>
#include <type_traits>

template <class R, class... Listed>
constexpr bool kIsAnyOf = (std::is_same_v<R, Listed> || ...);

/// Records that stand on one line.
template <class R>
constexpr bool kIsOneLine =
    kIsAnyOf<R, T_NODE_D, T_ELEM_D, T_MATL_D, T_EQDS_D, T_ULFC_D, T_REBAR, T_SECT_FACTORS,
             T_NODAL_LOAD, T_BEAM_LOAD, T_SETTLEMENT, T_TEMPERATURE_LOAD, T_PTNS_D, T_LCOM_ITEM,
             T_ULFI_UNKNOWN, T_STAG_LOAD, T_ULSI_ROW, T_SKEL_POINT, T_SIDES<double>, T_POLC_PATTERN,
             T_PUSH_INITIAL_LOAD, T_PUSH_STOPS_D, T_POVR_D, T_SPFC_NTC_STATE, T_EVAL_BILINEAR>;

class CCasePut {
public:
    template <class T>
    using Ref = const T&;
    static constexpr bool kReads = false;
    static constexpr bool kWrites = true;

    /// `names`: of a case file; without them (in the model file) references are keys.
    explicit CCasePut(CJsonWriter& out, const CCaseNames* names = nullptr)
        : m_out(out), m_names(names)
    {
    }

    /// The reason is a catalogue key.
    void Fail(const char* reason) { m_out.Fail(reason); }

    template <class T>
    void Need(const char* key, const T& value, T_DIM dim = kDimNone)
    {
        Begin(key);
        if constexpr (!std::is_integral_v<T> && requires { m_out.Value(value, dim); })
            m_out.Value(value, dim);
        else
            m_out.Value(value);
    }
    template <class T>
    void Opt(const char* key, const T& value, const T& missing, T_DIM dim = kDimNone)
    {
        if (!Same(value, missing)) Need(key, value, dim);
    }
    const char* OptOr(const char* key, const char*, double value, double missing, T_DIM dim)
    {
        Opt(key, value, missing, dim);
        return key;
    }
    template <class T>
    void OptIf(const char* key, const std::optional<T>& value, T_DIM dim = kDimNone)
    {
        if (value) Need(key, *value, dim);
    }
    template <class T>
    void State(const char* key, const T& value)
    {
        Need(key, value);
    }
    template <std::size_t N>
    void StateFixed(const char* key, const std::array<double, N>& values,
                    const std::array<T_DIM, N>& dims)
    {
        NeedFixed(key, values, dims);
    }
    template <std::size_t N>
    void NeedFixed(const char* key, const std::array<double, N>& values,
                   const std::array<T_DIM, N>& dims)
    {
        Begin(key);
        m_out.Value(std::span<const double>(values), std::span<const T_DIM>(dims));
    }
    template <std::size_t N>
    void OptFixed(const char* key, const std::array<double, N>& values,
                  const std::array<double, N>& missing, const std::array<T_DIM, N>& dims)
    {
        const auto same = [](double a, double b) { return Same(a, b); };
        if (!std::equal(values.begin(), values.end(), missing.begin(), same))
            NeedFixed(key, values, dims);
    }
    template <std::size_t N>
    void Flags(const char* key, const std::array<bool, N>& flags,
               const std::array<const char*, N>& names, const char*)
    {
        std::vector<std::string> set;
        for (std::size_t i = 0; i < N; ++i) {
            if (flags[i]) set.emplace_back(names[i]);
        }
        Texts(key, set);
    }
    void Texts(const char* key, const std::vector<std::string>& texts)
    {
        if (texts.empty()) return;
        Begin(key);
        m_out.Value(std::span<const std::string>(texts));
    }
    void OptRef(const char* key, int target, RECORD_KIND kind)
    {
        if (target != 0) NeedRef(key, target, kind);
    }
    void NeedRef(const char* key, int target, RECORD_KIND kind)
    {
        if (!m_names) return Need(key, target);
        Begin(key);
        const std::string* const name = m_names->NameOf(kind, target);
        if (!name) return m_out.Fail("IDS_QM_CASE_NO_NAME_OF_KEY", std::to_string(target));
        m_out.Value(std::string_view(*name));
    }
    void KeyRef(const char* key, int target, RECORD_KIND) { Need(key, target); }
    void OptKeyRef(const char* key, int target, RECORD_KIND) { Opt(key, target, 0); }
    void FreeKeyRef(const char* key, int target, RECORD_KIND) { Need(key, target); }
    void Refs(const char* key, const std::vector<int>& targets, RECORD_KIND kind)
    {
        if (!m_names) return OptNodes(key, targets);
        std::vector<std::string> names;
        for (const int target : targets) {
            const std::string* const name = m_names->NameOf(kind, target);
            if (!name) return m_out.Fail("IDS_QM_CASE_NO_NAME_OF_KEY", std::to_string(target));
            names.push_back(*name);
        }
        Texts(key, names);
    }
    void NameRef(const char* key, const std::string& target, RECORD_KIND) { Need(key, target); }
    void OptNameRef(const char* key, const std::string& target, RECORD_KIND)
    {
        Opt(key, target, {});
    }
    void NameRefs(const char* key, const std::vector<std::string>& targets, RECORD_KIND)
    {
        Texts(key, targets);
    }
    void NodePair(const char* key, int nodeI, int nodeJ, std::size_t count, const char*)
    {
        const std::array<int, 2> nodes{nodeI, nodeJ};
        Begin(key);
        m_out.Value(std::span<const int>(nodes).first(count));
    }
    void Node(const char* key, int id) { Need(key, id); }
    void Element(const char* key, int id) { Need(key, id); }
    void NodeList(const char* key, const std::vector<int>& ids) { Need(key, ids); }
    void OptNodes(const char* key, const std::vector<int>& ids)
    {
        if (!ids.empty()) Need(key, ids);
    }
    void OptElements(const char* key, const std::vector<int>& ids) { OptNodes(key, ids); }
    void StageStep(const char* key, int step, int missing)
    {
        if (step == missing) return;
        if (step > kStageFirstStep) return Need(key, step);
        Begin(key);
        if (step != kStageFirstStep && step != kStageLastStep)
            return m_out.Fail("IDS_QM_CASE_NO_STEP", std::to_string(step));
        m_out.Value(kStageStepNames[step == kStageFirstStep ? 0 : 1]);
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
    template <int kFirst = 0, class E>
    void Enum(const char* key, E value, std::span<const char* const> names, const char*)
    {
        WriteName(key, static_cast<int>(value) - kFirst, names);
    }
    template <class E>
    void EnumIf(const char* key, const std::optional<E>& value, std::span<const char* const> names,
                const char* what)
    {
        if (value) Enum(key, *value, names, what);
    }
    template <class... A>
    void Letter(const char* key, char value, const A&...)
    {
        Begin(key);
        m_out.Value(std::string_view(&value, 1));
    }
    template <class... A>
    void LetterIf(const char* key, const std::optional<char>& value, const A&...)
    {
        if (value) Letter(key, *value);
    }
    template <class... A>
    void WordIf(const char* key, const std::optional<std::string>& value, const A&...)
    {
        OptIf(key, value);
    }
    template <class... T>
    void Variant(const char* key, const std::variant<T...>& value,
                 std::span<const char* const> names, const char*)
    {
        WriteName(key, static_cast<int>(value.index()), names);
    }
    void NodeTable(const char* key, const std::map<int, T_DOF6>& values)
    {
        Begin(key);
        m_out.BeginObject();
        for (const auto& [node, components] : values)
            m_out.Member(std::to_string(node), std::span<const double>(components));
        m_out.EndObject();
    }
    template <int kFirst = 0, class E>
    void EnumOpt(const char* key, E value, E missing, std::span<const char* const> names,
                 const char*)
    {
        if (value != missing) WriteName(key, static_cast<int>(value) - kFirst, names);
    }
    template <class E>
    void Code(const char* key, E value, std::span<const char* const> names, const char*)
    {
        const auto code = static_cast<int>(value);
        if (code < 0 || static_cast<std::size_t>(code) >= names.size()) return Need(key, code);
        WriteName(key, code, names);
    }
    /// Left out when none of its members is written.
    template <class R, class... C>
    void Part(const char* key, const R& r, const C&... context)
    {
        m_waiting.push_back({key, kIsOneLine<R>});
        CaseFields(*this, r, context...);
        EndPart();
    }
    template <class R, class... C>
    void NeedPart(const char* key, const R& r, const C&... context)
    {
        m_waiting.push_back({key, kIsOneLine<R>});
        BeginWaiting();
        CaseFields(*this, r, context...);
        EndPart();
    }
    template <class R, class... C>
    void PartIf(const char* key, const std::optional<R>& r, const C&... context)
    {
        if (r) NeedPart(key, *r, context...);
    }
    /// On one line, left out when none of its members is written.
    template <class F>
    void Group(const char* key, const F& members)
    {
        m_waiting.push_back({key, true});
        members(*this);
        EndPart();
    }
    template <class F>
    void NeedGroup(const char* key, const F& members)
    {
        m_waiting.push_back({key, false});
        BeginWaiting();
        members(*this);
        EndPart();
    }
    template <class R, class... C>
    void List(const char* key, const std::vector<R>& all, const C&... context)
    {
        if (!all.empty()) WriteList(key, all, context...);
    }
    template <class R, class... C>
    void ListIf(const char* key, const std::optional<std::vector<R>>& all, const C&... context)
    {
        if (all) WriteList(key, *all, context...);
    }
    template <std::size_t N>
    void Padded(const char* key, const std::array<double, N>& values, T_DIM dim)
    {
        std::size_t count = N;
        while (count > 0 && Same(values[count - 1], 0.0))
            --count;
        if (count == 0) return;
        Begin(key);
        m_out.Value(std::span<const double>(values.data(), count), dim);
    }
    template <std::size_t N>
    void Pairs(const char* key, const std::array<T_PM_POINT, N>& points)
    {
        std::array<double, N> p{}, m{};
        bool blank = true;
        for (std::size_t i = 0; i < N; ++i) {
            p[i] = points[i].p;
            m[i] = points[i].m;
            blank = blank && Same(p[i], 0.0) && Same(m[i], 0.0);
        }
        if (blank) return;
        Begin(key);
        m_out.BeginObject();
        m_out.Member("p", std::span<const double>(p));
        m_out.Member("m", std::span<const double>(m));
        m_out.EndObject();
    }

private:
    static bool Same(double a, double b) // -0.0 is not 0.0
    {
        return std::bit_cast<std::uint64_t>(a) == std::bit_cast<std::uint64_t>(b);
    }
    template <class T>
    static bool Same(const T& a, const T& b)
    {
        return a == b;
    }

    template <class R, class... C>
    void WriteList(const char* key, const std::vector<R>& all, const C&... context)
    {
        Begin(key);
        m_out.BeginArray();
        for (const R& r : all) {
            m_out.BeginObject(kIsOneLine<R>);
            CCasePut item(m_out, m_names);
            CaseFields(item, r, context...);
            m_out.EndObject();
        }
        m_out.EndArray();
    }

    void WriteName(const char* key, int index, std::span<const char* const> names)
    {
        Begin(key);
        if (index < 0 || static_cast<std::size_t>(index) >= names.size())
            return m_out.Fail("IDS_QM_CASE_NO_NAME_OF_VALUE", std::to_string(index));
        m_out.Value(names[static_cast<std::size_t>(index)]);
    }
    /// The parts that were waiting for their first member, then the key.
    void Begin(const char* key)
    {
        BeginWaiting();
        m_out.Key(key);
    }
    void BeginWaiting()
    {
        for (; m_begun < m_waiting.size(); ++m_begun) {
            m_out.Key(m_waiting[m_begun].key);
            m_out.BeginObject(m_waiting[m_begun].oneLine);
        }
    }
    void EndPart()
    {
        if (m_begun == m_waiting.size()) {
            m_out.EndObject();
            --m_begun;
        }
        m_waiting.pop_back();
    }

    CJsonWriter& m_out;
    const CCaseNames* m_names; // null in the model file
    struct T_PART {
        const char* key;
        bool oneLine;
    };
    std::vector<T_PART> m_waiting; // the open parts, outermost first
    std::size_t m_begun = 0;       // those that have been written
};
