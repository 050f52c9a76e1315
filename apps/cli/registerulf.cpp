// The arguments of the commands on unknown load factors.
#include "factors/tunecommand.h"
#include "iteratecommands.h"
#include "registershared.h"
#include "registrations.h"
#include "ulfcommands.h"

namespace {

using OPTIONS = std::shared_ptr<T_ULF_OPTIONS>;

void AddItem(CLI::App* sub, const OPTIONS& o, bool required)
{
    auto* option = sub->add_option("--item", o->item, Say("IDS_QM_HELP_ULF_ITEM"));
    if (required) option->required();
}

void AddSum(CLI::App* sub, bool& sumStageLoads)
{
    sub->add_flag("--sum-stage-loads", sumStageLoads, Say("IDS_QM_HELP_ULF_SUM"));
}

void AddForce(CLI::App* sub, const OPTIONS& o)
{
    sub->add_flag("--force", o->force, Say("IDS_QM_HELP_ULF_FORCE"));
}

void AddSolve(const T_GROUP& group, const OPTIONS& o)
{
    auto* solve = AddOne(group, "solve", Say("IDS_QM_HELP_ULF_SOLVE"),
                         " --item LEVEL --plot bars.svg", o, RunUlfSolve);
    AddItem(solve, o, true);
    AddJson(solve, o->json, Say("IDS_QM_HELP_ULF_SOLVE_JSON"));
    solve->add_option("--plot", o->plot, Say("IDS_QM_HELP_ULF_SOLVE_PLOT"));
    AddSum(solve, o->sumStageLoads);
    solve->add_flag("--dump", o->dump, Say("IDS_QM_HELP_ULF_DUMP"));
    solve->add_option("--shape-plot", o->shapePlot, Say("IDS_QM_HELP_ULF_SHAPE_PLOT"));
    AddOverwrite(solve, o->overwrite);
}

void AddIterate(CLI::App* ulf, EXIT_CODE& code)
{
    const auto o = std::make_shared<T_ITERATE_OPTIONS>();
    auto* sub = ulf->add_subcommand("iterate", Say("IDS_QM_HELP_ULF_ITERATE"));
    AddFile(sub, o->file);
    sub->add_option("--item", o->item, Say("IDS_QM_HELP_ULF_STAGE_ITEM"))->required();
    sub->add_option("--iterations", o->iterations, Say("IDS_QM_HELP_ULF_ITERATIONS"))
        ->capture_default_str();
    sub->add_option("--tolerance", o->tolerance, Say("IDS_QM_HELP_ULF_TOLERANCE"))
        ->capture_default_str();
    sub->add_flag("--overwrite", o->overwrite, Say("IDS_QM_HELP_ULF_OVERWRITE"));
    sub->add_flag("--append", o->append, Say("IDS_QM_HELP_ULF_APPEND"));
    AddJson(sub, o->json, Say("IDS_QM_HELP_ULF_ITERATE_JSON"));
    sub->add_option("--plot", o->plot, Say("IDS_QM_HELP_ULF_ITERATE_PLOT"));
    AddSum(sub, o->sumStageLoads);
    AddExample(sub, "ulf iterate bridge.qmdb --item STAYS --tolerance 1e-6");
    sub->callback([=, &code] { code = RunUlfIterate(*o); });
}

void AddTune(const T_GROUP& group)
{
    const auto o = std::make_shared<T_TUNE_OPTIONS>();
    auto* tune = AddOne(group, "tune", Say("IDS_QM_HELP_ULF_TUNE"),
                        " --item LEVEL --factor T101=1.2 --plot deck.svg", o, RunUlfTune);
    tune->add_option("--item", o->item, Say("IDS_QM_HELP_ULF_ITEM"))->required();
    tune->add_option("--factor", o->factors, Say("IDS_QM_HELP_ULF_TUNE_FACTOR"))
        ->allow_extra_args(false);
    tune->add_option("--deck", o->deck, Say("IDS_QM_HELP_ULF_TUNE_DECK"));
    tune->add_option("--plot", o->plot, Say("IDS_QM_HELP_ULF_TUNE_PLOT"));
    tune->add_option("--plot-moments", o->plotMoments, Say("IDS_QM_HELP_ULF_TUNE_MOMENTS"));
    AddOverwrite(tune, o->overwrite);
}

} // namespace

void AddUlf(CLI::App& app, EXIT_CODE& code)
{
    auto* ulf = app.add_subcommand("ulf", Say("IDS_QM_HELP_ULF"));
    ulf->require_subcommand(1);
    AddExample(ulf, "ulf solve examples/cable-stayed-bridge/case.json --item LEVEL");
    const T_GROUP group{ulf, "examples/cable-stayed-bridge/case.json", code};
    const OPTIONS o = std::make_shared<T_ULF_OPTIONS>();
    AddOne(group, "list", Say("IDS_QM_HELP_ULF_LIST"), "", o, RunUlfList);
    AddItem(AddOne(group, "check", Say("IDS_QM_HELP_CHECK_RULES"), "", o, RunUlfCheck), o, false);
    AddSolve(group, o);
    AddIterate(ulf, code);
    AddTune(group);
    auto* explain = AddOne(group, "explain", Say("IDS_QM_HELP_ULF_EXPLAIN"),
                           " --item \"NO UPLIFT\"", o, RunUlfExplain);
    AddItem(explain, o, true);
    AddJson(explain, o->json, Say("IDS_QM_HELP_ULF_EXPLAIN_JSON"));
    AddOverwrite(explain, o->overwrite);
    AddSum(explain, o->sumStageLoads);
    auto* sheet = AddOne(group, "export", Say("IDS_QM_HELP_ULF_EXPORT"),
                         " --item LEVEL -o level.xlsx", o, RunUlfExport);
    AddItem(sheet, o, true);
    AddSum(sheet, o->sumStageLoads);
    sheet->add_option("-o", o->out, Say("IDS_QM_HELP_ULF_SHEET"))->required();
    AddOverwrite(sheet, o->overwrite);
    AddForce(sheet, o);
    sheet->add_flag("--open", o->open, Say("IDS_QM_HELP_ULF_OPEN"));
    sheet->add_option("--date", o->date, Say("IDS_QM_HELP_ULF_DATE"));
    sheet->add_option("--sheet-version", o->sheetVersion, Say("IDS_QM_HELP_ULF_SHEET_VERSION"))
        ->capture_default_str();
    auto* combine = AddOne(group, "combine", Say("IDS_QM_HELP_ULF_COMBINE"),
                           " --item LEVEL --name TUNED -o tuned.json", o, RunUlfCombine);
    AddItem(combine, o, true);
    combine->add_option("--name", o->name, Say("IDS_QM_HELP_ULF_NAME"))->required();
    combine->add_option("-o", o->out, Say("IDS_QM_HELP_ULF_OUT"));
    AddOverwrite(combine, o->overwrite);
    AddForce(combine, o);
}
