// Rules of unknown load factor items, static ones and those of construction stages: everything
// that is wrong with a record.
#pragma once

#include "qm_base/finding.h"
#include "qm_db/datactrl.h"

#include <vector>

/// Rules that an item does not keep, its own first, then those of the constraints it names (field
/// "constraints[NAME].id"). Items of both kinds share their names. ownKey: its key in the model, 0
/// for a new one.
std::vector<T_FINDING> CheckUlfItem(const T_ULFI_D& item, int ownKey, const CDataCtrl& data);

/// The same of an item of construction stages. What is wrong with a row is told once for each such
/// row, with its number from 1, stage/step and load case, field "rows[1].case".
std::vector<T_FINDING> CheckUlfStageItem(const T_ULSI_D& item, int ownKey, const CDataCtrl& data);
