// The help in other forms: of a command by its name, manual pages, completion of a shell.
#include "console/console.h"
#include "help/completion.h"
#include "help/manpage.h"
#include "output.h"
#include "registershared.h"
#include "registrations.h"

#include <algorithm>
#include <cstdio>
#include <string_view>

namespace {

struct T_HELP_OPTIONS {
    std::vector<std::string> command;
    std::string manFolder, shell;
    bool overwrite = false;
};

/// "a,b" of "TEXT:{a,b}"; empty where any word is taken.
std::vector<std::string> ChoicesIn(std::string_view type)
{
    std::vector<std::string> choices;
    const auto from = type.find(":{"), end = type.rfind('}');
    if (from == type.npos || end == type.npos) return choices;
    type = type.substr(from + 2, end - from - 2);
    while (!type.empty()) {
        const auto comma = std::min(type.find(','), type.size());
        choices.emplace_back(type.substr(0, comma));
        type.remove_prefix(std::min(comma + 1, type.size()));
    }
    return choices;
}

/// Names in an order that doesn't depend on where the options lie in memory.
std::vector<std::string> NamesOf(const std::set<CLI::Option*>& options)
{
    std::vector<std::string> names;
    for (const CLI::Option* option : options)
        names.push_back(option->get_name());
    std::ranges::sort(names);
    return names;
}

T_OPTION_TEXT TextOf(const CLI::Option& option)
{
    T_OPTION_TEXT text;
    if (!option.get_snames().empty()) text.shortName = "-" + option.get_snames().front();
    if (!option.get_lnames().empty()) text.longName = "--" + option.get_lnames().front();
    if (option.get_type_size() != 0) {
        const std::string type = option.get_type_name();
        text.choices = ChoicesIn(type);
        text.value = text.IsPlace() ? option.get_name(true, false) : type.substr(0, type.find(':'));
        const bool tellsLimits = text.choices.empty() && type.find(':') != type.npos;
        if (tellsLimits) text.limits = type.substr(type.find(':') + 1);
        text.preset = option.get_default_str();
    }
    text.about = option.get_description();
    text.needs = NamesOf(option.get_needs());
    text.excludes = NamesOf(option.get_excludes());
    text.required = option.get_required();
    text.several = option.get_items_expected_max() > 1;
    return text;
}

std::vector<CLI::App*> CommandsBelow(CLI::App& app)
{
    return app.get_subcommands([](const CLI::App* sub) { return !sub->get_name().empty(); });
}

T_COMMAND_TEXT TextOf(CLI::App& app, const std::string& name)
{
    T_COMMAND_TEXT text{
        name, app.get_description(), {}, {}, {}, app.get_require_subcommand_min() == 0};
    const std::string footer = app.get_footer();
    const auto line = footer.rfind("qm-rps ");
    if (line != footer.npos) text.example = footer.substr(line);
    for (const bool isPlace : {true, false}) // arguments by place stand first, as in --help
        for (const CLI::Option* option : app.get_options())
            if (option->get_positional() == isPlace) text.options.push_back(TextOf(*option));
    for (CLI::App* sub : CommandsBelow(app))
        text.commands.push_back(TextOf(*sub, name + " " + sub->get_name()));
    return text;
}

EXIT_CODE WriteManPages(const T_COMMAND_TEXT& program, const T_HELP_OPTIONS& o)
{
    const std::vector<T_HELP_FILE> pages = ManPages(program);
    std::vector<T_OUTPUT> outputs;
    for (const T_HELP_FILE& page : pages)
        outputs.push_back({o.manFolder + "/" + page.name, OUTPUT_KIND::Text});
    if (const EXIT_CODE code = CheckOutputs({}, outputs, o.overwrite); code != EXIT_CODE::Done)
        return code;
    for (std::size_t i = 0; i < pages.size(); ++i)
        if (const EXIT_CODE code = WriteOutput(outputs[i].path, pages[i].text);
            code != EXIT_CODE::Done)
            return code;
    return EXIT_CODE::Done;
}

/// What --help of the command says that the words name; of the program without any.
EXIT_CODE PrintHelp(CLI::App& program, const std::vector<std::string>& words)
{
    CLI::App* app = &program;
    std::string above; // the names before that of the command
    for (const std::string& word : words) {
        const auto below = CommandsBelow(*app);
        const auto at = std::ranges::find(below, word, &CLI::App::get_name);
        if (at == below.end())
            return Complain(EXIT_CODE::Usage, Say("IDS_QM_CLI_UNKNOWN_COMMAND", word));
        above += (above.empty() ? "" : " ") + app->get_name();
        app = *at;
    }
    return WriteOutput("-", app->help(above));
}

EXIT_CODE RunHelp(CLI::App& program, const T_HELP_OPTIONS& o)
{
    if (o.manFolder.empty() && o.shell.empty()) return PrintHelp(program, o.command);
    const T_COMMAND_TEXT text = TextOf(program, program.get_name());
    if (!o.manFolder.empty())
        if (const EXIT_CODE code = WriteManPages(text, o); code != EXIT_CODE::Done) return code;
    if (o.shell.empty()) return EXIT_CODE::Done;
    return WriteOutput("-", o.shell == "bash" ? BashCompletion(text) : ZshCompletion(text));
}

} // namespace

void AddDocuments(CLI::App& app, EXIT_CODE& code)
{
    auto* sub = app.add_subcommand("help", Say("IDS_QM_HELP_HELP_COMMAND"));
    const auto o = std::make_shared<T_HELP_OPTIONS>();
    sub->add_option("COMMAND", o->command, Say("IDS_QM_HELP_HELP_OF"));
    sub->add_option("--man", o->manFolder, Say("IDS_QM_HELP_HELP_MAN"))->type_name("FOLDER");
    sub->add_option("--completion", o->shell, Say("IDS_QM_HELP_HELP_COMPLETION"))
        ->check(CLI::IsMember({"bash", "zsh"}));
    AddOverwrite(sub, o->overwrite);
    AddExample(sub, "help ulf solve");
    sub->callback([o, &app, &code] { code = RunHelp(app, *o); });
}
