#include "qm_base/logfile.h"

#include <filesystem>
#include <fstream>
#include <gtest/gtest.h>
#include <sstream>

namespace fs = std::filesystem;

TEST(LogFile, AppendsToWhatIsThere)
{
    const fs::path path = fs::path(testing::TempDir()) / "qm_base_logfile_test.txt";
    fs::remove(path);
    EXPECT_EQ(1, CLogFile(path.string()).Write("one\n"));
    const CLogFile log(path.string());
    EXPECT_EQ(1, log.Write("two"));
    EXPECT_EQ(1, log.Write("\r\n"));

    std::ostringstream text;
    text << std::ifstream(path, std::ios::binary).rdbuf();
    EXPECT_EQ("one\ntwo\r\n", text.str());
    fs::remove(path);
}

TEST(LogFile, RefusesAFileThatCannotBeWritten)
{
    EXPECT_EQ(0, CLogFile("").Write("x"));
    EXPECT_EQ(0, CLogFile(testing::TempDir()).Write("x")) << "a folder";
    EXPECT_EQ(0, CLogFile(testing::TempDir() + "/no-such-folder/log.txt").Write("x"));
    EXPECT_EQ(0, CLogFile("/dev/full").Write("x")) << "a full disk";
}
