// The files that evaluate writes: JSON, report, curve table, pictures.
#include "program.h"
#include "qm_base/textformat.h"

#include <gtest/gtest.h>
#include <nlohmann/json.hpp>
#include <set>
#include <sstream>

namespace {

using json = nlohmann::json;
const char* const kOne = "PX ATC-40 A";

TEST(Outputs, JsonHasTheDocumentedKeysAndNoOthers)
{
    const std::set<std::string> kKeys{
        "name",   "push",         "method",  "procedure", "status", "factors", "capacity",
        "target", "limit_states", "outcome", "messages",  "trials", "trace",   "performance_point"};
    const json all =
        json::parse(RunProgram({"evaluate", ExampleCase("first-steps"), "--json", "-"}).out);
    ASSERT_EQ(8U, all.size());
    const std::string page = ReadText(ProjectFolder() / "docs/file-formats.md");
    for (const json& r : all) {
        std::set<std::string> keys;
        for (const auto& item : r.items())
            keys.insert(item.key());
        EXPECT_EQ(r.at("trials") != 0, keys.erase("all_points") == 1) << r.at("name");
        EXPECT_EQ(r.at("trials") == 0, keys.erase("derivation") == 1) << r.at("name");
        EXPECT_EQ(kKeys, keys) << r.at("name");
        const json flat = r.flatten();
        for (const auto& part : flat.items()) {
            const std::string path = part.key();
            const std::string key = path.substr(path.rfind('/') + 1);
            if (key.find_first_not_of("0123456789") == std::string::npos) continue;
            EXPECT_NE(std::string::npos, page.find("`" + key + "`"))
                << key << " is not in docs/file-formats.md";
        }
    }
}

TEST(Outputs, AdditionalStepsAndSpectraStandBesideTheResult)
{
    const std::vector<std::string> plain{
        "evaluate", ExampleCase("first-steps"), "--only", kOne, "--json", "-"};
    std::vector<std::string> more = plain;
    more.insert(more.end(), {"--add-step", "20", "--add-spectrum", "EC8"});
    const json a = json::parse(RunProgram(plain).out)[0], b = json::parse(RunProgram(more).out)[0];
    EXPECT_EQ(a.at("performance_point"), b.at("performance_point"));
    const json& step = b.at("additional_steps").at(0); // D = 0.036 + 0.0048 (20 - 10)
    EXPECT_EQ(20, step.at("step"));
    EXPECT_NEAR(0.084, step.at("D"), 1e-12);
    EXPECT_NEAR(768.0, step.at("V"), 1e-9);
    const json& point = b.at("additional_points").at(0);
    EXPECT_EQ("EC8", point.at("spectrum"));
    EXPECT_EQ("found", point.at("status"));
    EXPECT_NE(a.at("performance_point").at("Sd"), point.at("performance_point").at("Sd"));
    more.back() = "no such spectrum";
    EXPECT_EQ(2, RunProgram(more).code);
    more[more.size() - 3] = "41"; // the push has 40 steps
    EXPECT_EQ(2, RunProgram(more).code);
}

TEST(Outputs, CompareListsEveryMethodWithTheSpread)
{
    const CTempFolder folder;
    const std::string file = ExampleCase("first-steps");
    const T_RUN run = RunProgram(
        {"compare", file, "--push", "PX", "--spectrum", "ATC", "--json", folder / "c.json"});
    ASSERT_EQ(0, run.code) << run.err;
    for (const char* text : {"ATC-40 A", "ATC-40 B", "FEMA440 A", "FEMA440 B", "FEMA440 C",
                             "EC8 SD", "NTC2008 SLV", "NTC2018 SLV", "spread of D over 8 methods"})
        EXPECT_NE(std::string::npos, run.out.find(text)) << text;
    const json compared = json::parse(ReadText(folder / "c.json"));
    const json alone =
        json::parse(RunProgram({"evaluate", file, "--only", kOne, "--json", "-"}).out);
    EXPECT_EQ(alone[0].at("performance_point"), compared.at(0).at("performance_point"));
    EXPECT_EQ(2, RunProgram({"compare", file, "--push", "PX", "--spectrum", "none"}).code);
    EXPECT_EQ(2, RunProgram({"compare", file, "--push", "none", "--spectrum", "ATC"}).code);
}

TEST(Outputs, ReportHasItsSectionsAndTheNumbersOfTheJson)
{
    const CTempFolder folder;
    const T_RUN run =
        RunProgram({"evaluate", ExampleCase("first-steps"), "--only", kOne, "--report",
                    folder / "r.txt", "--curve", folder / "c.txt", "--json", folder / "r.json"});
    ASSERT_EQ(0, run.code) << run.err;
    const std::string report = ReadText(folder / "r.txt"), curve = ReadText(folder / "c.txt");
    const json point = json::parse(ReadText(folder / "r.json"))[0].at("performance_point");
    for (const std::string& text :
         {std::string("qm_rps 0.1.0"), std::string("[ Performance Point ]"),
          std::string("Disp. Control Node : 4"), std::string("Direction : DX"),
          "* V, D : " + std::to_string(point.at("V").get<double>()) + ", " +
              std::to_string(point.at("D").get<double>()),
          std::string("Gamma : 1.28571"), std::string("m* : 200")})
        EXPECT_NE(std::string::npos, report.find(text)) << text;
    EXPECT_TRUE(report.ends_with(curve)) << "the report ends with the curve table";
    std::size_t rows = 0;
    for (const std::string& line : Lines(curve))
        rows += line.find("e-0") != std::string::npos && line.find(':') == std::string::npos;
    EXPECT_EQ(41U, rows); // steps 0 to 40
}

/// The words of a text that are numbers.
std::vector<double> Numbers(const std::string& text)
{
    std::vector<double> numbers;
    std::istringstream words(text);
    for (std::string word; words >> word;)
        if (const auto number = ParseFinite(word)) numbers.push_back(*number);
    return numbers;
}

TEST(Outputs, ItalianTextsWithTheSameNumbers)
{
    const CTempFolder folder;
    std::string loose = ReadText(ExampleCase("tuned-beam"));
    const std::string held = "\"restraint\": [1, 0, 1, 0, 0, 0]";
    ASSERT_NE(std::string::npos, loose.find(held));
    WriteText(folder / "loose.json",
              loose.replace(loose.find(held), held.size(), "\"restraint\": [0, 0, 1, 0, 0, 0]"));
    const struct {
        std::vector<std::string> command;
        std::vector<const char*> says;
    } kRows[] = {
        {{"evaluate", ExampleCase("first-steps"), "--trace"},
         {"valutazione", "trovato", "domanda", "prova"}},
        {{"info", ExampleCase("first-steps")}, {"nodi: ", "valutazione PX EC8"}},
        {{"analyse", ExampleCase("tuned-beam")}, {"spostamenti", "reazioni (forze"}},
        {{"ulf", "solve", ExampleCase("tuned-beam"), "--item", "PROPS"}, {"condizione", "attiva"}},
        {{"ulf", "solve", ExampleCase("tuned-beam"), "--item", "X"}, {"nessuna voce"}},
        {{"analyse", folder / "loose.json"}, {"libera di traslare lungo X"}}, // from the engine
    };
    for (const auto& row : kRows) {
        std::vector<std::string> italian{"--lang", "it"};
        italian.insert(italian.end(), row.command.begin(), row.command.end());
        const T_RUN en = RunProgram(row.command), it = RunProgram(italian);
        EXPECT_EQ(en.code, it.code) << it.err;
        EXPECT_EQ(Numbers(en.out), Numbers(it.out)) << row.command[0];
        for (const char* text : row.says) {
            EXPECT_NE(std::string::npos, (it.out + it.err).find(text)) << text << it.out << it.err;
            EXPECT_EQ(std::string::npos, (en.out + en.err).find(text)) << text;
        }
    }
}

TEST(Outputs, AnElementListIsTakenAsWindowsTakeIt)
{
    const CTempFolder folder;
    const auto assigned = [&](const char* elements) {
        const T_RUN run =
            RunProgram({"hinge", "assign", ExampleCase("hinge-library"), "--type", "steel beam",
                        "--elements", elements, "-o", folder / "a.json"});
        return run.code == 0 ? ReadText(folder / "a.json") : std::to_string(run.code);
    };
    const std::string plain = assigned("2,3");
    EXPECT_GT(plain.size(), 1000U);
    for (const char* same : {"2, 3", "3,2", "2 - 3", "2,3,2"})
        EXPECT_EQ(plain, assigned(same)) << same;
    for (const char* none : {"", "2,", "3-2", "0", "a"})
        EXPECT_EQ("2", assigned(none)) << none;
}

#ifdef QM_UI

/// What stands between tags: the words of an SVG picture.
std::string Words(const std::string& svg)
{
    std::string words;
    bool tag = false;
    for (const char c : svg) {
        if (c == '<') tag = true;
        if (!tag && c != '\n') words += c;
        if (c == '>') {
            tag = false;
            words += ' ';
        }
    }
    return words;
}

TEST(Outputs, PictureHasTitleAxesLegendAndPoint)
{
    const CTempFolder folder;
    const T_RUN run = RunProgram(
        {"evaluate", ExampleCase("first-steps"), "--only", kOne, "--plot", folder / "p.svg"});
    ASSERT_EQ(0, run.code) << run.err;
    EXPECT_EQ("", run.err);
    const std::string svg = ReadText(folder / "p.svg");
    EXPECT_TRUE(svg.starts_with("<?xml"));
    const std::string words = Words(svg);
    for (const char* text :
         {kOne, "Spectral displacement Sd (m)", "Spectral acceleration Sa (g)", "Elastic demand",
          "Reduced demand", "Capacity", "Trial points", "Performance point", "Sd = 0.07752 m",
          "T_eff = 1.00", "T0 = 0.628 s", "Outcome: converged"})
        EXPECT_NE(std::string::npos, words.find(text)) << text;
}

TEST(Outputs, AnUnknownPictureFormatIsWrongUsage)
{
    const CTempFolder folder;
    const T_RUN run = RunProgram({"evaluate", ExampleCase("first-steps"), "--only", kOne, "--json",
                                  folder / "o.json", "--plot", folder / "p.gif"});
    EXPECT_EQ(2, run.code);
    EXPECT_EQ(1U, Lines(run.err).size()) << run.err;
    EXPECT_TRUE(folder.Names().empty()) << "refused before anything is written";
}

#endif

} // namespace
