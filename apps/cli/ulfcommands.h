// The commands on unknown load factors.
#pragma once

#include "exitcodes.h"

#include <string>

struct T_ULF_OPTIONS {
    std::string file;
    std::string item;           // name of the item; empty: all (check)
    std::string json;           // file, or "-" for standard output
    std::string plot;           // constraints against their bounds: .svg, .png or .pdf
    std::string shapePlot;      // displacements before and after
    std::string out;            // spreadsheet, or the file with the combination
    std::string name;           // of the combination to make
    std::string date;           // in the spreadsheet, YYYY-MM-DD; empty: today
    int sheetVersion = 16;      // of the spreadsheet program
    bool overwrite = false;     // files that are there
    bool dump = false;          // write the problem of the solver beside the file
    bool open = false;          // start the spreadsheet program on the sheet
    bool force = false;         // write factors that miss constraints
    bool sumStageLoads = false; // load groups 0 and 1 of a stage item read the sum of all
};

/// Items, static and of construction stages, and constraints of the file.
EXIT_CODE RunUlfList(const T_ULF_OPTIONS& options);
/// Every rule that items and constraints don't keep. NotFound when there is any.
EXIT_CODE RunUlfCheck(const T_ULF_OPTIONS& options);
/// Finds the factors. A case file is analysed in memory, construction stages always; else a model
/// file must hold results.
/// NotFound: there is no solution, or a constraint is not met.
EXIT_CODE RunUlfSolve(const T_ULF_OPTIONS& options);
/// What holds the solution and what relaxing it buys; or which constraints contradict each other,
/// and the compromise that misses them least. NotFound: there is no solution.
EXIT_CODE RunUlfExplain(const T_ULF_OPTIONS& options);
/// Solves and writes the spreadsheet with the influence matrix. NotFound: also for factors that
/// miss constraints, which only `force` writes.
EXIT_CODE RunUlfExport(const T_ULF_OPTIONS& options);
/// Solves and adds the load combination with the factors. NotFound: likewise. Usage: also for an
/// item of construction stages, since there are no combinations of loads at stages.
EXIT_CODE RunUlfCombine(const T_ULF_OPTIONS& options);
