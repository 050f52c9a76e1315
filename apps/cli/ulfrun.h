// A solved (or refused) unknown load factor item, and its text forms.
#pragma once

#include "exitcodes.h"
#include "qm_rps/factors/ulfanalysed.h"
#include "qm_rps/factors/ulfexplain.h"
#include "qm_rps/ulfitemdialog.h"

#include <memory>
#include <string>

/// What a run gave.
struct T_ULF_OUTCOME {
    EXIT_CODE code = EXIT_CODE::Done; // NotFound: no solution, or a constraint is not met
    std::string status;               // "found", "not met", "not found", "not proved", "refused"
    std::string message;              // one line
    int solverCode = 0;
    bool exact = false;
};

/// A document with one of its items, ready to be calculated.
struct T_ULF_OPENED {
    CDBDoc doc;
    bool stage = false; // the item is one of construction stages
    std::unique_ptr<CUlfItemDialog> dialog;
    std::vector<int> cases; // keys of the load cases of a static item
};

/// Opens the file and finds the item by its name, static or of construction stages. Done, or the
/// code to exit with after one line on stderr: also for a name that both kinds of item have.
EXIT_CODE OpenUlfItem(const std::string& file, const std::string& item, bool sumStageLoads,
                      T_ULF_OPENED& out);

/// Analyses in memory what the item reads: for a static item of a case file the load cases of its
/// combination, for one of stages the stages, which no file keeps. An item with findings is left
/// to its calculation, which refuses it. Done, or as above.
EXIT_CODE AnalyseForUlf(const std::string& file, T_ULF_OPENED& in);

/// Analyses the construction stages unless they have current results.
EXIT_CODE AnalyseStages(CDBDoc& doc, const std::string& file);

/// Calculates and names the outcome.
T_ULF_OUTCOME SolveUlf(CUlfItemDialog& dialog);

/// Tables of the factors and of the constraints.
std::string UlfTables(const T_ULF_RESULT& result);

/// Start, factor and pretension of each stay, and its force; nothing without stays.
std::string StayTable(const std::vector<T_ULF_STAY>& stays, const T_UNITS& units);
