// What an engineer should know before he believes an evaluation: settings that have no effect, a
// spectrum that is not of the method, and figures that no building has. Each remark is a message
// with its numbers.
#pragma once

#include "qm_rps/pushover/pushevaluation.h"

/// Appends the remarks on a finished result with a capacity spectrum to its messages. The document
/// is the one that was evaluated, `spectrum` the record of the evaluation in current units.
void AddRemarks(CDBDoc& doc, const T_SPFC_D& spectrum, T_PUSH_EVALUATION& result);
