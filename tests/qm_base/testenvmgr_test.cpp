#include "qm_base/testenvmgr.h"

#include <cstdlib>
#include <gtest/gtest.h>

TEST(TestEnvMgr, AnswersForTheExactValueOnly)
{
    CTestEnvMgr::ClearST();
    EXPECT_FALSE(CTestEnvMgr::IsTestEnvST("FEMA440", "yes"));
    CTestEnvMgr::SetTestEnvST("FEMA440", "yes");
    EXPECT_TRUE(CTestEnvMgr::IsTestEnvST("FEMA440", "yes"));
    EXPECT_FALSE(CTestEnvMgr::IsTestEnvST("FEMA440", "Yes"));
    EXPECT_FALSE(CTestEnvMgr::IsTestEnvST("FEMA", "yes"));
    CTestEnvMgr::SetTestEnvST("FEMA440", "no");
    EXPECT_FALSE(CTestEnvMgr::IsTestEnvST("FEMA440", "yes"));
    CTestEnvMgr::ClearST();
    EXPECT_FALSE(CTestEnvMgr::IsTestEnvST("FEMA440", "no"));
}

TEST(TestEnvMgr, ReadsTheEnvironmentForASwitchThatWasNeverSet)
{
    CTestEnvMgr::ClearST();
    setenv("QM_TEST_TRIAL", "yes", 1);
    EXPECT_TRUE(CTestEnvMgr::IsTestEnvST("TRIAL", "yes"));
    CTestEnvMgr::SetTestEnvST("TRIAL", "no");
    EXPECT_FALSE(CTestEnvMgr::IsTestEnvST("TRIAL", "yes"));
    unsetenv("QM_TEST_TRIAL");
    CTestEnvMgr::ClearST();
    EXPECT_FALSE(CTestEnvMgr::IsTestEnvST("TRIAL", "yes"));
    EXPECT_FALSE(CTestEnvMgr::IsTestEnvST("TRIAL", ""));
}
