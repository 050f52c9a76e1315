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

TEST_F(MsgFunction, StartsInEnglishAndKnowsItalian)
{
    EXPECT_EQ("en", MMSGFunction::GetLanguage());
    EXPECT_EQ((std::vector<std::string>{"en", "it"}), MMSGFunction::Languages());
    EXPECT_EQ("Load Factor", MMSGFunction::GetValue("IDS_PUSHOVER_Load_Factor"));
    EXPECT_EQ(1, MMSGFunction::SetLanguage("it"));
    EXPECT_EQ("it", MMSGFunction::GetLanguage());
    EXPECT_EQ("Moltiplicatore di carico", MMSGFunction::GetValue("IDS_PUSHOVER_Load_Factor"));
}

TEST_F(MsgFunction, RefusesAnUnknownLanguageAndStaysInItsOwn)
{
    EXPECT_EQ(1, MMSGFunction::SetLanguage("it"));
    EXPECT_EQ(0, MMSGFunction::SetLanguage("xx"));
    EXPECT_EQ(0, MMSGFunction::SetLanguage(""));
    EXPECT_EQ("it", MMSGFunction::GetLanguage());
    EXPECT_TRUE(MMSGFunction::Keys("xx").empty());
    EXPECT_EQ(MMSGFunction::Keys("en"), MMSGFunction::Keys("it"));
    EXPECT_EQ("", MMSGFunction::GetValueOf("xx", "IDS_PUSHOVER_Load_Factor"));
}

TEST_F(MsgFunction, GivesTheKeyWhereNoCatalogueHasIt)
{
    for (const char* language : {"en", "it"}) {
        EXPECT_EQ(1, MMSGFunction::SetLanguage(language));
        EXPECT_EQ("IDS_NO_SUCH", MMSGFunction::GetValue("IDS_NO_SUCH"));
        EXPECT_EQ("IDS_NO_SUCH", MMSGFunction::Format("IDS_NO_SUCH", {"x"}));
        EXPECT_EQ("", MMSGFunction::GetValueOf(language, "IDS_NO_SUCH"));
    }
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

TEST_F(MsgFunction, HeadsOfTheReportKeepTheirBlanks)
{
    // The step column of a report is 20 characters wide, followed by 4 blanks.
    const std::string head =
        MMSGFunction::Format("IDS_RPS_PUSHOVER__step____20s____20s_n", {"x", "y"});
    EXPECT_EQ("                step    x    y\n", head);
}

TEST_F(MsgFunction, RemovesOnePairOfQuotes)
{
    const std::pair<const char*, const char*> kCases[] = {
        {"rps", "rps"},     {"\"rps\"", "rps"}, {"\"\"rps\"\"", "\"rps\""},
        {"\"rps", "\"rps"}, {"rps\"", "rps\""}, {"\"", "\""},
        {"\"\"", ""},       {"", ""},           {" \"rps\"", " \"rps\""}};
    for (const auto& [text, plain] : kCases)
        EXPECT_EQ(plain, MMSGFunction::RemoveQuote(text)) << text;
}
