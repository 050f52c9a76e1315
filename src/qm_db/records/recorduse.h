// Which records refer to a record: what would be left dangling if it were deleted.
#pragma once

#include "qm_db/records.h"

#include <string>
#include <vector>

enum class RECORD_KIND {
    Element,
    Diaphragm,
    EqualDisplacement,
    LoadCase,
    Combination,
    UlfItem,
    Storey,
    Hinge,
    HingeType,
    Pushover,
    UlfConstraint,
    Stage,
    UlfStageItem,
    Evaluation
};

struct T_RECORD_USER {
    RECORD_KIND kind = RECORD_KIND::Element;
    int key = 0; // of the record that refers
    bool operator==(const T_RECORD_USER&) const = default;
};
using T_RECORD_USERS = std::vector<T_RECORD_USER>;

/// The users of a record of type T: kind by kind, keys ascending, each once. Constraints of unknown
/// load factors may refer to nodes and elements that are not there; they do not count.
template <class T>
T_RECORD_USERS UsersOf(const T_MODEL&, int)
{
    return {};
}
template <>
T_RECORD_USERS UsersOf<T_NODE_D>(const T_MODEL& model, int id);
template <>
T_RECORD_USERS UsersOf<T_ELEM_D>(const T_MODEL& model, int id);
template <>
T_RECORD_USERS UsersOf<T_MATL_D>(const T_MODEL& model, int key);
template <>
T_RECORD_USERS UsersOf<T_SECT_D>(const T_MODEL& model, int key);
template <>
T_RECORD_USERS UsersOf<T_STLD_D>(const T_MODEL& model, int key);
template <>
T_RECORD_USERS UsersOf<T_LCOM_D>(const T_MODEL& model, int key);
template <>
T_RECORD_USERS UsersOf<T_STAG_D>(const T_MODEL& model, int key);
template <>
T_RECORD_USERS UsersOf<T_PHGT_D>(const T_MODEL& model, int key);

/// Evaluations name their spectrum and load case, items their constraints.
template <>
T_RECORD_USERS UsersOf<T_SPFC_D>(const T_MODEL& model, int key);
template <>
T_RECORD_USERS UsersOf<T_POLC_D>(const T_MODEL& model, int key);
template <>
T_RECORD_USERS UsersOf<T_ULFC_D>(const T_MODEL& model, int key);

/// "element 4"; "combination \"C1\"" for what has a name.
std::string DescribeUser(const T_MODEL& model, const T_RECORD_USER& user);
