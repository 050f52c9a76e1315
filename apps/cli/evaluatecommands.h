// The commands on pushover evaluations.
#pragma once

#include "exitcodes.h"

#include <string>
#include <vector>

struct T_EVALUATE_OPTIONS {
    std::string file;
    std::vector<std::string> only;    // names of evaluations; empty: all
    std::string push;                 // name of their push or one direction of it; empty: all
    std::string json;                 // file, or "-" for standard output
    std::string report;               // text report
    bool plain = false;               // the report alone, without what it rests on
    std::string code;                 // judges members by it in the report; empty: generated hinges
    std::string curve;                // curve table alone
    std::string plot;                 // .svg, .png or .pdf
    std::string plotDemand;           // the demand spectrum over periods
    std::string overlay;              // all of them in one picture
    bool whole = false;               // of which the whole curves, not the region of their points
    std::string bars;                 // picture of one figure of each
    std::string barsOf = "D";         // of kCardNames
    std::string summary;              // the figures of each and its verdict: .csv, or "-"
    std::vector<int> steps;           // additional steps to list
    std::vector<std::string> spectra; // additional spectra for performance points
    bool trace = false;
    bool overwrite = false; // files that are there
    bool noStore = false;   // don't store the limit-state steps in a model file
};

struct T_COMPARE_OPTIONS {
    std::string file;
    std::string push;     // name of the pushover load case
    std::string spectrum; // name of the spectrum
    int behavior = 0;
    std::string json; // file, or "-"
    std::string plot; // .svg, .png or .pdf
    bool overwrite = false;
};

EXIT_CODE RunCompare(const T_COMPARE_OPTIONS& options);
EXIT_CODE RunEvaluate(const T_EVALUATE_OPTIONS& options);
