#include "modelstoresample.h"
#include "qm_base/msgfunction.h"
#include "qm_db/modelstore.h"
#include "qm_db/store/modelreader.h"
#include "qm_db/store/sqlitedb.h"

#include <cstring>
#include <fcntl.h>
#include <filesystem>
#include <gtest/gtest.h>
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
    };
    for (const auto& c : cases) {
        WriteBytes(m_path, m_bytes);
        CSqliteDb::OpenForWriting(m_path).Exec(c.sql);
        ExpectRefused(c.label);
        if (c.sumsToo) WriteChecksums(CSqliteDb::OpenForWriting(m_path));
        ExpectRefused(c.label);
    }
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
