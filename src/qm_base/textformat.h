// Text from numbers and numbers from text, with '.' as the decimal point whatever the locale is.
#pragma once

#include <cstdarg>
#include <optional>
#include <string>
#include <string_view>

/// printf-style text. Ignores the process locale: the decimal point is always '.'.
/// A format that can't be carried out gives an empty text.
[[gnu::format(printf, 1, 2)]] std::string FormatText(const char* fmt, ...);

/// FormatText for a function that has its own "..."; `args` is used up.
[[gnu::format(printf, 1, 0)]] std::string FormatTextV(const char* fmt, std::va_list args);

/// Shortest decimal text that reads back as the same double ("0.1", "1e+48", "-0").
std::string ShortestText(double value);

/// The whole text as a finite number: a leading '+' is accepted; blanks, trailing text, "1,5",
/// "nan", "inf" and values out of range give nullopt.
std::optional<double> ParseFinite(std::string_view text);
