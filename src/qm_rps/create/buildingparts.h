// What a frame is asked for, read and checked: sections and grades by name, lists, loads.
#pragma once

#include "qm_rps/create/building.h"

/// Section and material of columns, beams or braces, in SI. The material's density is told apart:
/// the record has none, see MakeBuilding.
struct T_BUILDING_PART {
    T_SECT_D section;
    T_MATL_D material;
    double area = 0.0, density = 0.0;
};

/// "0.4x0.6" (b x h) or the name of a steel shape, and a grade. 0: fault filled with this field, or
/// "grade." and this field.
[[nodiscard]] int ReadBuildingPart(const std::string& field, const std::string& section,
                                   const std::string& grade, const T_UNITS& units,
                                   T_BUILDING_PART& out, T_FINDING& fault);

/// Lists of bays and storeys, loads and factor. 0: fault filled.
[[nodiscard]] int CheckBuilding(const T_BUILDING& in, T_FINDING& fault);

/// What no building has, in words for the user: a storey outside of 1.5 to 20 m, a bay outside of
/// 0.5 to 100 m. Most likely the units are others. Empty: nothing.
std::string BuildingDoubt(const T_BUILDING& in);
/// 0.02 to 10 s.
bool IsUsualPeriod(double period);
