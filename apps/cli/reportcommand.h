// The command that writes the report data set.
#pragma once

#include "exitcodes.h"

#include <string>

/// Writes storeys, masses, drifts, curves and results of all load cases as JSON, "-" for standard
/// output; names the file that it wrote.
EXIT_CODE RunReportData(const std::string& file, const std::string& out, bool overwrite);
