// qm-rps: the command line. Reads the arguments; the commands do the work.
#include "console/console.h"
#include "output.h"
#include "qm_base/msgfunction.h"
#include "qm_base/say.h"
#include "qm_db/casefile.h"
#include "qm_solver/libraryspace.h"
#include "registrations.h"

#include <CLI/CLI.hpp>

#include <csignal>
#include <cstdio>
#include <new>
#include <span>
#include <stdexcept>
#include <string_view>

namespace {

/// --lang before the commands are told: their help has words. The parser judges its value.
void ChooseLanguage(int argc, char** argv)
{
    constexpr std::string_view kOption = "--lang";
    for (int i = 1; i < argc && argv[i][0] == '-'; ++i) {
        std::string_view value = argv[i];
        if (!value.starts_with(kOption)) continue;
        value.remove_prefix(kOption.size());
        if (value.starts_with('='))
            value.remove_prefix(1);
        else if (!value.empty())
            continue; // another option that begins so
        else if (i + 1 < argc)
            value = argv[++i];
        (void)!zql::lib::MMSGFunction::SetLanguage(value);
    }
}

/// Registers the commands and runs the one that is asked for.
int RunCommand(int argc, char** argv)
{
    CLI::App app{"", "qm-rps"};
    std::signal(SIGXFSZ, SIG_IGN); // a file-size limit is a write error, not the end
    EXIT_CODE code = EXIT_CODE::Done;
    std::string language = "en";
    AddHelp(app);
    app.add_flag_callback(
        "--allow-outside", [] { CCaseFile::SetAllowOutside(true); },
        Say("IDS_QM_HELP_ALLOW_OUTSIDE"));
    app.add_option("--lang", language, Say("IDS_QM_HELP_LANG"))->check(CLI::IsMember({"en", "it"}));
    app.require_subcommand(1);
    AddModel(app, code);
    AddNew(app, code);
    AddParts(app, code);
    AddRecord(app, code);
    AddEvaluations(app, code);
    AddHingeCommands(app, code);
    AddSection(app, code);
    AddCase(app, code);
    AddAnalyse(app, code);
    AddViews(app, code);
    AddPush(app, code);
    AddJudge(app, code);
    AddUlf(app, code);
    AddReport(app, code);
    AddDocuments(app, code);
    try {
        app.parse(argc, argv);
    } catch (const CLI::ParseError& e) {
        if (e.get_exit_code() == 0) return app.exit(e); // --help, --version
        const bool unknown =
            argc > 1 && argv[1][0] != '-' &&
            app.get_subcommands([&](const CLI::App* s) { return s->get_name() == argv[1]; })
                .empty();
        const std::string what = unknown ? Say("IDS_QM_CLI_UNKNOWN_COMMAND", std::string(argv[1]))
                                         : ParserWords(e.what());
        const std::string meant =
            MeantWord(app, std::span<const char* const>(argv + 1, argv + argc));
        const std::string words = meant.empty() ? what : what + "; " + meant;
        return ToInt(Complain(EXIT_CODE::Usage, Say("IDS_QM_CLI_SEE_HELP", words)));
    }
    if (!CConsole::Flush()) {
        return ToInt(Complain(EXIT_CODE::NoAccess, Say("IDS_QM_CLI_NO_STDOUT")));
    }
    return ToInt(code);
}

} // namespace

int main(int argc, char** argv)
{
    solver::StartLean(argv);
    ChooseLanguage(argc, argv);
    const CConsole console;
    try {
        return RunCommand(argc, argv);
    } catch (const std::bad_alloc&) {
    } catch (const std::length_error&) { // of a list that no memory could hold
    }
    return ToInt(Complain(EXIT_CODE::NoAccess, Say("IDS_QM_NO_MEMORY")));
}
