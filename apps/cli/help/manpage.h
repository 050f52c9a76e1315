// Manual pages (man 7): one for the program, and one for each command with those below it.
#pragma once

#include "help/commandtext.h"

struct T_HELP_FILE {
    std::string name, text; // "qm-rps-hinge.1"; ASCII alone, other letters as escapes
};

/// The pages of the program in the user's language, that of the program first.
std::vector<T_HELP_FILE> ManPages(const T_COMMAND_TEXT& program);
