// A judgement as text, in the chosen language: for the terminal and for reports.
#pragma once

#include "qm_rps/dialog/texttable.h"
#include "qm_rps/judge/judgementtable.h"

/// Rows of a state that have the same columns.
struct T_JUDGED_PART {
    T_TEXT_TABLE table;
    std::vector<VERDICT> verdicts; // by row
};
/// The worst rows of a state for a page: member ends, then what has one demand of another kind
/// (joints, axial force); the verdict beside the place, without columns in which no row has
/// anything.
std::vector<T_JUDGED_PART> JudgedParts(const T_JUDGEMENT& judgement, const T_JUDGED_STATE& state,
                                       std::size_t mostRows);
/// Counts, first passes and the rows of every limit state. mostRows: of each state, the worst; 0:
/// all.
std::string JudgementText(const T_JUDGEMENT& judgement, std::size_t mostRows);
/// The same with the ten worst rows of each limit state, as a part of a report.
std::string JudgementReport(const T_JUDGEMENT& judgement);
/// A sentence for each limit state and mode: where along the push the first end is beyond it, and
/// at what ground acceleration.
std::string JudgedLimitsText(const T_JUDGEMENT& judgement);
/// The same as a table; nothing: no state is judged along the push.
T_TEXT_TABLE JudgedLimitsTable(const T_JUDGEMENT& judgement);
/// The numbers behind the checks of every row, with their clauses and marks.
std::string JudgementTrace(const T_JUDGEMENT& judgement);
