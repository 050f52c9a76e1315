// Results of evaluations as JSON: a list with one object per evaluation.
#pragma once

#include "qm_rps/push/pushatpoint.h"
#include "qm_rps/pushover/pushevaluation.h"
#include "json/jsontext.h"

#include <string>
#include <vector>

/// The list as the next value. What does not exist is null.
void WriteResults(CJsonText& writer, const std::vector<T_PUSH_EVALUATION>& results,
                  const std::vector<T_HINGES_AT>& hinges = {});

/// The list as a text of its own. Numbers print shortest round trip; ends with a line end.
/// hinges: what the hinges do at the points of each evaluation, as many as results, or empty.
std::string ResultJson(const std::vector<T_PUSH_EVALUATION>& results,
                       const std::vector<T_HINGES_AT>& hinges = {});

/// "not found", "found" or "elastic", for the status of a result.
const char* StatusName(int result);
