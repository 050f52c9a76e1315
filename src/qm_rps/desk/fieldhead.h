// Names of a record's members with their units.
#pragma once

#include "qm_db/recordform.h"
#include "qm_rps/dialog/unithead.h"

/// "size (m)", "gravity (m/s2)", "w (kN/m)": times are in seconds, so that an acceleration has the
/// dimension of a length, and a load per length and a spring that of a mass.
inline std::string FieldHead(const std::string& name, const T_FIELD_ROW& row, const T_UNITS& units)
{
    const bool isMass = row.path == "mass" || row.path.starts_with("mass/"); // of a node
    if (row.dim == kDimMass && !isMass)
        return HeadWithUnit(name, kDimNone, units) + " (" + std::string(NameOf(units.force)) + "/" +
               std::string(NameOf(units.length)) + ")";
    std::string head = HeadWithUnit(name, row.dim, units);
    if (row.isAcceleration) head.insert(head.size() - 1, "/s2");
    return head;
}
