// Numbers as the case file prints them.
#pragma once

#include "qm_db/records/units.h"

#include <optional>
#include <string>

/// Shortest text that reads back as the same double; no exponent from 1e-5 up to 1e15 ("100000"),
/// "-0.0" for the negative zero (JSON readers take "-0" for the integer 0). The value is finite.
std::string NumberText(double value);

/// A stored SI value in the given units: the shortest text that becomes exactly the stored value
/// when it is read and converted. Where rounding leaves no such text (the value came from other
/// units), the text for the nearest value that has one. nullopt: the value is not finite there.
std::optional<std::string> SiText(double si, const T_UNITS& units, T_DIM dim);
