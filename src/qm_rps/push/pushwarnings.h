// What should be known of the hinges before they are pushed.
#pragma once

#include "qm_db/dbdoc.h"

#include <string>
#include <vector>

/// That a push of the model is elastic: it has no hinges, or none of them acts. Empty: some act.
std::string NoHingeText(const T_MODEL& model);

/// Entered values that another entered one makes void, of the hinge types that stand on elements
/// and act, a line each. None of them keeps the push from running.
std::vector<std::string> PushWarnings(CDBDoc& doc);
