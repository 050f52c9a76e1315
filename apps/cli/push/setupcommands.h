// The commands that set a push up: global control and load cases, cases made at once, increment
// functions.
#pragma once

#include "exitcodes.h"

#include <map>
#include <optional>
#include <string>
#include <vector>

struct T_PUSH_SETUP_OPTIONS {
    std::string file;
    std::string caseName; // pushover load case; empty: the global control
    bool fresh = false;   // the load case is a new one of that name
    std::map<std::string, std::vector<std::string>> settings; // "--steps": {"50"}; see kSettings
    std::string out;        // file to write, where something is set
    bool overwrite = false; // a file that is there
    std::string json;
};

struct T_CASE_GENERATE_OPTIONS {
    std::string file;
    std::vector<std::string> directions, patterns; // "X", "Y"; "uniform", "mode"; empty: all
    double eccentricity = 0.0;
    std::string signs; // "both", "+", "-"
    std::optional<double> target;
    int node = 0; // 0: chosen by the program
    std::string out;
    bool overwrite = false;
};

struct T_PUSH_FUNCTION_OPTIONS {
    std::string file;
    std::string add, change, remove, rename; // names
    std::vector<std::string> rows;           // "STEP=FACTOR"
    std::string out;
    bool overwrite = false;
    std::string plot, json;
};

/// Shows what load cases are pushed with; with settings it changes the global control or one load
/// case and writes the model.
EXIT_CODE RunPushSetup(const T_PUSH_SETUP_OPTIONS& options);
/// Makes load cases in both ways along X and Y and writes the model.
EXIT_CODE RunCaseGenerate(const T_CASE_GENERATE_OPTIONS& options);
/// Lists increment functions; adds, changes, deletes or draws one.
EXIT_CODE RunPushFunction(const T_PUSH_FUNCTION_OPTIONS& options);
