// The help in the user's language: what the argument parser itself says, and its labels.
#include "qm_base/messagetext.h"
#include "qm_base/nearname.h"
#include "qm_rps/pushover/report/pushoverreport.h"
#include "registershared.h"
#include "registrations.h"

#include <algorithm>
#include <optional>
#include <string_view>
#include <vector>

namespace {

/// The parser's formatter, which has labels for all but the heads of groups.
class CHelpFormatter : public CLI::Formatter {
public:
    CHelpFormatter()
    {
        label("Usage", Say("IDS_QM_HELP_LABEL_USAGE"));
        label("OPTIONS", Say("IDS_QM_HELP_LABEL_OPTIONS_BADGE"));
        label("Options", Say("IDS_QM_HELP_LABEL_OPTIONS"));
        label("Positionals", Say("IDS_QM_HELP_LABEL_POSITIONALS"));
        label("SUBCOMMAND", Say("IDS_QM_HELP_LABEL_SUBCOMMAND"));
        label("REQUIRED", Say("IDS_QM_HELP_LABEL_REQUIRED"));
        label("Needs", Say("IDS_QM_HELP_LABEL_NEEDS"));
        label("Excludes", Say("IDS_QM_HELP_LABEL_EXCLUDES"));
    }
    std::string make_group(std::string group, bool isPositional,
                           std::vector<const CLI::Option*> options) const override
    {
        return CLI::Formatter::make_group(get_label(group), isPositional, options);
    }
};

// What the parser says: the English texts are its own words, so they tell what fills the places.
constexpr const char* kRefusals[] = {
    "IDS_QM_CLI_ARG_SUBCOMMAND", "IDS_QM_CLI_ARG_EXTRA",    "IDS_QM_CLI_ARG_EXTRAS",
    "IDS_QM_CLI_ARG_CONVERT",    "IDS_QM_CLI_ARG_RANGE",    "IDS_QM_CLI_ARG_CHOICE",
    "IDS_QM_CLI_ARG_LEAST",      "IDS_QM_CLI_ARG_MOST",     "IDS_QM_CLI_ARG_MISSING",
    "IDS_QM_CLI_ARG_REQUIRES",   "IDS_QM_CLI_ARG_EXCLUDES", "IDS_QM_CLI_ARG_REQUIRED",
};

/// What fills the places of `text` from left to right to give `words`; nullopt: nothing does.
std::optional<std::vector<std::string>> PlacesIn(std::string_view text, std::string_view words)
{
    constexpr std::size_t kPlace = 3; // "{1}"
    std::vector<std::string> args;
    for (std::size_t brace; (brace = text.find('{')) != text.npos;) {
        if (!words.starts_with(text.substr(0, brace))) return std::nullopt;
        words.remove_prefix(brace);
        text.remove_prefix(brace + kPlace);
        const std::string_view next = text.substr(0, text.find('{'));
        const std::size_t end = next.empty() ? words.size() : words.find(next);
        if (end == words.npos) return std::nullopt;
        args.emplace_back(words.substr(0, end));
        words.remove_prefix(end);
    }
    return words == text ? std::optional(args) : std::nullopt;
}

/// Commands that stand below this one.
std::vector<const CLI::App*> CommandsOf(const CLI::App& app)
{
    return app.get_subcommands([](const CLI::App*) { return true; });
}

/// The option of a command of that name ("--out", "-o"), or null.
const CLI::Option* OptionOf(const CLI::App& app, std::string_view name)
{
    const std::string plain(name.substr(0, name.find('=')));
    for (const CLI::Option* option : app.get_options())
        if (option->check_name(plain)) return option;
    return nullptr;
}

std::string NearCommand(const CLI::App& app, std::string_view word)
{
    std::vector<std::string_view> names;
    for (const CLI::App* sub : CommandsOf(app))
        names.push_back(sub->get_name());
    return NearestName(word, names);
}

std::string NearOption(const CLI::App& app, std::string_view word)
{
    std::vector<std::string> names;
    for (const CLI::Option* option : app.get_options())
        for (const std::string& name : option->get_lnames())
            names.push_back("--" + name);
    const std::vector<std::string_view> views(names.begin(), names.end());
    return NearestName(word.substr(0, word.find('=')), views);
}

std::string Meant(std::string_view word, const std::string& near)
{
    return near.empty() ? near : Say("IDS_QM_CLI_MEANT", near, std::string(word));
}

} // namespace

std::string MeantWord(const CLI::App& program, std::span<const char* const> words)
{
    const CLI::App* app = &program;
    for (std::size_t i = 0; i < words.size(); ++i) {
        const std::string_view word = words[i];
        if (word.starts_with("-")) {
            const CLI::Option* option = OptionOf(*app, word);
            if (!option) return word.starts_with("--") ? Meant(word, NearOption(*app, word)) : "";
            const bool takesNext = option->get_expected_min() > 0 && word.find('=') == word.npos;
            if (takesNext) i += static_cast<std::size_t>(option->get_expected_min());
            continue;
        }
        const auto commands = CommandsOf(*app);
        if (commands.empty()) continue; // a file
        const auto at = std::ranges::find(commands, word, &CLI::App::get_name);
        if (at == commands.end()) return Meant(word, NearCommand(*app, word));
        app = *at;
    }
    return {};
}

std::string ParserWords(const std::string& what)
{
    using zql::lib::MMSGFunction;
    for (const char* const key : kRefusals) {
        const auto args = PlacesIn(MMSGFunction::GetValueOf("en", key), what);
        if (!args) continue;
        const std::vector<std::string_view> views(args->begin(), args->end());
        // The upper end of positive numbers is the largest one, which the parser writes out.
        constexpr std::size_t kLongest = 40;
        if (args->size() == 4 && args->back().size() > kLongest)
            return Say("IDS_QM_CLI_ARG_ABOVE", (*args)[0], (*args)[1]);
        return zql::lib::FillPlaces(MMSGFunction::GetValue(key), views);
    }
    return what;
}

void AddHelp(CLI::App& app)
{
    app.description(Say("IDS_QM_HELP_PROGRAM"));
    app.formatter(std::make_shared<CHelpFormatter>());
    app.group(Say("IDS_QM_HELP_LABEL_SUBCOMMANDS"));
    app.set_help_flag("-h,--help", Say("IDS_QM_HELP_HELP"));
    app.set_version_flag("--version", ProductText(), Say("IDS_QM_HELP_VERSION"));
    app.footer(Say("IDS_QM_HELP_EXIT_CODES") + '\n' +
               Example("evaluate examples/first-steps/case.json"));
}
