// The command that pushes load cases and shows the results.
#pragma once

#include "exitcodes.h"

#include <string>
#include <vector>

struct T_PUSH_OPTIONS {
    std::string file;
    std::vector<std::string> cases;  // pushover load cases; empty: all that can be pushed
    bool all = false;                // every one, those that can't be pushed refused
    std::string json;                // file, or "-" for standard output
    std::string plot;                // capacity curves: .svg, .png or .pdf
    std::string plotHinges;          // the frame with the states of its hinges
    std::string plotStoreys;         // storeys over the height
    std::string of, at, state;       // result, evaluation, its limit state that these two show
    int step = 0;                    // likewise; 0: the last one, or that of `at`
    std::vector<std::string> hinges; // results whose hinges are printed
    std::string nodes;               // "1,5-9": displacements of these in the JSON
    std::string out;                 // write the model with its results here (.qmdb)
    bool overwrite = false;          // files that are there
    bool noStore = false;            // don't store the results in a model file
};

/// Done: every push came to its target or to a stop that was asked for; NotFound: one did not.
EXIT_CODE RunPush(const T_PUSH_OPTIONS& options);
