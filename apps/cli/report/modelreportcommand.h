// The command that writes the report of a model.
#pragma once

#include "exitcodes.h"
#include <optional>
#include <string>

struct T_MODEL_REPORT_OPTIONS {
    std::string file, html, pdf;
    /// What is not given is as the model keeps it.
    std::optional<std::string> only; // chapters, separated by commas
    std::optional<std::string> project, author, checker, date;
    std::optional<int> rows; // of a table at most; 0: all
    bool keep = false;       // the settings, in the model
    std::string out;         // the model with its settings; empty: the file itself
    bool overwrite = false;
};

/// Keeps the settings where that is asked for, before anything else. Pushes what its evaluations
/// need, evaluates, judges and solves, and writes one document; names the files that it wrote.
/// Ctrl-C ends it without a file.
EXIT_CODE RunModelReport(const T_MODEL_REPORT_OPTIONS& options);
