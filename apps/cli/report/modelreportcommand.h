// The command that writes the report of a model.
#pragma once

#include "exitcodes.h"
#include "qm_db/records.h"

#include <string>

struct T_MODEL_REPORT_OPTIONS {
    std::string file, html, pdf;
    std::string only; // chapters, separated by commas; empty: all
    T_REPORT_D head;
    std::size_t rows = 200; // of a table at most; 0: all
    bool overwrite = false;
};

/// Pushes what its evaluations need, evaluates, judges and solves, and writes one document; names
/// the files that it wrote. Ctrl-C ends it without a file.
EXIT_CODE RunModelReport(const T_MODEL_REPORT_OPTIONS& options);
