// Why a model can't be made of what was given: one finding with the field that it is about.
#pragma once

#include "qm_base/finding.h"
#include "qm_base/say.h"

/// Fills the finding; always 0, for `return CreateFault(...)`.
template <class... ARGS>
int CreateFault(T_FINDING& fault, const char* field, const char* key, const ARGS&... args)
{
    fault = {};
    fault.field = field;
    fault.messageKey = key;
    fault.text = Say(key, args...);
    return 0;
}
