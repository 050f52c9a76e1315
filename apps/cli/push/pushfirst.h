// The pushes that other commands need before they can read results.
#pragma once

#include "exitcodes.h"
#include "qm_rps/evaluatedsteps.h"

#include <set>

/// Pushes these load cases (keys) one after the other, with what should be known of the hinges
/// (PushWarnings) on stderr and progress on a terminal; Ctrl-C ends the
/// one that runs, with its steps, and starts no other. Their results become those of the document.
/// Where a load case asks for steps at the performance points of its evaluations, it is pushed
/// again with these. Done, or the code to exit with after one line on stderr.
EXIT_CODE PushCases(CDBDoc& doc, const std::string& file, const std::vector<int>& keys,
                    std::vector<T_PUSH_RUN>& out);

/// Pushes those that have no results, or old ones of our own, and says so. A case without control
/// data stays without.
EXIT_CODE PushWhereMissing(CDBDoc& doc, const std::string& file, const std::set<int>& keys);

/// Shows the steps where somebody looks at them; Ctrl-C asks to stop while a CInterrupt lives.
/// direction: 1 to 6, of control; a translation where nothing else is said.
PUSH_PROGRESS_FN ProgressOnTerminal(CDBDoc& doc, int direction = 1);

/// What the hinges do at the points of these evaluations, with progress on a terminal; Ctrl-C ends
/// it, the evaluations stand.
std::vector<T_HINGES_AT> HingesAtPoints(CDBDoc& doc, const std::vector<T_PUSH_EVALUATION>& results);
