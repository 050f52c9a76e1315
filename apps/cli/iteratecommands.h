// The command of the iterative analysis for pretension.
#pragma once

#include "exitcodes.h"

#include <string>

struct T_ITERATE_OPTIONS {
    std::string file;
    std::string item;           // name of the construction-stage item
    int iterations = 5;         // required number
    double tolerance = 1e-3;    // of convergence
    bool overwrite = false;     // an existing report
    bool append = false;        // to it
    bool sumStageLoads = false; // load groups 0 and 1 read the sum of all stage loads
    std::string json;           // file, or "-" for standard output
    std::string plot;           // factors and tolerance: .svg, .png or .pdf
};

/// Analyses the stages, then scales pretension, analyses and solves until the factors are 1. Copies
/// FILE_01, FILE_02 ... and the report stand beside the file, which stays as it was. Done:
/// converged, or no iteration was asked for; NotFound: not converged in the required number,
/// cancelled, no factors, or factors that do not meet the constraints; NoAccess: also when the
/// report is there and neither overwrite nor append was asked for.
EXIT_CODE RunUlfIterate(const T_ITERATE_OPTIONS& options);
