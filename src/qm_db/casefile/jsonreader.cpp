#include "qm_db/casefile/jsonreader.h"

#include "qm_base/nearname.h"
#include "qm_base/textformat.h"
#include "qm_db/records/inputlimits.h"

#include <algorithm>
#include <charconv>
#include <cmath>
#include <limits>

namespace {

// In the order of the variant in T_JSON.
constexpr const char* kBool = "IDS_QM_JSON_BOOL";
constexpr const char* kNumber = "IDS_QM_JSON_NUMBER";
constexpr const char* kText = "IDS_QM_JSON_TEXT";
constexpr const char* kArray = "IDS_QM_JSON_ARRAY";
constexpr const char* kObject = "IDS_QM_JSON_OBJECT";
constexpr std::array<const char*, 7> kKindNames{
    "IDS_QM_JSON_NULL", kBool, kNumber, kText, kArray, kArray, kObject};

bool IsInt(double value)
{
    return std::fabs(value) <= std::numeric_limits<int>::max() && value == std::floor(value);
}

std::string Joined(std::span<const char* const> names)
{
    std::string all;
    for (const char* name : names)
        all += (all.empty() ? "" : ", ") + std::string(name);
    return all;
}

/// The key with the known one that was meant; where none is near, with a short list of them.
std::string UnknownKey(const std::string& key, std::span<const std::string_view> known)
{
    constexpr std::size_t kShortList = 12;
    const std::string meant = NearestName(key, known);
    if (!meant.empty())
        return Say("IDS_QM_JSON_UNKNOWN_KEY_NEAR", QuotedText(key), QuotedText(meant));
    std::string all;
    std::size_t count = 0;
    for (auto name = known.begin(); name != known.end(); ++name) {
        if (std::find(known.begin(), name, *name) != name) continue; // asked for twice
        all += (count++ == 0 ? "" : ", ") + std::string(*name);
    }
    if (count == 0 || count > kShortList) return Say("IDS_QM_JSON_UNKNOWN_KEY", QuotedText(key));
    return Say("IDS_QM_JSON_UNKNOWN_KEY_KNOWN", QuotedText(key), all);
}

} // namespace

void CJsonReader::FailWith(const std::string& words, FILE_FAULT fault)
{
    if (!Failed()) *m_error = {fault, m_place.empty() ? words : m_place + ": " + words};
}

void CJsonReader::FailAtItem(std::string_view key, std::size_t index, const char* reason)
{
    if (Failed()) return;
    CJsonReader(nullptr, ItemPlace(MemberPlace(m_place, key), index), *m_error).Fail(reason);
}

void CJsonReader::FailType(const char* expected)
{
    const std::size_t kind = m_value ? m_value->data.index() : 0;
    Fail("IDS_QM_JSON_TYPE", Say(expected), Say(kKindNames[kind]));
}

void CJsonReader::FailCount(std::size_t found, std::size_t expected)
{
    Fail("IDS_QM_JSON_COUNT", std::to_string(found), std::to_string(expected));
}

void CJsonReader::Check(std::string_view key, bool ok, const char* reason)
{
    if (!ok && Has(key)) FailAt(key, reason);
}

T_JSON* CJsonReader::Find(std::string_view key) const
{
    auto* members = m_value ? std::get_if<T_JSON_MEMBERS>(&m_value->data) : nullptr;
    if (!members) return nullptr;
    for (T_JSON_MEMBER& member : *members) {
        if (member.key == key) return &member.value;
    }
    return nullptr;
}

void CJsonReader::Keys(std::span<const std::string_view> known)
{
    const auto* members = m_value ? std::get_if<T_JSON_MEMBERS>(&m_value->data) : nullptr;
    if (!members) return FailType(kObject);
    for (const T_JSON_MEMBER& member : *members) {
        if (std::find(known.begin(), known.end(), member.key) == known.end())
            return FailWith(UnknownKey(member.key, known));
    }
}

CJsonReader CJsonReader::Member(std::string_view key)
{
    T_JSON* value = Find(key);
    if (!value) Fail("IDS_QM_JSON_MISSING", QuotedText(key));
    return {value, MemberPlace(m_place, key), *m_error};
}

void CJsonReader::GetName(std::string_view key, std::string& out, std::set<std::string>& taken)
{
    Get(key, out);
    if (const char* const reason = NameFault(out)) Check(key, false, reason);
    if (!taken.insert(out).second) FailAt(key, "IDS_QM_JSON_TWICE", QuotedText(out));
}

int CJsonReader::Choice(std::span<const char* const> names, const char* what)
{
    std::string text;
    Read(text);
    const auto it = std::find(names.begin(), names.end(), text);
    if (it != names.end()) return static_cast<int>(it - names.begin());
    Fail("IDS_QM_JSON_CHOICE", Say(what), QuotedText(text), Joined(names));
    return 0;
}

void CJsonReader::Read(double& out)
{
    if (Failed()) return;
    const auto* number = m_value ? std::get_if<double>(&m_value->data) : nullptr;
    if (!number) return FailType(kNumber);
    if (!IsUsableNumber(*number)) return Fail("IDS_QM_CASE_TOO_LARGE");
    out = *number;
}

void CJsonReader::Read(int& out)
{
    double number = 0.0;
    Read(number);
    if (Failed()) return;
    if (!IsInt(number)) return Fail("IDS_QM_JSON_NOT_INTEGER", ShortestText(number));
    out = static_cast<int>(number);
}

void CJsonReader::Read(bool& out)
{
    if (Failed()) return;
    const auto* flag = m_value ? std::get_if<bool>(&m_value->data) : nullptr;
    if (!flag) return FailType(kBool);
    out = *flag;
}

void CJsonReader::Read(std::string& out)
{
    if (Failed()) return;
    const auto* text = m_value ? std::get_if<std::string>(&m_value->data) : nullptr;
    if (!text) return FailType(kText);
    out = *text;
}

void CJsonReader::Read(std::vector<double>& out)
{
    if (Failed()) return;
    auto* numbers = m_value ? std::get_if<T_JSON_NUMBERS>(&m_value->data) : nullptr;
    if (numbers) {
        const auto bad = std::ranges::find_if_not(*numbers, IsUsableNumber);
        if (bad != numbers->end())
            return CJsonReader(nullptr, ItemPlace(m_place, bad - numbers->begin()), *m_error)
                .Fail("IDS_QM_CASE_TOO_LARGE");
        out = std::move(*numbers);
        return;
    }
    double number = 0.0; // a mixed array: the first item that is no number makes the fault
    ForEachItem([&](CJsonReader& item, std::size_t) { item.Read(number); });
}

void CJsonReader::Read(std::vector<int>& out)
{
    std::vector<int> values;
    ForEachItem([&](CJsonReader& item, std::size_t) { item.Read(values.emplace_back()); });
    if (!Failed()) out = std::move(values);
}

int CJsonReader::NodeIdOf(const std::string& key)
{
    int node = 0;
    const char* const end = key.data() + key.size();
    const auto [stop, fault] = std::from_chars(key.data(), end, node);
    if (fault != std::errc{} || stop != end || node <= 0 || key.front() == '0')
        Fail("IDS_QM_JSON_NODE_KEY");
    return node;
}
