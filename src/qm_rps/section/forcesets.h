// Sets of forces on sections: from a file, from results.
#pragma once

#include "qm_db/dbdoc.h"
#include "qm_rps/section/sectioncheck.h"
#include "qm_rps/section/sectionpairs.h"

/// Values with commas (or semicolons) below a head of the columns name, N, My, Mz, Vy, Vz, T in any
/// order, in these units ("N" or "N (kN)"); a column that is missing is 0, a set without a name has
/// its number. 1 done; 0 with line and reason, `out` unchanged.
[[nodiscard]] int ReadForceSets(const std::string& text, const T_UNITS& units,
                                std::vector<T_SECTION_FORCES>& out, std::string& reason);

/// A section with its material and the forces on it.
struct T_SECTION_JOB {
    T_SECTION_PAIR pair;
    std::vector<T_SECTION_FORCES> forces;
};

/// The forces that the results of a load case or combination have in beams (five places each) and
/// trusses; no elements: all. Sets are named "DEAD 12 I", "DEAD 12 1/4"; rounding is left out, and
/// sets without a force. 1 done; 0 with the reason: no such case or element, results missing or
/// older than the model, no forces at all.
[[nodiscard]] int ForcesOfMembers(CDBDoc& doc, const std::string& loadCase,
                                  const std::vector<int>& elements, std::vector<T_SECTION_JOB>& out,
                                  std::string& reason);
