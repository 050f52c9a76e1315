#include "qm_db/store/modelschema.h"

#include "qm_base/msgfunction.h"
#include "qm_db/file/storefault.h"
#include "qm_db/store/sqlitedb.h"
#include "qm_db/store/sqlitestmt.h"

#include <algorithm>
#include <vector>

namespace {

// Tables that came with version 2. Nested records are text: "body" is the record's object in the
// case file, in SI, without its key and name. Elements and generated hinges are in "arrays".
constexpr const char* kMaterials =
    "CREATE TABLE materials(key INTEGER PRIMARY KEY, name TEXT NOT NULL, body TEXT NOT NULL, "
    "negative_zeros INTEGER NOT NULL) STRICT";
constexpr const char* kSections =
    "CREATE TABLE sections(key INTEGER PRIMARY KEY, name TEXT NOT NULL, body TEXT NOT NULL, "
    "negative_zeros INTEGER NOT NULL) STRICT";
constexpr const char* kHingeTypes =
    "CREATE TABLE hinge_types(key INTEGER PRIMARY KEY, name TEXT NOT NULL, body TEXT NOT NULL, "
    "negative_zeros INTEGER NOT NULL) STRICT";
constexpr const char* kInelasticHinges =
    "CREATE TABLE inelastic_hinges(key INTEGER PRIMARY KEY, name TEXT NOT NULL, "
    "body TEXT NOT NULL, negative_zeros INTEGER NOT NULL) STRICT";
constexpr const char* kIncrementFunctions =
    "CREATE TABLE increment_functions(key INTEGER PRIMARY KEY, name TEXT NOT NULL, "
    "negative_zeros INTEGER NOT NULL) STRICT";

// Tables that came with version 3.
constexpr const char* kVersion3[] = {
    "CREATE TABLE diaphragms(key INTEGER PRIMARY KEY, body TEXT NOT NULL, "
    "negative_zeros INTEGER NOT NULL) STRICT",
    "CREATE TABLE equal_displacements(key INTEGER PRIMARY KEY, body TEXT NOT NULL, "
    "negative_zeros INTEGER NOT NULL) STRICT",
    "CREATE TABLE load_cases(key INTEGER PRIMARY KEY, name TEXT NOT NULL, body TEXT NOT NULL, "
    "negative_zeros INTEGER NOT NULL) STRICT",
    "CREATE TABLE combinations(key INTEGER PRIMARY KEY, name TEXT NOT NULL, body TEXT NOT NULL, "
    "negative_zeros INTEGER NOT NULL) STRICT",
    "CREATE TABLE ulf_constraints(key INTEGER PRIMARY KEY, name TEXT NOT NULL, "
    "body TEXT NOT NULL, negative_zeros INTEGER NOT NULL) STRICT",
    "CREATE TABLE ulf_items(key INTEGER PRIMARY KEY, name TEXT NOT NULL, body TEXT NOT NULL, "
    "negative_zeros INTEGER NOT NULL) STRICT",
    "CREATE TABLE static_results(key INTEGER PRIMARY KEY, nodes INTEGER NOT NULL, "
    "elements INTEGER NOT NULL, fingerprint INTEGER NOT NULL, "
    "negative_zeros INTEGER NOT NULL) STRICT"};

// Tables that came with version 4.
constexpr const char* kVersion4[] = {
    "CREATE TABLE stages(key INTEGER PRIMARY KEY, name TEXT NOT NULL, body TEXT NOT NULL, "
    "negative_zeros INTEGER NOT NULL) STRICT",
    "CREATE TABLE ulf_stage_items(key INTEGER PRIMARY KEY, name TEXT NOT NULL, "
    "body TEXT NOT NULL, negative_zeros INTEGER NOT NULL) STRICT",
    "CREATE TABLE staged_results(key INTEGER PRIMARY KEY, stage INTEGER NOT NULL, "
    "step INTEGER NOT NULL, load_case INTEGER NOT NULL, load_group INTEGER NOT NULL, "
    "nodes INTEGER NOT NULL, elements INTEGER NOT NULL, fingerprint INTEGER NOT NULL, "
    "negative_zeros INTEGER NOT NULL) STRICT"};

// Tables that came with version 5.
constexpr const char* kVersion5[] = {
    "CREATE TABLE push_results(key INTEGER PRIMARY KEY, pushover INTEGER NOT NULL, "
    "turn INTEGER NOT NULL, angle REAL NOT NULL, control_x REAL NOT NULL, "
    "control_y REAL NOT NULL, control_z REAL NOT NULL, control_rx REAL NOT NULL, "
    "control_ry REAL NOT NULL, control_rz REAL NOT NULL, nodes INTEGER NOT NULL, "
    "hinges INTEGER NOT NULL, steps INTEGER NOT NULL, events INTEGER NOT NULL, "
    "turns INTEGER NOT NULL, start_reaction REAL NOT NULL, outcome TEXT NOT NULL, end_stage "
    "INTEGER NOT NULL, "
    "end_load_factor REAL NOT NULL, end_displacement REAL NOT NULL, "
    "end_element INTEGER NOT NULL, structure_print INTEGER NOT NULL, "
    "hinge_print INTEGER NOT NULL, load_print INTEGER NOT NULL, setup_print INTEGER NOT NULL, "
    "negative_zeros INTEGER NOT NULL, end_hinge INTEGER NOT NULL, end_storey INTEGER NOT NULL) "
    "STRICT"};

// Scalars are typed columns, quantities in SI. Bit i of negative_zeros says that the i-th column
// of the row is -0.0: a REAL column stores a whole number as an integer, which has no such value.
// Every list of numbers (node ids, coordinates, mode shapes, spectrum tables) is a row of "arrays":
// `count` numbers of `width` bytes, 'i' integers or 'f' IEEE floating point numbers, packed.
// A change here is a new schema version and a migration.
constexpr const char* kTables[] = {
    "CREATE TABLE model(key INTEGER PRIMARY KEY, title TEXT NOT NULL, force_unit TEXT NOT NULL, "
    "length_unit TEXT NOT NULL, gravity REAL, negative_zeros INTEGER NOT NULL, "
    "concrete_code TEXT, steel_code TEXT, alternative_hysteresis INTEGER NOT NULL, "
    "wall_strength_degradation INTEGER NOT NULL, gsd INTEGER NOT NULL, plane INTEGER, body TEXT) "
    "STRICT",

    "CREATE TABLE storeys(key INTEGER PRIMARY KEY, name TEXT NOT NULL, height REAL NOT NULL, "
    "negative_zeros INTEGER NOT NULL) STRICT",

    "CREATE TABLE modes(key INTEGER PRIMARY KEY, period REAL NOT NULL, "
    "negative_zeros INTEGER NOT NULL) STRICT",

    "CREATE TABLE spectra(key INTEGER PRIMARY KEY, name TEXT NOT NULL, kind TEXT NOT NULL, "
    "Ca REAL, Cv REAL, floors INTEGER, type INTEGER, soil TEXT, topography INTEGER, ag REAL, "
    "damping REAL, S REAL, TB REAL, TC REAL, TD REAL, "
    "SLO_ag REAL, SLO_F0 REAL, SLO_TCstar REAL, SLD_ag REAL, SLD_F0 REAL, SLD_TCstar REAL, "
    "SLV_ag REAL, SLV_F0 REAL, SLV_TCstar REAL, SLC_ag REAL, SLC_F0 REAL, SLC_TCstar REAL, "
    "gravity REAL, negative_zeros INTEGER NOT NULL) STRICT",

    "CREATE TABLE pushovers(key INTEGER PRIMARY KEY, name TEXT NOT NULL, "
    "control_node INTEGER NOT NULL, direction INTEGER NOT NULL, pattern_kind INTEGER NOT NULL, "
    "negative_zeros INTEGER NOT NULL, body TEXT) STRICT",

    "CREATE TABLE evaluations(key INTEGER PRIMARY KEY, name TEXT NOT NULL, push TEXT NOT NULL, "
    "method INTEGER NOT NULL, procedure TEXT, spectrum TEXT NOT NULL, behavior INTEGER, "
    "elastic_damping REAL, eigen_factors INTEGER, masonry INTEGER, drift_kind INTEGER, "
    "plot_type INTEGER, alpha_in_percent INTEGER, has_bilinear INTEGER NOT NULL, "
    "bilinear_rule TEXT, bilinear_secant REAL, bilinear_drop REAL, bilinear_iterate INTEGER, "
    "negative_zeros INTEGER NOT NULL) STRICT",

    "CREATE TABLE limit_state_steps(key INTEGER PRIMARY KEY, "
    "negative_zeros INTEGER NOT NULL) STRICT",

    "CREATE TABLE arrays(owner TEXT NOT NULL, key INTEGER NOT NULL, name TEXT NOT NULL, "
    "kind TEXT NOT NULL, count INTEGER NOT NULL, width INTEGER NOT NULL, "
    "byte_order TEXT NOT NULL, data BLOB NOT NULL, PRIMARY KEY(owner, key, name)) "
    "STRICT, WITHOUT ROWID",

    "CREATE TABLE results(key INTEGER PRIMARY KEY, steps INTEGER NOT NULL, "
    "nodes INTEGER NOT NULL, negative_zeros INTEGER NOT NULL) STRICT",

    // part: 0 load factors, 1 base reactions, 2 ids of 512 nodes, 3 displacements of 512 nodes in
    // one step; of static results 4 ids of 512 nodes, 5 ids of 512 elements, 6 displacements and
    // 7 reactions of the nodes, 8 forces of the elements. pushover is the key of the load case,
    // of a static one from part 4 on. chunk and step count from 0 and are 0 where they mean
    // nothing; step of a result of construction stages is its key in staged_results, from 1. Of
    // runs of a push, whose key in push_results stands in pushover: 9 node ids, 10 components of
    // hinges, 11 steps, 12 events, 13 turns of hinges in them; by step 14 displacements of 80
    // nodes, 15 states of 128 components; 16 displacements of all nodes before the first step.
    "CREATE TABLE result_blocks(pushover INTEGER NOT NULL, part INTEGER NOT NULL, "
    "chunk INTEGER NOT NULL, step INTEGER NOT NULL, count INTEGER NOT NULL, "
    "width INTEGER NOT NULL, byte_order TEXT NOT NULL, checksum INTEGER NOT NULL, "
    "data BLOB NOT NULL, PRIMARY KEY(pushover, part, chunk, step)) STRICT, WITHOUT ROWID",

    "CREATE TABLE checksums(name TEXT PRIMARY KEY, value INTEGER NOT NULL) STRICT, WITHOUT ROWID",

    kMaterials, kSections, kHingeTypes, kInelasticHinges, kIncrementFunctions};

constexpr std::size_t kHingeTables = 5; // at the end of kTables; they came with version 2

/// Columns that a later version added to a table of kTables.
struct T_ADDED_COLUMN {
    int since;
    const char* table; // how its statement begins
    const char* column;
};
constexpr T_ADDED_COLUMN kAddedColumns[] = {
    {2, "CREATE TABLE model(", "concrete_code TEXT"},
    {2, "CREATE TABLE model(", "steel_code TEXT"},
    {2, "CREATE TABLE model(", "alternative_hysteresis INTEGER NOT NULL"},
    {2, "CREATE TABLE model(", "wall_strength_degradation INTEGER NOT NULL"},
    {2, "CREATE TABLE model(", "gsd INTEGER NOT NULL"},
    {2, "CREATE TABLE pushovers(", "body TEXT"},
    {3, "CREATE TABLE model(", "plane INTEGER"},
    {4, "CREATE TABLE model(", "body TEXT"},
    {6, "CREATE TABLE push_results(", "end_hinge INTEGER NOT NULL"},
    {6, "CREATE TABLE push_results(", "end_storey INTEGER NOT NULL"},
};

constexpr T_MEMBER_PLACE kMemberPlaces[] = {
    {"model", "force", MEMBER_PLACE::Column, "force_unit"},
    {"model", "length", MEMBER_PLACE::Column, "length_unit"},
    {"model", "concrete", MEMBER_PLACE::Column, "concrete_code"},
    {"model", "steel", MEMBER_PLACE::Column, "steel_code"},
    {"nodes", "id", MEMBER_PLACE::Packed, "id"},
    {"nodes", "xyz", MEMBER_PLACE::Packed, "xyz"},
    {"nodes", "mass", MEMBER_PLACE::Packed, "mass"},
    {"nodes", "restraint", MEMBER_PLACE::Packed, "restraint"},
    {"storeys", "nodes", MEMBER_PLACE::List, "nodes"},
    {"modes", "shape", MEMBER_PLACE::List, "shape"},
    {"modes", "participation", MEMBER_PLACE::List, "participation"},
    {"modes", "mass_percent", MEMBER_PLACE::List, "mass_percent"},
    {"elements", "id", MEMBER_PLACE::Packed, "data"},
    {"elements", "nodes", MEMBER_PLACE::Packed, "data"},
    {"elements", "section", MEMBER_PLACE::Packed, "data"},
    {"elements", "material", MEMBER_PLACE::Packed, "data"},
    {"elements", "member", MEMBER_PLACE::Packed, "data"},
    {"elements", "kind", MEMBER_PLACE::Packed, "kind"},
    {"elements", "release", MEMBER_PLACE::Packed, "release"},
    {"elements", "z_axis", MEMBER_PLACE::Packed, "z_axis"},
    {"elements", "offset", MEMBER_PLACE::Packed, "offset"},
    {"elements", "stiffness", MEMBER_PLACE::Packed, "stiffness"},
    {"hinges", "element", MEMBER_PLACE::Packed, "refs"},
    {"hinges", "hinge_type", MEMBER_PLACE::Packed, "refs"},
    {"hinges", "crack", MEMBER_PLACE::Packed, "crack"},
    {"hinges", "yield", MEMBER_PLACE::Packed, "yield"},
    {"hinges", "crack_J", MEMBER_PLACE::Packed, "crack_J"},
    {"hinges", "yield_J", MEMBER_PLACE::Packed, "yield_J"},
    {"increment_functions", "step", MEMBER_PLACE::List, "step"},
    {"increment_functions", "factor", MEMBER_PLACE::List, "factor"},
    {"spectra", "SLO", MEMBER_PLACE::Part, "SLO"},
    {"spectra", "SLD", MEMBER_PLACE::Part, "SLD"},
    {"spectra", "SLV", MEMBER_PLACE::Part, "SLV"},
    {"spectra", "SLC", MEMBER_PLACE::Part, "SLC"},
    {"spectra", "TC*", MEMBER_PLACE::Column, "TCstar"},
    {"spectra", "T", MEMBER_PLACE::List, "T"},
    {"spectra", "Sa", MEMBER_PLACE::List, "Sa"},
    {"pushovers", "pattern", MEMBER_PLACE::Part, "pattern"},
    {"pushovers", "modes", MEMBER_PLACE::List, "modes"},
    {"limit_state_steps", "EC8", MEMBER_PLACE::List, "ec8"},
    {"limit_state_steps", "NTC", MEMBER_PLACE::List, "ntc"},
    {"evaluations", "user_damping", MEMBER_PLACE::List, "user_damping"},
    {"evaluations", "bilinear", MEMBER_PLACE::Part, "bilinear"},
};

/// Version 1 had no hinges and no load cases that are still to be run.
void MigrateFrom1(const CSqliteDb& db)
{
    db.Exec("ALTER TABLE model ADD COLUMN concrete_code TEXT;"
            "ALTER TABLE model ADD COLUMN steel_code TEXT;"
            "ALTER TABLE model ADD COLUMN alternative_hysteresis INTEGER NOT NULL DEFAULT 0;"
            "ALTER TABLE model ADD COLUMN wall_strength_degradation INTEGER NOT NULL DEFAULT 0;"
            "ALTER TABLE model ADD COLUMN gsd INTEGER NOT NULL DEFAULT 0;"
            "ALTER TABLE pushovers ADD COLUMN body TEXT");
    for (const char* const sql :
         {kMaterials, kSections, kHingeTypes, kInelasticHinges, kIncrementFunctions})
        db.Exec(sql);
}

/// Version 2 had neither loads nor static results, and beams without ends of their own.
void MigrateFrom2(const CSqliteDb& db)
{
    db.Exec("ALTER TABLE model ADD COLUMN plane INTEGER");
    for (const char* const sql : kVersion3)
        db.Exec(sql);
}

/// Version 3 had no construction stages. The body of the model is their control.
void MigrateFrom3(const CSqliteDb& db)
{
    db.Exec("ALTER TABLE model ADD COLUMN body TEXT");
    for (const char* const sql : kVersion4)
        db.Exec(sql);
}

/// Tables of a version, in the order in which it makes them.
std::vector<std::string> TablesOf(int version)
{
    std::vector<std::string> all(std::begin(kTables), std::end(kTables));
    if (version == 1) all.resize(all.size() - kHingeTables);
    if (version >= 3) all.insert(all.end(), std::begin(kVersion3), std::end(kVersion3));
    if (version >= 4) all.insert(all.end(), std::begin(kVersion4), std::end(kVersion4));
    if (version >= 5) all.insert(all.end(), std::begin(kVersion5), std::end(kVersion5));
    for (const T_ADDED_COLUMN& added : kAddedColumns) {
        if (version >= added.since) continue;
        const std::string text = std::string(", ") + added.column;
        for (std::string& sql : all) {
            const auto at = sql.starts_with(added.table) ? sql.find(text) : sql.npos;
            if (at != sql.npos) sql.erase(at, text.size());
        }
    }
    return all;
}

/// Version 4 had no results of a push of our own.
void MigrateFrom4(const CSqliteDb& db)
{
    const std::vector<std::string> all = TablesOf(5);
    for (std::size_t i = TablesOf(4).size(); i < all.size(); ++i)
        db.Exec(all[i]);
}

/// Version 5 did not know which end of an element, or which storey, had ended a push.
void MigrateFrom5(const CSqliteDb& db)
{
    db.Exec("ALTER TABLE push_results ADD COLUMN end_hinge INTEGER NOT NULL DEFAULT 0;"
            "ALTER TABLE push_results ADD COLUMN end_storey INTEGER NOT NULL DEFAULT 0");
}

} // namespace

std::span<const T_MEMBER_PLACE> MemberPlaces()
{
    return kMemberPlaces;
}

const T_SCHEMA& CurrentSchema()
{
    static constexpr T_MIGRATION kMigrations[] = {{1, MigrateFrom1},
                                                  {2, MigrateFrom2},
                                                  {3, MigrateFrom3},
                                                  {4, MigrateFrom4},
                                                  {5, MigrateFrom5}};
    static constexpr T_SCHEMA kSchema{6, kMigrations};
    return kSchema;
}

void CreateSchema(const CSqliteDb& db)
{
    for (const std::string& sql : TablesOf(CurrentSchema().version))
        db.Exec(sql);
    db.Exec("PRAGMA application_id = " + std::to_string(kModelApplicationId));
    db.Exec("PRAGMA user_version = " + std::to_string(CurrentSchema().version));
}

void CheckSchema(const CSqliteDb& db, int version)
{
    CSqliteStmt stmt(db, "SELECT type, sql FROM sqlite_schema ORDER BY rowid");
    const std::vector<std::string> tables = TablesOf(version);
    std::size_t count = 0;
    bool same = true;
    while (same && stmt.Step()) {
        same = count < tables.size() && stmt.Text(0) == "table" && stmt.Text(1) == tables[count];
        ++count;
    }
    if (!same || count != tables.size())
        ThrowDamaged(zql::lib::MMSGFunction::GetValue("IDS_QM_DB_DAMAGE_SCHEMA"));
}

bool CanMigrate(int from, const T_SCHEMA& schema)
{
    for (int version = from; version < schema.version; ++version)
        if (std::ranges::find(schema.migrations, version, &T_MIGRATION::from) ==
            schema.migrations.end())
            return false;
    return true;
}

void Migrate(const CSqliteDb& db, int from, const T_SCHEMA& schema)
{
    for (int version = from; version < schema.version; ++version)
        std::ranges::find(schema.migrations, version, &T_MIGRATION::from)->up(db);
}
