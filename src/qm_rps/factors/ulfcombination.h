// Load combinations: flattened, and made from solved load factors.
#pragma once

#include "qm_db/dbdoc.h"

#include <map>
#include <optional>

/// A combination as load cases with factors; empty: it is gone, or contains itself.
std::optional<T_LCOM_D> FlatCombination(const CDataCtrl& data, int key);

/// Combinations to add: one, or several parts and a master that refers to them.
struct T_ULF_COMBINATION_PLAN {
    std::vector<T_LCOM_D> parts;
    bool split = false; // the parts are collected in a master combination
};

/// n entries make n / 999 + 1 combinations. One: every factor is replaced by the load case's
/// factor. Several, named "name-1", "name-2" ... with at most 999 entries each: every factor is
/// multiplied by the load case's factor. factors: by key of the load case.
T_ULF_COMBINATION_PLAN PlanUlfCombinations(const std::string& name, const T_LCOM_D& normalised,
                                           const std::map<int, double>& factors);

/// Adds them to the document, each addition reported in the message history; parts after one that
/// was refused are still added. One edit that can be undone. 1 all added; 0 not all.
[[nodiscard]] int AddUlfCombinations(CDBDoc& doc, const std::string& name,
                                     const T_ULF_COMBINATION_PLAN& plan);
