// Rules of load combinations: everything that is wrong with a record.
#pragma once

#include "qm_base/finding.h"
#include "qm_db/datactrl.h"

#include <vector>

/// The name is given and free. ownKey: of the combination in the model, 0 for a new one.
std::vector<T_FINDING> CheckCombinationName(const std::string& name, int ownKey,
                                            const T_MODEL& model);

/// Name, rows, and that it can be flattened: its rows exist and none of them contains itself. That
/// another combination contains this one is seen only when it is stored.
std::vector<T_FINDING> CheckCombination(const T_LCOM_D& combination, int ownKey,
                                        const CDataCtrl& data);
