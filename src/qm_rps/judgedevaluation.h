// The member ends of a model judged at what an evaluation has found.
#pragma once

#include "qm_rps/evaluatedsteps.h"
#include "qm_rps/judge/judgementresult.h"

/// Pushes the load case of the evaluation again with its points and the vertices of its path as
/// steps, judges every member end at them, finds where along the path the first one passes each
/// limit state, and by what factor on the spectrum the evaluation's own method finds that
/// displacement. The document stays as it is. Nothing to judge: the note says why.
///
/// Demands of the limit states DL, SD, NC and SLD, SLV, SLC are judged each by its own level (IO,
/// LS, CP where the code has these), the performance point by all three.
T_JUDGEMENT JudgeEvaluation(CDBDoc& doc, const T_PUSH_EVALUATION& result,
                            const T_JUDGE_OPTIONS& options, const PUSH_PROGRESS_FN& progress);

/// The judgement that a report has; none where no code is named and the model has no hinges that a
/// code gave.
std::optional<T_JUDGEMENT> JudgementForReport(CDBDoc& doc, const T_PUSH_EVALUATION& result,
                                              const T_JUDGE_OPTIONS& options,
                                              const PUSH_PROGRESS_FN& progress);
/// The same as text; empty where there is none.
std::string ReportOfJudgement(CDBDoc& doc, const T_PUSH_EVALUATION& result,
                              const T_JUDGE_OPTIONS& options, const PUSH_PROGRESS_FN& progress);
