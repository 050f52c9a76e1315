// Load factors checked on the structure: it is analysed once more under the loads times their
// factors, and the constrained quantities are read from these results.
#pragma once

#include "qm_db/dbdoc.h"
#include "qm_rps/factors/ulfanalysed.h"

struct T_ULF_CHECKED {
    std::vector<T_ULF_ANALYSED> rows; // one for each constraint; empty: not checked
    std::string why;                  // it is not checked; empty: it is
    std::vector<T_ULF_STAY> stays;    // of stages: elements whose tension was scaled
};

/// Of static load cases: one load case with all loads times their factors, on a copy of the model.
/// The document stays as it is.
T_ULF_CHECKED CheckUlf(CDBDoc& doc, const T_ULF_RUN& run, const T_ULF_RESULT& result);

/// Of construction stages: the pretension that the unknowns scale is multiplied by their factors in
/// a copy of the model, whose stages are analysed. Not where a factor other than 1 belongs to
/// something else than pretension: the stages bring such a load as it is in the model.
T_ULF_CHECKED CheckUlfStages(CDBDoc& doc, const T_ULSI_D& item, const T_ULF_RUN& run,
                             const T_ULF_RESULT& result);
