// Bars of a concrete section laid by a rule: corners, faces, all round.
#pragma once

#include "qm_db/records.h"

#include <string>

/// Top is +z, right is +y.
enum class BAR_PLACE { Corners, Top, Bottom, Right, Left, Around };
inline constexpr std::array<const char*, 6> kBarPlaceNames{"corners", "top",  "bottom",
                                                           "right",   "left", "around"};

/// Bars of one diameter. Corners are four, whatever the count says.
struct T_BAR_GROUP {
    BAR_PLACE place = BAR_PLACE::Corners;
    int count = 4;
    double diameter = 0.0;
    bool operator==(const T_BAR_GROUP&) const = default;
};

/// The bars of a group in a rectangle or a circle with detailing, in the units of the section. They
/// touch the stirrup: their centres lie at cover + stirrup + half their diameter from the edge.
/// Rectangle: the bars of a face stand evenly between the places of corner bars; around it are the
/// four corners and the rest on the faces, opposite ones alike, so that the gaps are as even as
/// they can be (an even number, from 4). Circle: around it alone, evenly from +z on (from 3).
/// Refused, `out` unchanged: no detailing, another shape, a diameter that is not above 0, too few
/// or too many bars, and a bar that stands in another one or in one that the section has already.
/// 1 done; 0 with the reason in words.
[[nodiscard]] int LayBars(const T_SECT_D& section, const T_BAR_GROUP& group,
                          std::vector<T_REBAR>& out, std::string& reason);

/// By its area.
double BarDiameter(const T_REBAR& bar);
double BarArea(double diameter);
