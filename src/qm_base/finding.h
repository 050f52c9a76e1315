// What a check found: one rule that is not kept, with its place and its words.
#pragma once

#include <string>

/// The record itself is not kept here: a finding outlives the check.
struct T_FINDING {
    std::string field;      // path of the member in the record: "sides.pos.B.strength"
    std::string ruleText;   // the rule as the program words it, "F(B) > 0", or a catalogue key
    std::string messageKey; // of the message that reports it
    std::string text;       // that message, filled in
    std::string wording;    // the relation in words, where the catalogue has them
    std::string point;      // of a curve: "B" to "E", "IO" ...; empty: no point
    int part = -1;          // part of the record with pages of its own, as the record numbers them
    int page = 0;           // page of that part
    bool operator==(const T_FINDING&) const = default;
};
