// The command that checks sections for given forces.
#pragma once

#include "qm_rps/section/sectioncheck.h"
#include "section/sectioncommands.h"

struct T_SECTION_CHECK_COMMAND : T_SECTION_COMMAND {
    /// N, My, Mz, Vy, Vz, T in units of the file: a value for each set of forces, or one for all.
    std::array<std::vector<double>, 6> forces;
    std::string forcesFile;         // sets with names, as ReadForceSets reads them
    std::vector<std::string> cases; // load cases and combinations whose results are checked
    std::string elements;           // of these; empty: all
    bool byRatio = false;           // the worst set first, else as they come
    std::vector<std::string> codes; // of kSectionCheckCodeNames; empty: all
    double cotTheta = 1.0;
    bool trace = false;
};
inline constexpr std::array<const char*, 6> kSectionForceNames{"axial", "my", "mz",
                                                               "vy",    "vz", "torsion"};

/// Checks and prints: the forces of options and file on every section that is meant, or the results
/// of load cases (which it analyses) on the sections of their elements. BadInput with the first
/// section that can't be checked, nothing written.
EXIT_CODE RunSectionCheck(const T_SECTION_CHECK_COMMAND& command);
