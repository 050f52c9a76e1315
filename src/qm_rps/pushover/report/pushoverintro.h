// What stands before the text report of an evaluation, for who reads it without the model at hand.
#pragma once

#include "qm_rps/pushover/pushevaluation.h"

#include <string>

/// Evaluation, method, procedure, spectrum and its values, damping, masses, units of each figure,
/// outcome, warnings, and what the remarks mean there; in the chosen language. The report itself
/// follows as it is.
std::string PushoverIntroText(const T_PUSH_EVALUATION& e, const T_MODEL& model);
