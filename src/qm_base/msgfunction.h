// Message look-up: key to text in the chosen language, English where a text is missing.
#pragma once

#include <initializer_list>
#include <string>
#include <string_view>

namespace zql::lib {

class MMSGFunction {
public:
    /// Text of the key; the key itself when no catalogue has it. Placeholders stay as {1}, {2} ...
    static std::string GetValue(std::string_view key);

    /// Text of the key with {1}, {2} ... replaced by the arguments, in the order that the
    /// translation wants; a placeholder without an argument stays as it is. "{{" is a brace.
    static std::string Format(std::string_view key, std::initializer_list<std::string_view> args);

    /// "en" or "it". 1 done; 0 unknown language, nothing changed.
    [[nodiscard]] static int SetLanguage(std::string_view code);
    static std::string GetLanguage();
    /// Text of one language only (no fall-back); empty when that catalogue lacks the key.
    static std::string GetValueOf(std::string_view language, std::string_view key);

    /// The text without a pair of enclosing double quotes, if it has one.
    static std::string RemoveQuote(std::string_view text);
};

} // namespace zql::lib
