// Results of linear analysis, read from a document for printing.
#pragma once

#include "qm_db/dbdoc.h"

#include <array>
#include <set>
#include <string>
#include <vector>

/// A load case or combination whose results are shown.
struct T_SHOWN_CASE {
    std::string name;
    T_LCOM_D combination;
};

template <class T>
struct T_BY_ID {
    int id = 0;
    T value{};
};

using T_BEAM_ROWS = std::array<T_DOF6, kForcePositions>;

/// All results of one load case in the document's current units, ids ascending.
struct T_CASE_RESULTS {
    std::vector<T_BY_ID<T_DOF6>> displacements;
    std::vector<T_BY_ID<T_DOF6>> reactions; // of restrained nodes and of those with a spring
    std::vector<T_BY_ID<double>> trusses;
    std::vector<T_BY_ID<T_BEAM_ROWS>> beams;
};

/// By name, load cases before combinations; all load cases for no names. False: `error` names what
/// there is none of.
bool FindShownCases(CDBDoc& doc, const std::vector<std::string>& names,
                    std::vector<T_SHOWN_CASE>& out, std::string& error);

/// Keys of the load cases that these need, each once.
bool LoadCasesOf(CDBDoc& doc, const std::vector<T_SHOWN_CASE>& shown, std::vector<int>& out,
                 std::string& error);

/// False: `error` says why (results are missing, or older than the model).
bool ReadCaseResults(CDBDoc& doc, const T_SHOWN_CASE& shown, T_CASE_RESULTS& out,
                     std::string& error);

/// A state at the end of a step of a construction stage, with its results.
struct T_SHOWN_STAGE {
    std::string stage, load;  // names; "sum", "dead" and "erection" for sums
    int steps = 1;            // of the stage
    T_STAGE_CHOICE choice;    // the step as a number
    std::size_t elements = 0; // that stand
    T_CASE_RESULTS results;
};

/// Every stage for an empty name; step: a number or kStageLastStep. False: `error` names what there
/// is none of.
bool FindShownStages(CDBDoc& doc, const std::string& stage, int step, const std::string& load,
                     std::vector<T_SHOWN_STAGE>& out, std::string& error);

/// What stands in a stage, of one step and load; false: `error` says why.
bool ReadStageResults(CDBDoc& doc, const T_STAGE_CHOICE& choice, T_CASE_RESULTS& out,
                      std::string& error);

/// A mode with its values in current units.
struct T_MODE_RESULTS {
    double period = 0.0; // s
    std::vector<T_BY_ID<T_DOF6>> shape;
    T_DOF6 participation{}, massPercent{};
};
std::vector<T_MODE_RESULTS> ReadModes(CDBDoc& doc);
