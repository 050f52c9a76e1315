#include "qm_base/visibletext.h"

#include "qm_base/textformat.h"

#include <algorithm>
#include <array>

namespace {

struct T_RANGE {
    unsigned first, last;
};
// Unicode 15: C1 controls; marks of direction (UAX 9); separators of lines and paragraphs.
constexpr std::array<T_RANGE, 6> kHidden{{{0x80, 0x9F},
                                          {0x61C, 0x61C},
                                          {0x200B, 0x200F},
                                          {0x2028, 0x202E},
                                          {0x2066, 0x2069},
                                          {0xFEFF, 0xFEFF}}};

bool IsHidden(unsigned code)
{
    return std::ranges::any_of(kHidden,
                               [&](const T_RANGE& r) { return code >= r.first && code <= r.last; });
}

/// Bytes of the character that begins so; 0: no character does.
std::size_t LengthOf(unsigned char first)
{
    if (first < 0x80) return 1;
    if (first >= 0xC2 && first < 0xE0) return 2;
    if (first >= 0xE0 && first < 0xF0) return 3;
    return first >= 0xF0 && first < 0xF5 ? 4 : 0;
}

bool IsInside(char byte)
{
    return (static_cast<unsigned char>(byte) & 0xC0U) == 0x80U;
}

std::string BytesShown(std::string_view bytes)
{
    std::string out;
    for (const char c : bytes)
        out += FormatText("\\x%02x", static_cast<unsigned>(static_cast<unsigned char>(c)));
    return out;
}

/// One whole character.
std::string Shown(std::string_view character)
{
    const auto first = static_cast<unsigned char>(character[0]);
    if (character.size() == 1) {
        const bool passes = (first >= 0x20 && first != 0x7F) || first == '\n' || first == '\t';
        return passes ? std::string(character) : BytesShown(character);
    }
    unsigned code = first & (0x7FU >> character.size());
    for (const char c : character.substr(1))
        code = code << 6U | (static_cast<unsigned char>(c) & 0x3FU);
    return IsHidden(code) ? FormatText("\\u%04x", code) : std::string(character);
}

} // namespace

std::string CVisibleText::Next(std::string_view piece)
{
    std::string out;
    for (const char c : piece) {
        if (!m_open.empty() && !IsInside(c)) out += Rest();
        m_open += c;
        const std::size_t length = LengthOf(static_cast<unsigned char>(m_open[0]));
        if (length == 0) {
            out += Rest();
        } else if (m_open.size() == length) {
            out += Shown(m_open);
            m_open.clear();
        }
    }
    return out;
}

std::string CVisibleText::Rest()
{
    std::string out = BytesShown(m_open);
    m_open.clear();
    return out;
}

std::string VisibleLine(std::string_view line)
{
    CVisibleText visible;
    std::string out;
    for (const char c : visible.Next(line) + visible.Rest()) {
        if (c == '\n')
            out += "\\n";
        else if (c == '\t')
            out += "\\t";
        else
            out += c;
    }
    return out;
}
