// Debug dump of a problem handed to the load factor solver.
#pragma once

#include "qm_rps/factors/optproblem.h"

/// The text of the dump file.
std::string OptDumpText(const T_OPT_SYSTEM& system, bool exact, int iobj, int isign);
/// "frame.qmdb", true gives "frame_[EXACT].out".
std::string OptDumpPath(const std::string& modelPath, bool exact);
/// Writes or extends the file; one that can't be opened is silently skipped.
void WriteOptDump(const T_OPT_DUMP& dump, const T_OPT_ANSWER& answer, int iobj, int isign);
