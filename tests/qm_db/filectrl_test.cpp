#include "qm_db/filectrl.h"

#include "tempfolder.h"

#include <gtest/gtest.h>
#include <sys/resource.h>

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

} // namespace
