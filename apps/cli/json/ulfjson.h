// Factors, constraints and explanation of an unknown load factor item as JSON.
#pragma once

#include "ulfrun.h"

/// {"status", "code", "message", "mode", "factors", "constraints", "objective"}.
std::string UlfJson(const T_ULF_OUTCOME& outcome, const std::optional<T_ULF_RESULT>& result);
/// What holds the solution, or what contradicts, with the words of ExplainUlf in "lines".
std::string ExplainJson(const T_ULF_EXPLAINED& explained);
