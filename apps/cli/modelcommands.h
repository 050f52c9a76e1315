// The commands on model and case files.
#pragma once

#include "exitcodes.h"

#include <string>

/// Writes a case file as a model file, and says what it holds.
EXIT_CODE RunImport(const std::string& caseFile, const std::string& modelFile, bool overwrite);
/// Writes a model or case file as a case file, "-" for standard output.
EXIT_CODE RunExport(const std::string& modelFile, const std::string& caseFile, bool overwrite);
/// Says what a file holds; with `check` after every result block was read.
EXIT_CODE RunInfo(const std::string& file, bool check);
