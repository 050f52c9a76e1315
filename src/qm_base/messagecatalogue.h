// One language's texts: a UTF-8 file of lines "key = text", "#" comments and blank lines.
#pragma once

#include <map>
#include <string>
#include <string_view>
#include <vector>

namespace zql::lib {

struct T_CATALOGUE_FAULT {
    int line = 0;     // from 1
    std::string what; // what is wrong with it
    bool operator==(const T_CATALOGUE_FAULT&) const = default;
};

class CMessageCatalogue {
public:
    using Texts = std::map<std::string, std::string, std::less<>>;

    /// Reads a catalogue file. Blanks around key and text are dropped; a text in double quotes
    /// keeps the blanks inside. Escapes are those of C for line, tab and backslash. Returns what is
    /// wrong, line by line: a line that is no entry, an empty text, an unknown escape, a key that
    /// stands twice (the first text counts). Everything else is taken.
    std::vector<T_CATALOGUE_FAULT> Read(std::string_view fileText);

    /// Text of the key, or null.
    const std::string* Find(std::string_view key) const;
    const Texts& All() const { return m_texts; }

private:
    /// Takes one line; what is wrong with it, or an empty text.
    std::string ReadLine(std::string_view line);

    Texts m_texts;
};

/// The key's text in the chosen language, else in the fall-back, else the key itself.
std::string TextIn(const CMessageCatalogue& chosen, const CMessageCatalogue& fallBack,
                   std::string_view key);

} // namespace zql::lib
