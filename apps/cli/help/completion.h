// Completion of the command line by a shell: commands, options, choices, and files of the kinds
// that an option takes.
#pragma once

#include "help/commandtext.h"

/// A script that bash reads: "source FILE", or a file of bash-completion.
std::string BashCompletion(const T_COMMAND_TEXT& program);
/// A function file of zsh ("_qm-rps" in a folder of fpath).
std::string ZshCompletion(const T_COMMAND_TEXT& program);
