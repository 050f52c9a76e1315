// The outcome of an evaluation in words, for documents.
#pragma once

#include "qm_rps/pushover/pushoutcome.h"

/// OutcomeName in the chosen language.
std::string OutcomeText(const T_OUTCOME& outcome);
