// What load cases are pushed with, as a table and as JSON.
#pragma once

#include "qm_db/dbdoc.h"

#include <string>
#include <vector>

/// The global control and the load cases of these keys: for each setting its value; what a load
/// case takes from the global control is marked so.
std::string SetupTable(CDBDoc& doc, const std::vector<int>& cases);

/// The same; keys as in a case file, each value the one that acts. "own" has the keys that the
/// load case does not take from the global control.
std::string SetupJson(CDBDoc& doc, const std::vector<int>& cases);
