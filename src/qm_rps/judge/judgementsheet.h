// Judgements as a spreadsheet whose ratios and counts are formulas, and as values with commas.
#pragma once

#include "qm_db/sheetfile.h"
#include "qm_rps/judge/judgementtable.h"

#include <span>

/// One row for each member end and limit state of all judgements, below a row of heads; above them
/// the number of rows with each verdict. Rows beyond those of a sheet are left out.
T_SHEET JudgementSheet(std::span<const T_JUDGEMENT> judgements);
/// The same rows as values with commas, below one line of heads.
std::string JudgementCsv(std::span<const T_JUDGEMENT> judgements);
