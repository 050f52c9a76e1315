#include "help/manpage.h"

#include "qm_base/say.h"
#include "qm_rps/pushover/report/pushoverreport.h"

#include <algorithm>
#include <cstdio>
#include <string_view>

namespace {

/// The code point that starts at `at`, which is moved behind it; the catalogue holds sound UTF-8.
unsigned CodePoint(std::string_view text, std::size_t& at)
{
    const auto first = static_cast<unsigned char>(text[at++]);
    if (first < 0x80U) return first;
    const int more = first >= 0xF0U ? 3 : first >= 0xE0U ? 2 : 1;
    unsigned code = first & (0x3FU >> more);
    for (int i = 0; i < more && at < text.size(); ++i)
        code = code << 6U | (static_cast<unsigned char>(text[at++]) & 0x3FU);
    return code;
}

/// Text as roff takes it: no line of it is a request, a hyphen stays one that can be copied.
std::string Roff(std::string_view text)
{
    std::string out;
    for (std::size_t at = 0; at < text.size();) {
        const unsigned code = CodePoint(text, at);
        if (code == '-')
            out += "\\-";
        else if (code == '\\')
            out += "\\e";
        else if (code == '\'')
            out += "\\(aq";
        else if (code == '.' && out.empty())
            out += "\\&.";
        else if (code < 0x80U)
            out += static_cast<char>(code);
        else {
            char escape[16];
            std::snprintf(escape, sizeof escape, "\\[u%04X]", code);
            out += escape;
        }
    }
    return out;
}

std::string Bold(std::string_view text)
{
    return "\\fB" + Roff(text) + "\\fR";
}

std::string Italic(std::string_view text)
{
    return "\\fI" + Roff(text) + "\\fR";
}

std::string Head(const char* key)
{
    return ".SH \"" + Roff(Say(key)) + "\"\n";
}

/// "qm-rps hinge" gives "qm-rps-hinge".
std::string PageName(std::string name)
{
    std::ranges::replace(name, ' ', '-');
    return name;
}

std::string Joined(const std::vector<std::string>& words, std::string_view between)
{
    std::string out;
    for (const std::string& word : words)
        out += (out.empty() ? "" : std::string(between)) + word;
    return out;
}

std::string ValueOf(const T_OPTION_TEXT& option)
{
    std::string one = option.choices.empty() ? Italic(option.value) : "";
    for (const std::string& choice : option.choices)
        one += (one.empty() ? "" : "|\\:") + Roff(choice); // a line may break behind the bar
    return option.several ? one + " ..." : one;
}

std::string NamesOf(const T_OPTION_TEXT& option)
{
    if (option.IsPlace()) return Italic(option.value) + (option.several ? " ..." : "");
    std::string names = option.shortName.empty() ? "" : Bold(option.shortName);
    if (!option.longName.empty()) names += (names.empty() ? "" : ", ") + Bold(option.longName);
    return option.value.empty() ? names : names + " " + ValueOf(option);
}

/// What a reader must know of an option beside what it does.
std::string NotesOf(const T_OPTION_TEXT& option)
{
    std::vector<std::string> notes;
    if (option.required && !option.IsPlace()) notes.push_back(Say("IDS_QM_MAN_REQUIRED"));
    if (!option.limits.empty()) notes.push_back(option.limits);
    if (!option.preset.empty()) notes.push_back(Say("IDS_QM_MAN_PRESET", option.preset));
    if (!option.needs.empty())
        notes.push_back(Say("IDS_QM_HELP_LABEL_NEEDS") + ": " + Joined(option.needs, " "));
    if (!option.excludes.empty())
        notes.push_back(Say("IDS_QM_HELP_LABEL_EXCLUDES") + ": " + Joined(option.excludes, " "));
    return notes.empty() ? "" : " (" + Joined(notes, "; ") + ")";
}

std::string OptionsOf(const T_COMMAND_TEXT& command)
{
    std::string out;
    for (const T_OPTION_TEXT& option : command.options)
        out += ".TP\n" + NamesOf(option) + "\n" + Roff(option.about + NotesOf(option)) + "\n";
    return out;
}

/// "qm-rps hinge list [OPTIONS] FILE"
std::string UsageOf(const T_COMMAND_TEXT& command)
{
    std::string out =
        Bold(command.name) + " [" + Italic(Say("IDS_QM_HELP_LABEL_OPTIONS_BADGE")) + "]";
    for (const T_OPTION_TEXT& option : command.options)
        if (option.IsPlace())
            out += option.required ? " " + NamesOf(option) : " [" + NamesOf(option) + "]";
    if (command.commands.empty()) return out;
    const std::string below = Italic(Say("IDS_QM_HELP_LABEL_SUBCOMMAND"));
    return out + (command.worksAlone ? " [" + below + "]" : " " + below);
}

std::string Example(const T_COMMAND_TEXT& command)
{
    return command.example.empty() ? "" : ".PP\n.nf\n" + Roff(command.example) + "\n.fi\n";
}

/// Each command below this one in full, those below it behind it.
std::string Subsections(const T_COMMAND_TEXT& command)
{
    std::string out;
    for (const T_COMMAND_TEXT& below : command.commands)
        out += ".SS \"" + Roff(below.name) + "\"\n" + Roff(below.about) + ".\n.PP\n" +
               UsageOf(below) + "\n" + OptionsOf(below) + Example(below) + Subsections(below);
    return out;
}

std::string ListOf(const T_COMMAND_TEXT& program)
{
    std::string out;
    for (const T_COMMAND_TEXT& command : program.commands)
        out += ".TP\n" + Bold(command.name) + "\n" + Roff(command.about) + "\n";
    return out;
}

std::string ExitStatus()
{
    std::string out;
    int code = 0;
    for (const char* key :
         {"IDS_QM_MAN_EXIT_DONE", "IDS_QM_MAN_EXIT_NOT_FOUND", "IDS_QM_MAN_EXIT_USAGE",
          "IDS_QM_MAN_EXIT_INPUT", "IDS_QM_MAN_EXIT_ACCESS"})
        out += ".TP\n" + Bold(std::to_string(code++)) + "\n" + Roff(Say(key)) + "\n";
    return out;
}

std::string SeeAlso(const std::vector<std::string>& pages)
{
    std::string out;
    for (const std::string& page : pages)
        out += ".BR " + Roff(page) + " (1)" + (page == pages.back() ? "\n" : ",\n");
    return out;
}

T_HELP_FILE Page(const T_COMMAND_TEXT& command, const std::string& body,
                 const std::vector<std::string>& seeAlso)
{
    const std::string name = PageName(command.name);
    std::string title = name;
    std::ranges::transform(title, title.begin(),
                           [](char c) { return c >= 'a' && c <= 'z' ? char(c - 'a' + 'A') : c; });
    const std::string text =
        ".TH \"" + Roff(title) + "\" 1 \"\" \"" + Roff(ProductText()) + "\" \"" +
        Roff(Say("IDS_QM_MAN_COMMANDS_OF_USERS")) + "\"\n" + Head("IDS_QM_MAN_NAME") + Roff(name) +
        " \\- " + Roff(command.about) + "\n" + Head("IDS_QM_MAN_SYNOPSIS") + UsageOf(command) +
        "\n" + Head("IDS_QM_MAN_OPTIONS") + OptionsOf(command) + body + Head("IDS_QM_MAN_EXIT") +
        ExitStatus() +
        (command.example.empty() ? "" : Head("IDS_QM_MAN_EXAMPLE") + Example(command)) +
        Head("IDS_QM_MAN_SEE") + SeeAlso(seeAlso);
    return {name + ".1", text};
}

} // namespace

std::vector<T_HELP_FILE> ManPages(const T_COMMAND_TEXT& program)
{
    std::vector<std::string> names;
    for (const T_COMMAND_TEXT& command : program.commands)
        names.push_back(PageName(command.name));
    names.emplace_back("qm-rps-desktop");
    std::vector<T_HELP_FILE> pages{
        Page(program, Head("IDS_QM_MAN_COMMANDS") + ListOf(program), names)};
    for (const T_COMMAND_TEXT& command : program.commands)
        pages.push_back(
            Page(command,
                 command.commands.empty() ? "" : Head("IDS_QM_MAN_COMMANDS") + Subsections(command),
                 {"qm-rps"}));
    return pages;
}
