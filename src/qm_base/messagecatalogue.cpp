#include "qm_base/messagecatalogue.h"

#include "qm_base/msgfunction.h"

#include <algorithm>
#include <optional>

namespace zql::lib {

namespace {

std::string_view Trim(std::string_view text)
{
    constexpr std::string_view kBlanks = " \t\r";
    const std::size_t first = text.find_first_not_of(kBlanks);
    if (first == std::string_view::npos) return {};
    return text.substr(first, text.find_last_not_of(kBlanks) - first + 1);
}

bool IsKey(std::string_view text)
{
    constexpr std::string_view kLetters =
        "ABCDEFGHIJKLMNOPQRSTUVWXYZabcdefghijklmnopqrstuvwxyz0123456789_";
    return !text.empty() && text.find_first_not_of(kLetters) == std::string_view::npos;
}

/// The text with \n \t \\ resolved; nullopt when another escape stands in it.
std::optional<std::string> Unescape(std::string_view text)
{
    std::string plain;
    for (std::size_t i = 0; i < text.size(); ++i) {
        if (text[i] != '\\') {
            plain += text[i];
            continue;
        }
        const char mark = ++i < text.size() ? text[i] : ' ';
        if (mark != 'n' && mark != 't' && mark != '\\') return std::nullopt;
        plain += mark == 'n' ? '\n' : mark == 't' ? '\t' : '\\';
    }
    return plain;
}

} // namespace

std::vector<T_CATALOGUE_FAULT> CMessageCatalogue::Read(std::string_view fileText)
{
    std::vector<T_CATALOGUE_FAULT> faults;
    for (int line = 1; !fileText.empty(); ++line) {
        const std::size_t end = fileText.find('\n');
        const std::string what = ReadLine(Trim(fileText.substr(0, end)));
        if (!what.empty()) faults.push_back({line, what});
        fileText.remove_prefix(end == std::string_view::npos ? fileText.size() : end + 1);
    }
    return faults;
}

std::string CMessageCatalogue::ReadLine(std::string_view line)
{
    if (line.empty() || line.starts_with('#')) return {};
    const std::size_t equal = line.find('=');
    const std::string key(Trim(line.substr(0, equal)));
    if (equal == std::string_view::npos || !IsKey(key)) return "not a line \"key = text\"";

    const std::string raw = MMSGFunction::RemoveQuote(Trim(line.substr(equal + 1)));
    if (raw.empty()) return key + ": empty text";
    const std::optional<std::string> text = Unescape(raw);
    if (!text) return key + ": unknown escape";
    return m_texts.try_emplace(key, *text).second ? std::string() : key + ": stands twice";
}

const std::string* CMessageCatalogue::Find(std::string_view key) const
{
    const auto found = m_texts.find(key);
    return found == m_texts.end() ? nullptr : &found->second;
}

std::string TextIn(const CMessageCatalogue& chosen, const CMessageCatalogue& fallBack,
                   std::string_view key)
{
    for (const CMessageCatalogue* catalogue : {&chosen, &fallBack})
        if (const std::string* text = catalogue->Find(key)) return *text;
    return std::string(key);
}

} // namespace zql::lib
