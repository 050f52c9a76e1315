// A table of texts that is only read: what result cells of windows show.
#pragma once

#include <string>
#include <vector>

struct T_TEXT_COLUMN {
    std::string head;
    bool number = false; // cells are numbers with '.', to be shown as the locale writes them
};

struct T_TEXT_TABLE {
    std::vector<T_TEXT_COLUMN> columns;
    std::vector<std::vector<std::string>> rows; // as many cells as columns
};
