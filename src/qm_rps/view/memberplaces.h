// Places along a member at which a table of forces has rows.
#pragma once

#include "qm_rps/view/memberline.h"

#include <map>

struct T_STATION {
    double x = 0.0, before = 0.0, behind = 0.0;
    double rounding = 0.0; // what a difference must exceed
    bool leaps = false;
};

/// A component along a member: between two stations it only rises or only falls.
[[nodiscard]] std::vector<T_STATION> StationsAlong(const CMemberLine& member, std::size_t c);

/// Places that have rows beside the five positions: where My or Mz turns between these, and where
/// any component leaps (true), at a position too: this one has one side alone.
[[nodiscard]] std::map<double, bool> PlacesBetween(const CMemberLine& member);
