// Stage and step as one number, and what acts there.
#pragma once

#include "qm_db/attrctrl.h"

/// Steps of a stage that a stage number can tell apart.
inline constexpr int kStageStepsMost = 999;

/// Stage key times 1000 plus the step, 0 standing for the last step: an entry of the optimizer's
/// records. Steps count from 1 to 999.
int UlfStageNumber(int stage, int step);
int StageOfUlfNumber(int number);
int StepOfUlfNumber(int number); // kStageLastStep for the last one

/// The step's number in its stage: the last one is the number of steps. 0: no such stage or step.
int UlfStepNumber(const T_MODEL& model, int stage, int step);

/// "S1/First Step"; empty where there is no such stage or step.
std::string UlfPlaceText(const CDataCtrl& data, int stage, int step);
/// Place and load case of a row, "S1/First Step T"; what is gone is left out.
std::string UlfStageRowText(const CDataCtrl& data, const T_ULSI_ROW& row);

/// Every stage and step of the model in their order; the final step of a stage with several is
/// kStageLastStep.
std::vector<std::pair<int, int>> UlfPlaces(const T_MODEL& model);
/// A constraint in words, with the stage and step where it is read, if any.
std::string UlfConstraintText(const CDataCtrl& data, const T_ULFC_D& constraint);

/// Load cases that the stage brings at this step or before and has not taken away by then, in the
/// stage's order.
std::vector<int> LoadsActingAt(const T_MODEL& model, int stage, int step);
