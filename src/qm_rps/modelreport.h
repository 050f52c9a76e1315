// The report of a model: everything that it needs is computed, then it is written.
#pragma once

#include "qm_rps/document/report.h"

/// Evaluates, judges and solves what the asked chapters show. Pushes are read as the document has
/// them: those without results are told in the report. The document stays as it is. 1 done; 0 the
/// progress wanted no more, `out` as it was.
[[nodiscard]] int MakeModelReport(CDBDoc& doc, const T_REPORT_OPTIONS& options, T_DOCUMENT& out);
