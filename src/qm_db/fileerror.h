// Why a file operation was refused.
#pragma once

#include <string>

enum class FILE_FAULT {
    None,
    BadInput, // the content is wrong: foreign, damaged, an invalid value
    NoAccess, // the file can't be opened, read, locked or written
    Changed,  // another program has changed it since it was read; nothing was saved
    Misuse    // a name that can't be meant: an output over an input, or of another kind
};

struct T_FILE_ERROR {
    FILE_FAULT fault = FILE_FAULT::None;
    std::string text; // one line: file, place, reason
};
