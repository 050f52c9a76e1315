// From an unknown load factor item and its constraints to the optimizer's records.
#pragma once

#include "qm_db/records.h"
#include "qm_rps/factors/optproblem.h"

/// A load case of the item's combination.
struct T_ULF_CASE {
    int key = 0;
    std::string name;
    double factor = 0.0; // in the combination; that of a known case
    bool unknown = false;
    double weight = 1.0; // of an unknown case
    bool operator==(const T_ULF_CASE&) const = default;
};

/// Key, known factor (0 of an unknown case), weight (1 of a known case), 0.
T_OPT_ITEM UlfItemRecord(const T_ULF_CASE& loadCase);

/// One record of an equality or a single bound; two of an inequality with both bounds, first the
/// upper, then the lower one; none of an inequality without bounds.
std::vector<T_OPT_RECORD> UlfConstraintRecords(const T_ULFC_D& constraint);

/// The problem of an item, with the way back from its records to constraints and cases.
struct T_ULF_FORMED {
    T_OPT_PROBLEM problem;
    std::vector<std::size_t> owner;    // record -> constraint
    std::vector<std::size_t> unknowns; // unknown -> load case
};

/// item gives objective, sign and the way of solving. Known cases with a factor of 0 have no part
/// in the problem and are left out: the optimizer would take them for unknown ones.
T_ULF_FORMED FormUlfProblem(const T_ULFI_D& item, std::span<const T_ULF_CASE> cases,
                            std::span<const T_ULFC_D> constraints);

/// The influence matrix of the constraints: for each the response of every load case at factor 1
/// (first place minus second place of a compared one). 1 done; 0 see source.Error().
[[nodiscard]] int ReadUlfInfluence(std::span<const T_ULF_CASE> cases,
                                   std::span<const T_ULFC_D> constraints, IUlfResponse& source,
                                   std::vector<std::vector<double>>& influence);
