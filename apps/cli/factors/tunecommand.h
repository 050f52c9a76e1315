// Load factors of one's own: what stays, deck and constraints do with them.
#pragma once

#include "exitcodes.h"

#include <string>
#include <vector>

struct T_TUNE_OPTIONS {
    std::string file;
    std::string item;
    std::vector<std::string> factors; // "CASE=1.2"; the others as they are found
    std::string deck;                 // displacements and moments along the deck: .csv, or "-"
    std::string plot;                 // displacements of the deck
    std::string plotMoments;
    bool overwrite = false;
};

/// NotFound: there are no factors, or a constraint is not met with these.
EXIT_CODE RunUlfTune(const T_TUNE_OPTIONS& options);
