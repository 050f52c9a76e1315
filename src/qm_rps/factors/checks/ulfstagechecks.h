// What an item of construction stages reads twice, not at all, or where nothing stands.
#pragma once

#include "qm_base/finding.h"
#include "qm_db/datactrl.h"

#include <vector>

/// Constraints of the item that can't be read: their stage is gone, or none is named while the rows
/// stand at several; the node, support or element does not stand there and would read 0. Field
/// "constraints[NAME].stage" or ".id".
std::vector<T_FINDING> CheckUlfConstraintPlaces(const T_ULSI_D& item, const T_MODEL& model);

/// Appends what was found about a constraint, with its name in front of the rule.
void AppendNamed(const std::string& item, const std::string& constraint,
                 std::vector<T_FINDING> found, std::vector<T_FINDING>& out);

/// Number from 1 of another row whose results contain those of this row, so that they would count
/// twice; 0: none. An unknown that an iteration does not scale may add to what a sum contains: its
/// factor is an increment.
std::size_t RowThatCounts(const T_ULSI_D& item, std::size_t row, const T_MODEL& model);

/// What a calculation goes by and the analysed structure does not: unknowns that an iteration never
/// applies, known factors other than 1, loads that no row reads.
std::vector<T_FINDING> UlfStageItemWarnings(const T_ULSI_D& item, const CDataCtrl& data);
