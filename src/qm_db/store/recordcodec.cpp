#include "qm_db/store/recordcodec.h"

#include "qm_db/file/checksum.h"
#include "qm_db/file/storefault.h"
#include "qm_db/store/recordcodecfields.h"
#include "qm_db/store/recordcodecpacked.h"

#include <algorithm>

namespace {

constexpr const char* kModel = "model";                  // its one record has the key 1
constexpr const char* kPushControl = "pushover_control"; // likewise; text alone

/// Records that share packed lists, and have no row.
template <class R>
constexpr bool kIsPacked = kIsAnyOf<R, T_NODE_D, T_ELEM_D, T_PHGE_D>;

bool HasTable(std::string_view name)
{
    return std::ranges::find(kModelTables, name) != kModelTables.end();
}

template <class R>
void WriteRow(const CSqliteDb& db, const CTablePlaces& places, const char* table, int key,
              const R& record, CPackedArrays& arrays)
{
    CRecordRow row(table, key);
    CRowPut put(row, arrays, places);
    RowFields(put, record);
    row.Insert(db);
}

/// What has neither a row nor packed lists: a text for each record that has something to say.
template <class R>
void WriteTexts(const T_RECORD_ROW<R>& kind, const T_MODEL& model, CPackedArrays& arrays)
{
    const CTablePlaces places(std::string_view(kind.store));
    for (const auto& [key, record] : model.*kind.table) {
        CRecordRow row(kind.store, key);
        CRowPut put(row, arrays, places);
        RowFields(put, record);
    }
}

void WritePushControl(const T_MODEL& model, CPackedArrays& arrays)
{
    if (model.pushControl == T_POGC_D()) return;
    CRecordRow row(kPushControl, 1);
    const CTablePlaces places{std::string_view(kPushControl)};
    CRowPut put(row, arrays, places);
    RowFields(put, model.pushControl);
}

template <class R>
void WriteRows(const CSqliteDb& db, const T_RECORD_ROW<R>& kind, const T_MODEL& model,
               CPackedArrays& arrays)
{
    const CTablePlaces places(db, kind.store);
    for (const auto& [key, record] : model.*kind.table)
        WriteRow(db, places, kind.store, key, record, arrays);
}

template <class R>
void ReadTexts(const T_RECORD_ROW<R>& kind, const CPackedArrays& arrays, T_MODEL& model)
{
    const CTablePlaces places(std::string_view(kind.store));
    T_TABLE<R>& table = model.*kind.table;
    for (const std::int64_t key : arrays.Keys(TextOwner(kind.store))) {
        const CRecordRow row(kind.store, key);
        if (key != static_cast<int>(key)) row.ThrowBadCell("key");
        const bool isNew = table.try_emplace(static_cast<int>(key)).second;
        if (isNew == kIsPacked<R>) row.ThrowBadCell("key");
        CRowGet get(row, arrays, places);
        RowFields(get, table.at(static_cast<int>(key)));
    }
}

void ReadPushControl(const CPackedArrays& arrays, T_MODEL& model)
{
    const CTablePlaces places{std::string_view(kPushControl)};
    for (const std::int64_t key : arrays.Keys(TextOwner(kPushControl))) {
        const CRecordRow row(kPushControl, key);
        if (key != 1) row.ThrowBadCell("key");
        CRowGet get(row, arrays, places);
        RowFields(get, model.pushControl);
    }
}

template <class R>
T_TABLE<R> ReadRows(const CSqliteDb& db, const char* table, const CPackedArrays& arrays,
                    T_TABLE_SUMS& sums)
{
    T_TABLE<R> records;
    CChecksum sum;
    const CTablePlaces places(db, table);
    for (const CRecordRow& row : CRecordRow::ReadAll(db, table, sum)) {
        const auto key = static_cast<int>(row.Key());
        if (key != row.Key()) row.ThrowBadCell("key");
        CRowGet get(row, arrays, places);
        RowFields(get, records[key]);
    }
    sums[table] = sum.Value();
    return records;
}

} // namespace

void WriteModel(const CSqliteDb& db, const T_MODEL& model)
{
    CPackedArrays arrays;
    PutNodes(model.nodes, arrays);
    PutElements(model.elements, arrays);
    PutHinges(model.hinges, arrays);
    WriteRow(db, CTablePlaces(db, kModel), kModel, 1, model.styp, arrays);
    for (const std::string_view table : kModelTables) // in the order of the schema
        ForEachKind([&](const auto& kind) {
            if (kind.store == table) WriteRows(db, kind, model, arrays);
        });
    ForEachKind([&](const auto& kind) {
        if (!HasTable(kind.store)) WriteTexts(kind, model, arrays);
    });
    WritePushControl(model, arrays);
    arrays.Write(db);
}

T_MODEL ReadModel(const CSqliteDb& db, T_TABLE_SUMS& sums)
{
    T_MODEL model;
    CChecksum arraySum;
    const CPackedArrays arrays = CPackedArrays::Read(
        db, arraySum, kNodes, [&](const CPackedArrays& some, std::int64_t chunk) {
            GetNodeChunk(some, chunk, model.nodes);
        });
    sums["arrays"] = arraySum.Value();

    const T_TABLE<T_STYP_D> styp = ReadRows<T_STYP_D>(db, kModel, arrays, sums);
    if (styp.size() != 1 || styp.begin()->first != 1) ThrowDamaged(kModel);
    model.styp = styp.begin()->second;
    for (const std::string_view table : kModelTables)
        ForEachKind([&]<class R>(const T_RECORD_ROW<R>& kind) {
            if (kind.store == table) model.*kind.table = ReadRows<R>(db, kind.store, arrays, sums);
        });
    GetElements(arrays, model.elements);
    GetHinges(arrays, model.hinges);
    ForEachKind([&](const auto& kind) {
        if (!HasTable(kind.store)) ReadTexts(kind, arrays, model);
    });
    ReadPushControl(arrays, model);
    return model;
}
