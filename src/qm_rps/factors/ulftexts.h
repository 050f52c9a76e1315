// Constraints of unknown load factors in words.
#pragma once

#include "qm_db/records.h"

#include <string>

/// "DX" to "RZ" of a displacement, "FX" to "MZ" of a reaction, the text of an element's force;
/// empty for a component out of range.
std::string UlfComponentText(ULFC_TYPE type, int component);
/// I-end, 1/4, 2/4, 3/4, J-end; empty when out of range.
std::string UlfPositionText(int position);
/// " <= ", " >= ", " = " and the bound as " %10.4f", or what it is compared with.
std::string UlfRelationText(const T_ULFC_D& constraint);
/// The quantity and its relation: "DZ of node 5 <=      0.0100". Values in the record's units.
std::string UlfDescription(const T_ULFC_D& constraint);
/// Unit of the quantity: "m", "rad", "kN", "kN*m".
std::string UlfUnitText(ULFC_TYPE type, int component, const T_UNITS& units);
