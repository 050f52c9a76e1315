// Which of the results of an analysis are shown, and their envelope over load cases.
#pragma once

#include "analysis/analysisresults.h"

#include <set>
#include <string>
#include <vector>

struct T_RESULT_CHOICE {
    std::set<int> nodes, elements; // both empty: all; else these alone
    std::size_t top = 0;           // of each table the rows with the largest values; 0: all

    bool IsAll() const { return nodes.empty() && elements.empty() && top == 0; }
};

/// The results of the chosen nodes and elements; ids ascending, with `top` by size descending:
/// of displacements the translation, of reactions the force, of beams the larger bending moment.
T_CASE_RESULTS Chosen(const T_CASE_RESULTS& results, const T_RESULT_CHOICE& choice);

/// Smallest and largest value of one component over the load cases, and where each occurs.
struct T_ENVELOPE_ROW {
    int id = 0;
    std::string component; // "DX", "My at J"
    double min = 0.0, max = 0.0;
    std::size_t minCase = 0, maxCase = 0; // indices; the first of equal ones
};

struct T_ENVELOPE {
    std::vector<T_ENVELOPE_ROW> displacements, reactions, trusses, beams;
};

/// Of results of the same model, one for each load case; at least one. Components that are 0 in
/// all cases are left out. With `top` the ids that are largest in any case.
T_ENVELOPE EnvelopeOf(const std::vector<T_CASE_RESULTS>& cases, const T_RESULT_CHOICE& choice);
