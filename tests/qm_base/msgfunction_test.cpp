#include "qm_base/msgfunction.h"

#include <gtest/gtest.h>

using zql::lib::MMSGFunction;

namespace {

/// Back to English after each test: the language is one for the process.
class MsgFunction : public testing::Test {
protected:
    void TearDown() override { EXPECT_EQ(1, MMSGFunction::SetLanguage("en")); }
};

} // namespace

TEST_F(MsgFunction, RefusesAnUnknownLanguageAndStaysInItsOwn)
{
    EXPECT_EQ(1, MMSGFunction::SetLanguage("it"));
    EXPECT_EQ(0, MMSGFunction::SetLanguage("xx"));
    EXPECT_EQ(0, MMSGFunction::SetLanguage(""));
    EXPECT_EQ("it", MMSGFunction::GetLanguage());
    EXPECT_EQ("", MMSGFunction::GetValueOf("xx", "IDS_PUSHOVER_Load_Factor"));
}

TEST_F(MsgFunction, PutsArgumentsIntoTheirPlaces)
{
    const char* const key = "IDS_PUSHOVER_Control_Node___d__Dir____";
    EXPECT_EQ("Control Node : {1}, Dir. : {2}", MMSGFunction::GetValue(key));
    EXPECT_EQ("Control Node : 5, Dir. : DX", MMSGFunction::Format(key, {"5", "DX", "spare"}));
    EXPECT_EQ("Control Node : 5, Dir. : {2}", MMSGFunction::Format(key, {"5"}));
    EXPECT_EQ(1, MMSGFunction::SetLanguage("it"));
    EXPECT_EQ("Nodo di controllo : 5, Dir. : DX", MMSGFunction::Format(key, {"5", "DX"}));
}
