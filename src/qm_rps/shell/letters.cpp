#include "qm_rps/shell/letters.h"

#include <cctype>
#include <optional>
#include <set>

namespace {

/// Lower case; 0: no letter or digit of the keyboard.
char LetterAt(const std::string& text, std::size_t at)
{
    const auto c = static_cast<unsigned char>(text[at]);
    return c < 0x80 && std::isalnum(c) ? static_cast<char>(std::tolower(c)) : '\0';
}

/// The place of the '&' that marks a letter.
std::optional<std::size_t> MarkOf(const std::string& text)
{
    for (std::size_t i = 0; i + 1 < text.size(); ++i) {
        if (text[i] != '&') continue;
        if (text[i + 1] != '&') return i;
        ++i;
    }
    return std::nullopt;
}

/// The first free letter, in two passes: beginnings of words, then any. What follows a tab is a
/// shortcut.
std::optional<std::size_t> FreeLetter(const std::string& text, const std::set<char>& taken)
{
    const std::size_t end = std::min(text.find('\t'), text.size());
    for (const bool starts : {true, false})
        for (std::size_t i = 0; i < end; ++i) {
            const char letter = LetterAt(text, i);
            const bool isStart = i == 0 || text[i - 1] == ' ' || text[i - 1] == '(';
            if (letter && (isStart || !starts) && !taken.contains(letter)) return i;
        }
    return std::nullopt;
}

} // namespace

std::vector<std::string> WithLetters(const std::vector<std::string>& texts)
{
    std::vector<std::string> out = texts;
    std::set<char> taken;
    std::vector<std::size_t> open;
    for (std::size_t i = 0; i < out.size(); ++i) {
        const std::optional<std::size_t> mark = MarkOf(out[i]);
        if (mark && taken.insert(LetterAt(out[i], *mark + 1)).second) continue;
        if (mark) out[i].erase(*mark, 1);
        open.push_back(i);
    }
    for (const std::size_t i : open) {
        const std::optional<std::size_t> at = FreeLetter(out[i], taken);
        if (!at) continue;
        taken.insert(LetterAt(out[i], *at));
        out[i].insert(*at, 1, '&');
    }
    return out;
}
