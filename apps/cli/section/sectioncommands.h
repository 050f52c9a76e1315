// Commands on the curves of sections.
#pragma once

#include "exitcodes.h"
#include "qm_db/dbdoc.h"
#include "qm_db/filectrl.h"
#include "qm_rps/section/sectioncurves.h"

#include <functional>
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

/// Reads what is asked of the sections that were found, which it may change.
using SECTION_PREPARE_FN = std::function<EXIT_CODE(std::vector<T_SECTION_PAIR>&)>;
/// Does the pair with this index. 1 done; 0 with the reason.
using SECTION_DO_FN =
    std::function<int(std::size_t, const T_SECT_D&, const T_MATL_D&, std::string&)>;
/// Opens the file once the outputs may be written, finds the sections that are meant with their
/// materials, prepares, and does each of them. Done, or the code to exit with after one line on
/// stderr.
EXIT_CODE OverSections(const T_SECTION_COMMAND& command, const std::vector<T_OUTPUT>& outputs,
                       CDBDoc& doc, const SECTION_PREPARE_FN& prepare, const SECTION_DO_FN& each);

/// Calculates and prints. BadInput with the first section that has no answer, nothing written.
EXIT_CODE RunSection(const T_SECTION_COMMAND& command);

std::string SectionJson(const std::vector<T_SECTION_ANSWER>& answers, const T_UNITS& units);
