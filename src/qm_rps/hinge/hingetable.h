// Hinge types, generated hinges and the elements for them, as windows and commands take them from a
// document: in its current units. Each edit is one undoable step.
#pragma once

#include "qm_db/dbdoc.h"

#include <optional>
#include <vector>

/// All by key.
T_TABLE<T_PHGT_D> HingeTypesOf(CDBDoc& doc);
T_TABLE<T_PHGE_D> HingesOf(CDBDoc& doc);

/// Adds or replaces a type. 1 stored; 0 refused, nothing changed.
[[nodiscard]] int StoreHingeType(CDBDoc& doc, int key, const T_PHGT_D& type);
/// 1 deleted; 0 it does not exist or, a type, elements have hinges of it.
[[nodiscard]] int EraseHingeType(CDBDoc& doc, int key);
[[nodiscard]] int EraseHinge(CDBDoc& doc, int key);

/// What hinges an element can have, walls as beam-columns; none: it does not exist.
std::optional<HINGE_ELEMENT> HingeElementOf(CDBDoc& doc, int element);
/// Elements that hinges of a type of this kind can be for, ascending.
std::vector<int> ElementsForHinges(CDBDoc& doc, HINGE_ELEMENT kind);

/// Section and material of an element; null what it lacks.
struct T_YIELD_CALC_ELEM {
    std::optional<T_SECT_D> section;
    std::optional<T_MATL_D> material;
};
T_YIELD_CALC_ELEM YieldCalcElemOf(CDBDoc& doc, int element);
