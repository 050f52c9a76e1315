// The command that runs linear analysis and shows its results.
#pragma once

#include "exitcodes.h"
#include "qm_db/dbdoc.h"

#include <string>
#include <vector>

struct T_ANALYSE_OPTIONS {
    std::string file;
    std::vector<std::string> cases; // load cases and combinations to show; empty: all load cases
    int modes = 0;                  // eigen modes to find
    std::string stage;              // construction stage to show alone; empty: all, in brief
    int step = kStageLastStep;      // of the stage
    std::string load = "sum";       // of the stages: sum, dead, erection or a load case
    std::string json;               // file, or "-" for standard output
    bool table = false;             // tables also when the results go to a JSON file
    std::string plot;               // deformed shape: .svg, .png or .pdf
    std::string plotCase;           // its load case or combination; empty: the first one shown
    int plotMode = 0;               // a mode in place of a load case
    std::string out;                // write the model with its results here
    std::string nodes, elements;    // "1,5-9": shown alone; empty: all
    int top = 0;                    // of each table the rows with the largest values; 0: all
    bool envelope = false;          // over the load cases in place of their tables
    bool overwrite = false;         // files that are there
    bool noStore = false;           // don't store the results in a model file
};

/// Analyses the load cases that are asked for (those of a combination included), prints what was
/// asked for, and keeps the results in a model file.
EXIT_CODE RunAnalyse(const T_ANALYSE_OPTIONS& options);

/// The code to exit with after an analysis that failed.
EXIT_CODE ExitCodeOf(const T_ANALYSIS_ERROR& error);

/// Linear analysis of these load cases (keys; empty: all, or none) and of the stages, with progress
/// on a terminal. Done, or the code to exit with after one line on stderr.
EXIT_CODE Analyse(CDBDoc& doc, const std::vector<int>& cases, int modes, bool noneForEmpty = false);
