// qm-rps: the command line. Reads the arguments; the commands do the work.
#include "commands.h"
#include "output.h"
#include "qm_base/msgfunction.h"
#include "qm_rps/pushover/pushoverreport.h"
#include "registrations.h"
#include "say.h"
#include "verify.h"

#include <CLI/CLI.hpp>

#include <csignal>
#include <cstdio>

namespace {

void AddImport(CLI::App& app, EXIT_CODE& code)
{
    auto* sub = app.add_subcommand("import", "Read a case file and write a model file");
    auto in = std::make_shared<std::string>(), out = std::make_shared<std::string>();
    sub->add_option("CASE", *in, "Case file (.json)")->required();
    sub->add_option("MODEL", *out, "Model file to write (.qmdb)")->required();
    sub->footer("Example:\n  qm-rps import examples/first-steps/case.json first-steps.qmdb");
    sub->callback([=, &code] { code = RunImport(*in, *out); });
}

void AddExport(CLI::App& app, EXIT_CODE& code)
{
    auto* sub = app.add_subcommand("export", "Write a model as a case file");
    auto in = std::make_shared<std::string>(), out = std::make_shared<std::string>("-");
    sub->add_option("MODEL", *in, "Model file (.qmdb) or case file")->required();
    sub->add_option("CASE", *out, "Case file to write, - for standard output")
        ->capture_default_str();
    sub->footer("Example:\n  qm-rps export examples/first-steps/case.json -");
    sub->callback([=, &code] { code = RunExport(*in, *out); });
}

void AddInfo(CLI::App& app, EXIT_CODE& code)
{
    auto* sub = app.add_subcommand("info", "Say what a model or case file holds");
    auto in = std::make_shared<std::string>();
    auto check = std::make_shared<bool>(false);
    sub->add_option("FILE", *in, "Model file (.qmdb) or case file (.json)")->required();
    sub->add_flag("--check", *check, "Read the whole file and check every result block");
    sub->footer("Example:\n  qm-rps info examples/first-steps/case.json");
    sub->callback([=, &code] { code = RunInfo(*in, *check); });
}

void AddEvaluate(CLI::App& app, EXIT_CODE& code)
{
    auto* sub = app.add_subcommand("evaluate", "Run the evaluations of a model or case file");
    auto o = std::make_shared<T_EVALUATE_OPTIONS>();
    sub->add_option("FILE", o->file, "Model file (.qmdb) or case file (.json)")->required();
    sub->add_option("--only", o->only, "Run only the evaluation of that name");
    sub->add_option("--json", o->json, "Write the results as JSON; - for standard output");
    sub->add_option("--report", o->report, "Write the text report");
    sub->add_option("--curve", o->curve, "Write the curve table");
    sub->add_option("--plot", o->plot,
                    "Draw the picture: .svg, .png or .pdf (several evaluations: "
                    "numbered before the extension)");
    sub->add_option("--add-step", o->steps,
                    "List a step of the curve beside the result (up to 10)");
    sub->add_option("--add-spectrum", o->spectra,
                    "Performance point for another spectrum too (up to 10)");
    sub->add_flag("--trace", o->trace, "Print every trial");
    sub->add_flag("--no-store", o->noStore, "Don't store limit-state steps in the model file");
    sub->footer("Example:\n  qm-rps evaluate examples/first-steps/case.json --trace");
    sub->callback([=, &code] { code = RunEvaluate(*o); });
}

void AddCompare(CLI::App& app, EXIT_CODE& code)
{
    auto* sub = app.add_subcommand("compare", "Run every method on one curve, with the spread");
    auto o = std::make_shared<T_COMPARE_OPTIONS>();
    sub->add_option("FILE", o->file, "Model file (.qmdb) or case file (.json)")->required();
    sub->add_option("--push", o->push, "Name of the pushover load case")->required();
    sub->add_option("--spectrum", o->spectrum, "Name of the spectrum")->required();
    sub->add_option("--behavior", o->behavior, "Structural behaviour or hysteresis model, 0 to 2")
        ->check(CLI::Range(0, 2))
        ->capture_default_str();
    sub->add_option("--json", o->json, "Write the results as JSON; - for standard output");
    sub->add_option("--plot", o->plot, "Draw the picture: .svg, .png or .pdf");
    sub->footer("Example:\n  qm-rps compare examples/first-steps/case.json --push PX "
                "--spectrum ATC");
    sub->callback([=, &code] { code = RunCompare(*o); });
}

void AddVerify(CLI::App& app, EXIT_CODE& code)
{
    auto* sub =
        app.add_subcommand("verify", "Compare the verification cases with their references");
    auto folder = std::make_shared<std::string>();
    sub->add_option("FOLDER", *folder, "Folder with checks.json and its case files")->required();
    sub->footer("Example:\n  qm-rps verify examples/verification");
    sub->callback([=, &code] { code = RunVerify(*folder); });
}

} // namespace

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
    AddImport(app, code);
    AddExport(app, code);
    AddInfo(app, code);
    AddEvaluate(app, code);
    AddCompare(app, code);
    AddVerify(app, code);
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
