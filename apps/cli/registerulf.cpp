// The arguments of the commands on unknown load factors.
#include "iteratecommands.h"
#include "registershared.h"
#include "registrations.h"
#include "ulfcommands.h"

namespace {

using OPTIONS = std::shared_ptr<T_ULF_OPTIONS>;

void AddItem(CLI::App* sub, const OPTIONS& o, bool required)
{
    auto* option = sub->add_option("--item", o->item, "Name of the unknown load factor item");
    if (required) option->required();
}

void AddSum(CLI::App* sub, bool& sumStageLoads)
{
    sub->add_flag(
        "--sum-stage-loads", sumStageLoads,
        "Load groups 0 and 1 of a construction-stage item read the sum of all stage loads");
}

void AddSolve(const T_GROUP& group, const OPTIONS& o)
{
    auto* solve =
        AddOne(group, "solve", "Find the factors", " --item LEVEL --plot bars.svg", o, RunUlfSolve);
    AddItem(solve, o, true);
    AddJson(solve, o->json, "Write the result as JSON; - for standard output");
    solve->add_option("--plot", o->plot, "Draw the constraints against their bounds");
    AddSum(solve, o->sumStageLoads);
    solve->add_option("--shape-plot", o->shapePlot, "Draw the displacements before and after");
}

void AddIterate(CLI::App* ulf, EXIT_CODE& code)
{
    const auto o = std::make_shared<T_ITERATE_OPTIONS>();
    auto* sub = ulf->add_subcommand("iterate", "Scale pretension until its factors are 1");
    AddFile(sub, o->file);
    sub->add_option("--item", o->item, "Name of the construction-stage item")->required();
    sub->add_option("--iterations", o->iterations, "Required number, 0 to 99")
        ->capture_default_str();
    sub->add_option("--tolerance", o->tolerance, "Convergence tolerance")->capture_default_str();
    sub->add_flag("--overwrite", o->overwrite,
                  "Overwrite the report (FILE with .ulf) if it exists");
    sub->add_flag("--append", o->append, "Add to it");
    AddJson(sub, o->json, "Write the history as JSON; - for standard output");
    sub->add_option("--plot", o->plot, "Draw factors and tolerance by iteration");
    AddSum(sub, o->sumStageLoads);
    AddExample(sub, "ulf iterate bridge.qmdb --item STAYS --tolerance 1e-6");
    sub->callback([=, &code] { code = RunUlfIterate(*o); });
}

} // namespace

void AddUlf(CLI::App& app, EXIT_CODE& code)
{
    auto* ulf = app.add_subcommand("ulf", "Unknown load factors: list, check, solve, explain, "
                                          "export, combine, iterate");
    ulf->require_subcommand(1);
    AddExample(ulf, "ulf solve examples/cable-stayed-bridge/case.json --item LEVEL");
    const T_GROUP group{ulf, "examples/cable-stayed-bridge/case.json", code};
    const OPTIONS o = std::make_shared<T_ULF_OPTIONS>();
    AddOne(group, "list", "List items and constraints", "", o, RunUlfList);
    AddItem(AddOne(group, "check", "Check every rule", "", o, RunUlfCheck), o, false);
    AddSolve(group, o);
    AddIterate(ulf, code);
    auto* explain = AddOne(group, "explain", "Say what holds the factors, or what contradicts",
                           " --item \"NO UPLIFT\"", o, RunUlfExplain);
    AddItem(explain, o, true);
    AddJson(explain, o->json, "Write it as JSON; - for standard output");
    AddSum(explain, o->sumStageLoads);
    auto* sheet = AddOne(group, "export", "Write the spreadsheet with the influence matrix",
                         " --item LEVEL -o level.xlsx", o, RunUlfExport);
    AddItem(sheet, o, true);
    AddSum(sheet, o->sumStageLoads);
    sheet->add_option("-o", o->out, "Spreadsheet to write (.xlsx)")->required();
    sheet->add_option("--date", o->date, "Date in the sheet, YYYY-MM-DD (default: today)");
    sheet->add_option("--sheet-version", o->sheetVersion, "Version of the spreadsheet program")
        ->capture_default_str();
    auto* combine = AddOne(group, "combine", "Add the load combination with the factors",
                           " --item LEVEL --name TUNED -o tuned.json", o, RunUlfCombine);
    AddItem(combine, o, true);
    combine->add_option("--name", o->name, "Name of the combination")->required();
    combine->add_option("-o", o->out,
                        "File to write: .qmdb or case file (default: the model file)");
}
