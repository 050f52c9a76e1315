// Stage and step as one number, and what acts there.
#pragma once

#include "qm_db/records.h"

/// Steps of a stage that a stage number can tell apart.
inline constexpr int kStageStepsMost = 999;

/// Stage key times 1000 plus the step, 0 standing for the last step: an entry of the optimizer's
/// records. Steps count from 1 to 999.
int UlfStageNumber(int stage, int step);
int StageOfUlfNumber(int number);
int StepOfUlfNumber(int number); // kStageLastStep for the last one

/// The step's number in its stage: the last one is the number of steps. 0: no such stage or step.
int UlfStepNumber(const T_MODEL& model, int stage, int step);

/// Load cases that the stage brings at this step or before and has not taken away by then, in the
/// stage's order.
std::vector<int> LoadsActingAt(const T_MODEL& model, int stage, int step);
