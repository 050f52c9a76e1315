#include "qm_rps/shell/letters.h"

#include <gtest/gtest.h>

using TEXTS = std::vector<std::string>;

TEST(Letters, EachEntryHasOneOfItsOwn)
{
    struct T_CASE {
        const char* name;
        TEXTS texts, expected;
    };
    const T_CASE cases[] = {
        {"brought ones stay", {"&Save", "Save &as..."}, {"&Save", "Save &as..."}},
        {"the second gives way, to the beginning of a word first",
         {"&Push...", "&Pull back"},
         {"&Push...", "Pull &back"}},
        {"then within a word", {"&A", "&B", "Abc", "Ba"}, {"&A", "&B", "Ab&c", "Ba"}},
        {"a mark that comes later is kept from one that has none",
         {"Open", "&Other"},
         {"O&pen", "&Other"}},
        {"lines and signs", {"", "&New", "R && D"}, {"", "&New", "&R && D"}},
        {"no letter of the keyboard",
         {"\xc3\xa8", "\xc3\xa8 pi\xc3\xb9"},
         {"\xc3\xa8", "\xc3\xa8 &pi\xc3\xb9"}},
        {"a shortcut is no text", {"&X", "X\tCtrl+C"}, {"&X", "X\tCtrl+C"}},
    };
    for (const T_CASE& c : cases)
        EXPECT_EQ(c.expected, WithLetters(c.texts)) << c.name;
}
