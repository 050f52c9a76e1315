// What a fuzz target does with a promise that is not kept.
#pragma once

#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <string>
#include <string_view>

inline void Expect(bool kept, const char* promise, const std::string& what = {})
{
    if (kept) return;
    std::fprintf(stderr, "not kept: %s\n%s\n", promise, what.c_str());
    std::abort();
}

/// A refusal is one line that says something.
inline void ExpectOneLine(const std::string& text)
{
    Expect(!text.empty() && text.find_first_of("\n\r") == text.npos, "a message is one line", text);
}

inline std::string_view TextOf(const std::uint8_t* data, std::size_t size)
{
    return {reinterpret_cast<const char*>(data), size};
}
