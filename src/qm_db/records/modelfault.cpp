#include "qm_db/records/modelfault.h"

#include "qm_base/say.h"
#include "qm_db/records/hingefields.h"
#include "qm_db/records/inputlimits.h"
#include "qm_db/records/pushfields.h"
#include "qm_db/records/stagefields.h"
#include "qm_db/spectrumrules.h"

#include <algorithm>
#include <cmath>
#include <set>
#include <utility>

namespace {

/// Keeps the first fault of a record: "member: reason". Rules are not asked of members that a case
/// file would leave out.
class CFieldJudge : public CFieldLook<CFieldJudge> {
public:
    template <class T>
    using Ref = const T&;

    std::string Fault() const { return m_words.empty() ? "" : m_member + ": " + m_words; }
    const std::string& Member() const { return m_member; }
    const std::string& Words() const { return m_words; } // empty: all rules are kept
    void Fail(std::string_view key, const std::string& words)
    {
        if (!m_words.empty()) return;
        m_member = m_place + std::string(key);
        m_words = words;
    }

    template <class T>
    void Need(const char* key, const T& value, T_DIM = kDimNone)
    {
        Key(key);
        Numbers(value);
    }
    template <class T>
    void Opt(const char* key, const T& value, const T& missing, T_DIM = kDimNone)
    {
        if (value == missing)
            Leave(key);
        else
            Need(key, value);
    }
    const char* OptOr(const char* key, const char*, double value, double missing, T_DIM)
    {
        Opt(key, value, missing);
        return key;
    }
    template <class T>
    void OptIf(const char* key, const std::optional<T>& value, T_DIM = kDimNone)
    {
        if (!value) return Leave(key);
        Need(key, *value);
    }
    template <class T>
    void State(const char* key, const T& value)
    {
        Need(key, value);
    }
    template <class T>
    void Pairs(const char* key, const T& points)
    {
        Key(key);
        for (const T_PM_POINT& point : points)
            Number(point.p, kDimNone), Number(point.m, kDimNone);
    }
    void NodeTable(const char* key, const std::map<int, T_DOF6>& values)
    {
        Key(key);
        for (const auto& [node, components] : values)
            Numbers(components);
    }
    void StageStep(const char* key, int step, int missing)
    {
        if (step == missing) return Leave(key);
        Key(key);
        Rule(key, step == kStageLastStep || step >= kStageFirstStep, "IDS_QM_CASE_STEPS_FROM_1");
    }
    template <class R, class... C>
    void Part(const char* key, const R& r, const C&... context)
    {
        Key(key);
        Inside(std::string(key) + '.', [&] { CaseFields(*this, r, context...); });
    }
    template <class R, class... C>
    void NeedPart(const char* key, const R& r, const C&... context)
    {
        Part(key, r, context...);
    }
    template <class R, class... C>
    void PartIf(const char* key, const std::optional<R>& r, const C&... context)
    {
        if (!r) return Leave(key);
        Part(key, *r, context...);
    }
    template <class R, class... C>
    void List(const char* key, const std::vector<R>& all, const C&... context)
    {
        Key(key);
        for (std::size_t i = 0; i < all.size(); ++i)
            Inside(std::string(key) + '[' + std::to_string(i) + "].",
                   [&] { CaseFields(*this, all[i], context...); });
    }
    template <class R, class... C>
    void ListIf(const char* key, const std::optional<std::vector<R>>& all, const C&... context)
    {
        if (!all) return Leave(key);
        List(key, *all, context...);
    }
    template <class F>
    void Group(const char* key, const F& members)
    {
        Key(key);
        Inside(std::string(key) + '.', [&] { members(*this); });
    }
    template <class F>
    void NeedGroup(const char* key, const F& members)
    {
        Group(key, members);
    }

    template <int kFirst = 0, class E>
    void Enum(const char* key, const E& value, std::span<const char* const> names, const char* what)
    {
        Key(key);
        const auto at = static_cast<std::int64_t>(value) - kFirst;
        if (at < 0 || at >= static_cast<std::int64_t>(names.size()))
            FailChoice(key, std::to_string(at + kFirst), names, what);
    }
    template <int kFirst = 0, class E>
    void EnumOpt(const char* key, const E& value, const std::type_identity_t<E>&,
                 std::span<const char* const> names, const char* what)
    {
        Enum<kFirst>(key, value, names, what);
    }
    template <class E>
    void EnumIf(const char* key, const std::optional<E>& value, std::span<const char* const> names,
                const char* what)
    {
        if (!value) return Leave(key);
        Enum(key, *value, names, what);
    }
    void Letter(const char* key, char value, std::span<const char* const> names, const char* what)
    {
        Word(key, std::string(1, value), names, what);
    }
    void LetterIf(const char* key, std::optional<char> value, std::span<const char* const> names,
                  const char* what)
    {
        if (!value) return Leave(key);
        Letter(key, *value, names, what);
    }
    void WordIf(const char* key, const std::optional<std::string>& value,
                std::span<const char* const> names, const char* what)
    {
        if (!value) return Leave(key);
        Word(key, *value, names, what);
    }

    void Check(const char* key, bool ok, const char* reason) { Rule(key, ok, reason); }
    template <class T, class F>
    void CheckEach(const char* key, const T& values, F ok, const char* reason)
    {
        for (const auto& value : values)
            Rule(key, ok(value), reason);
    }
    void SameCount(const char* key, std::size_t count, std::size_t expected)
    {
        if (count != expected)
            Fail(key, Say("IDS_QM_JSON_COUNT", std::to_string(count), std::to_string(expected)));
    }
    void Rule(const char* key, bool ok, const char* reason)
    {
        if (!ok && (!key || !m_left.contains(key))) Fail(key ? key : "", Say(reason));
    }

    // What the base class calls with each member.
    void Key(const char* key)
    {
        m_key = key;
        m_left.erase(key);
    }
    void Number(double value, T_DIM)
    {
        if (!std::isfinite(value)) Fail(m_key, Say("IDS_QM_JSON_NOT_FINITE"));
        if (!IsUsableNumber(value)) Fail(m_key, Say("IDS_QM_CASE_TOO_LARGE"));
    }

private:
    /// Members of what is inside a member.
    template <class F>
    void Inside(const std::string& place, const F& members)
    {
        const std::string outer = m_place;
        m_place += place;
        const std::set<std::string_view> left = std::exchange(m_left, {});
        members();
        m_place = outer;
        m_left = left;
    }
    /// A case file would not have the member.
    void Leave(const char* key) { m_left.insert(key); }
    template <class T>
    void Numbers(const T& value)
    {
        if constexpr (std::is_same_v<T, double>)
            Number(value, kDimNone);
        else if constexpr (requires { std::tuple_size<T>::value; } ||
                           std::is_same_v<T, std::vector<double>>)
            for (const auto& number : value)
                Numbers(number);
    }
    void Word(const char* key, const std::string& word, std::span<const char* const> names,
              const char* what)
    {
        Key(key);
        if (std::ranges::find(names, word) == names.end()) FailChoice(key, word, names, what);
    }
    void FailChoice(const char* key, const std::string& found, std::span<const char* const> names,
                    const char* what)
    {
        std::string all;
        for (const char* const name : names)
            all += (all.empty() ? "" : ", ") + std::string(name);
        Fail(key, Say("IDS_QM_JSON_CHOICE", Say(what), '"' + found + '"', all));
    }

    std::string m_member, m_words;
    std::string m_place;    // of what the members are in
    std::string_view m_key; // of the member that was met last
    std::set<std::string_view> m_left;
};

// What stands outside a record's list of members.
template <class R>
void JudgeMore(CFieldJudge&, const R&)
{
}
void JudgeMore(CFieldJudge& judge, const T_ULFC_D& r)
{
    judge.Rule("upper", !r.inequality || r.upper || r.lower, "IDS_QM_CASE_CONSTRAINT_NO_BOUND");
}
void JudgeMore(CFieldJudge& judge, const T_POLC_D& r)
{
    judge.CheckEach(
        "modes", r.modes, [](int mode) { return mode > 0; }, "IDS_QM_CASE_MODES_FROM_1");
}
void JudgeMore(CFieldJudge& judge, const T_EVAL_D& r)
{
    for (const T_FINDING& finding : OptionFindings(r))
        judge.Fail(finding.field, finding.text);
}

/// Each kind in the order of the registry, until a record has a fault.
class CModelJudge {
public:
    explicit CModelJudge(const T_MODEL& model) : m_model(model) {}

    template <class R>
    void operator()(const T_RECORD_ROW<R>& row)
    {
        std::set<std::string_view> taken;
        for (const auto& [key, record] : m_model.*row.table) {
            if (!m_fault.empty()) return;
            CFieldJudge judge;
            if constexpr (kHasName<R>) {
                const char* const reason = NameFault(record.name);
                judge.Rule("name", !reason, reason ? reason : "");
                if (!taken.insert(record.name).second)
                    judge.Fail("name", Say("IDS_QM_JSON_TWICE", '"' + record.name + '"'));
            }
            CaseFields(judge, record);
            JudgeMore(judge, record);
            Take(judge, std::string(row.store) + ' ' + std::to_string(key));
        }
    }
    void Take(const CFieldJudge& judge, const std::string& place)
    {
        if (!judge.Fault().empty()) m_fault = place + ' ' + judge.Fault();
    }
    const std::string& Fault() const { return m_fault; }

private:
    const T_MODEL& m_model;
    std::string m_fault;
};

template <class R>
std::vector<T_FINDING> FindingsOf(const T_TABLE<R>& table, const R& record, int key)
{
    CFieldJudge judge;
    const char* const reason = NameFault(record.name);
    judge.Rule("name", !reason, reason ? reason : "");
    for (const auto& [other, taken] : table)
        if (other != key && taken.name == record.name)
            judge.Fail("name", Say("IDS_QM_JSON_TWICE", '"' + record.name + '"'));
    CaseFields(judge, record);
    if (judge.Words().empty()) return {};
    T_FINDING finding;
    finding.field = judge.Member();
    finding.ruleText = judge.Member();
    finding.messageKey = "IDS_QM_DB_RECORD_FAULT";
    finding.text = Say(finding.messageKey, judge.Member(), judge.Words());
    return {finding};
}

} // namespace

std::vector<T_FINDING> RecordFindings(const T_MODEL& model, const T_SECT_D& record, int key)
{
    return FindingsOf(model.sections, record, key);
}

std::vector<T_FINDING> RecordFindings(const T_MODEL& model, const T_MATL_D& record, int key)
{
    return FindingsOf(model.materials, record, key);
}

std::vector<T_FINDING> RecordFindings(const T_MODEL& model, const T_SPFC_D& record, int key)
{
    return FindingsOf(model.spectra, record, key);
}

std::string ModelFault(const T_MODEL& model)
{
    CModelJudge all(model);
    CFieldJudge head;
    CaseFields(head, model.styp);
    all.Take(head, "model");
    CFieldJudge control;
    CaseFields(control, model.pushControl);
    all.Take(control, "pushover_control");
    ForEachKind(all);
    return all.Fault();
}
