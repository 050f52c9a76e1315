// The rules of a case file asked of one spectrum, as a window asks.
#pragma once

#include "qm_base/finding.h"
#include "qm_db/records.h"

#include <vector>

/// The first rule that the spectrum would not keep: its name is given and no other spectrum's, and
/// the rules of its own members. key: of the spectrum in the model; 0: a new one.
std::vector<T_FINDING> RecordFindings(const T_MODEL& model, const T_SPFC_D& record, int key);
