// The release assertion of the pushover sources: logged where it is switched on, work carries on.
#pragma once

#include "qm_base/appbase.h"

inline void ReleaseAssert(const char* source, int line)
{
    if (CAppBase::IsReleaseAssert_ST()) CAppBase::ReleaseAssertion_ST(source, line);
}
