// The calculation of the load factors of an item: records in, factors or the refusal out.
#pragma once

#include "qm_db/dbdoc.h"
#include "qm_rps/factors/ulfresult.h"
#include "qm_rps/factors/ulfstageresponse.h"

/// Of a static item that keeps its rules and whose combination has these cases; the matrix of all
/// cases comes from the source, also when there is no solution to explain. Either outcome goes to
/// the message history.
T_ULF_CALCULATION CalculateUlf(CDBDoc& doc, const T_ULFI_D& item,
                               const std::vector<T_ULF_CASE>& cases, IUlfResponse& source,
                               const T_OPT_DUMP& dump);

/// Of an item of construction stages that keeps its rules. The cases of the result are its rows,
/// "S1/First Step T". Either outcome goes to the message history.
T_ULF_CALCULATION CalculateUlfStages(CDBDoc& doc, const T_ULSI_D& item, CUlfStageResponse& source,
                                     const T_OPT_DUMP& dump = {});
