#include "qm_db/records/inputlimits.h"

#include <algorithm>

const char* NameFault(std::string_view name)
{
    const auto isControl = [](char c) { return static_cast<unsigned char>(c) < 0x20 || c == 0x7f; };
    if (name.empty()) return "IDS_QM_JSON_NAME_EMPTY";
    return std::ranges::any_of(name, isControl) ? "IDS_QM_JSON_NAME_CONTROL" : nullptr;
}
