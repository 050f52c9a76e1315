// Results as JSON text: an array with one object per evaluation.
#pragma once

#include "qm_rps/pushover/pushevaluation.h"

#include <string>
#include <vector>

/// Numbers print shortest round trip; what does not exist is null. Ends with a line end.
std::string ResultJson(const std::vector<T_PUSH_EVALUATION>& results);
