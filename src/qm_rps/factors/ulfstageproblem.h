// From a construction-stage item and its constraints to the optimizer's records.
#pragma once

#include "qm_rps/factors/ulfrecords.h"
#include "qm_rps/factors/ulfstageresponse.h"

/// As of a static problem; its cases are the rows of the item.
struct T_ULF_STAGE_FORMED : T_ULF_FORMED {
    std::vector<int> loads; // optimizer item -> key of its load case
};

/// Records of the rows and constraints; a constraint that names a stage and step is read there.
/// Known rows with a factor of 0 are left out: the optimizer would take them for unknown ones. The
/// order is that of the rows: a stored item has its unknown rows before its known ones, each list
/// as it was given (FitRecord).
T_ULF_STAGE_FORMED FormUlfStageProblem(const T_ULSI_D& item, std::span<const T_ULFC_D> constraints);

/// The influence matrix: for each constraint the response of every row, also of those that are left
/// out of the problem. 1 done; 0 see source.Error(). The source reads the rows' loads afterwards.
[[nodiscard]] int ReadUlfStageInfluence(const T_ULSI_D& item, const T_ULF_FORMED& formed,
                                        CUlfStageResponse& source,
                                        std::vector<std::vector<double>>& influence);

/// Load cases whose pretension an unknown row scales: its own one where the row reads its own
/// result, else all that act at its stage and step. None of a row without the pretension flag.
std::vector<int> LoadsScaledBy(const T_MODEL& model, const T_ULSI_ROW& row);
