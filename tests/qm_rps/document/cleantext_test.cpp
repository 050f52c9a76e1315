#include "qm_rps/document/documenthtml.h"

#include <gtest/gtest.h>

namespace {

const std::string kBad = "\uFFFD";

} // namespace

TEST(CleanText, KeepsLettersOfEveryScriptAndNothingElse)
{
    const struct {
        std::string text, clean;
    } kCases[] = {
        {"Trave 1\u00E8 \u05E9\u05DC\u05D5\u05DD \U0001F3D7", // Italian, Hebrew, beyond 16 bits
         "Trave 1\u00E8 \u05E9\u05DC\u05D5\u05DD \U0001F3D7"},
        {"a\tb\nc", "a\tb\nc"},
        {std::string("a\0b", 3) + "\x1b[2J\x7f", "a" + kBad + "b" + kBad + "[2J" + kBad},
        {"\u0085\u009F", kBad + kBad}, // C1 controls
        {"pier \u202E1202 \u2066x", "pier " + kBad + "1202 " + kBad + "x"},
        {"\xC3", kBad}, // cut letter
        {"\xC0\xAF"
         "b",
         kBad + kBad + "b"},                             // a longer form than needed
        {"\xED\xA0\x80", kBad + kBad + kBad},            // half of a pair
        {"\xF5\x80\x80\x80", kBad + kBad + kBad + kBad}, // beyond the last letter
        {"\xE2\x82"
         "a",
         kBad + kBad + "a"},
    };
    for (const auto& c : kCases)
        EXPECT_EQ(c.clean, CleanText(c.text)) << c.text;
}

TEST(DocumentHtml, NamesAreTextWhereverTheyStand)
{
    const std::string evil = "<script>alert(\"1\")</script>'&\u202E\x01",
                      written = "&lt;script&gt;alert(&quot;1&quot;)&lt;/script&gt;&#39;&amp;" +
                                kBad + kBad;
    T_DOCUMENT d;
    d.language = d.title = d.subtitle = d.program = d.contents = d.signOffTitle = evil;
    d.head = {{evil, evil}};
    d.signOff = {evil};
    d.words.factHeads.fill(evil);
    T_FACT fact;
    fact.symbol = fact.definition = fact.clause = fact.formula = fact.numbers = fact.unit =
        fact.text = evil;
    fact.value = 1.0;
    T_DOC_TABLE table{evil, {{{evil, true}}, {{evil}}}};
    d.chapters = {
        {evil,
         {T_DOC_TEXT{evil}, table, T_DOC_FACTS{evil, {fact}}, T_DOC_PICTURE{evil, T_FRAME_VIEW{}}},
         {{evil}}}};
    const std::string html = HtmlOf(d, [](const T_DOC_PICTURE&) { return "<svg></svg>"; });
    EXPECT_EQ(std::string::npos, html.find("<script"));
    EXPECT_EQ(std::string::npos, html.find("alert(\""));
    std::size_t count = 0;
    for (std::size_t at = html.find(written); at != std::string::npos;
         at = html.find(written, at + 1))
        ++count;
    // Head of the file and title block 8, sign-off 2, contents 2, chapters 2, text 1, table 3;
    // facts: caption 1, heads 5, fields 7; caption of the picture 1.
    EXPECT_EQ(32U, count);
    const std::string name(10000, 'x');
    d.chapters.front().title = name;
    EXPECT_NE(std::string::npos, HtmlOf(d, {}).find(name)); // nothing is lost
}
