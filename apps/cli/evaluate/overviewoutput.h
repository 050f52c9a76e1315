// Several evaluations side by side: overlaid in one picture, as bars, as a table.
#pragma once

#include "evaluatecommands.h"
#include "qm_db/filectrl.h"
#include "qm_rps/pushover/pushevaluation.h"

/// What of these was asked for, for CheckOutputs.
std::vector<T_OUTPUT> OverviewOutputs(const T_EVALUATE_OPTIONS& options);

/// Writes it; a summary to "-" goes to standard output.
EXIT_CODE WriteOverview(CDBDoc& doc, const T_EVALUATE_OPTIONS& options,
                        const std::vector<T_PUSH_EVALUATION>& results);
