// What keeps a model whole when a pushover load case is stored in it: its file can be read again,
// its results are still understood.
#pragma once

#include "qm_base/finding.h"
#include "qm_db/dbdoc.h"

/// Whether the load case of this key has results.
bool HasPushResults(CDBDoc& doc, int key);

/// Rules of the document that the record under this key (0: a new one) does not keep: free name,
/// existing node, node with results, control data where there are none.
std::vector<T_FINDING> LoadCaseDocFindings(CDBDoc& doc, int key, const T_POLC_D& record);
