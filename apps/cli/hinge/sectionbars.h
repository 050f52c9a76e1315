// Bars of a concrete section laid by a rule, and its picture.
#pragma once

#include "exitcodes.h"

#include <array>
#include <string>

struct T_SECTION_BARS_OPTIONS {
    std::string file;
    std::string section;               // its name
    std::array<std::string, 6> bars{}; // by BAR_PLACE: "3x0.016", of corners "0.02"; empty: none
    bool keep = false;                 // the bars that are there
    std::string out;                   // file to write
    bool overwrite = false;
};

/// Lays the bars in the order of BAR_PLACE, prints all of the section, writes the file. Usage where
/// a group can't be laid, nothing written.
EXIT_CODE RunSectionBars(const T_SECTION_BARS_OPTIONS& options);
/// Outline, stirrup and bars as a picture.
EXIT_CODE RunSectionPlot(const T_SECTION_BARS_OPTIONS& options);
