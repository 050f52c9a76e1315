// The arguments of linear analysis.
#include "analysecommands.h"
#include "registershared.h"
#include "registrations.h"

void AddAnalyse(CLI::App& app, EXIT_CODE& code)
{
    auto* sub =
        app.add_subcommand("analyse", "Analysis of load cases, construction stages and modes");
    auto o = std::make_shared<T_ANALYSE_OPTIONS>();
    AddFile(sub, o->file);
    sub->add_option("--case", o->cases, "Load case or combination to show (default: all cases)");
    sub->add_option("--modes", o->modes, "Number of eigen modes to find")
        ->check(CLI::Range(1, 1000000));
    auto* stage = sub->add_option("--stage", o->stage,
                                  "Construction stage to show alone (default: all, in brief)");
    sub->add_option("--step", o->step, "Step of the stage (default: the last one)")
        ->check(CLI::Range(1, 1000000))
        ->needs(stage);
    sub->add_option("--load", o->load,
                    "Of the stages: sum, dead, erection or a load case (default: sum)");
    AddJson(sub, o->json);
    sub->add_flag("--table", o->table, "Print the tables also when the JSON goes to a file");
    sub->add_option("--plot", o->plot, "Draw the deformed shape: .svg, .png or .pdf");
    auto* plotCase =
        sub->add_option("--plot-case", o->plotCase, "Load case or combination of the picture");
    sub->add_option("--plot-mode", o->plotMode, "Mode of the picture")->excludes(plotCase);
    sub->add_option("-o", o->out, "Write the model with its results (.qmdb) or as a case file");
    sub->add_flag("--no-store", o->noStore, "Don't store the results in the model file");
    sub->footer("Results are in the file's units. Member forces are internal forces of the cut "
                "seen from the I side.\nExample:\n  qm-rps analyse "
                "examples/cable-stayed-bridge/case.json --case DEAD --plot shape.svg");
    sub->callback([=, &code] { code = RunAnalyse(*o); });
}
