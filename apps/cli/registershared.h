// Arguments that several commands have.
#pragma once

#include "exitcodes.h"
#include "qm_base/say.h"

#include <CLI/CLI.hpp>

#include <memory>
#include <string>

inline CLI::Option* AddFile(CLI::App* sub, std::string& file)
{
    return sub->add_option("FILE", file, Say("IDS_QM_HELP_FILE"))->required();
}

/// Where a command writes its results as JSON.
inline CLI::Option* AddJson(CLI::App* sub, std::string& path,
                            const std::string& what = Say("IDS_QM_HELP_JSON"))
{
    return sub->add_option("--json", path, what);
}

/// Whether files that are there already are replaced.
inline CLI::Option* AddOverwrite(CLI::App* sub, bool& overwrite)
{
    return sub->add_flag("--overwrite", overwrite, Say("IDS_QM_HELP_OVERWRITE"));
}

/// What stands below the help: `command` without the program's name.
inline std::string Example(const std::string& command)
{
    return Say("IDS_QM_HELP_EXAMPLE", command);
}

inline void AddExample(CLI::App* sub, const std::string& command)
{
    sub->footer(Example(command));
}

/// A command with commands below it, whose examples run on one case file.
struct T_GROUP {
    CLI::App* app;
    const char* caseFile;
    EXIT_CODE& code;
};

/// One command of the group: its file, its example and what it runs.
template <class OPTIONS>
CLI::App* AddOne(const T_GROUP& group, const char* name, const std::string& what,
                 const char* example, std::shared_ptr<OPTIONS> o, EXIT_CODE (*run)(const OPTIONS&))
{
    auto* sub = group.app->add_subcommand(name, what);
    AddFile(sub, o->file);
    AddExample(sub, group.app->get_name() + " " + name + " " + group.caseFile + example);
    sub->callback([o, run, &code = group.code] { code = run(*o); });
    return sub;
}
