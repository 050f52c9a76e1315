// The arguments of the commands on pushover evaluations.
#include "evaluatecommands.h"
#include "registershared.h"
#include "registrations.h"
#include "verifycommand.h"

namespace {

void AddEvaluate(CLI::App& app, EXIT_CODE& code)
{
    auto* sub = app.add_subcommand("evaluate", "Run the evaluations of a model or case file");
    auto o = std::make_shared<T_EVALUATE_OPTIONS>();
    AddFile(sub, o->file);
    sub->add_option("--only", o->only, "Run only the evaluation of that name");
    AddJson(sub, o->json);
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
    AddExample(sub, "evaluate examples/first-steps/case.json --trace");
    sub->callback([=, &code] { code = RunEvaluate(*o); });
}

void AddCompare(CLI::App& app, EXIT_CODE& code)
{
    auto* sub = app.add_subcommand("compare", "Run every method on one curve, with the spread");
    auto o = std::make_shared<T_COMPARE_OPTIONS>();
    AddFile(sub, o->file);
    sub->add_option("--push", o->push, "Name of the pushover load case")->required();
    sub->add_option("--spectrum", o->spectrum, "Name of the spectrum")->required();
    sub->add_option("--behavior", o->behavior, "Structural behaviour or hysteresis model, 0 to 2")
        ->check(CLI::Range(0, 2))
        ->capture_default_str();
    AddJson(sub, o->json);
    sub->add_option("--plot", o->plot, "Draw the picture: .svg, .png or .pdf");
    AddExample(sub, "compare examples/first-steps/case.json --push PX "
                    "--spectrum ATC");
    sub->callback([=, &code] { code = RunCompare(*o); });
}

void AddVerify(CLI::App& app, EXIT_CODE& code)
{
    auto* sub =
        app.add_subcommand("verify", "Compare the verification cases with their references");
    auto folder = std::make_shared<std::string>();
    sub->add_option("FOLDER", *folder, "Folder with checks.json and its case files")->required();
    AddExample(sub, "verify examples/verification");
    sub->callback([=, &code] { code = RunVerify(*folder); });
}

} // namespace

void AddEvaluations(CLI::App& app, EXIT_CODE& code)
{
    AddEvaluate(app, code);
    AddCompare(app, code);
    AddVerify(app, code);
}
