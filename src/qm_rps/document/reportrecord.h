// What the title block of a report says, and which chapters it has. Plain data.
#pragma once

#include <string>
#include <vector>

struct T_REPORT_D {
    std::string project, author, checker, date;
    std::vector<std::string> chapters; // their names; empty: all
    bool operator==(const T_REPORT_D&) const = default;
};
