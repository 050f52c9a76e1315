// Hinges of members as a code gives them.
#pragma once

#include "exitcodes.h"
#include "qm_rps/generate/codehinges.h"

#include <string>

struct T_HINGE_GENERATE_OPTIONS {
    std::string file;
    std::string code;     // one of kHingeCodeNames
    std::string elements; // "1,4-9"
    bool all = false;
    bool stale = false;            // those of stale types, by their own code and level
    std::string level = "primary"; // or "secondary"
    bool keepGoing = false;
    std::string push;              // load case whose V counts
    std::string axialRange;        // "from..to"
    double tie = 0.0;              // of spandrels, file's units
    T_STEEL_CONNECTION connection; // of steel beams, file's units; no kind: none
    std::string json, out;
    bool trace = false;
    bool overwrite = false;
};

/// Generates, prints the table, writes the file. BadInput with the first element that can't have a
/// hinge, nothing written; with --keep-going NotFound where elements were left out.
EXIT_CODE RunHingeGenerate(const T_HINGE_GENERATE_OPTIONS& options);

/// Every generated number with its inputs, clause and mark, type by type.
std::string CodeHingesJson(const T_CODE_HINGES& hinges, const std::string& code,
                           const T_UNITS& units);
