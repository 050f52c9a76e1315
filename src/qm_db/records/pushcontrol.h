// Control that a pushover load case is run with, and the rules of what it is made of: the global
// control, initial loads, increment functions.
#pragma once

#include "qm_base/finding.h"
#include "qm_db/records.h"

#include <span>
#include <string_view>
#include <vector>

/// Most increments of a load case.
inline constexpr int kMostPushSteps = 1000000;

/// The global control with what the load case has of its own. The initial loads of a case that
/// starts from the end of another one (`initialCase`) do not count: that one's stand.
T_POGC_D PushControlOf(const T_MODEL& model, const T_POLC_D& loadCase);

/// Rules that are not kept, in the order of the check.
std::vector<T_FINDING> PushControlFindings(const T_POGC_D& control, const T_MODEL& model);
/// "initialLoads[0].factor" ...
std::vector<T_FINDING> InitialLoadFindings(std::span<const T_PUSH_INITIAL_LOAD> loads,
                                           const T_MODEL& model);
/// A first row of step 0 and factor 0 may stand there: it says nothing.
std::vector<T_FINDING> IncrementFunctionFindings(const T_POFC_D& function);

/// Why a member of a case file is refused, a catalogue key; null: it keeps its rules.
const char* PushControlFault(const T_POGC_D& control, std::string_view caseKey);
const char* InitialLoadFault(const T_PUSH_INITIAL_LOAD& load, std::string_view caseKey);
const char* IncrementFunctionFault(const T_POFC_D& function, std::string_view caseKey);
