// A record of any kind by value, in SI, and what the form does with it.
#pragma once

#include "qm_db/casefile/jsonvalue.h"
#include "qm_db/editscope.h"
#include "qm_db/recordform.h"

template <class... R>
std::variant<std::monostate, T_STYP_D, T_POGC_D, R...> AnyOf(const std::tuple<T_RECORD_ROW<R>...>&);
using T_ANY_RECORD = decltype(AnyOf(kRecords));

/// What a record is read and printed beside: the model that it belongs to, and its key (0: new).
struct T_FORM_PLACE {
    const T_MODEL& model;
    int key = 0;
};

/// monostate: there is none.
T_ANY_RECORD FindAny(const T_MODEL& model, RECORD_KIND kind, int key);
/// A blank one.
T_ANY_RECORD BlankAny(RECORD_KIND kind);

/// The record as an object of a case file in these units. 0: it refers to what is missing.
[[nodiscard]] int PrintAny(const T_FORM_PLACE& place, const T_ANY_RECORD& record,
                           const T_UNITS& units, T_JSON& out, std::string& reason);
/// Reads the object back by the rules of a case file. `record` has the kind; 0: it stays.
[[nodiscard]] int ReadAny(const T_FORM_PLACE& place, T_JSON object, const T_UNITS& units,
                          T_ANY_RECORD& record, std::string& reason);
/// The rows of a record; texts are those of its object.
std::vector<T_FIELD_ROW> ListAny(const T_MODEL& model, const T_ANY_RECORD& record,
                                 const T_JSON& object, std::size_t mostItems);
/// A new item of the list at the path, or the part that is left out there, in SI. 0: there is
/// nothing to add; with a reason where it must refer to what has to be made first.
[[nodiscard]] int NewPart(const T_MODEL& model, const T_ANY_RECORD& record, const std::string& path,
                          T_JSON& out, std::string& reason);
/// Sets the choice at the path and gives what depends on it its defaults. False: no such choice.
bool TurnAny(T_ANY_RECORD& record, const std::string& path, const std::string& choice);
/// References that a record must have and that are blank are set to the first record of their
/// kind. Gives the kind of which there is none.
std::optional<RECORD_KIND> FillAny(const T_MODEL& model, T_ANY_RECORD& record);
/// "Make a material first", in words.
std::string NeedsFirst(RECORD_KIND kind);
/// Default values that keep the rules of the kind.
void PresetAny(const T_MODEL& model, int key, T_ANY_RECORD& record);

/// The name of a record; null where it has none.
std::string* NameIn(T_ANY_RECORD& record);
/// The id of a node or an element, which is its key; null of other kinds.
int* IdIn(T_ANY_RECORD& record);
/// Puts it into the open step. 0: refused.
[[nodiscard]] int PutAny(CDBDoc& doc, CEditScope& edit, int key, const T_ANY_RECORD& record);
