// Results of the push as JSON.
#pragma once

#include "qm_rps/push/pushrun.h"
#include "json/jsontext.h"

#include <set>
#include <string>
#include <vector>

/// "element", "end" and "component" of a hinge; the end of an integration point is a number.
void WritePlace(CJsonText& writer, const T_PUSH_LAW_PLACE& place);

/// A list of the runs in the units given, one entry per stored step, the first one is step 1. Of
/// the nodes those of `nodes` alone; empty: none.
std::string PushJson(const std::vector<T_PUSH_RUN>& runs, const std::set<int>& nodes,
                     const T_UNITS& units);
