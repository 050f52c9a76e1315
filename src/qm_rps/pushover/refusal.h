// What a computation hands back where it refuses: key, text and place, for whoever shows it.
#pragma once

#include "qm_base/finding.h"
#include "qm_base/msgfunction.h"

#include <initializer_list>

/// Fills the refusal, `values` into the text of the key, and returns 0.
inline int Refuse(T_FINDING& refusal, const char* field, const char* key,
                  std::initializer_list<std::string_view> values = {})
{
    refusal = {};
    refusal.field = field;
    refusal.messageKey = key;
    refusal.text = zql::lib::MMSGFunction::Format(key, values);
    return 0;
}
