// The rules of a case file asked of a whole model, wherever it comes from.
#pragma once

#include "qm_base/finding.h"
#include "qm_db/records.h"

#include <string>
#include <vector>

/// The first record that a case file could not hold: "spectra 3 Sa: 1 values, expected 2". Asked
/// are numbers, names, options of lists and the rules of the record's own members; references to
/// other records are not. Empty when all records keep their rules.
std::string ModelFault(const T_MODEL& model);

/// The first rule that a record of the model would not keep, as a window asks: its name is given
/// and no other record's, and the rules of its own members. key: of the record; 0: a new one.
std::vector<T_FINDING> RecordFindings(const T_MODEL& model, const T_SECT_D& record, int key);
std::vector<T_FINDING> RecordFindings(const T_MODEL& model, const T_MATL_D& record, int key);
