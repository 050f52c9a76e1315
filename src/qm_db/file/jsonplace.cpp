#include "qm_db/file/jsonplace.h"

#include "qm_base/textformat.h"

namespace {

constexpr std::size_t kLongestQuote = 60; // bytes

bool IsLetter(char c)
{
    return (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z') || c == '_';
}

bool IsIdentifier(std::string_view key)
{
    if (key.empty() || !IsLetter(key.front())) return false;
    for (const char c : key) {
        if (!IsLetter(c) && !(c >= '0' && c <= '9')) return false;
    }
    return true;
}

} // namespace

std::string EscapedText(std::string_view text)
{
    std::string escaped;
    for (const char c : text) {
        const auto code = static_cast<unsigned char>(c);
        if (code < 0x20 || code == 0x7f)
            escaped += FormatText("\\u%04x", static_cast<unsigned>(code));
        else
            escaped += c;
    }
    return escaped;
}

std::string QuotedText(std::string_view text)
{
    std::string_view head = text.substr(0, kLongestQuote);
    while (head.size() < text.size() && !head.empty() &&
           (static_cast<unsigned char>(text[head.size()]) & 0xC0) == 0x80)
        head.remove_suffix(1); // not in the middle of a UTF-8 character
    return '"' + EscapedText(head) + (head.size() < text.size() ? "...\"" : "\"");
}

std::string MemberPlace(const std::string& place, std::string_view key)
{
    const std::string shown = IsIdentifier(key) ? std::string(key) : QuotedText(key);
    return place.empty() ? shown : place + '.' + shown;
}

std::string ItemPlace(const std::string& place, std::size_t index)
{
    return place + FormatText("[%zu]", index);
}
