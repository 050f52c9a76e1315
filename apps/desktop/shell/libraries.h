// The libraries that the program uses.
#pragma once

#include <string>
#include <vector>

struct T_LIBRARY {
    std::string name;
    std::string version; // as it runs, or as the program was built with where it has no such call
    std::string licence;
};

std::vector<T_LIBRARY> UsedLibraries();
