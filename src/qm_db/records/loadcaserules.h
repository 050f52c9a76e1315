// Rules of pushover load cases: control and stop criteria, and the rows of the pattern list.
#pragma once

#include "qm_base/finding.h"
#include "qm_db/records.h"

#include <span>
#include <string_view>

/// Kinds of pattern row that name a mode.
inline bool IsModePattern(int kind)
{
    return kind == 2 || kind == 3;
}

/// Sets the kind of the master pattern and the modes by the pattern rows, where there are rows:
/// the kind of the first one and the mode numbers in their order.
void TakeMasterPattern(T_POLC_D& record);

/// Rules of the record that are not kept, in the order of the check. How it is controlled is judged
/// where there are control data: a case of another solver has none. The model tells which increment
/// functions, load cases and other pushovers exist; under `key` it has the record as it was before
/// (0: by its name, or not at all).
std::vector<T_FINDING> LoadCaseFindings(const T_POLC_D& record, const T_MODEL& model, int key = 0);

/// Why a member of a case file is refused, a catalogue key; null: it keeps its rules. Members of
/// "stops" by their own keys.
const char* LoadCaseFault(const T_POLC_D& record, const T_MODEL& model, std::string_view caseKey);
/// Whether a displacement of the control node may be asked for as a step: finite, and on the way
/// from 0 to where the push ends, as far as the record tells.
bool IsOnTheWay(const T_POLC_D& record, double displacement);

/// What is wrong with a pattern row by itself; its field starts with `prefix`.
std::vector<T_FINDING> PatternRowFindings(const T_POLC_PATTERN& row,
                                          const std::string& prefix = {});
/// What is wrong with it behind the rows before it.
std::vector<T_FINDING> PatternPlaceFindings(const T_POLC_PATTERN& row,
                                            std::span<const T_POLC_PATTERN> before,
                                            const std::string& prefix = {});
/// Both for every row of a list: "patterns[0]" ...
std::vector<T_FINDING> PatternFindings(std::span<const T_POLC_PATTERN> rows);

/// Modes and static load cases that the rows name and the model does not have. A model without any
/// of its own names those of another solver.
std::vector<T_FINDING> PatternDocFindings(const T_MODEL& model,
                                          std::span<const T_POLC_PATTERN> rows);

/// "patterns[2]".
std::string PatternField(std::size_t row);
