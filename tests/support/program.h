// Runs the real program on real files, for the tests of the whole.
#pragma once

#include "tempfolder.h"

#include <filesystem>
#include <string>
#include <vector>

/// What a run left behind.
struct T_RUN {
    int code = -1; // exit code; -1 when it did not end by itself
    std::string out, err;
};

struct T_RUN_OPTIONS {
    std::filesystem::path folder; // to run in; empty: where the test runs
    long fileSizeLimit = 0;       // bytes that a file may grow to; 0: no limit
    bool obeyModes = false;       // also root may not write where the mode forbids it
};

/// Runs qm-rps with these arguments.
T_RUN RunProgram(const std::vector<std::string>& arguments, const T_RUN_OPTIONS& options = {});

/// Runs one line of shell in which `qm-rps` is the program.
T_RUN RunShell(const std::string& line, const std::filesystem::path& folder);

std::vector<std::string> Lines(const std::string& text);

/// The project's folder and its examples.
std::filesystem::path ProjectFolder();
std::string ExampleCase(const std::string& name);

/// A valid case of one storey, one push and one evaluation "E1".
extern const char* const kSmallCase;
/// The small case with one piece of text replaced; the piece must be there.
std::string SmallCaseWith(const std::string& from, const std::string& to);
