// Arguments that several commands have.
#pragma once

#include "exitcodes.h"

#include <CLI/CLI.hpp>

#include <memory>
#include <string>

inline CLI::Option* AddFile(CLI::App* sub, std::string& file)
{
    return sub->add_option("FILE", file, "Model file (.qmdb) or case file (.json)")->required();
}

/// Where a command writes its results as JSON.
inline CLI::Option* AddJson(CLI::App* sub, std::string& path,
                            const char* what = "Write the results as JSON; - for standard output")
{
    return sub->add_option("--json", path, what);
}

inline void AddExample(CLI::App* sub, const std::string& command)
{
    sub->footer("Example:\n  qm-rps " + command);
}

/// A command with commands below it, whose examples run on one case file.
struct T_GROUP {
    CLI::App* app;
    const char* caseFile;
    EXIT_CODE& code;
};

/// One command of the group: its file, its example and what it runs.
template <class OPTIONS>
CLI::App* AddOne(const T_GROUP& group, const char* name, const char* what, const char* example,
                 std::shared_ptr<OPTIONS> o, EXIT_CODE (*run)(const OPTIONS&))
{
    auto* sub = group.app->add_subcommand(name, what);
    AddFile(sub, o->file);
    AddExample(sub, group.app->get_name() + " " + name + " " + group.caseFile + example);
    sub->callback([o, run, &code = group.code] { code = run(*o); });
    return sub;
}
