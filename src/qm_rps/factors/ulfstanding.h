// What stands and what has acted at a construction stage, and what the rows of an item read of it.
#pragma once

#include "qm_db/records.h"

#include <optional>
#include <set>
#include <utility>
#include <vector>

/// Elements and supports that the stages have brought by one of them and not taken away; nodes at
/// an end of such an element. Steps of a stage do not matter: both change at its first one.
struct T_STANDING {
    std::set<int> elements, nodes, supports;
};
T_STANDING StandingAt(const T_MODEL& model, int stage);

/// Load cases that a stage has brought by the end of a step, ascending, also those that have gone
/// again: what they leave stays in their results.
std::vector<int> CasesBroughtBy(const T_MODEL& model, int stage, int step);

/// True for load groups 0 and 1, which read a sum.
bool ReadsSum(const T_ULSI_ROW& row);
/// Whether the results that a row of the item reads contain those of the load case.
bool ReadsCase(const T_MODEL& model, const T_ULSI_D& item, const T_ULSI_ROW& row, int loadCase);

/// Stage and step at which the constraint reads the rows: its own, or that at which all rows stand.
/// Empty: the rows stand at several, so that their sum is no state of the structure.
std::optional<std::pair<int, int>> ReadingPlace(const T_MODEL& model, const T_ULSI_D& item,
                                                const T_ULFC_D& constraint);
