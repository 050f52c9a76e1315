// Heads of columns and fields with their units.
#pragma once

#include "qm_db/records.h"

#include <optional>
#include <string>

/// The head of a column with its unit: "X (m)"; a number without a dimension has its name alone.
std::string HeadWithUnit(const std::string& head, const std::optional<T_DIM>& dim,
                         const T_UNITS& units);
