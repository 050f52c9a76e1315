// The arguments of the commands that set a push up.
#include "push/setupcommands.h"
#include "push/setupsettings.h"
#include "registershared.h"
#include "registrations.h"

namespace {

constexpr const char* kFrame = "examples/rc-frame-3-storey/case.json";

void AddSetup(const T_GROUP& push)
{
    const auto o = std::make_shared<T_PUSH_SETUP_OPTIONS>();
    auto* sub = AddOne(push, "setup", Say("IDS_QM_HELP_PUSH_SETUP"),
                       " --p-delta initial --steps 50 -o setup.json", o, RunPushSetup);
    sub->add_option("--case", o->caseName, Say("IDS_QM_HELP_SETUP_CASE"));
    sub->add_flag("--new", o->fresh, Say("IDS_QM_HELP_SETUP_NEW"));
    for (const T_SETTING& setting : Settings()) {
        auto* option = sub->add_option_function<SETTING_WORDS>(
            setting.option,
            [o, name = setting.option](const SETTING_WORDS& words) { o->settings[name] = words; },
            Say(setting.help));
        if (setting.isList)
            option->expected(1, -1);
        else
            option->expected(1);
    }
    sub->add_option("-o,--output", o->out, Say("IDS_QM_HELP_TO_WRITE"));
    AddOverwrite(sub, o->overwrite);
    AddJson(sub, o->json);
}

void AddFunction(const T_GROUP& push)
{
    const auto o = std::make_shared<T_PUSH_FUNCTION_OPTIONS>();
    auto* sub =
        AddOne(push, "function", Say("IDS_QM_HELP_PUSH_FUNCTION"),
               " --add slow --rows 1=0.1 10=0.5 20=1 -o functions.json", o, RunPushFunction);
    auto* add = sub->add_option("--add", o->add, Say("IDS_QM_HELP_FUNCTION_ADD"));
    auto* change = sub->add_option("--change", o->change, Say("IDS_QM_HELP_FUNCTION_CHANGE"));
    auto* remove = sub->add_option("--delete", o->remove, Say("IDS_QM_HELP_FUNCTION_DELETE"));
    add->excludes(change)->excludes(remove);
    change->excludes(remove);
    auto* rename = sub->add_option("--rename", o->rename, Say("IDS_QM_HELP_SETUP_RENAME"));
    rename->needs(change);
    sub->add_option("--rows", o->rows, Say("IDS_QM_HELP_FUNCTION_ROWS"))->excludes(remove);
    sub->add_option("-o,--output", o->out, Say("IDS_QM_HELP_TO_WRITE"));
    AddOverwrite(sub, o->overwrite);
    sub->add_option("--plot", o->plot, Say("IDS_QM_HELP_HINGE_PICTURE"));
    AddJson(sub, o->json);
}

} // namespace

void AddPushSetup(CLI::App& push, EXIT_CODE& code)
{
    const T_GROUP group{&push, kFrame, code};
    AddSetup(group);
    AddFunction(group);
}

void AddCaseGenerate(CLI::App& cases, EXIT_CODE& code)
{
    const T_GROUP group{&cases, kFrame, code};
    const auto o = std::make_shared<T_CASE_GENERATE_OPTIONS>();
    auto* sub = AddOne(group, "generate", Say("IDS_QM_HELP_CASE_GENERATE"),
                       " --target 0.2 -o eight.json", o, RunCaseGenerate);
    sub->add_option("--directions", o->directions, Say("IDS_QM_HELP_GENERATE_DIRECTIONS"))
        ->delimiter(',')
        ->check(CLI::IsMember({"X", "Y"}));
    sub->add_option("--patterns", o->patterns, Say("IDS_QM_HELP_GENERATE_PATTERNS"))
        ->delimiter(',')
        ->check(CLI::IsMember({"uniform", "mode"}));
    sub->add_option("--eccentricity", o->eccentricity, Say("IDS_QM_HELP_GENERATE_ECCENTRICITY"));
    sub->add_option("--signs", o->signs, Say("IDS_QM_HELP_GENERATE_SIGNS"))
        ->check(CLI::IsMember({"both", "+", "-"}));
    sub->add_option("--target", o->target, Say("IDS_QM_HELP_GENERATE_TARGET"));
    sub->add_option("--node", o->node, Say("IDS_QM_HELP_GENERATE_NODE"));
    sub->add_option("-o,--output", o->out, Say("IDS_QM_HELP_TO_WRITE"))->required();
    AddOverwrite(sub, o->overwrite);
}
