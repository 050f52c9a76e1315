// A cell of a table with commas between its columns (RFC 4180).
#pragma once

#include <string>

/// Between quotes where the text holds a comma, a quote or a line break; quotes in it are doubled.
inline std::string CsvCell(const std::string& text)
{
    if (text.find_first_of(",\"\r\n") == std::string::npos) return text;
    std::string out = "\"";
    for (const char c : text)
        out += c == '"' ? std::string("\"\"") : std::string(1, c);
    return out + "\"";
}
