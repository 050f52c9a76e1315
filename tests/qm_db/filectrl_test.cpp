#include "qm_db/filectrl.h"

#include "tempfolder.h"

#include <gtest/gtest.h>
#include <sys/resource.h>
#include <sys/wait.h>
#include <unistd.h>

namespace fs = std::filesystem;

namespace {

class FileCtrl : public testing::Test {
protected:
    CTempFolder m_folder;
    std::string m_path = m_folder / "frame.json";
    T_FILE_ERROR m_error;
};

/// Lowers the limit of the size of files while it lives.
class CSizeLimit {
public:
    explicit CSizeLimit(rlim_t bytes)
    {
        getrlimit(RLIMIT_FSIZE, &m_before);
        const rlimit limit{bytes, m_before.rlim_max};
        setrlimit(RLIMIT_FSIZE, &limit);
    }
    ~CSizeLimit() { setrlimit(RLIMIT_FSIZE, &m_before); }

private:
    rlimit m_before{};
};

TEST_F(FileCtrl, KeepsTheOldFileWhenTheDiskIsFull)
{
    ASSERT_EQ(1, CFileCtrl::WriteWholeFile(m_path, "old", m_error));
    {
        const CSizeLimit limit(1000); // the process would die of SIGXFSZ without care
        EXPECT_EQ(0, CFileCtrl::WriteWholeFile(m_path, std::string(5000, 'n'), m_error));
    }
    EXPECT_EQ(FILE_FAULT::NoAccess, m_error.fault);
    EXPECT_EQ(0U, m_error.text.find(m_path + ": can't write: ")) << m_error.text;
    EXPECT_EQ("old", ReadText(m_path));
    EXPECT_EQ(std::vector<std::string>{"frame.json"}, m_folder.Names());
    EXPECT_EQ(0, CFileCtrl::WriteWholeFile("/dev/full", "n", m_error));
    EXPECT_EQ(FILE_FAULT::NoAccess, m_error.fault);
}

TEST_F(FileCtrl, KeepsLinkAndPermissions)
{
    const std::string link = m_folder / "link.json";
    ASSERT_EQ(1, CFileCtrl::WriteWholeFile(m_path, "old", m_error));
    fs::permissions(m_path, fs::perms(0640));
    fs::create_symlink("frame.json", link);
    ASSERT_EQ(1, CFileCtrl::WriteWholeFile(link, "new", m_error)) << m_error.text;
    EXPECT_TRUE(fs::is_symlink(link));
    EXPECT_EQ("new", ReadText(m_path));
    EXPECT_EQ(fs::perms(0640), fs::status(m_path).permissions());
}

TEST_F(FileCtrl, RefusesWhatIsNoFile)
{
    std::string text = "as it was";
    EXPECT_EQ(0, CFileCtrl::ReadWholeFile(m_folder.Path(), text, m_error));
    EXPECT_EQ(FILE_FAULT::NoAccess, m_error.fault);
    EXPECT_EQ(0, CFileCtrl::ReadWholeFile(m_path, text, m_error));
    EXPECT_EQ(m_path + ": can't open: No such file or directory", m_error.text);
    EXPECT_EQ("as it was", text);
    EXPECT_EQ(0, CFileCtrl::WriteWholeFile(m_folder.Path(), "x", m_error));
    EXPECT_EQ(0, CFileCtrl::WriteWholeFile(m_folder / "none/x", "x", m_error));
    EXPECT_TRUE(m_folder.Names().empty());
}

/// What the rule of outputs says to these, with frame.json as the input: fault, and its words.
struct T_OUTPUTS_CASE {
    std::vector<T_OUTPUT> outputs; // names in the folder
    FILE_FAULT fault;              // without overwriting
    FILE_FAULT forced;             // with it
    const char* says = "";
};

TEST_F(FileCtrl, OutputsGoNeverOverInputsNorTwiceToOnePlace)
{
    using enum OUTPUT_KIND;
    using enum FILE_FAULT;
    WriteText(m_path, "{}");
    WriteText(m_folder / "old.json", "{}");
    WriteText(m_folder / "empty.json", "");
    WriteText(m_folder / "model", "SQLite format 3 and more");
    fs::create_symlink("frame.json", m_folder / "link.json");
    fs::create_hard_link(m_path, m_folder / "hard.json");
    const T_OUTPUTS_CASE kCases[] = {
        {{{"new.json", Json}, {"r", Text}, {"p.SVG", Picture}, {"", Sheet}}, None, None},
        {{{"frame.json", Json}}, Misuse, Misuse, "is read"},
        {{{"./no/../frame.json", Json}}, Misuse, Misuse, "is read"},
        {{{"link.json", Json}}, Misuse, Misuse, "is read"},
        {{{"hard.json", Document}}, Misuse, Misuse, "is read"},
        {{{"a", Json}, {"./a", Text}}, Misuse, Misuse, "two outputs"},
        {{{"-", Json}, {"-", Text}}, Misuse, Misuse, "two outputs"},
        {{{"a.svg", Json}}, Misuse, Misuse, "a picture"},
        {{{"a.json", Text}}, Misuse, Misuse, "a model or case file"},
        {{{"a.qmdb", Text}}, Misuse, Misuse, "a model file"},
        {{{"a", Model}}, Misuse, Misuse, ".qmdb"},
        {{{"a.gif", Picture}}, Misuse, Misuse, ".svg"},
        {{{"model", Json}}, Misuse, Misuse, "only a model"},
        {{{"old.json", Json}}, NoAccess, None, "--overwrite"},
        {{{"empty.json", Json}}, None, None},
        {{{"/dev/null", Json}, {"/dev/null", Text}}, None, None},
    };
    const auto faultOf = [&](const T_OUTPUTS_CASE& row, bool overwrite) {
        std::vector<T_OUTPUT> outputs = row.outputs;
        for (T_OUTPUT& o : outputs)
            if (!o.path.empty() && o.path != "-" && o.path[0] != '/') o.path = m_folder / o.path;
        m_error = {};
        const int done =
            CFileCtrl::CheckOutputs(std::span(&m_path, 1), outputs, overwrite, m_error);
        EXPECT_EQ(done == 1, m_error.fault == None);
        return m_error.fault;
    };
    for (const T_OUTPUTS_CASE& row : kCases) {
        EXPECT_EQ(row.forced, faultOf(row, true)) << row.outputs[0].path;
        EXPECT_EQ(row.fault, faultOf(row, false)) << row.outputs[0].path;
        EXPECT_NE(std::string::npos, m_error.text.find(row.says)) << m_error.text;
    }
}

TEST_F(FileCtrl, NewFilesAreNoMoreOpenThanTheModel)
{
    WriteText(m_path, "{}");
    const auto modeOfNew = [&](const std::string& like) {
        CFileCtrl::MakeFilesLike(like);
        const std::string made = m_folder / "made";
        fs::remove(made);
        EXPECT_EQ(1, CFileCtrl::WriteWholeFile(made, "x", m_error)) << m_error.text;
        return fs::status(made).permissions();
    };
    const fs::perms usual = modeOfNew("");
    fs::permissions(m_path, fs::perms(0600));
    EXPECT_EQ(fs::perms(0600), modeOfNew(m_path));
    fs::permissions(m_path, fs::perms(0440));
    EXPECT_EQ(fs::perms(0640) & usual, modeOfNew(m_path));
    EXPECT_EQ(usual, modeOfNew(m_folder / "none"));
}

TEST_F(FileCtrl, SweepsWhatAKilledWriterHasLeft)
{
    const pid_t child = fork();
    if (child == 0) _exit(0); // a number that no process has
    waitpid(child, nullptr, 0);
    const std::string gone = m_folder / "other.svg.qm.tmp-" + std::to_string(child) + "-1";
    const std::string alive = m_folder / "a.json.qm.tmp-" + std::to_string(getppid()) + "-1";
    const std::string foreign = m_folder / "b.tmp-" + std::to_string(child) + "-1";
    for (const std::string& name : {gone, alive, foreign})
        WriteText(name, "half");
    ASSERT_EQ(1, CFileCtrl::WriteWholeFile(m_path, "new", m_error));
    EXPECT_FALSE(fs::exists(gone));
    EXPECT_TRUE(fs::exists(alive)); // younger than ten minutes
    EXPECT_TRUE(fs::exists(foreign));
}

} // namespace
