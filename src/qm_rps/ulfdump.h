// Debug dump of a problem handed to the load factor solver.
#pragma once

#include "qm_rps/optdsgn.h"

/// The text of the dump file.
std::string UlfDumpText(const T_ULF_SYSTEM& system, bool exact, int iobj, int isign);
/// "frame.qmdb", true gives "frame_[EXACT].out".
std::string UlfDumpPath(const std::string& modelPath, bool exact);
/// Writes or extends the file; one that can't be opened is silently skipped.
void WriteUlfDump(const T_ULF_DUMP& dump, const T_ULF_ANSWER& answer, int iobj, int isign);
