// The files that evaluate writes: JSON, report, curve table, pictures.
#include "program.h"
#include "qm_base/textformat.h"

#include <cmath>
#include <regex>
#include <set>
#include <sstream>

namespace {

using Outputs = CProgramTest;
const std::string kOne = "evaluate @first-steps --only 'PX ATC-40 A'";

TEST_F(Outputs, JsonHasTheDocumentedKeysAndNoOthers)
{
    const std::set<std::string> kKeys{
        "name",     "push",     "method", "procedure",         "status",
        "factors",  "capacity", "target", "limit_states",      "outcome",
        "messages", "trials",   "trace",  "performance_point", "curve"};
    const json all = Json("evaluate @first-steps");
    ASSERT_EQ(8U, all.size());
    const std::string page = ReadText(ProjectFolder() / "docs/file-formats.md");
    for (const json& r : all) {
        std::set<std::string> keys;
        for (const auto& item : r.items())
            keys.insert(item.key());
        EXPECT_EQ(r.at("trials") != 0, keys.erase("all_points") == 1) << r.at("name");
        EXPECT_EQ(r.at("trials") == 0, keys.erase("derivation") == 1) << r.at("name");
        EXPECT_EQ(r.at("trials") == 0, keys.erase("curve_stays_elastic") == 1) << r.at("name");
        EXPECT_EQ(r.at("trials") != 0, keys.erase("first_slope_change") == 1) << r.at("name");
        EXPECT_EQ(r.at("trials") != 0, keys.erase("periods_by_ductility") == 1) << r.at("name");
        EXPECT_EQ(kKeys, keys) << r.at("name");
        const json flat = r.flatten();
        for (const auto& part : flat.items()) {
            const std::string key = part.key().substr(part.key().rfind('/') + 1);
            if (key.find_first_not_of("0123456789") == std::string::npos) continue;
            EXPECT_NE(std::string::npos, page.find("`" + key + "`"))
                << key << " is not in docs/file-formats.md";
        }
    }
}

TEST_F(Outputs, AdditionalStepsAndSpectraStandBesideTheResult)
{
    const json a = Json(kOne)[0], b = Json(kOne + " --add-step 20 --add-spectrum EC8")[0];
    EXPECT_EQ(a.at("performance_point"), b.at("performance_point"));
    const json& step = b.at("additional_steps").at(0); // D = 0.036 + 0.0048 (20 - 10)
    EXPECT_EQ(20, step.at("step"));
    EXPECT_NEAR(0.084, step.at("D"), 1e-12);
    EXPECT_NEAR(768.0, step.at("V"), 1e-9);
    const json& point = b.at("additional_points").at(0);
    EXPECT_EQ("EC8", point.at("spectrum"));
    EXPECT_EQ("found", point.at("status"));
    EXPECT_NE(a.at("performance_point").at("Sd"), point.at("performance_point").at("Sd"));
}

// Step 41 of 40 is said and left out; target displacements take no spectrum and are not blamed.
TEST_F(Outputs, WhatIsRefusedBesideAResultLeavesTheResults)
{
    EXPECT_EQ(0, Run("evaluate @first-steps --add-spectrum EC8").code);
    const T_RUN run = Run("evaluate @first-steps --add-spectrum EC8 --add-step 41 --json r.json");
    EXPECT_EQ(2, run.code);
    ExpectHolds(run.err, {"41", "PX NTC2018"});
    const json results = json::parse(Text("r.json"));
    ASSERT_EQ(8U, results.size());
    for (const json& r : results)
        EXPECT_EQ(r.at("trials") != 0, r.contains("additional_points")) << r.at("name");
    EXPECT_EQ(2, Run("evaluate @first-steps --only 'PX EC8' --add-spectrum EC8").code);
}

// Yield at Sd = 0.036 / Gamma and 720 kN / (M* g), then 0.05 of the stiffness: T0 = 0.2 pi and
// Teff = T0 sqrt(mu / (1 + 0.05 (mu - 1))); the push ends at mu = 5.
TEST_F(Outputs, SlopeChangeAndPeriodsByDuctilityStandInJsonAndPicture)
{
    const json r = Json("evaluate @first-steps --only 'PX ATC-40 B' --plot p.svg "
                        "--plot-demand d.svg")[0];
    EXPECT_NEAR(0.028, r.at("first_slope_change").at("Sd"), 1e-12);
    const json& periods = r.at("periods_by_ductility");
    ASSERT_EQ(3U, periods.size());
    const double T0 = 0.2 * std::acos(-1.0);
    for (const json& p : periods) {
        const double mu = p.at("mu");
        EXPECT_NEAR(T0 * std::sqrt(mu / (1.0 + 0.05 * (mu - 1.0))), p.at("T_eff"), 1e-4) << mu;
    }
    ExpectHolds(Text("p.svg"), {"first slope change", "Teff(mu=4) = 1.17 s"});
    ExpectHolds(Text("d.svg"), {"T (s)"});
    const json& curve = r.at("curve");
    EXPECT_NEAR(0.14, curve.at("largest_displacement"), 1e-12); // 0.18 m / Gamma
}

TEST_F(Outputs, CompareListsEveryMethodWithTheSpread)
{
    ExpectHolds(Done("compare @first-steps --push PX --spectrum ATC --json c.json"),
                {"ATC-40 A", "ATC-40 B", "FEMA440 A", "FEMA440 B", "FEMA440 C", "EC8 SD",
                 "NTC2008 SLV", "NTC2018 SLV", "spread of D over 8 methods"});
    EXPECT_EQ(Json(kOne)[0].at("performance_point"),
              json::parse(Text("c.json"))[0].at("performance_point"));
}

TEST_F(Outputs, ReportHasItsSectionsAndTheNumbersOfTheJson)
{
    Done(kOne + " --report r.txt --curve c.txt --json r.json");
    const std::string report = Text("r.txt"), curve = Text("c.txt");
    const json point = json::parse(Text("r.json"))[0].at("performance_point");
    const std::string values = "* V, D : " + std::to_string(point.at("V").get<double>()) + ", " +
                               std::to_string(point.at("D").get<double>());
    ExpectHolds(report, {"qm_rps 0.1.0", "[ Performance Point ]", "Disp. Control Node : 4",
                         "Direction : DX", values.c_str(), "Gamma : 1.28571", "m* : 200"});
    EXPECT_TRUE(report.ends_with(curve)) << "the report ends with the curve table";
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

TEST_F(Outputs, ItalianTextsWithTheSameNumbers)
{
    Write("loose.json",
          With(ReadText(ExampleCase("tuned-beam")), "\"restraint\": [1, 0, 1, 0, 0, 0]",
               "\"restraint\": [0, 0, 1, 0, 0, 0]"));
    const struct {
        std::string command;
        std::vector<const char*> says;
    } kRows[] = {
        {"evaluate @first-steps --trace", {"valutazione", "trovato", "domanda", "prova"}},
        {"info @first-steps", {"nodi: ", "valutazione PX EC8"}},
        {"analyse @tuned-beam", {"spostamenti", "reazioni (forze"}},
        {"ulf solve @tuned-beam --item PROPS", {"condizione", "attiva"}},
        {"ulf solve @tuned-beam --item X", {"nessuna voce"}},
        {"analyse loose.json", {"libera di traslare lungo X"}}, // from the engine
    };
    for (const auto& row : kRows) {
        const T_RUN en = Run(row.command), it = Run("--lang it " + row.command);
        EXPECT_EQ(en.code, it.code) << it.err;
        EXPECT_EQ(Numbers(en.out), Numbers(it.out)) << row.command;
        for (const char* text : row.says) {
            ExpectHolds(it.out + it.err, {text});
            EXPECT_EQ(std::string::npos, (en.out + en.err).find(text)) << text;
        }
    }
}

TEST_F(Outputs, AnElementListIsTakenAsWindowsTakeIt)
{
    const auto assigned = [&](const std::string& elements) {
        const int code = Run("hinge assign @hinge-library --type 'steel beam' --elements '" +
                             elements + "' -o a.json --overwrite")
                             .code;
        return code == 0 ? Text("a.json") : std::to_string(code);
    };
    const std::string plain = assigned("2,3");
    EXPECT_GT(plain.size(), 1000U);
    EXPECT_EQ(plain, assigned("3, 2 - 3"));
    EXPECT_EQ("2", assigned("3-2"));
}

#ifdef QM_UI
TEST_F(Outputs, PictureHasTitleAxesLegendAndPoint)
{
    Done(kOne + " --plot p.svg");
    const std::string svg = Text("p.svg");
    EXPECT_TRUE(svg.starts_with("<?xml"));
    ExpectHolds(std::regex_replace(svg, std::regex("<[^>]*>|\n"), ""),
                {"PX ATC-40 A", "Spectral Displacement (m)", "Spectral Acceleration (g)",
                 "Elastic demand", "Reduced demand", "Capacity", "Trial points",
                 "Performance point", "Sd = 0.07752 m", "T_eff = 1.00", "T0 = 0.628 s",
                 "Outcome: converged"});
}
#endif

} // namespace
