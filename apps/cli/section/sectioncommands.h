// Commands on the curves of sections.
#pragma once

#include "exitcodes.h"
#include "qm_rps/section/sectioncurves.h"

#include <string>
#include <vector>

struct T_SECTION_COMMAND {
    std::string file;
    SECTION_TASK task = SECTION_TASK::Capacity;
    std::vector<std::string> sections; // names or numbers; empty: all that have a material
    std::string material;              // empty: that of the elements
    std::string values = "characteristic", law = "eurocode", confined = "no";
    T_SECTION_OPTIONS options;      // numbers
    std::vector<double> directions; // degrees; empty: 0
    std::vector<double> axial;      // in units of the file
    bool ofMoment = false;
    int points = 40;
    double maxCurvature = 0.0; // in units of the file
    bool table = false;
    std::string json, csv, sheet, plot;
    bool overwrite = false;
};

T_SECTION_OPTIONS SectionOptionsOf(const T_SECTION_COMMAND& command);
/// The sections that are meant, with their materials. Usage and BadInput are told.
EXIT_CODE FindSectionPairs(const T_MODEL& model, const T_SECTION_COMMAND& command,
                           std::vector<T_SECTION_PAIR>& out);

/// Calculates and prints. BadInput with the first section that has no answer, nothing written.
EXIT_CODE RunSection(const T_SECTION_COMMAND& command);

std::string SectionJson(const std::vector<T_SECTION_ANSWER>& answers, const T_UNITS& units);
