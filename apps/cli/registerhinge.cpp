// The arguments of the commands on hinge types and pushover load cases.
#include "hingecommands.h"
#include "registershared.h"
#include "registrations.h"

void AddHingeCommands(CLI::App& app, EXIT_CODE& code)
{
    auto* hinge = app.add_subcommand("hinge", "Plastic hinge types: list, show, check, yield, "
                                              "assign, generated, convert, axial, plot");
    hinge->require_subcommand(1);
    AddExample(hinge, "hinge check examples/hinge-library/case.json");
    const T_GROUP hinges{hinge, "examples/hinge-library/case.json", code};
    const auto o = std::make_shared<T_HINGE_OPTIONS>();
    const auto type = [&](CLI::App* sub, bool required) {
        auto* option = sub->add_option("--type", o->type, "Name of the hinge type");
        if (required) option->required();
    };
    type(AddOne(hinges, "list", "List the hinge types", "", o, RunHingeList), false);
    type(AddOne(hinges, "show", "Show every value of a type", "", o, RunHingeShow), false);
    type(AddOne(hinges, "check", "Check every rule", "", o, RunHingeCheck), false);
    type(AddOne(hinges, "yield", "Yield strengths and deformations from section and material", "",
                o, RunHingeYield),
         false);
    auto* assign =
        AddOne(hinges, "assign", "Give elements hinges of a type",
               " --type \"steel beam\" --elements 2,3 -o assigned.json", o, RunHingeAssign);
    type(assign, true);
    assign->add_option("--elements", o->elements, "Element ids: 1,2,5-9")->required();
    assign->add_option("-o", o->out, "File to write: .qmdb or case file")->required();
    AddOne(hinges, "generated", "List the hinges of elements with their strengths", "", o,
           RunHingeGenerated);
    auto* convert =
        AddOne(hinges, "convert", "Switch FEMA curves between D/Dy and plastic",
               " --type \"steel beam\" --to plastic -o plastic.json", o, RunHingeConvert);
    type(convert, true);
    convert->add_option("--component", o->component, "One component only, Fx to Mz");
    convert->add_option("--to", o->to, "ddy or plastic")
        ->required()
        ->check(CLI::IsMember({"ddy", "plastic"}));
    convert->add_option("-o", o->out, "File to write: .qmdb or case file")->required();
    auto* axial =
        AddOne(hinges, "axial", "Edit the list of axial forces of a FEMA curve",
               " --type \"steel column\" --component My --add 250 -o axial.json", o, RunHingeAxial);
    type(axial, true);
    axial->add_option("--component", o->component, "Fx to Mz")->required();
    axial->add_option("--end", o->end, "I or J")->check(CLI::IsMember({"I", "J"}));
    axial->add_option("--add", o->add, "Axial force to add");
    axial->add_option("--remove", o->remove, "Axial force to remove");
    axial->add_option("--change", o->change, "Old and new axial force")->expected(2);
    axial->add_option("-o", o->out, "File to write: .qmdb or case file")->required();
    auto* plot = AddOne(hinges, "plot", "Draw a backbone or the interaction curves",
                        " --type \"steel beam\" --component My -o hinge.svg", o, RunHingePlot);
    type(plot, true);
    plot->add_option("--component", o->component, "Fx to Mz");
    plot->add_option("--end", o->end, "I or J")->check(CLI::IsMember({"I", "J"}));
    plot->add_flag("--interaction", o->interaction, "Interaction instead of a backbone");
    plot->add_option("-o", o->out, "Picture: .svg, .png or .pdf")->required();
}

void AddCase(CLI::App& app, EXIT_CODE& code)
{
    auto* cases = app.add_subcommand("case", "Pushover load cases: check");
    cases->require_subcommand(1);
    AddExample(cases, "case check examples/hinge-library/case.json");
    auto* check = cases->add_subcommand("check", "Check load cases and their pattern rows");
    auto file = std::make_shared<std::string>();
    check->add_option("FILE", *file, "Model file (.qmdb) or case file (.json)")->required();
    AddExample(check, "case check examples/hinge-library/case.json");
    check->callback([=, &code] { code = RunCaseCheck(*file); });
}
