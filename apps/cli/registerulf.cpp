// The arguments of the commands on unknown load factors.
#include "iteratecommands.h"
#include "registrations.h"
#include "ulfcommands.h"

#include <CLI/CLI.hpp>

namespace {

using OPTIONS = std::shared_ptr<T_ULF_OPTIONS>;

/// One command below "ulf": its file, its item, its example and what it runs.
CLI::App* AddOne(CLI::App* ulf, const char* name, const char* what, const char* example, OPTIONS o,
                 EXIT_CODE (*run)(const T_ULF_OPTIONS&), EXIT_CODE& code)
{
    auto* sub = ulf->add_subcommand(name, what);
    sub->add_option("FILE", o->file, "Model file (.qmdb) or case file (.json)")->required();
    sub->footer(std::string("Example:\n  qm-rps ulf ") + name +
                " examples/cable-stayed-bridge/case.json" + example);
    sub->callback([=, &code] { code = run(*o); });
    return sub;
}

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

void AddSolve(CLI::App* ulf, const OPTIONS& o, EXIT_CODE& code)
{
    auto* solve = AddOne(ulf, "solve", "Find the factors", " --item LEVEL --plot bars.svg", o,
                         RunUlfSolve, code);
    AddItem(solve, o, true);
    solve->add_option("--json", o->json, "Write the result as JSON; - for standard output");
    solve->add_option("--plot", o->plot, "Draw the constraints against their bounds");
    AddSum(solve, o->sumStageLoads);
    solve->add_option("--shape-plot", o->shapePlot, "Draw the displacements before and after");
}

void AddIterate(CLI::App* ulf, EXIT_CODE& code)
{
    const auto o = std::make_shared<T_ITERATE_OPTIONS>();
    auto* sub = ulf->add_subcommand("iterate", "Scale pretension until its factors are 1");
    sub->add_option("FILE", o->file, "Model file (.qmdb) or case file (.json)")->required();
    sub->add_option("--item", o->item, "Name of the construction-stage item")->required();
    sub->add_option("--iterations", o->iterations, "Required number, 0 to 99")
        ->capture_default_str();
    sub->add_option("--tolerance", o->tolerance, "Convergence tolerance")->capture_default_str();
    sub->add_flag("--overwrite", o->overwrite,
                  "Overwrite the report (FILE with .ulf) if it exists");
    sub->add_flag("--append", o->append, "Add to it");
    sub->add_option("--json", o->json, "Write the history as JSON; - for standard output");
    sub->add_option("--plot", o->plot, "Draw factors and tolerance by iteration");
    AddSum(sub, o->sumStageLoads);
    sub->footer("Example:\n  qm-rps ulf iterate bridge.qmdb --item STAYS --tolerance 1e-6");
    sub->callback([=, &code] { code = RunUlfIterate(*o); });
}

} // namespace

void AddUlf(CLI::App& app, EXIT_CODE& code)
{
    auto* ulf = app.add_subcommand("ulf", "Unknown load factors: list, check, solve, explain, "
                                          "export, combine, iterate");
    ulf->require_subcommand(1);
    ulf->footer("Example:\n  qm-rps ulf solve examples/cable-stayed-bridge/case.json --item LEVEL");
    const OPTIONS o = std::make_shared<T_ULF_OPTIONS>();
    AddOne(ulf, "list", "List items and constraints", "", o, RunUlfList, code);
    AddItem(AddOne(ulf, "check", "Check every rule", "", o, RunUlfCheck, code), o, false);
    AddSolve(ulf, o, code);
    AddIterate(ulf, code);
    auto* explain = AddOne(ulf, "explain", "Say what holds the factors, or what contradicts",
                           " --item \"NO UPLIFT\"", o, RunUlfExplain, code);
    AddItem(explain, o, true);
    explain->add_option("--json", o->json, "Write it as JSON; - for standard output");
    AddSum(explain, o->sumStageLoads);
    auto* sheet = AddOne(ulf, "export", "Write the spreadsheet with the influence matrix",
                         " --item LEVEL -o level.xlsx", o, RunUlfExport, code);
    AddItem(sheet, o, true);
    AddSum(sheet, o->sumStageLoads);
    sheet->add_option("-o", o->out, "Spreadsheet to write (.xlsx)")->required();
    sheet->add_option("--date", o->date, "Date in the sheet, YYYY-MM-DD (default: today)");
    sheet->add_option("--sheet-version", o->sheetVersion, "Version of the spreadsheet program")
        ->capture_default_str();
    auto* combine = AddOne(ulf, "combine", "Add the load combination with the factors",
                           " --item LEVEL --name TUNED -o tuned.json", o, RunUlfCombine, code);
    AddItem(combine, o, true);
    combine->add_option("--name", o->name, "Name of the combination")->required();
    combine->add_option("-o", o->out,
                        "File to write: .qmdb or case file (default: the model file)");
}
