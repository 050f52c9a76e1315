#include "qm_base/visibletext.h"

#include <gtest/gtest.h>

TEST(VisibleText, ShowsWhatATerminalWouldObey)
{
    const struct {
        const char* text;
        const char* shown;
    } kRows[] = {
        {"Torre \xC3\xA8 1\t\xE6\xA2\x81\n", "Torre \xC3\xA8 1\t\xE6\xA2\x81\n"},
        {"\x1b[31m\r\x7f", "\\x1b[31m\\x0d\\x7f"},
        {"a\xC2\x9B"
         "b",
         "a\\u009bb"},                                      // one-character form of ESC [
        {"x\xE2\x80\xAEy\xE2\x81\xA6", "x\\u202ey\\u2066"}, // direction of writing
        {"\x9B"
         "31m\xE2\x80z\xFF",
         "\\x9b31m\\xe2\\x80z\\xff"}, // no UTF-8
    };
    for (const auto& row : kRows) {
        CVisibleText whole, pieces;
        EXPECT_EQ(row.shown, whole.Next(row.text) + whole.Rest());
        std::string shown;
        for (const char* c = row.text; *c != 0; ++c)
            shown += pieces.Next({c, 1});
        EXPECT_EQ(row.shown, shown + pieces.Rest()) << "piece by piece";
    }
    EXPECT_EQ("a\\nb", VisibleLine("a\nb"));
}
