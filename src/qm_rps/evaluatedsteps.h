// Steps of a push at what its evaluations find.
#pragma once

#include "qm_rps/push/pushatpoint.h"
#include "qm_rps/pushover/pushevaluation.h"

#include <span>

/// The evaluations of a document. One of a load case that is pushed in several directions stands
/// for each of them, whose name ("P@90") is then that of its push and stands behind its own.
/// only: the one of that name; empty: all.
std::vector<T_EVAL_D> EvaluationsOf(CDBDoc& doc, const std::string& only = {});

/// Displacements of the control node (m) at the performance points and targets of the evaluations
/// of a load case, to be steps of its push; its results must be those of the document. Empty where
/// the load case does not ask for them or was cancelled; directions between the axes have none.
std::vector<double> StepsOfEvaluations(CDBDoc& doc, std::span<const T_PUSH_RUN> runs);

/// What every hinge does at what the evaluations found: at performance points, and at the demands
/// and capacities of limit states. Each load case whose results are of our own and not older than
/// the model is pushed again, once, with these displacements as steps; the document stays as it is.
/// One entry per evaluation, without points where its push is of another program.
std::vector<T_HINGES_AT> HingesOfEvaluations(CDBDoc& doc,
                                             std::span<const T_PUSH_EVALUATION> results,
                                             const PUSH_PROGRESS_FN& progress);

/// The same of one evaluation, with the push whose steps the points are (PushAtPoints); the run is
/// empty where there is no point or a note says why.
/// `forces`: told of the initial loads, of the start and of every step of that push, which then
/// also has a step at each vertex of its path (where strength drops, one 1e-6 of its way before
/// that, too), so that it is straight between them.
T_HINGES_AT PushToEvaluation(CDBDoc& doc, const T_PUSH_EVALUATION& result,
                             const PUSH_PROGRESS_FN& progress, T_PUSH_RUN& run,
                             const PUSH_FORCES_FN& forces = {});

/// Evaluates a stored evaluation; the document stays as it is. 1 done, whatever was found; 0 error
/// says that there is none of this name, or what it refuses.
[[nodiscard]] int EvaluateStored(CDBDoc& doc, const std::string& name, T_PUSH_EVALUATION& out,
                                 std::string& error);
