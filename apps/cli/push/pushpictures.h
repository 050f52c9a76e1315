// Pictures of one step of a push.
#pragma once

#include "push/pushcommands.h"
#include "qm_rps/push/pushrun.h"

/// Whether load case or evaluation of the pictures can be told before these cases are pushed.
EXIT_CODE CheckSteps(CDBDoc& doc, const T_PUSH_OPTIONS& o, const std::vector<int>& keys);

/// The frame with its hinges and the storeys, where they are asked for, of results that the
/// document has. Done, or the code to exit with after one line on stderr.
EXIT_CODE DrawSteps(CDBDoc& doc, const T_PUSH_OPTIONS& o, const std::vector<T_PUSH_RUN>& runs);
