// How a push has ended, in words.
#pragma once

#include "qm_solver/pushresult.h"

#include <string>

enum class PUSH_STATUS { Reached, Stopped, Failed };
inline constexpr const char* kPushStatusNames[] = {"reached", "stopped", "failed"};

/// The target, a stop that was asked for, or anything else.
PUSH_STATUS StatusOf(solver::PUSH_OUTCOME outcome);
/// Short name, always in English ("target reached").
std::string PushOutcomeName(solver::PUSH_OUTCOME outcome);
/// Both in the chosen language.
std::string PushStatusText(PUSH_STATUS status);
std::string PushOutcomeText(solver::PUSH_OUTCOME outcome);
/// What it means and what to look at, in the chosen language. loadFactor: of the end; place: the
/// hinge or storey that ended it, a sentence, may be empty; hasSteps: the case has stored steps.
std::string PushOutcomeAdvice(solver::PUSH_OUTCOME outcome, double loadFactor,
                              const std::string& place, bool hasSteps = true);
