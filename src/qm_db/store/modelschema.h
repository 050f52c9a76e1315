// Tables of the model file, its marks, and the way up from older versions.
#pragma once

#include <array>
#include <cstdint>
#include <span>
#include <string>
#include <string_view>

class CSqliteDb;

/// In the SQLite header: whose database it is.
inline constexpr std::uint32_t kModelApplicationId = 0x716D6462; // "qmdb"

/// Brings a database from schema version `from` to `from` + 1. May throw CStoreFault.
struct T_MIGRATION {
    int from;
    void (*up)(const CSqliteDb& db);
};

struct T_SCHEMA {
    int version;                             // what this program writes
    std::span<const T_MIGRATION> migrations; // any order; one per older version that can be read
};

/// Tables with a checksum of their own, in the order of writing. "sqlite_schema" (the text of the
/// schema itself) is summed too; result_blocks is summed without the data, which have their own.
inline constexpr std::array<const char*, 25> kModelTables{"model",
                                                          "storeys",
                                                          "modes",
                                                          "spectra",
                                                          "pushovers",
                                                          "evaluations",
                                                          "limit_state_steps",
                                                          "materials",
                                                          "sections",
                                                          "hinge_types",
                                                          "arrays",
                                                          "results",
                                                          "inelastic_hinges",
                                                          "increment_functions",
                                                          "diaphragms",
                                                          "equal_displacements",
                                                          "load_cases",
                                                          "combinations",
                                                          "ulf_constraints",
                                                          "ulf_items",
                                                          "static_results",
                                                          "stages",
                                                          "ulf_stage_items",
                                                          "staged_results",
                                                          "push_results"};

/// Where a member of a record stands: in a column of another name; as a list in "arrays"; packed
/// with those of all records; as a part whose members have the columns name_member, with has_name
/// where nothing else tells whether it is there.
enum class MEMBER_PLACE { Column, List, Packed, Part };
struct T_MEMBER_PLACE {
    std::string_view table, member; // as in the case file
    MEMBER_PLACE place;
    const char* name;
};
/// Members that are not here stand in the column of their name where there is one, else in the text
/// of the record: an object of a case file, in SI.
std::span<const T_MEMBER_PLACE> MemberPlaces();

inline constexpr const char* kBlockTable = "result_blocks";
inline constexpr const char* kSumTable = "checksums";

const T_SCHEMA& CurrentSchema();

/// Makes the tables of the current version and sets application id and version.
void CreateSchema(const CSqliteDb& db);

/// Throws "damaged" unless the schema is, statement by statement, that of the version: no view, no
/// trigger, no index, no column that would run an expression of the file's when it is read.
void CheckSchema(const CSqliteDb& db, int version);

/// Whether there is a step up from that version and from each one after it.
bool CanMigrate(int from, const T_SCHEMA& schema);
/// Walks the database up to the schema's version; CanMigrate() has been asked.
void Migrate(const CSqliteDb& db, int from, const T_SCHEMA& schema);
