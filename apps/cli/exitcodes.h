// Exit codes of the command line.
#pragma once

enum class EXIT_CODE {
    Done = 0,     // done, and every point was found
    NotFound = 1, // done, but a point was not found
    Usage = 2,    // wrong usage
    BadInput = 3, // bad input file
    NoAccess = 4  // a file can't be read or written
};

inline int ToInt(EXIT_CODE code)
{
    return static_cast<int>(code);
}
