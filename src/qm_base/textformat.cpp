#include "qm_base/textformat.h"

#include "qm_base/neutrallocale.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <cmath>
#include <cstdio>

std::string FormatText(const char* fmt, ...)
{
    std::va_list args;
    va_start(args, fmt);
    std::string text = FormatTextV(fmt, args);
    va_end(args);
    return text;
}

std::string FormatTextV(const char* fmt, std::va_list args)
{
    const CNeutralLocale neutral;
    std::array<char, 256> buffer;
    std::va_list again;
    va_copy(again, args);
    const int count = std::vsnprintf(buffer.data(), buffer.size(), fmt, args);

    std::string text;
    if (count > 0) {
        const auto length = static_cast<std::size_t>(count);
        text.assign(buffer.data(), std::min(length, buffer.size() - 1));
        if (length >= buffer.size()) {
            text.resize(length);
            std::vsnprintf(text.data(), length + 1, fmt, again);
        }
    }
    va_end(again);
    return text;
}

std::string ShortestText(double value)
{
    std::array<char, 32> buffer; // the longest double needs 24
    const auto result = std::to_chars(buffer.data(), buffer.data() + buffer.size(), value);
    return {buffer.data(), result.ptr};
}

std::optional<double> ParseFinite(std::string_view text)
{
    if (text.starts_with('+')) {
        text.remove_prefix(1);
        if (text.starts_with('-')) return std::nullopt;
    }
    const char* const end = text.data() + text.size();
    double value = 0.0;
    const auto [stop, error] = std::from_chars(text.data(), end, value);
    if (error != std::errc{} || stop != end || !std::isfinite(value)) return std::nullopt;
    return value;
}
