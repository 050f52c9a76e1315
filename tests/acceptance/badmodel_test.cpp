// Bad model files through the program, and files that can't be changed.
#include "program.h"

#include <fcntl.h>
#include <regex>
#include <sys/file.h>
#include <unistd.h>

namespace fs = std::filesystem;

namespace {

/// A folder with the model of the small case in "m.qmdb".
class BadModel : public CProgramTest {
protected:
    BadModel()
    {
        const CTempFolder other;
        WriteText(other / "case.json", kSmallCase);
        Done("import " + other / "case.json" + " m.qmdb");
        m_good = Text("m.qmdb");
    }
    /// Info, evaluate and export refuse the bytes with one line that names the file and holds one
    /// of the words of `reason`, a regular expression.
    void ExpectBad(const std::string& bytes, const std::string& reason) const
    {
        Write("m.qmdb", bytes);
        for (const char* line :
             {"info m.qmdb", "evaluate m.qmdb --json o.json", "export m.qmdb o.json"}) {
            const std::string err = ExpectRefused(line, 3, "m.qmdb");
            EXPECT_TRUE(std::regex_search(err, std::regex(reason))) << line << reason << err;
            EXPECT_EQ(bytes, Text("m.qmdb")) << line;
            EXPECT_EQ(std::vector<std::string>{"m.qmdb"}, m_folder.Names()) << line;
        }
    }

    std::string m_good;
};

TEST_F(BadModel, SaysWhatIsWrongWithTheFile)
{
    ASSERT_GT(m_good.size(), 4096U);
    ExpectBad("", "empty");
    for (const std::size_t size : {std::size_t{40}, std::size_t{4096}, m_good.size() - 1})
        ExpectBad(m_good.substr(0, size), "truncated|cut|incomplete|shorter");
    ExpectBad("Dear Sir or Madam, ...\n", "no model|not a model");
    const auto with = [&](std::size_t at, char byte) {
        return m_good.substr(0, at) + byte + m_good.substr(at + 1);
    };
    ExpectBad(with(68, 'x'), "another|other"); // application id of a SQLite file
    ExpectBad(with(63, 99), "newer");          // low byte of the user version
    const auto title = m_good.find("small frame");
    ASSERT_NE(std::string::npos, title);
    ExpectBad(with(title, 'r'), "damaged"); // one bit of a record
}

TEST_F(BadModel, AFullDiskLeavesNoHalfResult)
{
    for (const std::string option : {"--json", "--report", "--curve"}) {
        // No file may grow to more than 512 bytes.
        const T_RUN run = Run("evaluate m.qmdb --no-store " + option + " o", "ulimit -f 1; ");
        EXPECT_EQ(4, run.code) << option << run.err;
        EXPECT_EQ(1U, Lines(run.err).size()) << option << run.err;
        EXPECT_EQ(std::vector<std::string>{"m.qmdb"}, m_folder.Names()) << option;
    }
}

TEST_F(BadModel, AFileThatIsOpenElsewhereIsNotReplaced)
{
    // Another process that edits the model holds this lock.
    const int held = open((m_folder / "m.qmdb").c_str(), O_RDWR | O_CLOEXEC);
    ASSERT_GE(held, 0);
    ASSERT_EQ(0, flock(held, LOCK_EX | LOCK_NB));
    Write("case.json", With(kSmallCase, "small frame", "another frame"));
    ExpectRefused("import case.json m.qmdb --overwrite", 4, "open");
    EXPECT_EQ(m_good, Text("m.qmdb"));
    Done("evaluate m.qmdb --no-store"); // reading is free
    close(held);
    Done("import case.json m.qmdb --overwrite");
}

TEST_F(BadModel, AReadOnlyFileInAReadOnlyFolderIsEvaluated)
{
    const std::string results = Done("evaluate m.qmdb --json -");
    fs::permissions(m_folder / "m.qmdb", fs::perms::owner_read);
    fs::permissions(m_folder.Path(), fs::perms::owner_read | fs::perms::owner_exec);
    // Without this right root, too, is held by the mode of files and folders.
    const std::string held = geteuid() == 0 ? "setpriv --bounding-set=-dac_override " : "";
    const T_RUN refused = Run("export m.qmdb o.json", held);
    EXPECT_EQ(4, refused.code) << "the folder must be closed for this test to mean something";
    const T_RUN run = Run("evaluate m.qmdb --json -", held);
    EXPECT_EQ(0, run.code) << run.err;
    EXPECT_EQ(results, run.out);
    EXPECT_EQ("", run.err);
    EXPECT_EQ(0, Run("info m.qmdb --check", held).code);
    EXPECT_EQ(m_good, Text("m.qmdb"));
    EXPECT_EQ(std::vector<std::string>{"m.qmdb"}, m_folder.Names());
}

} // namespace
