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
