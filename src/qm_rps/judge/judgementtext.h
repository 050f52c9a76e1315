// A judgement as text, in the chosen language: for the terminal and for reports.
#pragma once

#include "qm_rps/dialog/texttable.h"
#include "qm_rps/judge/judgementtable.h"

/// The worst rows of a state, without columns that say nothing: what terminal and report show.
T_TEXT_TABLE JudgedTable(const T_JUDGEMENT& judgement, const T_JUDGED_STATE& state,
                         std::size_t mostRows);
/// Counts, first passes and the rows of every limit state. mostRows: of each state, the worst; 0:
/// all.
std::string JudgementText(const T_JUDGEMENT& judgement, std::size_t mostRows);
/// The same with the ten worst rows of each limit state, as a part of a report.
std::string JudgementReport(const T_JUDGEMENT& judgement);
/// A sentence for each limit state and mode: where along the push the first end is beyond it, and
/// at what ground acceleration.
std::string JudgedLimitsText(const T_JUDGEMENT& judgement);
/// The numbers behind the checks of every row, with their clauses and marks.
std::string JudgementTrace(const T_JUDGEMENT& judgement);
