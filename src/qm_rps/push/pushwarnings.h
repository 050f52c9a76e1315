// What should be known of the hinges before they are pushed.
#pragma once

#include "qm_db/dbdoc.h"

#include <string>
#include <vector>

/// Entered values that another entered one makes void, of the hinge types that stand on elements
/// and act, a line each. None of them keeps the push from running.
std::vector<std::string> PushWarnings(CDBDoc& doc);
