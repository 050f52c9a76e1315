// Storing and deleting one named record, each as an edit of its own that can be undone.
#pragma once

#include "qm_db/editscope.h"

/// key: of the record in the model; 0 for a new one, which gets its key. 1 stored; 0 refused, the
/// model and the key as they were.
template <class T>
[[nodiscard]] int StoreRecord(CDBDoc& doc, int& key, const T& record)
{
    const int used = key ? key : NextKey(TableOf<T>(doc.Data().Model()));
    CEditScope edit(doc, record.name);
    if (!edit.Put(used, record) || !edit.Commit()) return 0;
    key = used;
    return 1;
}

/// Of a record that is there. 1 deleted, and its key 0; 0 refused: others refer to it.
template <class T>
[[nodiscard]] int DeleteRecord(CDBDoc& doc, int& key)
{
    CEditScope edit(doc, TableOf<T>(doc.Data().Model()).at(key).name);
    if (!edit.Erase<T>(key) || !edit.Commit()) return 0;
    key = 0;
    return 1;
}
