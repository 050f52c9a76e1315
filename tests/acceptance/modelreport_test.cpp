// The report of a model, through the program.
#include "program.h"

namespace {

class ModelReport : public CProgramTest {};

std::size_t CountOf(const std::string& text, const std::string& what)
{
    std::size_t count = 0;
    for (std::size_t at = text.find(what); at != std::string::npos; at = text.find(what, at + 1))
        ++count;
    return count;
}

// Gamma, alpha, m*, beta0 of the second trial, D and V are those of the calculation by hand in
// docs/verification.md.
TEST_F(ModelReport, HasWhatWasFoundWithItsFormulasAndNumbers)
{
    const std::string steps = std::string("@first-steps");
    EXPECT_EQ("r.html\nr.pdf\n", Done("report " + steps +
                                      " --html r.html --pdf r.pdf --project \"A & B <C>\" "
                                      "--author \"A. Engineer\" --date 2026-11-23"));
    const std::string html = Text("r.html");
    ExpectHolds(html, {"A &amp; B &lt;C&gt;", "A. Engineer", "2026-11-23", "1.28571", "0.857143",
                       "M alpha / Gamma", "300 x 0.857143 / 1.28571", "200 kN s2/m", "0.0996",
                       "783.6", "63.7 (ay dpi - dy api) / (api dpi)", "ATC-40 8.2.2.1.1", "<svg"});
    // Nothing is loaded from elsewhere, nothing runs.
    for (const char* const no : {"<script", "src=", "@import", "url(http"})
        EXPECT_EQ(0U, CountOf(html, no)) << no;
    const std::string pdf = Text("r.pdf");
    EXPECT_TRUE(pdf.starts_with("%PDF-"));
    EXPECT_EQ(0U, CountOf(pdf, "CreationDate"));
    EXPECT_GE(CountOf(pdf, "/Dest"), CountOf(html, "<h2 id=") + CountOf(html, "<h3 id="));
    Done("report " + steps +
         " --html s.html --pdf s.pdf --project \"A & B <C>\" "
         "--author \"A. Engineer\" --date 2026-11-23");
    EXPECT_EQ(html, Text("s.html"));
    EXPECT_EQ(pdf, Text("s.pdf"));
}

TEST_F(ModelReport, TakesChaptersAndSpeaksItalian)
{
    const std::string bridge = std::string("@cable-stayed-bridge");
    Done("--lang it report " + bridge + " --html r.html --only model,factors --rows 3");
    const std::string html = Text("r.html");
    ExpectHolds(html, {"lang=\"it\"", "Fattori di carico incogniti", "righe da 1 a 3 di", "LEVEL"});
    EXPECT_EQ(2U, CountOf(html, "<h2 id="));
    (void)ExpectRefused("report " + bridge + " --html r.html --only model,hinge --overwrite", 2,
                        "there is no chapter \"hinge\"; those are: model, loads");
    (void)ExpectRefused("report " + bridge, 2, "give --html, --pdf or both");
    (void)ExpectRefused("report " + bridge + " --html r.html", 4, "--overwrite");
    (void)ExpectRefused("report " + bridge + " --pdf r.html --overwrite", 2, "ends with .pdf");
}

// Verdicts, remarks and traces of hinges that a code gave.
TEST_F(ModelReport, JudgesWhatACodeGave)
{
    Done("hinge generate " + std::string("@rc-frame-code-hinges") +
         " --code EN1998-3 --all -o g.json");
    Done("report g.json --html r.html");
    ExpectHolds(Text("r.html"), {"Verdicts of members", "EN 1998-3 (A.1)", "theta_um",
                                 "recalled from memory", "Where the numbers come from: element 1"});
}

} // namespace
