// Text to a JSON document, strict: no comments, no byte order mark, no key twice in one object.
#pragma once

#include "qm_db/casefile/jsonvalue.h"
#include "qm_db/fileerror.h"

#include <string_view>

/// Deepest nesting that is read; a case file needs 6 levels.
inline constexpr int kJsonMaxDepth = 64;

/// 1 done; 0 error filled with one line ("line 3, column 7: ..." or "nodes[0]: ..."), `out` as it
/// was. Numbers that overflow a double are errors.
[[nodiscard]] int ParseJson(std::string_view text, T_JSON& out, T_FILE_ERROR& error);
