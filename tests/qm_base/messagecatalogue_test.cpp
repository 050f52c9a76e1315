#include "qm_base/messagecatalogue.h"

#include <gtest/gtest.h>

using namespace zql::lib;

TEST(MessageCatalogue, ReadsKeysTextsQuotesAndEscapes)
{
    CMessageCatalogue c;
    const auto faults =
        c.Read("# comment\r\n\n  A_1 =  a = b # c \r\nB=\"  x \"\nC = 1\\n\\t\\\\n\n"
               "D = \"\\n \"\nE = \"\nF = capacità");
    EXPECT_TRUE(faults.empty()) << faults[0].what;
    const CMessageCatalogue::Texts expected{{"A_1", "a = b # c"}, {"B", "  x "}, {"C", "1\n\t\\n"},
                                            {"D", "\n "},         {"E", "\""},   {"F", "capacità"}};
    EXPECT_EQ(expected, c.All());
    EXPECT_EQ(nullptr, c.Find("A"));
}

TEST(MessageCatalogue, NamesEveryFaultAndKeepsTheRest)
{
    CMessageCatalogue c;
    const auto faults = c.Read("A = first\nno entry\n= text\nB B = x\nC =\nD = \"\"\nE = \\q\n"
                               "F = x\\\nA = second\nG = good\n");
    const std::vector<T_CATALOGUE_FAULT> expected{
        {2, "not a line \"key = text\""},
        {3, "not a line \"key = text\""},
        {4, "not a line \"key = text\""},
        {5, "C: empty text"},
        {6, "D: empty text"},
        {7, "E: unknown escape"},
        {8, "F: unknown escape"},
        {9, "A: stands twice"},
    };
    EXPECT_EQ(expected, faults);
    EXPECT_EQ((CMessageCatalogue::Texts{{"A", "first"}, {"G", "good"}}), c.All());
}
