#include "qm_base/appbase.h"

#include "qm_base/debugout.h"

#include <gtest/gtest.h>

TEST(AppBase, KeepsAndTracesAssertionsAndCarriesOn)
{
    std::string trace;
    SetDebugSink([&](std::string_view line) { trace = line; });
    CAppBase::TakeAssertions_ST();
    CAppBase::ReleaseAssertion_ST("src/qm_rps/a", 72);
    CAppBase::ReleaseAssertion_ST(nullptr, 88);
    SetDebugSink({});

    EXPECT_EQ("release assertion: (88)", trace);
    EXPECT_EQ((std::vector<T_ASSERTION>{{"src/qm_rps/a", 72}, {"", 88}}),
              CAppBase::TakeAssertions_ST());
    EXPECT_TRUE(CAppBase::TakeAssertions_ST().empty());
}

TEST(AppBase, KeepsTheLatestThousand)
{
    CAppBase::TakeAssertions_ST();
    for (int line = 1; line <= 1003; ++line)
        CAppBase::ReleaseAssertion_ST("x", line);
    const auto kept = CAppBase::TakeAssertions_ST();
    ASSERT_EQ(1000u, kept.size());
    EXPECT_EQ(4, kept.front().line);
    EXPECT_EQ(1003, kept.back().line);
}

TEST(AppBase, ReportsNothingWhileSwitchedOff)
{
    CAppBase::TakeAssertions_ST();
    EXPECT_TRUE(CAppBase::IsReleaseAssert_ST());
    CAppBase::EnableReleaseAssert_ST(false);
    EXPECT_FALSE(CAppBase::IsReleaseAssert_ST());
    CAppBase::ReleaseAssertion_ST("x", 1);
    CAppBase::EnableReleaseAssert_ST(true);
    EXPECT_TRUE(CAppBase::TakeAssertions_ST().empty());
}
