// An evaluation among several: its answer, its verdict in a word, and why there is none. Lists,
// cards, bars and tables are made of these.
#pragma once

#include "qm_rps/dialog/texttable.h"
#include "qm_rps/pushover/evaluation/pushevaluator.h"

#include <span>

/// What an evaluation says of the structure. A performance point alone is no verdict on it.
/// PartlyOk: nothing is missed, but states with a demand have no capacity to compare it with.
enum class EVALUATION_VERDICT { Ok, PartlyOk, NotGood, BeyondPush, NotChecked, NoPoint, Refused };

struct T_EVALUATION_ENTRY {
    T_EVAL_D eval;            // as asked for
    T_PUSH_EVALUATION result; // of nothing where it was refused
    std::string refused;      // why it was not evaluated; empty: it was
    /// Largest storey drift ratio at the answer. Between two steps on the straight line of theirs,
    /// which the drift of no storey exceeds there.
    std::optional<double> drift;
};

/// Where the answer stands: the performance point, or the target of the limit state that stands
/// for the evaluation (SD of Eurocode 8, SLV of NTC, else the first that has one).
struct T_EVALUATION_ANSWER {
    std::string state; // empty: a performance point
    double Sd = 0.0, D = 0.0;
    std::optional<double> Sa, V; // none beyond the end of the curve
};
std::optional<T_EVALUATION_ANSWER> AnswerOf(const T_PUSH_EVALUATION& e);
/// The target displacement behind that state; null: none.
const T_TARGET_DISP* TargetOfAnswer(const T_PUSH_EVALUATION& e);

/// Evaluates; what is refused or fails says why in the entry. The document stays as it is.
T_EVALUATION_ENTRY EvaluateEntry(CDBDoc& doc, CPushEvaluator& evaluator, const T_EVAL_D& eval);
/// Of a result that is at hand. refused: why it is not of these settings; empty: it is.
T_EVALUATION_ENTRY EntryOf(CDBDoc& doc, const T_EVAL_D& eval, const T_PUSH_EVALUATION& result,
                           const std::string& refused);

EVALUATION_VERDICT VerdictOf(const T_EVALUATION_ENTRY& entry);
/// "OK", "not checked"; and what it rests on, or why nothing is known.
std::string VerdictText(EVALUATION_VERDICT verdict);
std::string VerdictReason(const T_EVALUATION_ENTRY& entry);

/// "ATC-40 B".
std::string MethodText(const T_EVAL_D& eval);
/// "SD: D = 2.18 in, V = 315 kips"; without an answer why there is none.
std::string ResultText(const T_EVALUATION_ENTRY& entry);

/// One row for each, with units in the heads and "-" where there is no value.
T_TEXT_TABLE OverviewCells(std::span<const T_EVALUATION_ENTRY> entries);
