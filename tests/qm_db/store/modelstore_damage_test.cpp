#include "modelstoresample.h"
#include "qm_base/msgfunction.h"
#include "qm_db/modelstore.h"
#include "qm_db/store/modelreader.h"
#include "qm_db/store/resultblocks.h"
#include "qm_db/store/sqlitedb.h"

#include <cstring>
#include <fcntl.h>
#include <filesystem>
#include <gtest/gtest.h>
#include <limits>
#include <unistd.h>

namespace fs = std::filesystem;
using zql::lib::MMSGFunction;

namespace {

class ModelStoreDamage : public testing::Test {
protected:
    void SetUp() override { Save(RichContent()); }

    void Save(const T_MODEL_CONTENT& content)
    {
        ASSERT_EQ(1, CModelStore().Save(m_path, content, m_error)) << m_error.text;
        m_bytes = BytesOf(m_path);
    }
    /// Opens what is at the path; m_error and m_content tell how it went.
    int Open()
    {
        m_content = {};
        return CModelStore().Open(m_path, OPEN_MODE::ReadOnly, m_content, m_error);
    }
    /// The file is refused as bad input with one line that names it; nothing came out.
    void ExpectRefused(const std::string& label)
    {
        EXPECT_EQ(0, Open()) << label;
        EXPECT_EQ(FILE_FAULT::BadInput, m_error.fault) << label;
        EXPECT_NE(std::string::npos, m_error.text.find(m_path)) << m_error.text;
        EXPECT_EQ(std::string::npos, m_error.text.find('\n')) << m_error.text;
        EXPECT_EQ(T_MODEL{}, m_content.model) << label;
        EXPECT_EQ(0, CModelStore::CheckWhole(m_path, m_error)) << label;
    }
    std::string Message(const char* key, const std::string& second = {},
                        const std::string& third = {}) const
    {
        return MMSGFunction::Format(key, {m_path, second, third});
    }
    /// Changes one byte of the file in place.
    void Poke(std::size_t at, char byte)
    {
        const int file = ::open(m_path.c_str(), O_WRONLY);
        EXPECT_EQ(1, ::pwrite(file, &byte, 1, static_cast<off_t>(at)));
        ::close(file);
    }

    CTempFolder m_folder;
    std::string m_path = m_folder.File("frame.qmdb");
    std::string m_bytes;
    T_FILE_ERROR m_error;
    T_MODEL_CONTENT m_content;
};

char Flipped(char byte, std::size_t bit)
{
    return static_cast<char>(byte ^ (1 << bit));
}

/// Position of the packed number in the file.
std::size_t Find(const std::string& bytes, double value)
{
    std::string packed(sizeof value, '\0');
    std::memcpy(packed.data(), &value, sizeof value);
    return bytes.find(packed);
}

TEST_F(ModelStoreDamage, OneFlippedBitIsFoundOrChangesNothing)
{
    const T_MODEL_CONTENT original = RichContent();
    const std::size_t stride = m_bytes.size() / 2500 | 1;
    int found = 0;
    int harmless = 0; // unused bytes of a page
    for (std::size_t at = 0; at < m_bytes.size(); at += stride) {
        Poke(at, Flipped(m_bytes[at], at / stride % 8));
        if (!Open()) {
            ++found;
            EXPECT_NE(std::string::npos, m_error.text.find(m_path)) << at;
        } else {
            ++harmless;
            EXPECT_TRUE(SameContent(original, m_content)) << "byte " << at;
        }
        Poke(at, m_bytes[at]);
    }
    EXPECT_GT(found, 100);
    EXPECT_GT(harmless, 100);
    EXPECT_EQ(1, Open()) << m_error.text;
}

TEST_F(ModelStoreDamage, CutFilesAreRefused)
{
    const auto size = static_cast<std::int64_t>(m_bytes.size());
    for (std::int64_t length = 1; length < size; length += length < 120 ? 7 : 997) {
        WriteBytes(m_path, m_bytes.substr(0, static_cast<std::size_t>(length)));
        ExpectRefused("length " + std::to_string(length));
        const std::string whole = std::to_string(length < 100 ? 100 : size);
        if (length >= 16) {
            EXPECT_EQ(Message("IDS_QM_DB_FILE_TRUNCATED", std::to_string(length), whole),
                      m_error.text);
        }
    }
    WriteBytes(m_path, m_bytes + std::string(4096, '\0'));
    ExpectRefused("longer");
}

TEST_F(ModelStoreDamage, OtherTablesUnderOurMarkAreRefused)
{
    constexpr const char* kReversed = "UPDATE result_blocks SET step = step + 10 WHERE part = 3;"
                                      "UPDATE result_blocks SET step = 12 - step WHERE part = 3";
    constexpr const char* kNan = "UPDATE arrays SET data = x'000000000000F87F000000000000F03F' "
                                 "WHERE owner = 'spectra' AND key = 10 AND name = 'Sa'";
    constexpr const char* kTrigger =
        "CREATE TRIGGER t AFTER INSERT ON modes BEGIN DELETE FROM modes; END";
    const struct {
        const char* label;
        const char* sql;
        bool sumsToo; // refused even with new checksums
    } cases[] = {
        {"table missing", "DROP TABLE result_blocks", false},
        {"another table", "CREATE TABLE extra(a)", true},
        {"a trigger", kTrigger, true},
        {"record missing", "DELETE FROM evaluations WHERE key = 2", false},
        {"node places missing", "DELETE FROM arrays WHERE owner = 'nodes' AND name = 'xyz'", true},
        {"not a number", kNan, true},
        {"block missing", "DELETE FROM result_blocks WHERE part = 3 AND step = 1", true},
        {"blocks without a head", "DELETE FROM results WHERE key = 3", true},
        {"blocks reversed", kReversed, true},
        {"unknown unit", "UPDATE model SET force_unit = 'stone'", true},
        {"sum missing", "DELETE FROM checksums WHERE name = 'modes'", false},
        {"a text that is no record's", "UPDATE model SET body = '{\"x\": 1}'", true},
        {"a text that is no JSON", "UPDATE model SET body = '{'", true},
        {"a version without a way up", "PRAGMA user_version = 0", true},
        {"an old version with new columns", "PRAGMA user_version = 1", true},
        {"a node key twice",
         "UPDATE arrays SET data = x'010000000100000007000000' "
         "WHERE owner = 'nodes' AND name = 'id'",
         true},
        {"more steps than bytes", "UPDATE results SET steps = 1000000000 WHERE key = 1", true},
        {"more nodes than bytes",
         "INSERT INTO static_results VALUES(1, 2000000000, 2000000000, 0, 0)", true},
    };
    for (const auto& c : cases) {
        WriteBytes(m_path, m_bytes);
        CSqliteDb::OpenForWriting(m_path).Exec(c.sql);
        ExpectRefused(c.label);
        if (c.sumsToo) WriteChecksums(CSqliteDb::OpenForWriting(m_path));
        ExpectRefused(c.label);
    }
}

/// Right checksums do not make a value right: what a case file refuses is refused here, by name.
TEST_F(ModelStoreDamage, ValuesThatBreakTheRulesOfTheirRecordAreRefused)
{
    const struct {
        const char* sql;
        const char* place; // and the reason, where there is room for two
    } cases[] = {
        {"UPDATE pushovers SET direction = 7 WHERE key = 1", "pushovers 1 direction"},
        {"UPDATE pushovers SET direction = 0 WHERE key = 1", "pushovers 1 direction"},
        {"UPDATE pushovers SET direction = -2 WHERE key = 1", "pushovers 1 direction"},
        {"UPDATE pushovers SET direction = 1000000 WHERE key = 1", "pushovers 1 direction"},
        {"UPDATE pushovers SET pattern_kind = 9 WHERE key = 1", "pushovers 1 pattern_kind"},
        {"DELETE FROM arrays WHERE owner = 'spectra' AND key = 9",
         "spectra 9 T: a spectrum needs at least 2 points"},
        {"DELETE FROM arrays WHERE owner = 'spectra' AND key = 9 AND name = 'Sa'",
         "spectra 9 Sa: 0 values, expected 3"},
        {"UPDATE spectra SET soil = 'Q' WHERE key = 3", "spectra 3 soil: unknown soil \"Q\""},
        {"UPDATE spectra SET Ca = 0 WHERE key = 1", "spectra 1 Ca: "},
        {"UPDATE spectra SET Ca = 9e999 WHERE key = 1", "spectra 1 Ca"},
        {"UPDATE spectra SET Ca = 1.1e100 WHERE key = 1", "spectra 1 Ca: a value is too large"},
        {"UPDATE spectra SET name = 'D1' WHERE key = 2", "spectra 2 name: \"D1\" appears twice"},
        {"UPDATE evaluations SET procedure = 'Z' WHERE key = 2", "evaluations 2 procedure: "},
        {"UPDATE evaluations SET bilinear_rule = 'x' WHERE key = 2",
         "evaluations 2 bilinear.rule: "},
        {"UPDATE evaluations SET plot_type = 99 WHERE key = 2", "evaluations 2 plotType: "},
        {"UPDATE storeys SET height = 0 WHERE key = 1", "storeys 1 height: "},
        {"UPDATE storeys SET name = '' WHERE key = 1", "storeys 1 name: a name can't be empty"},
        {"UPDATE modes SET period = -1 WHERE key = 1", "modes 1 period: "},
        {"UPDATE arrays SET data = x'FDFFFFFF0200000007000000' "
         "WHERE owner = 'nodes' AND name = 'id'",
         "nodes -3 id: "},
    };
    for (const auto& c : cases) {
        WriteBytes(m_path, m_bytes);
        CSqliteDb::OpenForWriting(m_path).Exec(c.sql);
        WriteChecksums(CSqliteDb::OpenForWriting(m_path));
        ExpectRefused(c.sql);
        EXPECT_NE(std::string::npos, m_error.text.find(c.place)) << m_error.text;
    }
}

TEST_F(ModelStoreDamage, ARecordThatWouldNotOpenAgainIsNotSaved)
{
    T_MODEL_CONTENT content = RichContent();
    content.model.storeys[1].height = -1.0;
    EXPECT_EQ(0, CModelStore().Save(m_path, content, m_error));
    EXPECT_NE(std::string::npos, m_error.text.find("not saved: storeys 1 height: "))
        << m_error.text;
    EXPECT_EQ(m_bytes, BytesOf(m_path));
}

TEST_F(ModelStoreDamage, BlocksOfNumbersThatAreNotFiniteAreRefused)
{
    constexpr double kInf = std::numeric_limits<double>::infinity();
    for (const double bad : {kInf, -kInf, std::numeric_limits<double>::quiet_NaN()}) {
        WriteBytes(m_path, m_bytes);
        const CSqliteDb db = CSqliteDb::OpenForWriting(m_path);
        db.Exec("DELETE FROM result_blocks WHERE pushover = 1 AND part = 1");
        const double values[] = {100.0, bad, 1.0};
        CBlockWriter(db).Write({1, BLOCK_PART::BaseReaction}, std::span<const double>(values));
        WriteChecksums(db);
        ExpectRefused("a block with " + std::to_string(bad));
    }
}

/// What SQLite would run while our own statements read the table "modes".
TEST_F(ModelStoreDamage, ASchemaThatRunsExpressionsIsRefusedInEveryVersion)
{
    constexpr const char* kEndless =
        "CREATE VIEW modes(key, period, negative_zeros) AS WITH RECURSIVE "
        "n(i) AS (SELECT 1 UNION ALL SELECT i + 1 FROM n) SELECT i, 1.0, 0 FROM n";
    const std::string files[] = {m_path, QM_TEST_DATA "/model-v1.qmdb",
                                 QM_TEST_DATA "/model-v2.qmdb", QM_TEST_DATA "/model-v3.qmdb",
                                 QM_TEST_DATA "/model-v4.qmdb"};
    for (const std::string& file : files) {
        WriteBytes(m_path, file == m_path ? m_bytes : BytesOf(file));
        ASSERT_EQ(1, Open()) << m_error.text;
        const CSqliteDb db = CSqliteDb::OpenForWriting(m_path);
        db.Exec("DROP TABLE modes");
        db.Exec(kEndless);
        ExpectRefused(file);
        EXPECT_EQ(
            Message("IDS_QM_DB_FILE_DAMAGED", MMSGFunction::GetValue("IDS_QM_DB_DAMAGE_SCHEMA")),
            m_error.text);
    }
}

/// A name in "checksums" is not part of a statement.
TEST_F(ModelStoreDamage, NamesOfChecksumsAreNotRun)
{
    WriteBytes(m_path, BytesOf(QM_TEST_DATA "/model-v1.qmdb"));
    CSqliteDb::OpenForWriting(m_path).Exec("INSERT INTO checksums VALUES('(WITH RECURSIVE n(key) "
                                           "AS (SELECT 1 UNION ALL SELECT key + 1 "
                                           "FROM n) SELECT key FROM n)', 0)");
    EXPECT_EQ(1, Open()) << m_error.text;
}

/// Written by the program when it knew version 1 only, with one byte changed.
TEST_F(ModelStoreDamage, DamageInAFileOfAnOlderVersionIsRefused)
{
    m_bytes = BytesOf(QM_TEST_DATA "/model-v1.qmdb");
    m_bytes[m_bytes.find("PX")] ^= 1;
    WriteBytes(m_path, m_bytes);
    ExpectRefused("version 1");
}

/// A journal of that name is no business of ours: replaying it would change or refuse the file.
TEST_F(ModelStoreDamage, JournalBesideTheFileIsLeftAlone)
{
    const std::string journal = "\xd9\xd5\x05\xf9\x20\xa1\x63\xd7" + std::string(1016, '\1');
    WriteBytes(m_path + "-journal", journal);
    ASSERT_EQ(1, Open()) << m_error.text;
    EXPECT_TRUE(SameContent(RichContent(), m_content));
    EXPECT_TRUE(journal == BytesOf(m_path + "-journal"));
}

/// Over 16 MiB: blocks are checked when they are read, and only those that are read.
TEST_F(ModelStoreDamage, LargeFilesCheckABlockWhenItIsRead)
{
    constexpr int kSteps = 2300;
    Save(GridContent(1024, kSteps)); // two chunks: nodes 10 ... 5120 and 5130 ... 10240
    ASSERT_GT(m_bytes.size(), std::size_t{16} << 20);
    const std::size_t at = Find(m_bytes, SampleDisplacement(7770, 1234));
    ASSERT_NE(std::string::npos, at);
    Poke(at, Flipped(m_bytes[at], 3));

    ASSERT_EQ(1, Open()) << m_error.text;
    IPushResult& result = *m_content.results.at(1);
    std::vector<double> series{1.0};
    ASSERT_EQ(1, result.ReadDisplacements(5120, series)) << result.Error();
    EXPECT_EQ(SampleDisplacement(5120, kSteps - 1), series.back());
    EXPECT_EQ("", result.Error());
    EXPECT_EQ(0, result.ReadDisplacements(5130, series)); // shares the damaged block
    EXPECT_TRUE(series.empty());
    const std::string block = MMSGFunction::Format(
        "IDS_QM_DB_DAMAGE_BLOCK",
        {"1", MMSGFunction::GetValue("IDS_QM_DB_PART_DISPLACEMENTS"), "2", "1235"});
    const std::string damage = Message("IDS_QM_DB_FILE_DAMAGED", block);
    EXPECT_EQ(damage, result.Error());
    ASSERT_EQ(1, result.ReadDisplacements(10, series));
    EXPECT_EQ(0, CModelStore::CheckWhole(m_path, m_error));
    EXPECT_EQ(damage, m_error.text);

    // Saving such results is refused; no half copy stays, here or under another name.
    const std::string copy = m_folder.File("copy.qmdb");
    EXPECT_EQ(0, CModelStore().Save(copy, m_content, m_error));
    EXPECT_EQ(FILE_FAULT::BadInput, m_error.fault);
    EXPECT_NE(std::string::npos, m_error.text.find(damage));
    EXPECT_EQ(0, CModelStore().Save(m_path, m_content, m_error));
    EXPECT_EQ(std::vector<std::string>{"frame.qmdb"}, m_folder.Names());
    EXPECT_EQ(m_bytes.size(), fs::file_size(m_path));
}

} // namespace
