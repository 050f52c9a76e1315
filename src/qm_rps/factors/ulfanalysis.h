// Analyses that load factors need, run from a window: they can be cancelled at any time.
#pragma once

#include "qm_db/dbdoc.h"

/// Done and total parts; returns false to cancel.
using ULF_PROGRESS = std::function<bool(std::size_t done, std::size_t total)>;

/// Runs an analysis in the document's worker. progress (may be empty) is asked again and again
/// while it runs, also when there is no news, so that a window stays alive. 1 the results are in
/// the document; 0 error filled, the document as it was.
[[nodiscard]] int RunWatchedAnalysis(CDBDoc& doc, T_ANALYSIS_OPTIONS options,
                                     const ULF_PROGRESS& progress, T_ANALYSIS_ERROR& error);
