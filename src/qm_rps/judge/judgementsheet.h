// Judgements as a spreadsheet whose ratios and counts are formulas.
#pragma once

#include "qm_db/sheetfile.h"
#include "qm_rps/judge/judgementtable.h"

#include <span>

/// One row for each member end and limit state of all judgements, below a row of heads; above them
/// the number of rows with each verdict. Rows beyond those of a sheet are left out.
T_SHEET JudgementSheet(std::span<const T_JUDGEMENT> judgements);
