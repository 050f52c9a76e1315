// A solved (or refused) unknown load factor item, and its text forms.
#pragma once

#include "exitcodes.h"
#include "qm_rps/ulfexplain.h"
#include "qm_rps/unknownloadfactoritemdlg.h"

#include <string>

/// What a run gave.
struct T_ULF_OUTCOME {
    EXIT_CODE code = EXIT_CODE::Done; // NotFound: no solution, or a constraint is not met
    std::string status;               // "found", "not met", "not found", "refused"
    std::string message;              // one line
    int solverCode = 0;
    bool exact = false;
};

/// Calculates and names the outcome.
T_ULF_OUTCOME SolveUlf(CUnknownLoadFactorItemDlg& dialog);

/// {"status", "code", "message", "mode", "factors", "constraints", "objective"}.
std::string UlfJson(const T_ULF_OUTCOME& outcome, const std::optional<T_ULF_RESULT>& result);
/// What holds the solution, or what contradicts, with the words of ExplainUlf in "lines".
std::string ExplainJson(const T_ULF_EXPLAINED& explained);
/// Tables of the factors and of the constraints.
std::string UlfTables(const T_ULF_RESULT& result);
/// Unit of a constraint's value; empty for a rotation.
std::string UlfUnit(CDBDoc& doc, const std::string& constraint);
