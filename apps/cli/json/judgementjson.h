// Judgements of member ends as JSON.
#pragma once

#include "qm_rps/judge/judgementresult.h"
#include "json/jsontext.h"

#include <span>

/// trace: with the numbers behind every check.
std::string JudgementJson(std::span<const T_JUDGEMENT> judgements, bool trace);
