// Words of the case file that belong to no record.
#pragma once

#include "qm_db/records/evalnames.h"

inline constexpr const char* kCaseFormat = "qm-rps case 1";
inline constexpr const char* kPushControlMember = "pushover_control";
inline constexpr const char* kStateBeforePush = "state before push";
