// The trial that an answer rests on.
#pragma once

#include "qm_rps/pushover/pushevaluation.h"

/// Whether the procedure tries a family of displacements and crosses what follows from them with
/// the capacity curve (ATC-40 8.2.2.2, procedure B), so that its last trial is any but the answer.
bool TriesFamily(const T_PUSH_EVALUATION& e);
/// Of a family the trial whose dpi lies nearest to the point, else the last one. Null: there is
/// none, or a family without a point.
const T_PERFPT_TRIAL* AnswerTrial(const T_PUSH_EVALUATION& e);
