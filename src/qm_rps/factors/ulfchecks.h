// Rules of unknown load factor items and constraints: everything that is wrong with a record.
#pragma once

#include "qm_base/ruletable.h"
#include "qm_db/records.h"

#include <optional>

inline constexpr const char* kUlfConstraintError =
    "IDS_RPS_UNKNOWN_LOAD_FACTOR_CONSTRAINT_INPUT_ERROR";
inline constexpr const char* kUlfItemError = "IDS_RPS_UNKNOWN_LOAD_FACTOR_INPUT_ERROR";

/// Rules that a constraint does not keep, in the order of the dialog's check. ownKey: its key in
/// the model, 0 for a new one. In `text`, names and numbers are filled in.
std::vector<T_FINDING> CheckUlfConstraint(const T_ULFC_D& constraint, int ownKey,
                                          const T_MODEL& model);

/// Rules that an item does not keep, its own first, then those of the constraints it names (field
/// "constraints[NAME].id"). Its name is also that of no construction-stage item. cases: its
/// combination flattened to load cases; nullopt where that can't be had.
std::vector<T_FINDING> CheckUlfItem(const T_ULFI_D& item, int ownKey, const T_MODEL& model,
                                    const std::optional<std::vector<T_LCOM_ITEM>>& cases);

/// Appends what the model's constraint of that name does not keep, field "constraints[NAME].id";
/// nothing where there is none.
void AddConstraintFindings(const std::string& name, const T_MODEL& model,
                           std::vector<T_FINDING>& out);

/// Key of the constraint of that name; 0: none.
int FindUlfConstraint(const T_MODEL& model, const std::string& name);
