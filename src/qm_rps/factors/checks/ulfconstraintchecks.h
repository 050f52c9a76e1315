// Rules of unknown load factor constraints: everything that is wrong with a record.
#pragma once

#include "qm_base/finding.h"
#include "qm_db/records.h"

#include <vector>

/// Rules that a constraint does not keep, in the order of the dialog's check. ownKey: its key in
/// the model, 0 for a new one. In `text`, names and numbers are filled in.
std::vector<T_FINDING> CheckUlfConstraint(const T_ULFC_D& constraint, int ownKey,
                                          const T_MODEL& model);

/// Key of the constraint of that name; 0: none.
int FindUlfConstraint(const T_MODEL& model, const std::string& name);
