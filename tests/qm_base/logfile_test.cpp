#include "qm_base/logfile.h"

#include <gtest/gtest.h>

TEST(LogFile, RefusesAFileThatCannotBeWritten)
{
    EXPECT_EQ(0, CLogFile("").Write("x"));
    EXPECT_EQ(0, CLogFile(testing::TempDir()).Write("x")) << "a folder";
    EXPECT_EQ(0, CLogFile(testing::TempDir() + "/no-such-folder/log.txt").Write("x"));
    EXPECT_EQ(0, CLogFile("/dev/full").Write("x")) << "a full disk";
}
