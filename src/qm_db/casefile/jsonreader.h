// A cursor over one value of a JSON document that knows its place. The first fault is kept: after
// it every reading does nothing, so that a record's reading needs no check after each member.
#pragma once

#include "qm_base/say.h"
#include "qm_db/casefile/jsonvalue.h"
#include "qm_db/file/jsonplace.h"
#include "qm_db/fileerror.h"

#include <algorithm>
#include <array>
#include <initializer_list>
#include <optional>
#include <set>
#include <span>
#include <string>
#include <string_view>
#include <vector>

class CJsonReader {
public:
    /// `value` may be null (a missing member). `error` takes the first fault, "place: reason".
    CJsonReader(T_JSON* value, std::string place, T_FILE_ERROR& error)
        : m_value(value), m_place(std::move(place)), m_error(&error)
    {
    }

    bool Failed() const { return m_error->fault != FILE_FAULT::None; }
    /// Records a fault of this value, or of its member `key`, unless there is one already. A reason
    /// is a key of the message catalogue, here and below; `args` take its places.
    template <class... ARGS>
    void Fail(std::string_view reason, const ARGS&... args)
    {
        if (!Failed()) FailWith(Say(reason, args...));
    }
    template <class... ARGS>
    void FailAt(std::string_view key, std::string_view reason, const ARGS&... args)
    {
        if (!Failed())
            CJsonReader(nullptr, MemberPlace(m_place, key), *m_error).Fail(reason, args...);
    }
    /// The same with a reason in words.
    void FailWith(const std::string& words, FILE_FAULT fault = FILE_FAULT::BadInput);
    /// A fault of the member unless `ok`; members that are left out are not judged.
    void Check(std::string_view key, bool ok, const char* reason);
    template <class T, class F>
    void CheckIf(std::string_view key, const std::optional<T>& value, F ok, const char* reason);
    /// The same for each value of an array; the place carries the index.
    template <class R, class F>
    void CheckEach(std::string_view key, const R& values, F ok, const char* reason);

    /// This value is an object and has no other keys.
    void Keys(std::initializer_list<std::string_view> known)
    {
        Keys(std::span<const std::string_view>(known.begin(), known.size()));
    }
    void Keys(std::span<const std::string_view> known);
    bool Has(std::string_view key) const { return Find(key) != nullptr; }
    /// A member that must be there.
    CJsonReader Member(std::string_view key);

    /// Reads a member that must be there; an optional one that may be left out; one with a default.
    template <class T>
    void Get(std::string_view key, T& out)
    {
        Member(key).Read(out);
    }
    template <class T>
    void Get(std::string_view key, std::optional<T>& out)
    {
        if (Has(key)) Member(key).Read(out.emplace());
    }
    template <class T>
    void GetIf(std::string_view key, T& out)
    {
        if (Has(key)) Member(key).Read(out);
    }
    /// Reads a name (not empty, no control characters) that no other record of its table has.
    void GetName(std::string_view key, std::string& out, std::set<std::string>& taken);
    /// Reads a text out of a list and gives its index; `what` names it, a catalogue key.
    int Choice(std::string_view key, std::span<const char* const> names, const char* what)
    {
        return Member(key).Choice(names, what);
    }
    /// The same for this value.
    int Choice(std::span<const char* const> names, const char* what);

    void Read(double& out);
    void Read(int& out);
    void Read(bool& out);
    void Read(std::string& out);
    void Read(std::vector<double>& out); // takes the numbers out of the document
    void Read(std::vector<int>& out);
    template <class T, std::size_t N>
    void Read(std::array<T, N>& out);

    /// Calls f(CJsonReader& item, index) for each item of the array; for each member of the object
    /// whose keys are node ids f(CJsonReader& member, int node).
    template <class F>
    void ForEachItem(F&& f);
    template <class F>
    void ForEachNode(F&& f);
    bool IsNumber() const { return m_value && std::holds_alternative<double>(m_value->data); }
    bool IsText() const { return m_value && std::holds_alternative<std::string>(m_value->data); }

private:
    T_JSON* Find(std::string_view key) const;
    void FailType(const char* expected);
    void FailAtItem(std::string_view key, std::size_t index, const char* reason);
    void FailCount(std::size_t found, std::size_t expected);
    int NodeIdOf(const std::string& key);

    T_JSON* m_value;
    std::string m_place;
    T_FILE_ERROR* m_error;
};

template <class T, class F>
void CJsonReader::CheckIf(std::string_view key, const std::optional<T>& value, F ok,
                          const char* reason)
{
    if (value) Check(key, ok(*value), reason);
}

template <class R, class F>
void CJsonReader::CheckEach(std::string_view key, const R& values, F ok, const char* reason)
{
    std::size_t index = 0;
    for (const auto& value : values) {
        if (!ok(value)) FailAtItem(key, index, reason);
        ++index;
    }
}

template <class T, std::size_t N>
void CJsonReader::Read(std::array<T, N>& out)
{
    std::vector<T> values;
    Read(values);
    if (Failed()) return;
    if (values.size() != N) return FailCount(values.size(), N);
    std::copy(values.begin(), values.end(), out.begin());
}

template <class F>
void CJsonReader::ForEachItem(F&& f)
{
    if (Failed()) return;
    auto* items = m_value ? std::get_if<T_JSON_ITEMS>(&m_value->data) : nullptr;
    const auto* numbers = m_value ? std::get_if<T_JSON_NUMBERS>(&m_value->data) : nullptr;
    if (!items && !numbers) return FailType("IDS_QM_JSON_ARRAY");
    const std::size_t count = items ? items->size() : numbers->size();
    for (std::size_t i = 0; i < count && !Failed(); ++i) {
        T_JSON number; // items of a packed array are numbers
        if (!items) number.data = (*numbers)[i];
        CJsonReader item(items ? &(*items)[i] : &number, ItemPlace(m_place, i), *m_error);
        f(item, i);
    }
}

template <class F>
void CJsonReader::ForEachNode(F&& f)
{
    if (Failed()) return;
    auto* members = m_value ? std::get_if<T_JSON_MEMBERS>(&m_value->data) : nullptr;
    if (!members) return FailType("IDS_QM_JSON_OBJECT");
    for (T_JSON_MEMBER& entry : *members) {
        CJsonReader member(&entry.value, MemberPlace(m_place, entry.key), *m_error);
        const int node = member.NodeIdOf(entry.key);
        if (Failed()) return;
        f(member, node);
    }
}
