#include "qm_base/debugout.h"

#include <cstdlib>
#include <gtest/gtest.h>
#include <string>

TEST(DebugOut, GoesToTheSinkAndStopsWhenItIsRemoved)
{
    std::string lines;
    SetDebugSink([&](std::string_view line) { lines.append(line).append("|"); });
    GDebugOut("#%d Dy:%g Ay:%g", 3, 0.25, 1e-7);
    SetDebugSink({});
    GDebugOut("late");
    EXPECT_EQ("#3 Dy:0.25 Ay:1e-07|", lines);
}

TEST(DebugOut, GoesToStderrOnlyWhenTheEnvironmentAsks)
{
    testing::internal::CaptureStderr();
    unsetenv("QM_DEBUG");
    GDebugOut("silent");
    setenv("QM_DEBUG", "0", 1);
    GDebugOut("silent");
    setenv("QM_DEBUG", "1", 1);
    GDebugOut("seen %d", 1);
    GDebugOut("seen 2\n");
    unsetenv("QM_DEBUG");
    EXPECT_EQ("seen 1\nseen 2\n", testing::internal::GetCapturedStderr());
}
