// The arguments of the push.
#include "push/pushcommands.h"
#include "registershared.h"
#include "registrations.h"

void AddPush(CLI::App& app, EXIT_CODE& code)
{
    auto* sub = app.add_subcommand("push", Say("IDS_QM_HELP_PUSH"));
    auto o = std::make_shared<T_PUSH_OPTIONS>();
    AddFile(sub, o->file)->required(false); // a command below has its own
    sub->add_option("--case", o->cases, Say("IDS_QM_HELP_PUSH_CASE"));
    sub->add_flag("--all", o->all, Say("IDS_QM_HELP_PUSH_ALL"));
    AddJson(sub, o->json);
    sub->add_option("--plot", o->plot, Say("IDS_QM_HELP_PUSH_PLOT"));
    sub->add_option("--plot-hinges", o->plotHinges, Say("IDS_QM_HELP_PUSH_PLOT_HINGES"));
    sub->add_option("--plot-storeys", o->plotStoreys, Say("IDS_QM_HELP_PUSH_PLOT_STOREYS"));
    sub->add_option("--step", o->step, Say("IDS_QM_HELP_PUSH_STEP"))
        ->check(CLI::Range(1, 10000000));
    sub->add_option("--at", o->at, Say("IDS_QM_HELP_PUSH_AT"));
    sub->add_option("--state", o->state, Say("IDS_QM_HELP_PUSH_AT_STATE"));
    sub->add_option("--of", o->of, Say("IDS_QM_HELP_PUSH_OF"));
    sub->add_option("--hinges", o->hinges, Say("IDS_QM_HELP_PUSH_HINGES"));
    sub->add_option("--nodes", o->nodes, Say("IDS_QM_HELP_PUSH_NODES"));
    sub->add_option("-o", o->out, Say("IDS_QM_HELP_PUSH_OUT"));
    AddOverwrite(sub, o->overwrite);
    sub->add_flag("--no-store", o->noStore, Say("IDS_QM_HELP_ANALYSE_NO_STORE"));
    AddExample(sub, "push examples/masonry-wall/case.json --all");
    AddPushSetup(*sub, code);
    sub->callback([=, &code] {
        if (!sub->get_subcommands().empty()) return;
        if (o->file.empty()) throw CLI::RequiredError("FILE");
        code = RunPush(*o);
    });
}
