// Runs the real program on real files, for the tests of the whole.
#pragma once

#include "tempfolder.h"

#include <filesystem>
#include <gtest/gtest.h>
#include <initializer_list>
#include <nlohmann/json.hpp>
#include <string>
#include <vector>

using json = nlohmann::json;

/// What a run left behind.
struct T_RUN {
    int code = -1; // exit code, above 127 when a signal ended it
    std::string out, err;
};

/// Runs a line of shell in which `qm-rps` is the program and "@name" the case of that example.
T_RUN RunShell(const std::string& line, const std::filesystem::path& folder);

/// Tests that run the program in a folder of their own.
class CProgramTest : public testing::Test {
protected:
    /// Runs `qm-rps` with these arguments, written as in a shell; `before` is shell, too.
    T_RUN Run(const std::string& arguments, const std::string& before = {}) const;
    /// Runs and must succeed; what it printed.
    std::string Done(const std::string& arguments) const;
    /// What `qm-rps <arguments> --json -` prints; it must end with that code.
    json Json(const std::string& arguments, int code = 0) const;
    /// Ends with that code, nothing printed and one line on standard error that holds `says`; the
    /// line.
    std::string ExpectRefused(const std::string& arguments, int code,
                              const std::string& says) const;

    std::string Text(const std::string& name) const { return ReadText(m_folder / name); }
    void Write(const std::string& name, const std::string& text) const
    {
        WriteText(m_folder / name, text);
    }

    const CTempFolder m_folder;
};

void ExpectHolds(const std::string& text, std::initializer_list<const char*> pieces);

/// The text with one piece replaced; the piece must be there.
std::string With(std::string text, const std::string& from, const std::string& to);

std::vector<std::string> Lines(const std::string& text);

/// The project's folder and its examples.
std::filesystem::path ProjectFolder();
std::string ExampleCase(const std::string& name);

/// A valid case of one storey, one push and one evaluation "E1".
extern const char* const kSmallCase;
