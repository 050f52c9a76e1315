// Names of what an evaluation can be of: a pushover load case, or one of the directions in which
// its static angle has it pushed ("NAME@90").
#pragma once

#include "qm_db/records.h"

#include <optional>

std::string TurnedName(const std::string& name, double angleDegrees);
/// "NAME@..." of this load case, whatever stands behind.
bool IsTurnOf(const std::string& turned, const std::string& name);

/// The directions of a load case by their turns, from 1; empty: it is pushed as it stands.
std::vector<std::string> TurnedNames(const T_POLC_D& record);

struct T_PUSH_NAME {
    int key = 0;  // of the load case
    int turn = 0; // so many times the static angle
};
/// Empty: no load case, and no direction of one, has this name.
std::optional<T_PUSH_NAME> FindPush(const T_MODEL& model, const std::string& name);

/// The load cases by their keys, each with its directions behind it.
std::vector<std::string> PushNames(const T_MODEL& model);
