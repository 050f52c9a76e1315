// The report data set as JSON text.
#pragma once

#include "qm_rps/ssreportinforw.h"

#include <string>

/// One object: units, storeys, pushover load cases with their steps, evaluations (as ResultJson
/// gives them). Numbers print shortest round trip; what does not exist is null. Ends with a line
/// end.
std::string ReportJson(const SSReportInfoRW& info);
