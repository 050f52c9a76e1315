// The arguments of the commands on pushover evaluations.
#include "evaluatecommands.h"
#include "qm_rps/judge/judgement.h"
#include "qm_rps/pushover/overview/evaluationcards.h"
#include "registershared.h"
#include "registrations.h"
#include "verifycommand.h"

namespace {

void AddEvaluate(CLI::App& app, EXIT_CODE& code)
{
    auto* sub = app.add_subcommand("evaluate", Say("IDS_QM_HELP_EVALUATE"));
    auto o = std::make_shared<T_EVALUATE_OPTIONS>();
    AddFile(sub, o->file);
    sub->add_option("--only", o->only, Say("IDS_QM_HELP_EVALUATE_ONLY"))->allow_extra_args(false);
    sub->add_option("--push", o->push, Say("IDS_QM_HELP_EVALUATE_PUSH"));
    AddJson(sub, o->json);
    auto* const report = sub->add_option("--report", o->report, Say("IDS_QM_HELP_EVALUATE_REPORT"));
    sub->add_flag("--plain", o->plain, Say("IDS_QM_HELP_PLAIN"))->needs(report);
    sub->add_option("--code", o->code, Say("IDS_QM_HELP_EVALUATE_CODE"))
        ->check(CLI::IsMember(JudgedCodeNames()))
        ->needs(report);
    sub->add_option("--curve", o->curve, Say("IDS_QM_HELP_EVALUATE_CURVE"));
    sub->add_option("--plot", o->plot, Say("IDS_QM_HELP_EVALUATE_PLOT"));
    sub->add_option("--plot-demand", o->plotDemand, Say("IDS_QM_HELP_EVALUATE_DEMAND"));
    auto* const overlay =
        sub->add_option("--overlay", o->overlay, Say("IDS_QM_HELP_EVALUATE_OVERLAY"));
    sub->add_flag("--whole-curve", o->whole, Say("IDS_QM_HELP_EVALUATE_WHOLE"))->needs(overlay);
    auto* const bars = sub->add_option("--bars", o->bars, Say("IDS_QM_HELP_EVALUATE_BARS"));
    sub->add_option("--bars-of", o->barsOf, Say("IDS_QM_HELP_EVALUATE_BARS_OF"))
        ->check(CLI::IsMember(std::vector<std::string>(kCardNames.begin(), kCardNames.end())))
        ->capture_default_str()
        ->needs(bars);
    sub->add_option("--summary", o->summary, Say("IDS_QM_HELP_EVALUATE_SUMMARY"));
    sub->add_option("--add-step", o->steps, Say("IDS_QM_HELP_EVALUATE_STEP"));
    sub->add_option("--add-spectrum", o->spectra, Say("IDS_QM_HELP_EVALUATE_SPECTRUM"));
    sub->add_flag("--trace", o->trace, Say("IDS_QM_HELP_EVALUATE_TRACE"));
    AddOverwrite(sub, o->overwrite);
    sub->add_flag("--no-store", o->noStore, Say("IDS_QM_HELP_EVALUATE_NO_STORE"));
    AddExample(sub, "evaluate examples/first-steps/case.json --trace");
    sub->callback([=, &code] { code = RunEvaluate(*o); });
}

void AddCompare(CLI::App& app, EXIT_CODE& code)
{
    auto* sub = app.add_subcommand("compare", Say("IDS_QM_HELP_COMPARE"));
    auto o = std::make_shared<T_COMPARE_OPTIONS>();
    AddFile(sub, o->file);
    sub->add_option("--push", o->push, Say("IDS_QM_HELP_COMPARE_PUSH"))->required();
    sub->add_option("--spectrum", o->spectrum, Say("IDS_QM_HELP_COMPARE_SPECTRUM"))->required();
    sub->add_option("--behavior", o->behavior, Say("IDS_QM_HELP_COMPARE_BEHAVIOR"))
        ->check(CLI::Range(0, 2))
        ->capture_default_str();
    AddJson(sub, o->json);
    sub->add_option("--plot", o->plot, Say("IDS_QM_HELP_PICTURE"));
    AddOverwrite(sub, o->overwrite);
    AddExample(sub, "compare examples/first-steps/case.json --push PX --spectrum ATC");
    sub->callback([=, &code] { code = RunCompare(*o); });
}

void AddVerify(CLI::App& app, EXIT_CODE& code)
{
    auto* sub = app.add_subcommand("verify", Say("IDS_QM_HELP_VERIFY"));
    auto folder = std::make_shared<std::string>();
    sub->add_option("FOLDER", *folder, Say("IDS_QM_HELP_VERIFY_FOLDER"))->required();
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
