// The rules of a case file asked of a whole model, wherever it comes from.
#pragma once

#include "qm_db/records.h"

#include <string>

/// The first record that a case file could not hold: "spectra 3 Sa: 1 values, expected 2". Asked
/// are numbers, names, options of lists and the rules of the record's own members; references to
/// other records are not. Empty when all records keep their rules.
std::string ModelFault(const T_MODEL& model);
