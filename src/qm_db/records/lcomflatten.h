// Nested load combinations to lists of load cases.
#pragma once

#include "qm_db/records.h"

#include <string>

/// The combination with each load case once, in the order of first appearance; factors along the
/// nesting multiplied, those of one case summed. 1 done; 0 `error` says why, `out` as it was.
[[nodiscard]] int FlattenLcom(const T_MODEL& model, const T_LCOM_D& in, T_LCOM_D& out,
                              std::string& error);
