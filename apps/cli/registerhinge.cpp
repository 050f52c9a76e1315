// The arguments of the commands on sections, hinge types and pushover load cases.
#include "hinge/generatehinges.h"
#include "hinge/sectionbars.h"
#include "hingecommands.h"
#include "qm_rps/section/barlayout.h"
#include "registershared.h"
#include "registrations.h"

namespace {

void AddGenerate(CLI::App* hinge, EXIT_CODE& code)
{
    const T_GROUP group{hinge, "examples/rc-frame-code-hinges/case.json", code};
    const auto o = std::make_shared<T_HINGE_GENERATE_OPTIONS>();
    auto* sub = AddOne(group, "generate", Say("IDS_QM_HELP_HINGE_GENERATE"),
                       " --code ASCE41-17 --all -o generated.json", o, RunHingeGenerate);
    sub->add_option("--code", o->code, Say("IDS_QM_HELP_HINGE_CODE"))
        ->check(CLI::IsMember(
            std::vector<std::string>(kHingeCodeNames.begin(), kHingeCodeNames.end())));
    sub->add_option("--elements", o->elements, Say("IDS_QM_HELP_HINGE_ELEMENTS"));
    sub->add_flag("--all", o->all, Say("IDS_QM_HELP_HINGE_ALL"));
    sub->add_flag("--stale", o->stale, Say("IDS_QM_HELP_HINGE_STALE"));
    sub->add_option("--level", o->level, Say("IDS_QM_HELP_HINGE_LEVEL"))
        ->check(CLI::IsMember({"primary", "secondary"}));
    sub->add_option("--push", o->push, Say("IDS_QM_HELP_HINGE_PUSH"));
    sub->add_option("--axial-range", o->axialRange, Say("IDS_QM_HELP_HINGE_AXIAL_RANGE"));
    sub->add_option("--tie", o->tie, Say("IDS_QM_HELP_HINGE_TIE"))->check(CLI::PositiveNumber);
    sub->add_option("--connection", o->connection.kind, Say("IDS_QM_HELP_HINGE_CONNECTION"))
        ->check(CLI::IsMember(
            std::vector<std::string>(kFrConnectionNames.begin(), kFrConnectionNames.end())));
    const auto measure = [&](const char* name, double& value, const char* help) {
        sub->add_option(name, value, Say(help))->check(CLI::PositiveNumber);
    };
    measure("--column-flange", o->connection.columnFlange, "IDS_QM_HELP_HINGE_COLUMN_FLANGE");
    measure("--continuity-plate", o->connection.continuityPlate, "IDS_QM_HELP_HINGE_PLATE");
    measure("--panel-ratio", o->connection.panelRatio, "IDS_QM_HELP_HINGE_PANEL");
    sub->add_flag("--keep-going", o->keepGoing, Say("IDS_QM_HELP_HINGE_KEEP_GOING"));
    sub->add_flag("--trace", o->trace, Say("IDS_QM_HELP_HINGE_TRACE"));
    AddJson(sub, o->json);
    sub->add_option("-o", o->out, Say("IDS_QM_HELP_TO_WRITE"))->required();
    AddOverwrite(sub, o->overwrite);
}

} // namespace

void AddHingeCommands(CLI::App& app, EXIT_CODE& code)
{
    auto* hinge = app.add_subcommand("hinge", Say("IDS_QM_HELP_HINGE"));
    hinge->require_subcommand(1);
    AddExample(hinge, "hinge check examples/hinge-library/case.json");
    const T_GROUP hinges{hinge, "examples/hinge-library/case.json", code};
    const auto o = std::make_shared<T_HINGE_OPTIONS>();
    const auto type = [&](CLI::App* sub, bool required) {
        auto* option = sub->add_option("--type", o->type, Say("IDS_QM_HELP_HINGE_TYPE"));
        if (required) option->required();
    };
    type(AddOne(hinges, "list", Say("IDS_QM_HELP_HINGE_LIST"), "", o, RunHingeList), false);
    type(AddOne(hinges, "show", Say("IDS_QM_HELP_HINGE_SHOW"), "", o, RunHingeShow), false);
    type(AddOne(hinges, "check", Say("IDS_QM_HELP_CHECK_RULES"), "", o, RunHingeCheck), false);
    type(AddOne(hinges, "yield", Say("IDS_QM_HELP_HINGE_YIELD"), "", o, RunHingeYield), false);
    auto* assign =
        AddOne(hinges, "assign", Say("IDS_QM_HELP_HINGE_ASSIGN"),
               " --type \"steel beam\" --elements 2,3 -o assigned.json", o, RunHingeAssign);
    type(assign, true);
    assign->add_option("--elements", o->elements, Say("IDS_QM_HELP_HINGE_ELEMENTS"))->required();
    assign->add_option("--axial-case", o->axialCase, Say("IDS_QM_HELP_HINGE_AXIAL_CASE"));
    assign->add_option("-o", o->out, Say("IDS_QM_HELP_TO_WRITE"))->required();
    AddOverwrite(assign, o->overwrite);
    AddOne(hinges, "generated", Say("IDS_QM_HELP_HINGE_GENERATED"), "", o, RunHingeGenerated);
    AddGenerate(hinge, code);
    auto* convert =
        AddOne(hinges, "convert", Say("IDS_QM_HELP_HINGE_CONVERT"),
               " --type \"steel beam\" --to plastic -o plastic.json", o, RunHingeConvert);
    type(convert, true);
    convert->add_option("--component", o->component, Say("IDS_QM_HELP_HINGE_ONE_COMPONENT"));
    convert->add_option("--to", o->to, Say("IDS_QM_HELP_HINGE_TO"))
        ->required()
        ->check(CLI::IsMember({"ddy", "plastic"}));
    convert->add_option("-o", o->out, Say("IDS_QM_HELP_TO_WRITE"))->required();
    AddOverwrite(convert, o->overwrite);
    auto* axial =
        AddOne(hinges, "axial", Say("IDS_QM_HELP_HINGE_AXIAL"),
               " --type \"steel column\" --component My --add 250 -o axial.json", o, RunHingeAxial);
    type(axial, true);
    axial->add_option("--component", o->component, Say("IDS_QM_HELP_HINGE_COMPONENT"))->required();
    axial->add_option("--end", o->end, Say("IDS_QM_HELP_HINGE_END"))
        ->check(CLI::IsMember({"I", "J"}));
    axial->add_option("--add", o->add, Say("IDS_QM_HELP_HINGE_ADD"));
    axial->add_option("--remove", o->remove, Say("IDS_QM_HELP_HINGE_REMOVE"));
    axial->add_option("--change", o->change, Say("IDS_QM_HELP_HINGE_CHANGE"))->expected(2);
    axial->add_option("-o", o->out, Say("IDS_QM_HELP_TO_WRITE"))->required();
    AddOverwrite(axial, o->overwrite);
    auto* options = AddOne(hinges, "options", Say("IDS_QM_HELP_HINGE_OPTIONS"),
                           " --concrete Eurocode2:04 --steel Eurocode3:05 -o codes.json", o,
                           RunHingeModelOptions);
    options->add_option("--concrete", o->concreteCode, Say("IDS_QM_HELP_HINGE_CONCRETE_CODE"));
    options->add_option("--steel", o->steelCode, Say("IDS_QM_HELP_HINGE_STEEL_CODE"));
    const auto onOff = [&](const char* name, std::string& word, const char* help) {
        options->add_option(name, word, Say(help))->check(CLI::IsMember({"on", "off"}));
    };
    onOff("--alternative-hysteresis", o->alternative, "IDS_QM_HELP_HINGE_ALT");
    onOff("--wall-degradation", o->wallDegradation, "IDS_QM_HELP_HINGE_WALL_DEG");
    onOff("--gsd", o->gsd, "IDS_QM_HELP_HINGE_GSD");
    options->add_option("--alpha1", o->alpha1, Say("IDS_QM_HELP_HINGE_ALPHA"))->expected(2);
    options->add_option("--alpha2", o->alpha2, Say("IDS_QM_HELP_HINGE_ALPHA"))->expected(2);
    options->add_option("-o", o->out, Say("IDS_QM_HELP_TO_WRITE"));
    AddOverwrite(options, o->overwrite);
    auto* surface = AddOne(hinges, "surface", Say("IDS_QM_HELP_HINGE_SURFACE"),
                           " --type \"steel column\" -o surface.json", o, RunHingeSurface);
    type(surface, true);
    surface->add_option("-o", o->out, Say("IDS_QM_HELP_TO_WRITE"))->required();
    AddOverwrite(surface, o->overwrite);
    auto* plot = AddOne(hinges, "plot", Say("IDS_QM_HELP_HINGE_PLOT"),
                        " --type \"steel beam\" --component My -o hinge.svg", o, RunHingePlot);
    type(plot, true);
    plot->add_option("--component", o->component, Say("IDS_QM_HELP_HINGE_COMPONENT"));
    plot->add_option("--end", o->end, Say("IDS_QM_HELP_HINGE_END"))
        ->check(CLI::IsMember({"I", "J"}));
    plot->add_flag("--interaction", o->interaction, Say("IDS_QM_HELP_HINGE_INTERACTION"));
    plot->add_flag("--values", o->values, Say("IDS_QM_HELP_HINGE_VALUES"));
    plot->add_flag("--box", o->box, Say("IDS_QM_HELP_HINGE_BOX"));
    plot->add_option("-o", o->out, Say("IDS_QM_HELP_HINGE_PICTURE"))->required();
    AddOverwrite(plot, o->overwrite);
}

void AddSectionBars(CLI::App& section, EXIT_CODE& code)
{
    const T_GROUP group{&section, "examples/rc-frame-code-hinges/case.json", code};
    const auto o = std::make_shared<T_SECTION_BARS_OPTIONS>();
    const auto common = [&](CLI::App* sub, const char* out) {
        sub->add_option("--section", o->section, Say("IDS_QM_HELP_SECTION_NAME"))->required();
        sub->add_option("-o", o->out, Say(out))->required();
        AddOverwrite(sub, o->overwrite);
    };
    auto* bars =
        AddOne(group, "bars", Say("IDS_QM_HELP_SECTION_BARS"),
               " --section \"column 40x40\" --corners 0.02 --top 1x0.016 --bottom 1x0.016 -o "
               "bars.json",
               o, RunSectionBars);
    common(bars, "IDS_QM_HELP_TO_WRITE");
    constexpr std::array<const char*, 6> kHelp{
        "IDS_QM_HELP_BARS_CORNERS", "IDS_QM_HELP_BARS_TOP",  "IDS_QM_HELP_BARS_BOTTOM",
        "IDS_QM_HELP_BARS_RIGHT",   "IDS_QM_HELP_BARS_LEFT", "IDS_QM_HELP_BARS_AROUND"};
    for (std::size_t i = 0; i < kHelp.size(); ++i)
        bars->add_option(std::string("--") + kBarPlaceNames[i], o->bars[i], Say(kHelp[i]));
    bars->add_flag("--keep", o->keep, Say("IDS_QM_HELP_BARS_KEEP"));
    common(AddOne(group, "plot", Say("IDS_QM_HELP_SECTION_PLOT"),
                  " --section \"column 40x40\" -o section.svg", o, RunSectionPlot),
           "IDS_QM_HELP_HINGE_PICTURE");
}

void AddCase(CLI::App& app, EXIT_CODE& code)
{
    auto* cases = app.add_subcommand("case", Say("IDS_QM_HELP_CASE"));
    cases->require_subcommand(1);
    AddExample(cases, "case check examples/hinge-library/case.json");
    auto* check = cases->add_subcommand("check", Say("IDS_QM_HELP_CASE_CHECK"));
    auto file = std::make_shared<std::string>();
    check->add_option("FILE", *file, Say("IDS_QM_HELP_FILE"))->required();
    AddExample(check, "case check examples/hinge-library/case.json");
    check->callback([=, &code] { code = RunCaseCheck(*file); });
    AddCaseGenerate(*cases, code);
}
