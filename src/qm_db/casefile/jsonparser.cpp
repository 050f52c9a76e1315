#include "qm_db/casefile/jsonparser.h"

#include "qm_base/say.h"
#include "qm_db/file/jsonplace.h"

#include <algorithm>
#include <nlohmann/json.hpp>
#include <optional>

namespace {

constexpr std::size_t kLongestReason = 120; // bytes of a parser message that are shown

/// The key that appears twice; nullopt when all differ.
std::optional<std::string> DoubledKey(const T_JSON_MEMBERS& members)
{
    std::vector<std::string_view> keys;
    keys.reserve(members.size());
    for (const T_JSON_MEMBER& member : members)
        keys.push_back(member.key);
    std::sort(keys.begin(), keys.end());
    const auto twice = std::adjacent_find(keys.begin(), keys.end());
    if (twice == keys.end()) return std::nullopt;
    return std::string(*twice);
}

/// "line 3, column 7: what", the place of the byte before `offset`.
std::string AtOffset(std::string_view text, std::size_t offset, const std::string& what)
{
    const std::string_view head = text.substr(0, std::min(offset, text.size()));
    const auto line = 1 + std::count(head.begin(), head.end(), '\n');
    const std::size_t lineStart = head.rfind('\n') + 1; // npos + 1 is 0
    const std::size_t column = std::max<std::size_t>(1, head.size() - lineStart);
    return Say("IDS_QM_JSON_LINE", std::to_string(line), std::to_string(column), what);
}

/// Where the first value deeper than the limit starts; the text before it is valid JSON.
std::size_t OffsetOfTooDeep(std::string_view text)
{
    int depth = 0;
    bool inText = false;
    for (std::size_t i = 0; i < text.size(); ++i) {
        const char c = text[i];
        if (inText && c == '\\')
            ++i;
        else if (c == '"')
            inText = !inText;
        else if (!inText && (c == '{' || c == '[') && ++depth > kJsonMaxDepth)
            return i + 1;
        else if (!inText && (c == '}' || c == ']'))
            --depth;
    }
    return text.size();
}

/// The parser's own words without its prefixes.
std::string ReasonOf(std::string_view what)
{
    if (const auto bracket = what.find("] "); bracket != what.npos) what.remove_prefix(bracket + 2);
    if (what.starts_with("parse error at")) {
        const auto colon = what.find(": ");
        if (colon != what.npos) what.remove_prefix(colon + 2);
    }
    std::string reason = EscapedText(what.substr(0, kLongestReason));
    return what.size() > kLongestReason ? reason + "..." : reason;
}

/// Receives the parser's events and builds the document.
class CJsonBuilder {
public:
    explicit CJsonBuilder(std::string_view text) : m_text(text) {}

    T_JSON m_root;
    std::string m_fault; // empty: none so far

    bool null() { return Add({}); }
    bool boolean(bool value) { return Add({value}); }
    bool number_integer(std::int64_t value) { return AddNumber(static_cast<double>(value)); }
    bool number_unsigned(std::uint64_t value) { return AddNumber(static_cast<double>(value)); }
    bool number_float(double value, const std::string&) { return AddNumber(value); }
    bool string(std::string& value) { return Add({std::move(value)}); }
    bool binary(std::vector<std::uint8_t>&) { return false; } // not in a text document
    bool start_object(std::size_t) { return Open({T_JSON_MEMBERS{}}); }
    bool start_array(std::size_t) { return Open({T_JSON_NUMBERS{}}); }

    bool key(std::string& name)
    {
        std::get<T_JSON_MEMBERS>(m_open.back()->data).emplace_back().key = std::move(name);
        return true;
    }
    bool end_object()
    {
        const auto twice = DoubledKey(std::get<T_JSON_MEMBERS>(m_open.back()->data));
        if (twice) m_fault = PlacePrefix() + Say("IDS_QM_JSON_KEY_TWICE", EscapedText(*twice));
        m_open.pop_back();
        return m_fault.empty();
    }
    bool end_array()
    {
        m_open.pop_back();
        return true;
    }
    bool parse_error(std::size_t offset, const std::string&, const std::exception& reason)
    {
        m_fault = AtOffset(m_text, offset, Say("IDS_QM_JSON_SYNTAX", ReasonOf(reason.what())));
        return false;
    }

private:
    bool AddNumber(double value)
    {
        if (!m_open.empty()) {
            if (auto* numbers = std::get_if<T_JSON_NUMBERS>(&m_open.back()->data)) {
                numbers->push_back(value);
                return true;
            }
        }
        return Add({value});
    }
    bool Add(T_JSON value)
    {
        Place(std::move(value));
        return true;
    }
    bool Open(T_JSON value)
    {
        if (m_open.size() >= static_cast<std::size_t>(kJsonMaxDepth)) {
            m_fault = AtOffset(m_text, OffsetOfTooDeep(m_text),
                               Say("IDS_QM_JSON_DEEP", std::to_string(kJsonMaxDepth)));
            return false;
        }
        m_open.push_back(&Place(std::move(value)));
        return true;
    }
    /// Puts a value where it belongs. While a child is open its parent doesn't grow, so that the
    /// pointers in m_open stay good.
    T_JSON& Place(T_JSON value)
    {
        if (m_open.empty()) return m_root = std::move(value);
        auto& data = m_open.back()->data;
        if (auto* members = std::get_if<T_JSON_MEMBERS>(&data))
            return members->back().value = std::move(value);
        if (const auto* numbers = std::get_if<T_JSON_NUMBERS>(&data)) {
            T_JSON_ITEMS items;
            for (const double number : *numbers)
                items.emplace_back().data = number;
            data = std::move(items);
        }
        return std::get<T_JSON_ITEMS>(data).emplace_back(std::move(value));
    }
    /// Place of the innermost open object, from the last entry of each open container.
    std::string PlacePrefix() const
    {
        std::string place;
        for (std::size_t i = 0; i + 1 < m_open.size(); ++i) {
            if (const auto* members = std::get_if<T_JSON_MEMBERS>(&m_open[i]->data))
                place = MemberPlace(place, members->back().key);
            else
                place = ItemPlace(place, std::get<T_JSON_ITEMS>(m_open[i]->data).size() - 1);
        }
        return place.empty() ? place : place + ": ";
    }

    std::string_view m_text;
    std::vector<T_JSON*> m_open; // the containers around the next value, outermost first
};

} // namespace

int ParseJson(std::string_view text, T_JSON& out, T_FILE_ERROR& error)
{
    CJsonBuilder builder(text);
    if (text.starts_with("\xEF\xBB\xBF"))
        builder.m_fault = AtOffset(text, 1, Say("IDS_QM_JSON_BYTE_ORDER"));
    else if (text.find_first_not_of(" \t\r\n") == text.npos)
        builder.m_fault = Say("IDS_QM_JSON_EMPTY");
    else if (const auto zero = text.find('\0'); zero != text.npos) // the parser would stop there
        builder.m_fault = AtOffset(text, zero + 1, Say("IDS_QM_JSON_ZERO_BYTE"));
    else
        nlohmann::json::sax_parse(text.data(), text.data() + text.size(), &builder);
    if (!builder.m_fault.empty()) {
        error = {FILE_FAULT::BadInput, std::move(builder.m_fault)};
        return 0;
    }
    out = std::move(builder.m_root);
    return 1;
}
