// A model file with right checksums and any values is refused in one line, or gives a model that
// keeps its rules and results that can be read. The input is a program of edits of a small model
// file: each takes a table, a row, a column and a value; all checksums are computed anew. An input
// that begins with "SQLite format 3" is a file of its own.
#include "fuzzcheck.h"
#include "qm_db/casefile.h"
#include "qm_db/records/modelfault.h"
#include "qm_db/store/modelreader.h"
#include "qm_db/store/resultblocks.h"
#include "qm_db/store/sqlitedb.h"
#include "qm_db/store/sqlitestmt.h"

#include <cmath>
#include <cstring>
#include <fstream>
#include <limits>
#include <unistd.h>

namespace {

// A model with something in most tables.
constexpr const char* kCase = R"({"format": "qm-rps case 1", "title": "t",
"units": {"force": "kN", "length": "m"}, "plane": "XZ", "gravity": 9.81,
"nodes": [{"id": 1, "xyz": [0, 0, 0], "restraint": [1, 1, 1, 1, 1, 1]},
 {"id": 2, "xyz": [0, 0, 3], "mass": [10, 10, 10]}],
"storeys": [{"name": "1F", "height": 3, "nodes": [2]}],
"modes": [{"period": 0.5, "shape": {"1": [0, 0, 0, 0, 0, 0], "2": [1, 0, 0, 0, 0, 0]},
 "participation": [1, 0, 0, 0, 0, 0], "mass_percent": [90, 0, 0, 0, 0, 0]}],
"materials": [{"name": "S", "type": "steel", "E": 210000000, "nu": 0.3, "density": 7.85}],
"sections": [{"name": "B", "A": 0.03, "J": 1e-5, "Iy": 0.003, "Iz": 0.0001}],
"elements": [{"id": 1, "nodes": [1, 2], "material": "S", "section": "B", "z_axis": [1, 0, 0]}],
"load_cases": [{"name": "G", "self_weight": [0, 0, -1],
 "nodal": [{"node": 2, "load": [1, 0, 0, 0, 0, 0]}]}],
"combinations": [{"name": "C", "items": [{"case": "G", "factor": 1}]}],
"stages": [{"name": "S1", "activate": {"elements": [1], "supports": [1]}}],
"ulf_constraints": [{"name": "D", "type": "displacement", "id": 2, "component": "DX", "equal": 0}],
"ulf_items": [{"name": "I", "combination": "C", "objective": "square", "unknown": [{"case": "G"}],
 "constraints": ["D"]}],
"increment_functions": [{"name": "F", "step": [0, 1], "factor": [0, 1]}],
"spectra": [{"name": "A", "kind": "atc40", "Ca": 0.4, "Cv": 0.6},
 {"name": "U", "kind": "user", "T": [0, 1], "Sa": [1, 1]},
 {"name": "E", "kind": "ec8-2004", "type": 1, "soil": "B", "ag": 0.3}],
"pushover": [{"name": "P", "control_node": 2, "direction": "DX", "pattern": {"kind": "static"},
 "steps": {"load_factor": [1, 2], "base_reaction": [10, 15], "displacement": {"2": [0.01, 0.02]}},
 "limit_state_steps": {"EC8": [1, 2, -2]}}],
"evaluations": [{"name": "V", "push": "P", "method": "ATC-40", "procedure": "A",
 "spectrum": "A"}]})";

constexpr const char* kTables[] = {"model",          "storeys",         "modes",
                                   "spectra",        "pushovers",       "evaluations",
                                   "arrays",         "results",         "materials",
                                   "load_cases",     "result_blocks",   "stages",
                                   "sections",       "ulf_constraints", "limit_state_steps",
                                   "static_results", "staged_results",  "increment_functions"};

class CBytes {
public:
    CBytes(const std::uint8_t* data, std::size_t size) : m_data(data), m_left(size) {}
    bool IsEmpty() const { return m_left == 0; }
    std::uint8_t Byte()
    {
        if (m_left == 0) return 0;
        --m_left;
        return *m_data++;
    }
    std::string Text(std::size_t length)
    {
        std::string text;
        while (text.size() < length && m_left > 0)
            text += static_cast<char>(Byte());
        return text;
    }
    template <class T>
    T Number()
    {
        T value{};
        const std::string bytes = Text(sizeof value);
        std::memcpy(&value, bytes.data(), bytes.size());
        return value;
    }

private:
    const std::uint8_t* m_data;
    std::size_t m_left;
};

std::string PathOf(const char* what)
{
    const char* const folder = access("/dev/shm", W_OK) == 0 ? "/dev/shm" : "/tmp";
    return std::string(folder) + "/qm-fuzz-" + what + '-' + std::to_string(getpid()) + ".qmdb";
}

std::string ReadAll(const std::string& path)
{
    std::ifstream file(path, std::ios::binary);
    return {std::istreambuf_iterator<char>(file), {}};
}

void WriteAll(const std::string& path, std::string_view bytes)
{
    std::ofstream file(path, std::ios::binary | std::ios::trunc);
    file.write(bytes.data(), static_cast<std::streamsize>(bytes.size()));
}

/// The file that the edits start from.
const std::string& BaseFile()
{
    static const std::string bytes = [] {
        T_MODEL_CONTENT content;
        T_FILE_ERROR error;
        Expect(CCaseFile::Parse(kCase, "case.json", "/nowhere", content, error) != 0,
               "the sample is a case", error.text);
        const std::string path = PathOf("base");
        Expect(CModelStore().Save(path, content, error) != 0, "the sample is saved", error.text);
        const std::string all = ReadAll(path);
        unlink(path.c_str());
        return all;
    }();
    return bytes;
}

/// A number that readers may stumble over, or any.
std::int64_t Whole(CBytes& in)
{
    constexpr std::int64_t kOften[] = {0,
                                       -1,
                                       -2,
                                       1,
                                       2,
                                       7,
                                       9,
                                       1000000,
                                       2147483647,
                                       -2147483648LL,
                                       4294967297LL,
                                       std::numeric_limits<std::int64_t>::max(),
                                       std::numeric_limits<std::int64_t>::min()};
    const std::uint8_t which = in.Byte();
    if (which < std::size(kOften)) return kOften[which];
    return which < 128 ? which : in.Number<std::int64_t>();
}

void BindValue(CSqliteStmt& update, CBytes& in, std::string& bytes)
{
    const std::uint8_t kind = in.Byte() % 6;
    if (kind == 0) return update.BindNull(1);
    if (kind == 1) return update.Bind(1, Whole(in));
    if (kind == 2) return update.Bind(1, in.Number<double>());
    bytes = in.Text(kind == 5 ? 200 : in.Byte() % 64U);
    if (kind == 3)
        return update.Bind(
            1, std::span(reinterpret_cast<const std::byte*>(bytes.data()), bytes.size()));
    update.Bind(1, std::string_view(bytes));
}

/// One edit; what the table's own conditions refuse is left.
void Edit(const CSqliteDb& db, CBytes& in)
{
    const std::string table = kTables[in.Byte() % std::size(kTables)];
    const int row = in.Byte() % 16;
    std::string column;
    {
        const CSqliteStmt columns(db, "SELECT * FROM " + table);
        column = columns.ColumnName(in.Byte() % columns.ColumnCount());
    }
    if (table == "result_blocks" && column == "data") { // with a sum of its own
        const double values[] = {in.Number<double>(), in.Number<double>()};
        const int part = in.Byte() & 1;
        db.Exec("DELETE FROM result_blocks WHERE pushover = 1 AND part = " + std::to_string(part));
        return CBlockWriter(db).Write({1, static_cast<BLOCK_PART>(part)},
                                      std::span<const double>(values));
    }
    const bool isPlain = table != "arrays" && table != "result_blocks"; // has a row number
    const std::string key = isPlain             ? "key"
                            : table == "arrays" ? "owner || key || name"
                                                : "part * 1000 + chunk + step";
    CSqliteStmt update(db, "UPDATE " + table + " SET " + column + " = ?1 WHERE " + key +
                               " = (SELECT " + key + " FROM " + table + " LIMIT 1 OFFSET " +
                               std::to_string(row) + ')');
    std::string bytes;
    BindValue(update, in, bytes);
    update.Run();
}

void ReadEverything(const T_MODEL_CONTENT& content)
{
    const std::string fault = ModelFault(content.model);
    Expect(fault.empty(), "what opens keeps its rules", fault);
    for (const auto& [key, result] : content.results) {
        T_PUSH_DATA data;
        std::string error;
        if (!ReadWholeResult(*result, data, error)) ExpectOneLine(error);
        for (const double value : data.baseReaction)
            Expect(std::isfinite(value), "results are finite");
    }
    const auto readRun = [](IPushResult& result) {
        T_RUN_DATA data;
        std::string error;
        std::vector<T_DOF6> moves;
        std::vector<T_RUN_STATE> states;
        IPushRun* const run = result.Run();
        if (!run) return;
        if (!ReadWholeRun(*run, data, error)) ExpectOneLine(error);
        for (const int node : data.nodes)
            Expect(run->ReadNode(node, moves), "a node that is listed is read");
        for (std::size_t i = 0; i < data.hinges.size(); ++i)
            Expect(run->ReadHinge(i, states), "a hinge that is listed is read");
    };
    for (const auto& [key, result] : content.results)
        readRun(*result);
    for (const auto& [key, result] : content.turnedResults)
        readRun(*result);
    for (const auto& [key, result] : content.staticResults) {
        T_STATIC_DATA data;
        if (!result->ReadAll(data)) ExpectOneLine(result->Error());
    }
    std::string text;
    T_FILE_ERROR error;
    if (!CCaseFile::Print(content, text, error)) ExpectOneLine(error.text);
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    const std::string path = PathOf("file");
    const bool isFile = TextOf(data, size).starts_with("SQLite format 3");
    WriteAll(path, isFile ? TextOf(data, size) : std::string_view(BaseFile()));
    try {
        const CSqliteDb db = CSqliteDb::OpenForWriting(path);
        db.Exec("PRAGMA cache_size = -4000; BEGIN");
        CBytes in(data, isFile ? 0 : size);
        while (!in.IsEmpty()) {
            try {
                Edit(db, in);
            } catch (const std::exception&) {
            }
        }
        WriteChecksums(db);
        db.Exec("COMMIT");
    } catch (const std::exception&) { // a file that can't even be summed
    }
    T_MODEL_CONTENT content;
    T_FILE_ERROR error;
    if (CModelStore().Open(path, OPEN_MODE::ReadOnly, content, error))
        ReadEverything(content);
    else
        ExpectOneLine(error.text);
    content = {};
    unlink(path.c_str());
    return 0;
}
