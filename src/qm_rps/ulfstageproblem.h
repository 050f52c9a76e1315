// From a construction-stage item and its constraints to the optimizer's records, and its rules.
#pragma once

#include "qm_db/records.h"
#include "qm_rps/hingefindings.h"
#include "qm_rps/optdsgn.h"

/// The problem of an item, with the way back from its records to rows and constraints.
struct T_ULF_STAGE_FORMED {
    T_OPT_PROBLEM problem;
    std::vector<int> loads;            // optimizer item -> key of its load case
    std::vector<std::size_t> owner;    // record -> constraint
    std::vector<std::size_t> unknowns; // unknown -> row of the item
};

/// Records of the rows and constraints; a constraint that names a stage and step is read there.
/// Known rows with a factor of 0 are left out: the optimizer would take them for unknown ones.
T_ULF_STAGE_FORMED FormUlfStageProblem(const T_ULSI_D& item, std::span<const T_ULFC_D> constraints);

/// Load cases whose pretension an unknown row scales: its own one where the row reads its own
/// result, else all that act at its stage and step. None of a row without the pretension flag.
std::vector<int> LoadsScaledBy(const T_MODEL& model, const T_ULSI_ROW& row);

/// Rules that an item does not keep, in the order of the dialog's check: its own first, then those
/// of the constraints that it names. ownKey: its key in the model, 0 for a new one.
std::vector<T_FINDING> CheckUlfStageItem(const T_ULSI_D& item, int ownKey, const T_MODEL& model);
