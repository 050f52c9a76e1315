// Traces and warnings of what codes give, as JSON.
#pragma once

#include "qm_rps/codes/codesheet.h"
#include "json/jsontext.h"

void WriteWarnings(CJsonText& writer, const std::vector<T_CODE_WARNING>& warnings);
void WriteTrace(CJsonText& writer, const std::vector<T_CODE_TRACE>& trace, const T_UNITS& units);
