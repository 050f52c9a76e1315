// The records of a model to and from the tables of the model file (all but the results).
#pragma once

#include "qm_db/records.h"

#include <cstdint>
#include <map>
#include <string>

class CSqliteDb;

/// Checksums by table name.
using T_TABLE_SUMS = std::map<std::string, std::uint64_t>;

/// Throws CStoreFault: BadInput for a number that is not finite, NoAccess when writing fails.
void WriteModel(const CSqliteDb& db, const T_MODEL& model);

/// Reads every record table in one pass; the sums of the rows read go to `sums`.
T_MODEL ReadModel(const CSqliteDb& db, T_TABLE_SUMS& sums);
