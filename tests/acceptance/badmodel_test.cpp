// Bad model files through the program, and files that can't be changed.
#include "program.h"

#include <fcntl.h>
#include <gtest/gtest.h>
#include <regex>
#include <sys/file.h>
#include <unistd.h>

namespace fs = std::filesystem;

namespace {

bool HasWord(const std::string& text, const std::string& words)
{
    return std::regex_search(text, std::regex(words, std::regex::icase));
}

/// A folder with the model of the small case in "m.qmdb".
class BadModel : public testing::Test {
protected:
    void SetUp() override
    {
        const CTempFolder other;
        WriteText(other / "case.json", kSmallCase);
        ASSERT_EQ(0, RunProgram({"import", other / "case.json", Model()}).code);
        m_good = ReadText(Model());
        ASSERT_GT(m_good.size(), 4096U);
    }
    std::string Model() const { return m_folder / "m.qmdb"; }

    /// Info, evaluate and export refuse the bytes with one line that names the file and holds one
    /// of the words of `reason`, a regular expression.
    void ExpectRefused(const std::string& bytes, const std::string& reason) const
    {
        WriteText(Model(), bytes);
        const std::vector<std::string> commands[] = {
            {"info", Model()},
            {"evaluate", Model(), "--json", m_folder / "o.json"},
            {"export", Model(), m_folder / "o.json"},
        };
        for (const auto& arguments : commands) {
            const T_RUN run = RunProgram(arguments);
            EXPECT_EQ(3, run.code) << arguments[0] << ", " << reason;
            EXPECT_EQ("", run.out) << arguments[0] << ", " << reason;
            EXPECT_EQ(1U, Lines(run.err).size()) << arguments[0] << ": " << run.err;
            EXPECT_NE(std::string::npos, run.err.find("m.qmdb")) << arguments[0] << run.err;
            EXPECT_TRUE(HasWord(run.err, reason)) << arguments[0] << ", " << reason << run.err;
            EXPECT_EQ(bytes, ReadText(Model())) << arguments[0];
            EXPECT_EQ(std::vector<std::string>{"m.qmdb"}, m_folder.Names()) << arguments[0];
        }
    }

    CTempFolder m_folder;
    std::string m_good;
};

TEST_F(BadModel, SaysWhatIsWrongWithTheFile)
{
    ExpectRefused("", "empty");
    for (const std::size_t size : {std::size_t{40}, std::size_t{4096}, m_good.size() - 1})
        ExpectRefused(m_good.substr(0, size), "truncated|cut|incomplete|shorter");
    ExpectRefused("Dear Sir or Madam, ...\n", "no model|not a model");
    const auto with = [&](std::size_t at, char byte) {
        return m_good.substr(0, at) + byte + m_good.substr(at + 1);
    };
    ExpectRefused(with(68, 'x'), "another|other"); // application id of a SQLite file
    ExpectRefused(with(63, 99), "newer");          // low byte of the user version
    const auto title = m_good.find("small frame");
    ASSERT_NE(std::string::npos, title);
    ExpectRefused(with(title, 'r'), "damaged"); // one bit of a record
}

TEST_F(BadModel, AFullDiskLeavesNoHalfResult)
{
    T_RUN_OPTIONS full;
    full.fileSizeLimit = 512;
    for (const char* option : {"--json", "--report", "--curve"}) {
        const T_RUN run =
            RunProgram({"evaluate", Model(), "--no-store", option, m_folder / "o"}, full);
        EXPECT_EQ(4, run.code) << option << run.err;
        EXPECT_EQ(1U, Lines(run.err).size()) << option << run.err;
        EXPECT_EQ(std::vector<std::string>{"m.qmdb"}, m_folder.Names()) << option;
    }
}

TEST_F(BadModel, AFileThatIsOpenElsewhereIsNotReplaced)
{
    // Another process that edits the model holds this lock.
    const int held = open(Model().c_str(), O_RDWR | O_CLOEXEC);
    ASSERT_GE(held, 0);
    ASSERT_EQ(0, flock(held, LOCK_EX | LOCK_NB));
    const CTempFolder cases;
    WriteText(cases / "case.json", SmallCaseWith("small frame", "another frame"));
    const T_RUN run = RunProgram({"import", cases / "case.json", Model()});
    EXPECT_EQ(4, run.code);
    EXPECT_EQ(1U, Lines(run.err).size()) << run.err;
    EXPECT_TRUE(HasWord(run.err, "open|locked|in use")) << run.err;
    EXPECT_EQ(m_good, ReadText(Model()));
    EXPECT_EQ(0, RunProgram({"evaluate", Model(), "--no-store"}).code) << "reading is free";
    close(held);
    EXPECT_EQ(0, RunProgram({"import", cases / "case.json", Model()}).code);
}

TEST_F(BadModel, AReadOnlyFileInAReadOnlyFolderIsEvaluated)
{
    const std::string json = RunProgram({"evaluate", Model(), "--json", "-"}).out;
    ASSERT_FALSE(json.empty());
    fs::permissions(Model(), fs::perms::owner_read);
    fs::permissions(m_folder.Path(), fs::perms::owner_read | fs::perms::owner_exec);
    T_RUN_OPTIONS held;
    held.obeyModes = true;
    const T_RUN refused = RunProgram({"export", Model(), m_folder / "o.json"}, held);
    EXPECT_EQ(4, refused.code) << "the folder must be closed for this test to mean something";
    const T_RUN run = RunProgram({"evaluate", Model(), "--json", "-"}, held);
    EXPECT_EQ(0, run.code) << run.err;
    EXPECT_EQ(json, run.out);
    EXPECT_EQ("", run.err);
    EXPECT_EQ(0, RunProgram({"info", Model(), "--check"}, held).code);
    EXPECT_EQ(m_good, ReadText(Model()));
    EXPECT_EQ(std::vector<std::string>{"m.qmdb"}, m_folder.Names());
}

} // namespace
