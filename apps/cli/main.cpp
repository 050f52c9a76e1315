// qm-rps: the command line. Reads the arguments; the commands do the work.
#include "output.h"
#include "qm_base/msgfunction.h"
#include "qm_base/say.h"
#include "qm_rps/pushover/pushoverreport.h"
#include "registrations.h"

#include <CLI/CLI.hpp>

#include <csignal>
#include <cstdio>

int main(int argc, char** argv)
{
    CLI::App app{"Linear analysis, unknown load factors, pushover evaluation, plastic hinges",
                 "qm-rps"};
    std::signal(SIGXFSZ, SIG_IGN); // a file-size limit is a write error, not the end
    EXIT_CODE code = EXIT_CODE::Done;
    std::string language = "en";
    app.set_version_flag("--version", ProductText());
    app.add_option("--lang", language, "Language of messages: en or it")
        ->check(CLI::IsMember({"en", "it"}))
        ->each([](const std::string& l) {
            const int known = zql::lib::MMSGFunction::SetLanguage(l);
            (void)known; // checked above
        });
    app.require_subcommand(1);
    app.footer(
        "Exit codes: 0 found, 1 a point or factors were not found, 2 usage, 3 bad input, 4 file "
        "access.\n"
        "Example:\n  qm-rps evaluate examples/first-steps/case.json");
    AddModel(app, code);
    AddEvaluations(app, code);
    AddHingeCommands(app, code);
    AddCase(app, code);
    AddAnalyse(app, code);
    AddUlf(app, code);
    AddReport(app, code);
    try {
        app.parse(argc, argv);
    } catch (const CLI::ParseError& e) {
        if (e.get_exit_code() == 0) return app.exit(e); // --help, --version
        const bool unknown =
            argc > 1 && argv[1][0] != '-' &&
            app.get_subcommands([&](const CLI::App* s) { return s->get_name() == argv[1]; })
                .empty();
        const std::string what =
            unknown ? Say("IDS_QM_CLI_UNKNOWN_COMMAND", std::string(argv[1])) : e.what();
        return ToInt(Complain(EXIT_CODE::Usage, Say("IDS_QM_CLI_SEE_HELP", what)));
    }
    if (std::fflush(stdout) != 0 || std::ferror(stdout) != 0) {
        return ToInt(Complain(EXIT_CODE::NoAccess, Say("IDS_QM_CLI_NO_STDOUT")));
    }
    return ToInt(code);
}
