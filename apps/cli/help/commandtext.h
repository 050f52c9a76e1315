// What the help of the program says, apart from the argument parser: manual pages and the
// completion of shells are written from it, so that they know what --help knows.
#pragma once

#include <string>
#include <vector>

struct T_OPTION_TEXT {
    std::string shortName, longName;  // "-o", "--output"; both empty: an argument by its place
    std::string value;                // what stands for its value, "FILE", "TEXT"; empty: a flag
    std::vector<std::string> choices; // the words that it takes; empty: any
    std::string limits;               // of a number, as the parser says it: "INT in [1 - 99]"
    std::string about;
    std::string preset; // what is taken without it; empty: nothing
    std::vector<std::string> needs, excludes;
    bool required = false;
    bool several = false;

    bool IsPlace() const { return shortName.empty() && longName.empty(); }
};

struct T_COMMAND_TEXT {
    std::string name; // with those above it and the program: "qm-rps hinge list"
    std::string about;
    std::string example; // a line of shell; empty: none
    std::vector<T_OPTION_TEXT> options;
    std::vector<T_COMMAND_TEXT> commands;
    bool worksAlone = true; // without one of the commands below it
};

/// Endings of the files that the value of an option names, told by its help text and its name:
/// {"qmdb", "json"}. Empty: it names no file.
std::vector<std::string> FileEndings(const T_OPTION_TEXT& option);

/// Whether the value is a folder.
bool NamesFolder(const T_OPTION_TEXT& option);
