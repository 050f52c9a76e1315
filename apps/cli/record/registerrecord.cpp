// The arguments of the commands on records.
#include "record/recordcommands.h"
#include "registershared.h"
#include "registrations.h"

namespace {

constexpr const char* kFrame = "examples/rc-frame-3-storey/case.json";

CLI::App* AddKindCommand(const T_GROUP& group, const char* name, const char* help,
                         const char* example, const std::shared_ptr<T_RECORD_OPTIONS>& o,
                         EXIT_CODE (*run)(const T_RECORD_OPTIONS&))
{
    auto* sub = AddOne(group, name, Say(help), example, o, run);
    sub->add_option("KIND", o->kind, Say("IDS_QM_HELP_RECORD_OF"))->required();
    return sub;
}

void AddWriting(CLI::App* sub, T_RECORD_OPTIONS& o)
{
    sub->add_option("-o,--output", o.out, Say("IDS_QM_HELP_TO_WRITE"))->required();
    AddOverwrite(sub, o.overwrite);
}

void AddReading(const T_GROUP& group)
{
    const auto list = std::make_shared<T_RECORD_OPTIONS>();
    auto* sub =
        AddOne(group, "list", Say("IDS_QM_HELP_RECORD_LIST"), " section", list, RunRecordList);
    sub->add_option("KIND", list->kind, Say("IDS_QM_HELP_RECORD_OF"));
    AddJson(sub, list->json);
    sub->add_option("--csv", list->csv, Say("IDS_QM_HELP_RECORD_CSV"));
    sub->add_option("--sheet", list->sheet, Say("IDS_QM_HELP_RECORD_SHEET"));
    AddOverwrite(sub, list->overwrite);

    const auto show = std::make_shared<T_RECORD_OPTIONS>();
    sub = AddKindCommand(group, "show", "IDS_QM_HELP_RECORD_SHOW", " section column", show,
                         RunRecordShow);
    sub->add_option("RECORD", show->record, Say("IDS_QM_HELP_RECORD_WHICH"));
    sub->add_flag("--all", show->all, Say("IDS_QM_HELP_RECORD_ALL"));
    AddJson(sub, show->json);
}

void AddChanging(const T_GROUP& group)
{
    const auto set = std::make_shared<T_RECORD_OPTIONS>();
    auto* sub =
        AddKindCommand(group, "set", "IDS_QM_HELP_RECORD_SET",
                       " section column \"size=[24, 24]\" -o sized.json", set, RunRecordSet);
    sub->add_option("RECORD", set->record, Say("IDS_QM_HELP_RECORD_WHICH"));
    sub->add_option("SETTINGS", set->settings, Say("IDS_QM_HELP_RECORD_SETTINGS"));
    sub->add_option("--add", set->add, Say("IDS_QM_HELP_RECORD_ADD_ITEM"))->expected(1);
    sub->add_option("--remove", set->remove, Say("IDS_QM_HELP_RECORD_REMOVE"))->expected(1);
    AddWriting(sub, *set);
    AddJson(sub, set->json);

    const auto add = std::make_shared<T_RECORD_OPTIONS>();
    sub = AddKindCommand(group, "add", "IDS_QM_HELP_RECORD_ADD",
                         " spectrum --name mine kind=ec8-2004 ag=0.25 soil=C -o more.json", add,
                         RunRecordAdd);
    sub->add_option("SETTINGS", add->settings, Say("IDS_QM_HELP_RECORD_SETTINGS"));
    sub->add_option("--name", add->record, Say("IDS_QM_HELP_RECORD_NAME"));
    sub->add_option("--copy", add->copy, Say("IDS_QM_HELP_RECORD_COPY"));
    AddWriting(sub, *add);
    AddJson(sub, add->json);

    const auto remove = std::make_shared<T_RECORD_OPTIONS>();
    sub =
        AddKindCommand(group, "delete", "IDS_QM_HELP_RECORD_DELETE",
                       " evaluation \"PX_MODE1 ATC-40 A\" -o fewer.json", remove, RunRecordDelete);
    sub->add_option("RECORD", remove->records, Say("IDS_QM_HELP_RECORD_WHICH"))->required();
    AddWriting(sub, *remove);
}

} // namespace

void AddRecord(CLI::App& app, EXIT_CODE& code)
{
    auto* sub = app.add_subcommand("record", Say("IDS_QM_HELP_RECORD"));
    sub->require_subcommand(1);
    const T_GROUP group{sub, kFrame, code};
    AddReading(group);
    AddChanging(group);
}
