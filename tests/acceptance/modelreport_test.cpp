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

// Documents that only differ in when they were made are the same, in both languages.
TEST_F(ModelReport, TheSameInputGivesTheSameBytes)
{
    for (const std::string language : {"en", "it"}) {
        for (const char* const name : {"a", "b"})
            Done("--lang " + language + " report @rc-frame-code-hinges --overwrite --html " + name +
                 ".html --pdf " + name + ".pdf");
        EXPECT_EQ(Text("a.html"), Text("b.html")) << language;
        EXPECT_EQ(Text("a.pdf"), Text("b.pdf")) << language;
    }
}

TEST_F(ModelReport, TakesWhatTheModelKeepsWhereNothingElseIsSaid)
{
    EXPECT_EQ("k.json\n", Done("report @tuned-beam --keep -o k.json --author \"A. Engineer\" "
                               "--only model,factors --rows 4"));
    Done("import k.json k.qmdb");
    EXPECT_EQ("k.qmdb\nr.html\n",
              Done("report k.qmdb --keep --checker \"C. Hecker\" --html r.html"));
    for (const char* const file : {"k.json", "k.qmdb"}) {
        Done(std::string("report ") + file + " --html r.html --overwrite");
        ExpectHolds(Text("r.html"), {"A. Engineer", "rows 1 to 4 of"});
        EXPECT_EQ(2U, CountOf(Text("r.html"), "<h2 id=")) << file;
    }
    ExpectHolds(Text("r.html"), {"C. Hecker"});
    Done("report k.qmdb --author \"\" --only remarks --html r.html --overwrite");
    EXPECT_EQ(std::string::npos, Text("r.html").find("A. Engineer"));
    EXPECT_EQ(1U, CountOf(Text("r.html"), "<h2 id="));
    Done("report k.qmdb --html r.html --overwrite");
    ExpectHolds(Text("r.html"), {"A. Engineer", "C. Hecker"}); // what was said once was not kept
    (void)ExpectRefused("report @tuned-beam --keep", 2, "-o");
    (void)ExpectRefused("report k.json -o k.qmdb", 4, "--overwrite");
}

// Hand: the bilinear curve of first-steps yields at 0.036 m and 720 kN and ends at 0.18 m and
// 864 kN.
TEST_F(ModelReport, ComparesWhatTheEvaluationsFind)
{
    Done("report @first-steps --html r.html --only evaluations");
    const std::string html = Text("r.html");
    ExpectHolds(html, {"Comparison of the evaluations", "Evaluations of PX with spectrum ATC"});
    const std::string row = "<td>PX NTC2008 SLV</td><td>PX</td><td>NTC</td><td class=\"n\">";
    const std::size_t at = html.find(row);
    ASSERT_NE(std::string::npos, at);
    double D = 0.0, V = 0.0;
    ASSERT_EQ(2,
              std::sscanf(html.c_str() + at + row.size(), "%lf</td><td class=\"n\">%lf", &D, &V));
    EXPECT_NEAR(720.0 + (D - 0.036) / (0.18 - 0.036) * 144.0, V, 1e-3);
}

// 100 (sum m phi)^2 / (sum m phi^2 sum m) along X, from the case file.
TEST_F(ModelReport, WorksOutModalMassesThatTheModelDoesNotState)
{
    const json model = json::parse(ReadText(ExampleCase("masonry-wall")));
    double L = 0.0, M = 0.0, total = 0.0;
    for (const json& node : model.at("nodes")) {
        const std::string id = std::to_string(node.at("id").get<int>());
        const json shape = model.at("modes").at(0).at("shape");
        if (!node.contains("mass")) continue;
        total += node.at("mass").at(0).get<double>();
        for (std::size_t d = 0; d < 3 && shape.contains(id); ++d) {
            const double m = node.at("mass").at(d), phi = shape.at(id).at(d);
            if (d == 0) L += m * phi;
            M += m * phi * phi;
        }
    }
    char expected[32];
    std::snprintf(expected, sizeof expected, "%.4g", 100.0 * L * L / (M * total));
    Done("report @masonry-wall --html r.html --only modes");
    ExpectHolds(Text("r.html"), {expected, "are computed from nodal masses and mode shape"});
}

// The deck of the bridge lies where it should in the structure itself, and what the stages forecast
// to the first order does not.
TEST_F(ModelReport, ChecksFactorsOnTheAnalysedStructure)
{
    Done("report @cable-stayed-bridge --html r.html --only factors");
    EXPECT_EQ(3U, CountOf(Text("r.html"), "Check on the analysed structure")); // NO UPLIFT has none
    EXPECT_EQ(0U, CountOf(Text("r.html"), "not met"));
    Done("report @cable-stayed-bridge-staged --html s.html --only factors,stages,remarks");
    ExpectHolds(Text("s.html"), {"all construction stages once more", "not met",
                                 "does not keep every constraint with these factors",
                                 "Axial forces of the tensioned elements", "(12)"});
}

// What the check of hinges says stands in the report, too.
TEST_F(ModelReport, CollectsWhatTheChecksSay)
{
    const T_RUN check = Run("hinge check @hinge-library");
    Done("report @hinge-library --html r.html --only hinges,remarks");
    const std::string html = Text("r.html");
    EXPECT_NE(std::string::npos, check.out.find("with a mistake"));
    ExpectHolds(html, {"<td>with a mistake</td>"});
}

TEST_F(ModelReport, NamesOfAnyKindStayText)
{
    std::string model = ReadText(ExampleCase("tuned-beam"));
    json c = json::parse(model);
    const std::string evil = "<script>x</script> \"'& \u05E9\u05DC\u05D5\u05DD \u202Eabc\u0007";
    c["title"] = evil;
    c["sections"][0]["name"] = std::string(10000, 'W');
    for (json& e : c["elements"])
        e["section"] = c["sections"][0]["name"];
    Write("evil.json", c.dump());
    Done("report evil.json --html r.html --pdf r.pdf");
    const std::string html = Text("r.html");
    EXPECT_EQ(0U, CountOf(html, "<script"));
    ExpectHolds(html, {"&lt;script&gt;x&lt;/script&gt; &quot;&#39;&amp; \u05E9\u05DC\u05D5\u05DD "
                       "\uFFFDabc\uFFFD"});
    if (RunShell("command -v pdftotext", m_folder.Path()).code != 0)
        GTEST_SKIP() << "pdftotext is not installed";
    ASSERT_EQ(0, RunShell("pdftotext -layout r.pdf r.txt", m_folder.Path()).code);
    ExpectHolds(Text("r.txt"), {"<script>x</script>", "WWWWWWWWWWWWWWWWWWWWWWWW", "(10000"});
}

// The block says what the report rests on; without it the report is what it always was.
TEST_F(ModelReport, TextReportsBeginWithWhatTheyRestOn)
{
    const std::string one = "evaluate @first-steps --only \"PX NTC2018\" --overwrite --report ";
    Done(one + "full.txt");
    Done(one + "plain.txt --plain");
    const std::string full = Text("full.txt"), plain = Text("plain.txt");
    ASSERT_TRUE(full.ends_with(plain));
    const std::string intro = full.substr(0, full.size() - plain.size());
    ExpectHolds(intro, {"* Method : NTC2018", "SLV: ag = 0.261 g, F0 = 2.36, TC* = 0.35 s",
                        "xi = 5 %", "M : 300 kN s2/m", "m* : 200 kN s2/m", "D, Sd, dt",
                        "target displacement found", "* N/A : the capacity does not exceed"});
    EXPECT_TRUE(plain.starts_with("qm_rps "));
    Done("--lang it " + one + "it.txt");
    ExpectHolds(Text("it.txt"), {"Su che cosa si basa questo rapporto"});
}

} // namespace
