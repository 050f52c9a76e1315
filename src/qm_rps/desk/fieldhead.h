// Names of a record's members with their units.
#pragma once

#include "qm_db/recordform.h"
#include "qm_rps/dialog/unithead.h"

/// "size (m)", "gravity (m/s2)": an acceleration has the dimension of a length, times are in
/// seconds.
inline std::string FieldHead(const std::string& name, const T_FIELD_ROW& row, const T_UNITS& units)
{
    std::string head = HeadWithUnit(name, row.dim, units);
    if (row.isAcceleration) head.insert(head.size() - 1, "/s2");
    return head;
}
