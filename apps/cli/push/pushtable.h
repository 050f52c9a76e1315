// Results of the push as text tables for the terminal.
#pragma once

#include "qm_rps/push/pushrun.h"

#include <string>

/// How it ended, then the steps: load factor, displacement, base reaction, and how many hinge
/// components are in each state that occurs. mostRows: steps that are printed at most, evenly
/// spread with the first and the last one and those that were asked for; 0: all.
std::string PushTable(const T_PUSH_RUN& run, const T_UNITS& units, std::size_t mostRows);

/// Every hinge component at the last step: place, deformation, force and state.
std::string PushHingeTable(const T_PUSH_RUN& run, const T_UNITS& units);
