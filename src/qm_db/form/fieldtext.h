// What a person types for a member, as JSON; and what hangs together in an object.
#pragma once

#include "qm_db/form/anyrecord.h"

/// The value of a row without rows below it, of numbers in SI or as they are. "": done; else what
/// is wrong with the text.
std::string ValueOfText(const T_MODEL& model, const T_FIELD_ROW& row, const std::string& text,
                        bool toSi, T_JSON& out);
/// A list, a group, or what has no row: JSON, or values with commas between them, ids also "5-9".
std::string PartOfText(const std::optional<T_FIELD_ROW>& row, const std::string& text, T_JSON& out);

/// Takes the members away in whose place the one at the path stands.
void DropOthers(RECORD_KIND kind, const std::string& path, T_JSON& object);
/// The list that has as many items as the one at the path; empty: it stands alone.
std::string TwinOf(const std::string& path, const T_JSON& object);
/// Items of the list at the path.
std::size_t CountAt(const T_JSON& object, const std::string& path);
/// A value that goes on what the list has, or that stands in for a node. False: nothing is left
/// to choose.
bool NewValue(const T_MODEL& model, const T_FIELD_ROW& list, T_JSON& out);
/// The first node that the table at the path does not have.
std::string FreeNode(const T_MODEL& model, const T_JSON& object, const std::string& path);
/// "element 4, combination \"C1\"", the first ones of many.
std::string UsersText(const T_MODEL& model, const T_RECORD_USERS& users);
