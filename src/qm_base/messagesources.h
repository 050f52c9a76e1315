// The catalogue files as they stand in messages/, embedded by the build.
#pragma once

#include <span>
#include <string_view>

namespace zql::lib {

struct T_MESSAGE_SOURCE {
    std::string_view language; // "en", "it": the name of the file without extension
    std::string_view text;     // the whole file, UTF-8
};

/// One entry per language; English stands first. Defined in generated code.
std::span<const T_MESSAGE_SOURCE> MessageSources();

} // namespace zql::lib
