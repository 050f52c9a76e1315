#include "qm_rps/document/document.h"

#include <array>

namespace {

/// A character and the bytes that it takes.
struct T_READ {
    char32_t code = 0;
    std::size_t bytes = 0; // 0: no valid character begins here
};

/// The shortest forms alone, without surrogates (RFC 3629).
T_READ ReadChar(std::string_view text)
{
    const auto byte = [&](std::size_t i) { return static_cast<unsigned char>(text[i]); };
    if (byte(0) < 0x80U) return {byte(0), 1};
    struct T_FORM {
        unsigned mask, lead;
        char32_t least;
        std::size_t bytes;
    };
    constexpr std::array<T_FORM, 3> kForms{
        {{0xE0U, 0xC0U, 0x80U, 2}, {0xF0U, 0xE0U, 0x800U, 3}, {0xF8U, 0xF0U, 0x10000U, 4}}};
    for (const T_FORM& form : kForms) {
        if ((byte(0) & form.mask) != form.lead || text.size() < form.bytes) continue;
        char32_t code = byte(0) & ~form.mask;
        for (std::size_t i = 1; i < form.bytes; ++i) {
            if ((byte(i) & 0xC0U) != 0x80U) return {};
            code = code << 6U | (byte(i) & 0x3FU);
        }
        const bool isSurrogate = code >= 0xD800U && code <= 0xDFFFU;
        if (code < form.least || code > 0x10FFFFU || isSurrogate) return {};
        return {code, form.bytes};
    }
    return {};
}

bool IsAllowed(char32_t code)
{
    if (code == '\n' || code == '\t') return true;
    const bool isControl = code < 0x20U || (code >= 0x7FU && code < 0xA0U);
    // Embeddings, overrides and isolates change how what follows is read (Unicode UAX 9).
    const bool turns = (code >= 0x202AU && code <= 0x202EU) || (code >= 0x2066U && code <= 0x2069U);
    return !isControl && !turns && code != 0xFFFEU && code != 0xFFFFU;
}

} // namespace

std::string CleanText(std::string_view text)
{
    std::string out;
    while (!text.empty()) {
        const T_READ read = ReadChar(text);
        const std::size_t bytes = read.bytes == 0 ? 1 : read.bytes;
        if (read.bytes > 0 && IsAllowed(read.code))
            out += text.substr(0, bytes);
        else
            out += "\uFFFD";
        text.remove_prefix(bytes);
    }
    return out;
}
