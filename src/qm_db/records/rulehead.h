// Rules of records that stand in the model and in case files: one row, whoever asks.
#pragma once

#include "qm_base/ruletable.h"

#include <string_view>

/// All of a rule but its condition. A window names the member as the record has it and takes the
/// message of the catalogue; a case file names its own member and gives a reason of its own.
struct T_RECORD_HEAD {
    using PLACE = T_RULE_PLACE;
    const char* message = "";      // catalogue key
    const char* field = "";        // member of the record, below the place's prefix
    const char* caseKey = nullptr; // member in a case file; null: not judged there
    const char* reason = nullptr;  // what a case file's fault says, a catalogue key
};

template <class DATA>
using T_RECORD_RULE = T_RULE<DATA, T_RECORD_HEAD>;

inline T_FINDING FindingOf(const T_RECORD_HEAD& head, const T_RULE_PLACE& place)
{
    return FindingOf(T_RULE_HEAD{.message = head.message, .field = head.field}, place);
}

/// Why a member of a case file is refused, a catalogue key; null: it keeps its rules.
template <class DATA>
const char* FaultOf(std::span<const T_RECORD_RULE<DATA>> rows, const DATA& data,
                    std::string_view caseKey)
{
    for (const T_RECORD_RULE<DATA>& rule : rows)
        if (rule.head.caseKey && rule.head.caseKey == caseKey &&
            (!rule.applies || rule.applies(data)) && !rule.holds(data))
            return rule.head.reason;
    return nullptr;
}
