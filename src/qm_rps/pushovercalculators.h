// The performance-point calculators by method and procedure.
#pragma once

#include "qm_rps/pushover/evaluation/pushevaluator.h"
#include "qm_rps/pushovercalcperfptbase.h"

#include <memory>

/// The calculator of a performance-point method by the driver's procedure number: ATC-40 0 A, 1 B;
/// FEMA 440 0 A, 1 B (MADRS), 2 C. Null, and the release assertion, for any other number.
std::unique_ptr<CPushOverCalcPerfPtBase> MakePerfPtCalculator(PUSH_METHOD method, int procedure,
                                                              CPushOverPerfPtRecord& owner);

/// Makes the calculator, runs it once and hands out all that it found: what an evaluator is given.
std::optional<T_PERFPT_ANSWER> RunPerfPtProcedure(PUSH_METHOD method, int procedure,
                                                  CPushOverPerfPtRecord& record);
