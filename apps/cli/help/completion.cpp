#include "help/completion.h"

#include <algorithm>
#include <string_view>

namespace {

std::string Joined(const std::vector<std::string>& words, std::string_view between)
{
    std::string out;
    for (const std::string& word : words)
        out += (out.empty() ? "" : std::string(between)) + word;
    return out;
}

/// "hinge list" of "qm-rps hinge list"; empty for the program.
std::string BelowProgram(const std::string& name)
{
    const auto blank = name.find(' ');
    return blank == name.npos ? "" : name.substr(blank + 1);
}

std::string LastWord(const std::string& name)
{
    return name.substr(name.rfind(' ') + 1);
}

std::vector<std::string> NamesOf(const T_OPTION_TEXT& option)
{
    std::vector<std::string> names;
    for (const std::string& name : {option.shortName, option.longName})
        if (!name.empty()) names.push_back(name);
    return names;
}

/// What the value of an option is, in one word of the script: "words:a b", "files:json qmdb".
std::string ValueWord(const T_OPTION_TEXT& option)
{
    if (!option.choices.empty()) return "words:" + Joined(option.choices, " ");
    if (NamesFolder(option)) return "folder:";
    const std::vector<std::string> endings = FileEndings(option);
    return endings.empty() ? "text:" : "files:" + Joined(endings, " ");
}

// The table stands between these two; what it holds is only read, never run.
constexpr const char* kBashHead =
    R"(# Completion of qm-rps for bash, written by "qm-rps help --completion bash".

# Sets commands, options and places (what arguments by place are) of the command "$1".
_qm_rps_command()
{
  commands= options= places=
  case $1 in
)";
constexpr const char* kBashValues = R"(  esac
}

# Prints what the value of the option "$2" of the command "$1" is; nothing for a flag.
_qm_rps_value()
{
  case "$1 $2" in
)";
constexpr const char* kBashTail = R"(  esac
}

# Proposes what "$1" (words:a b, files:json qmdb, folder:, text:) says, for the word "$2".
_qm_rps_propose()
{
  local ending
  case $1 in
    words:*) mapfile -t COMPREPLY < <(compgen -W "${1#words:}" -- "$2") ;;
    folder:*)
      compopt -o filenames 2>/dev/null
      mapfile -t COMPREPLY < <(compgen -d -- "$2") ;;
    files:*)
      compopt -o filenames 2>/dev/null
      mapfile -t COMPREPLY < <(
        compgen -d -- "$2"
        for ending in ${1#files:}; do compgen -f -X "!*.$ending" -- "$2"; done) ;;
  esac
}

_qm_rps()
{
  local commands options places command= pending= several= place=0 i word value
  local current=${COMP_WORDS[COMP_CWORD]}
  COMPREPLY=()
  [ "$current" != = ] || current=
  _qm_rps_command ""
  for ((i = 1; i < COMP_CWORD; ++i)); do
    word=${COMP_WORDS[i]}
    case $word in
      =) continue ;;
      -[0-9.]*) ;; # a number
      -?*)
        value=$(_qm_rps_value "$command" "$word")
        several= pending=
        case $value in
          "") ;;
          +*) several=${value#+} pending=$several ;;
          *) pending=$value ;;
        esac
        continue ;;
    esac
    if [ -n "$pending" ]; then
      pending=
    elif [ -n "$commands" ] && [[ " $commands " == *" $word "* ]]; then
      command=${command:+$command }$word several=
      _qm_rps_command "$command"
    elif [ -z "$several" ]; then
      place=$((place + 1))
    fi
  done
  if [[ $current == -* ]]; then
    mapfile -t COMPREPLY < <(compgen -W "$options" -- "$current")
  elif [ -n "${pending:-$several}" ]; then
    _qm_rps_propose "${pending:-$several}" "$current"
  elif [ -n "$commands" ]; then
    [ -z "$places" ] || _qm_rps_propose "${places%%;*}" "$current"
    mapfile -t -O ${#COMPREPLY[@]} COMPREPLY < <(compgen -W "$commands" -- "$current")
  else
    for ((i = 0; i < place; ++i)); do
      [[ $places != *\;* ]] || places=${places#*;}
    done
    _qm_rps_propose "${places%%;*}" "$current"
  fi
}

complete -F _qm_rps qm-rps
)";

/// One branch of the tables for the command, and for each below it.
void AddToBash(const T_COMMAND_TEXT& command, std::string& table, std::string& values)
{
    const std::string name = BelowProgram(command.name);
    std::vector<std::string> commands, options, places;
    for (const T_COMMAND_TEXT& below : command.commands)
        commands.push_back(LastWord(below.name));
    for (const T_OPTION_TEXT& option : command.options) {
        const std::vector<std::string> names = NamesOf(option);
        options.insert(options.end(), names.begin(), names.end());
        if (option.IsPlace()) places.push_back(ValueWord(option));
        if (names.empty() || option.value.empty()) continue;
        std::string branch;
        for (const std::string& word : names)
            branch += (branch.empty() ? "" : " | ") + ("\"" + name + " " + word + "\"");
        values += "    " + branch + ") echo '" + (option.several ? "+" : "") + ValueWord(option) +
                  "' ;;\n";
    }
    table += "    \"" + name + "\")\n      commands='" + Joined(commands, " ") +
             "'\n      options='" + Joined(options, " ") + "'\n      places='" +
             Joined(places, ";") + "' ;;\n";
    for (const T_COMMAND_TEXT& below : command.commands)
        AddToBash(below, table, values);
}

/// A text within an argument of _arguments or _describe, which stands between single quotes.
std::string ZshText(std::string_view text)
{
    std::string out;
    for (const char c : text) {
        if (c == '\'')
            out += "'\\''";
        else if (c == '[' || c == ']' || c == ':' || c == '\\')
            (out += '\\') += c;
        else
            out += c;
    }
    return out;
}

std::string ZshAction(const T_OPTION_TEXT& option)
{
    if (!option.choices.empty()) return "(" + Joined(option.choices, " ") + ")";
    if (NamesFolder(option)) return "_files -/";
    const std::vector<std::string> endings = FileEndings(option);
    return endings.empty() ? " " : "_files -g \"*.(" + Joined(endings, "|") + ")\"";
}

std::string ZshOption(const T_OPTION_TEXT& option)
{
    std::string out;
    for (const std::string& name : NamesOf(option)) {
        out += " \\\n    '" + std::string(option.several ? "*" : "") + name + "[" +
               ZshText(option.about) + "]";
        if (!option.value.empty()) out += ":" + ZshText(option.value) + ":" + ZshAction(option);
        out += "'";
    }
    return out;
}

std::string ZshFunction(const std::string& name)
{
    std::string out = "_" + name;
    std::ranges::replace_if(
        out, [](char c) { return c == ' ' || c == '-'; }, '_');
    return out;
}

std::string ZshCommands(const T_COMMAND_TEXT& command)
{
    std::string list, calls, files;
    for (const T_OPTION_TEXT& option : command.options) // "push FILE" beside "push setup"
        if (option.IsPlace() && files.empty()) files = "\n      " + ZshAction(option);
    for (const T_COMMAND_TEXT& below : command.commands) {
        const std::string word = LastWord(below.name);
        list += "\n        '" + word + ":" + ZshText(below.about) + "'";
        calls += "\n        " + word + ") " + ZshFunction(below.name) + " ;;";
    }
    return " \\\n    '1: :->command' '*:: :->rest'\n  case $state in\n    command)\n"
           "      commands=(" +
           list + ")\n      _describe command commands" + files +
           " ;;\n    rest)\n      case $words[1] in" + calls + "\n      esac ;;\n  esac\n";
}

std::string ZshOf(const T_COMMAND_TEXT& command)
{
    std::string out = "\n" + ZshFunction(command.name) +
                      "()\n{\n  local context state line\n  local -a commands\n"
                      "  typeset -A opt_args\n  _arguments -C";
    for (const T_OPTION_TEXT& option : command.options)
        if (!option.IsPlace()) out += ZshOption(option);
    if (!command.commands.empty()) return out + ZshCommands(command) + "}\n";
    int place = 0;
    for (const T_OPTION_TEXT& option : command.options)
        if (option.IsPlace())
            out += " \\\n    '" + (option.several ? "*" : std::to_string(++place)) + ":" +
                   ZshText(option.value) + ":" + ZshAction(option) + "'";
    return out + "\n}\n";
}

void AddToZsh(const T_COMMAND_TEXT& command, std::string& out)
{
    out += ZshOf(command);
    for (const T_COMMAND_TEXT& below : command.commands)
        AddToZsh(below, out);
}

} // namespace

std::string BashCompletion(const T_COMMAND_TEXT& program)
{
    std::string table, values;
    AddToBash(program, table, values);
    return kBashHead + table + kBashValues + values + kBashTail;
}

std::string ZshCompletion(const T_COMMAND_TEXT& program)
{
    std::string out = "#compdef qm-rps\n# Completion of qm-rps for zsh, written by "
                      "\"qm-rps help --completion zsh\".\n";
    AddToZsh(program, out);
    return out + "\n" + ZshFunction(program.name) + " \"$@\"\n";
}
