// Rules of pushover load cases: control and stop criteria, and the rows of the pattern list.
#pragma once

#include "qm_base/finding.h"
#include "qm_db/records.h"

#include <span>

/// Kinds of pattern row that name a mode.
inline bool IsModePattern(int kind)
{
    return kind == 2 || kind == 3;
}

/// Rules of the record that are not kept, in the order of the check. A case without control data
/// (another solver's) is judged by its name alone. The model tells which increment functions exist.
/// Sets the kind of the master pattern and the modes by the pattern rows, where there are rows:
/// the kind of the first one and the mode numbers in their order.
void TakeMasterPattern(T_POLC_D& record);

std::vector<T_FINDING> LoadCaseFindings(const T_POLC_D& record, const T_MODEL& model);

/// What is wrong with a pattern row by itself; its field starts with `prefix`.
std::vector<T_FINDING> PatternRowFindings(const T_POLC_PATTERN& row,
                                          const std::string& prefix = {});
/// What is wrong with it behind the rows before it.
std::vector<T_FINDING> PatternPlaceFindings(const T_POLC_PATTERN& row,
                                            std::span<const T_POLC_PATTERN> before,
                                            const std::string& prefix = {});
/// Both for every row of a list: "patterns[0]" ...
std::vector<T_FINDING> PatternFindings(std::span<const T_POLC_PATTERN> rows);

/// "patterns[2]".
std::string PatternField(std::size_t row);
