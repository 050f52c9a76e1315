// The arguments of linear analysis.
#include "analysecommands.h"
#include "registershared.h"
#include "registrations.h"

void AddAnalyse(CLI::App& app, EXIT_CODE& code)
{
    auto* sub = app.add_subcommand("analyse", Say("IDS_QM_HELP_ANALYSE"));
    auto o = std::make_shared<T_ANALYSE_OPTIONS>();
    AddFile(sub, o->file);
    sub->add_option("--case", o->cases, Say("IDS_QM_HELP_ANALYSE_CASE"));
    sub->add_option("--modes", o->modes, Say("IDS_QM_HELP_ANALYSE_MODES"))
        ->check(CLI::Range(1, 1000000));
    auto* stage = sub->add_option("--stage", o->stage, Say("IDS_QM_HELP_ANALYSE_STAGE"));
    sub->add_option("--step", o->step, Say("IDS_QM_HELP_ANALYSE_STEP"))
        ->check(CLI::Range(1, 1000000))
        ->needs(stage);
    sub->add_option("--load", o->load, Say("IDS_QM_HELP_ANALYSE_LOAD"));
    AddJson(sub, o->json);
    sub->add_flag("--table", o->table, Say("IDS_QM_HELP_ANALYSE_TABLE"));
    sub->add_option("--node", o->nodes, Say("IDS_QM_HELP_ANALYSE_NODE"));
    sub->add_option("--element", o->elements, Say("IDS_QM_HELP_ANALYSE_ELEMENT"));
    sub->add_option("--top", o->top, Say("IDS_QM_HELP_ANALYSE_TOP"))->check(CLI::Range(1, 1000000));
    sub->add_flag("--envelope", o->envelope, Say("IDS_QM_HELP_ANALYSE_ENVELOPE"));
    sub->add_option("--plot", o->plot, Say("IDS_QM_HELP_ANALYSE_PLOT"));
    auto* plotCase =
        sub->add_option("--plot-case", o->plotCase, Say("IDS_QM_HELP_ANALYSE_PLOT_CASE"));
    sub->add_option("--plot-mode", o->plotMode, Say("IDS_QM_HELP_ANALYSE_PLOT_MODE"))
        ->excludes(plotCase);
    sub->add_option("-o", o->out, Say("IDS_QM_HELP_ANALYSE_OUT"));
    AddOverwrite(sub, o->overwrite);
    sub->add_flag("--no-store", o->noStore, Say("IDS_QM_HELP_ANALYSE_NO_STORE"));
    sub->footer(
        Say("IDS_QM_HELP_ANALYSE_UNITS") + '\n' +
        Example("analyse examples/cable-stayed-bridge/case.json --case DEAD --plot shape.svg"));
    sub->callback([=, &code] { code = RunAnalyse(*o); });
}
