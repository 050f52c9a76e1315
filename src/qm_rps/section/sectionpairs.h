// Which material a section has: the elements say it, else hinge types do.
#pragma once

#include "qm_db/records.h"

#include <string>
#include <vector>

struct T_SECTION_PAIR {
    int section = 0, material = 0; // keys
    bool operator==(const T_SECTION_PAIR&) const = default;
};

/// Each pair once, in the order of sections and materials.
std::vector<T_SECTION_PAIR> SectionPairs(const T_MODEL& model);

/// Key of the record with this name or this number; 0: none.
int SectionKey(const T_MODEL& model, const std::string& nameOrNumber);
int MaterialKey(const T_MODEL& model, const std::string& nameOrNumber);
