// Runs the cases of a verification folder and compares them with their references.
#pragma once

#include "exitcodes.h"

#include <string>

/// Reads FOLDER/checks.json, evaluates every case it names and prints a Markdown table: reference,
/// its stated precision, ours, difference. NotFound when a difference is larger than the
/// precision and has no explanation.
EXIT_CODE RunVerify(const std::string& folder);
