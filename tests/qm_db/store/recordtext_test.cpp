#include "qm_db/store/recordcodecfields.h"

#include "modelstoresample.h"
#include "qm_db/file/checksum.h"
#include "qm_db/file/storefault.h"
#include "qm_db/store/sqlitedb.h"

#include <gtest/gtest.h>

namespace {

constexpr const char* kTable = "later"; // one that the schema does not have

template <class R>
void Put(const T_TABLE<R>& records, CPackedArrays& arrays)
{
    const CTablePlaces places{std::string_view(kTable)};
    for (const auto& [key, record] : records) {
        CRecordRow row(kTable, key);
        CRowPut put(row, arrays, places);
        RowFields(put, record);
    }
}

template <class R>
T_TABLE<R> Get(const CPackedArrays& arrays)
{
    const CTablePlaces places{std::string_view(kTable)};
    T_TABLE<R> records;
    for (const std::int64_t key : arrays.Keys(TextOwner(kTable))) {
        const CRecordRow row(kTable, key);
        CRowGet get(row, arrays, places);
        RowFields(get, records[static_cast<int>(key)]);
    }
    return records;
}

/// The arrays as a model file gives them back.
CPackedArrays ThroughFile(const CPackedArrays& arrays)
{
    const CTempFolder folder;
    const std::string path = folder.File("later.qmdb");
    WriteBytes(path, "");
    const CSqliteDb db = CSqliteDb::OpenForWriting(path);
    CreateSchema(db);
    arrays.Write(db);
    CChecksum sum;
    return CPackedArrays::Read(db, sum, "nodes", [](const CPackedArrays&, std::int64_t) {});
}

template <class R>
void ExpectSame(const T_TABLE<R>& records)
{
    CPackedArrays arrays;
    Put(records, arrays);
    EXPECT_EQ(records, Get<R>(ThroughFile(arrays))) << RowOf<R>().store;
}

} // namespace

// What a later version adds to a record, or as a kind of record, needs no column.
TEST(RecordText, MembersWithoutAColumnAreKeptAsText)
{
    const T_MODEL model = RichContent().model;
    ExpectSame(model.evaluations);
    ExpectSame(model.spectra);
    ExpectSame(model.pushovers);
    ExpectSame(model.nodes);
    ExpectSame(T_TABLE<T_DIAP_D>{{1, {{1, 2}, 1}}});
}

TEST(RecordText, ATextThatIsNotTheRecordsIsDamage)
{
    for (const char* const text : {"{", "{\"name\": \"E\"}", "[]"}) {
        CPackedArrays arrays;
        arrays.Put(TextOwner(kTable), 1, "body", std::string_view(text));
        EXPECT_THROW(Get<T_EVAL_D>(arrays), CStoreFault) << text;
    }
}
