// Unknown load factors through the program: exact factors, the spreadsheet in an office program,
// the combination and its way back, contradictions, refusals.
#include "office.h"
#include "program.h"

#include <cmath>
#include <gtest/gtest.h>
#include <nlohmann/json.hpp>
#include <set>

namespace {

using json = nlohmann::json;

json Solved(const std::string& file, const std::string& item, int code = 0)
{
    const T_RUN run = RunProgram({"ulf", "solve", file, "--item", item, "--json", "-"});
    EXPECT_EQ(code, run.code) << run.err;
    return json::parse(run.out);
}

TEST(Ulf, FiveSpanBeamHasItsExactPropForces)
{
    // Exact rational solution; in units of w L, which is one prop load.
    const double kFactors[] = {43.0 / 38.0, 37.0 / 38.0, 37.0 / 38.0, 43.0 / 38.0};
    for (const char* item : {"PROPS", "MOMENTS"}) {
        const json r = Solved(ExampleCase("tuned-beam"), item);
        EXPECT_EQ("found", r.at("status"));
        EXPECT_EQ(0, r.at("code"));
        EXPECT_EQ("[EXACT]", r.at("mode"));
        for (int i = 0; i < 4; ++i)
            EXPECT_NEAR(kFactors[i], r.at("factors").at("P" + std::to_string(i + 2)).get<double>(),
                        1e-11)
                << item;
        for (const json& c : r.at("constraints")) {
            EXPECT_TRUE(c.at("active")) << c;
            EXPECT_NEAR(0.0, c.at("residual").get<double>(), 1e-9) << c;
        }
        EXPECT_NEAR(2.0 * (43.0 * 43.0 + 37.0 * 37.0) / (38.0 * 38.0),
                    r.at("objective").get<double>(), 1e-10);
    }
}

TEST(Ulf, ResultHasTheDocumentedKeysInTheirOrder)
{
    const T_RUN run =
        RunProgram({"ulf", "solve", ExampleCase("tuned-beam"), "--item", "SMALL", "--json", "-"});
    const auto r = nlohmann::ordered_json::parse(run.out);
    std::string keys;
    for (const auto& part : r.items())
        keys += part.key() + " ";
    EXPECT_EQ("status code message mode factors constraints objective ", keys);
    keys.clear();
    for (const auto& part : r.at("constraints").at(0).items())
        keys += part.key() + " ";
    EXPECT_EQ("name value upper lower residual active ", keys);
    EXPECT_EQ("[OPTIMIZE]", r.at("mode"));
    EXPECT_LT(r.at("objective").get<double>(), 4.457063) << "bounds are weaker than targets";
}

TEST(Ulf, CableStayedDeckIsLevelUnderDeadLoad)
{
    // Solved from another solver's recorded influence values with exact fractions.
    const std::pair<const char*, double> kFactors[] = {
        {"T101", 5774.555}, {"T102", 2765.100}, {"T103", 1518.974}, {"T104", 3603.577},
        {"T105", 4067.988}, {"T106", 1211.840}, {"T107", 4358.482}, {"T108", 4999.430}};
    const json r = Solved(ExampleCase("cable-stayed-bridge"), "LEVEL");
    for (const auto& [name, factor] : kFactors)
        EXPECT_NEAR(factor, r.at("factors").at(name).get<double>(), 1e-3) << name;
    EXPECT_EQ(1.0, r.at("factors").at("DEAD"));
}

TEST(Ulf, EveryOptimumKeepsItsBoundsAndMinMaxIsEven)
{
    const json square = Solved(ExampleCase("cable-stayed-bridge"), "BOUNDS");
    const json even = Solved(ExampleCase("cable-stayed-bridge"), "EVEN");
    const auto largest = [](const json& r) {
        double value = 0.0;
        for (const auto& f : r.at("factors").items())
            value = std::max(value, std::fabs(f.value().get<double>()));
        return value;
    };
    for (const json& r : {square, even}) {
        EXPECT_EQ("found", r.at("status"));
        for (const json& c : r.at("constraints")) {
            const double value = c.at("value"), size = std::fabs(c.at("upper").get<double>());
            EXPECT_LE(value, c.at("upper").get<double>() + 1e-9 * size) << c;
            EXPECT_GE(value, c.at("lower").get<double>() - 1e-9 * size) << c;
        }
    }
    EXPECT_NEAR(largest(even), even.at("objective").get<double>(), 1e-6);
    EXPECT_LT(largest(even), largest(square));
}

TEST(Ulf, AContradictionIsToldWithItsMembersAndACompromise)
{
    const std::string file = ExampleCase("tuned-beam");
    const json none = Solved(file, "IMPOSSIBLE", 1);
    EXPECT_EQ("not found", none.at("status"));
    EXPECT_EQ(6, none.at("code"));
    EXPECT_TRUE(none.at("factors").empty());
    EXPECT_TRUE(none.at("objective").is_null());

    const T_RUN run = RunProgram({"ulf", "explain", file, "--item", "IMPOSSIBLE", "--json", "-"});
    EXPECT_EQ(1, run.code) << run.err;
    const json e = json::parse(run.out);
    // Level supports leave no choice: the moment is 3/38 w L2 = 78.9, not at most 50.
    std::set<std::string> names;
    for (const json& member : e.at("conflict"))
        names.insert(member.at("name").get<std::string>());
    EXPECT_EQ((std::set<std::string>{"D2", "D3", "D4", "D5", "M3 small"}), names);
    EXPECT_EQ(4, e.at("rank"));
    EXPECT_FALSE(e.at("solved"));
    EXPECT_EQ(5U, e.at("compromise").at("factors").size());

    const T_RUN held = RunProgram({"ulf", "explain", file, "--item", "SMALL", "--json", "-"});
    EXPECT_EQ(0, held.code) << held.err;
    const json h = json::parse(held.out).at("held");
    ASSERT_EQ(2U, h.size()) << "two props are at their bound";
    EXPECT_EQ("sag 2", h.at(0).at("name"));
    EXPECT_EQ("lower", h.at(0).at("limit"));
}

TEST(Ulf, MultiplierIsWhatAUnitOfRelaxationBuys)
{
    // Difference quotient of the objective over the bound of one prop, by solving again.
    const CTempFolder folder;
    const std::string file = folder / "c.json";
    std::string text = ReadText(ExampleCase("tuned-beam"));
    const auto at = text.find("\"lower\": -0.005", text.find("\"sag 2\""));
    ASSERT_NE(std::string::npos, at);
    const auto objective = [&](const char* bound) {
        std::string changed = text;
        WriteText(file, changed.replace(at, 15, std::string("\"lower\": ") + bound));
        return Solved(file, "SMALL").at("objective").get<double>();
    };
    const double slope = (objective("-0.004999") - objective("-0.005001")) / 2e-6;
    const T_RUN run =
        RunProgram({"ulf", "explain", ExampleCase("tuned-beam"), "--item", "SMALL", "--json", "-"});
    const json held = json::parse(run.out).at("held");
    EXPECT_NEAR(slope, held.at(0).at("multiplier").get<double>(), 1e-4 * std::fabs(slope));
}

TEST(Ulf, TheSheetLivesInAnOfficeProgram)
{
    if (!COffice::IsThere()) GTEST_SKIP() << "soffice or python3 is not installed";
    const CTempFolder folder;
    const std::string sheet = folder / "level.xlsx";
    const std::string file = ExampleCase("cable-stayed-bridge");
    const T_RUN run =
        RunProgram({"ulf", "export", file, "--item", "LEVEL", "-o", sheet, "--date", "2026-3-7"});
    ASSERT_EQ(0, run.code) << run.err;
    const COffice office;
    const OFFICE_CELLS cells = office.Recalculated(sheet);
    ASSERT_LE(21U, cells.size());
    EXPECT_EQ("UnknownLoad Factor Result (Influence Matrix)", cells[1][0]);
    EXPECT_EQ("Date : 2026/3/7", cells[3][3]);
    EXPECT_EQ("Number of Constraints : 8", cells[4][0]);
    EXPECT_EQ("Number of Load Cases : 10", cells[4][3]);
    EXPECT_EQ("level 2", cells[7][2]);
    EXPECT_EQ("T101", cells[13][0]);
    const json solved = Solved(file, "LEVEL"),
               results =
                   json::parse(RunProgram({"analyse", file, "--case", "T101", "--json", "-"}).out);
    EXPECT_NEAR(solved.at("factors").at("T101").get<double>(), std::stod(cells[13][1]), 1e-9);
    const double unit = results.at("displacements").at("T101").at("2").at(2);
    EXPECT_NEAR(unit, std::stod(cells[13][2]), 1e-14 * std::fabs(unit) + 1e-19);
    for (std::size_t j = 2; j < 10; ++j) // levels of some 0.1 m cancel
        EXPECT_NEAR(0.0, std::stod(cells[10][j]), 1e-12) << j;
    EXPECT_EQ("=SUMPRODUCT(B12:B21,C12:C21)", office.Formulas(sheet)[10][2]);

    // One more kN in stay 101 moves every place by its influence value.
    const double factor = std::stod(cells[13][1]);
    ASSERT_TRUE(COffice::PutNumber(sheet, "B14", factor + 1000.0));
    const OFFICE_CELLS changed = office.Recalculated(sheet);
    for (std::size_t j = 2; j < 10; ++j)
        EXPECT_NEAR(1000.0 * std::stod(cells[13][j]), std::stod(changed[10][j]), 1e-12) << j;
}

TEST(Ulf, TheCombinationGivesTheConstraintValues)
{
    const CTempFolder folder;
    const std::string file = ExampleCase("cable-stayed-bridge"), tuned = folder / "tuned.json";
    const std::vector<std::string> combine{"ulf",    "combine", file, "--item", "BOUNDS",
                                           "--name", "TUNED",   "-o", tuned};
    const T_RUN run = RunProgram(combine);
    ASSERT_EQ(0, run.code) << run.err;
    const json solved = Solved(file, "BOUNDS");
    const json shape =
        json::parse(RunProgram({"analyse", tuned, "--case", "TUNED", "--json", "-"}).out);
    for (const json& c : solved.at("constraints")) {
        const std::string name = c.at("name");
        const double value = c.at("value");
        double read = 0.0;
        if (name.starts_with("deck "))
            read = shape.at("displacements").at("TUNED").at(name.substr(5)).at(2);
        else if (name.starts_with("stay "))
            read = shape.at("truss").at("TUNED").at(name.substr(5));
        else
            read = shape.at("displacements").at("TUNED").at("55").at(0);
        EXPECT_NEAR(value, read, 1e-9 * std::max(1.0, std::fabs(value))) << name;
    }
    // The same into a model file, in place.
    const std::string model = folder / "m.qmdb";
    ASSERT_EQ(0, RunProgram({"import", file, model}).code);
    ASSERT_EQ(0, RunProgram({"analyse", model, "--json", folder / "r.json"}).code);
    ASSERT_EQ(0, RunProgram({"ulf", "combine", model, "--item", "BOUNDS", "--name", "TUNED"}).code);
    const json stored =
        json::parse(RunProgram({"analyse", model, "--case", "TUNED", "--json", "-"}).out);
    EXPECT_EQ(shape.at("truss"), stored.at("truss"));
    EXPECT_EQ(solved, Solved(model, "BOUNDS")) << "the results are not older than the model";
}

TEST(Ulf, AChangedModelMakesItsResultsStale)
{
    const CTempFolder folder;
    const std::string model = folder / "m.qmdb", text = folder / "m.json";
    ASSERT_EQ(0, RunProgram({"import", ExampleCase("tuned-beam"), model}).code);
    const T_RUN run = RunProgram({"ulf", "solve", model, "--item", "PROPS"});
    EXPECT_EQ(3, run.code);
    EXPECT_NE(std::string::npos, run.err.find("\"W\"")) << "the case is named: " << run.err;
}

#ifdef QM_UI
TEST(Ulf, PicturesShowEveryConstraintAndBothShapes)
{
    const CTempFolder folder;
    const T_RUN run =
        RunProgram({"ulf", "solve", ExampleCase("cable-stayed-bridge"), "--item", "BOUNDS",
                    "--plot", folder / "b.svg", "--shape-plot", folder / "s.svg"});
    ASSERT_EQ(0, run.code) << run.err;
    const std::string bars = ReadText(folder / "b.svg"), shape = ReadText(folder / "s.svg");
    for (const char* text : {"deck 2", "pylon top", "stay 108", "upper bound", "active", "3348 kN",
                             "Constraint", "T101 = "})
        EXPECT_NE(std::string::npos, bars.find(text)) << text;
    for (const char* text : {"known load cases alone", "with the factors found", "Undeformed"})
        EXPECT_NE(std::string::npos, shape.find(text)) << text;
}
#endif

TEST(Ulf, RefusalsHaveTheirExitCodesAndLeaveNothing)
{
    const CTempFolder folder;
    const std::string file = ExampleCase("tuned-beam");
    const struct {
        std::vector<std::string> arguments;
        int code;
        const char* says;
    } kRows[] = {
        {{"solve", file, "--item", "none"}, 2, "none"},
        {{"solve", file}, 2, "--item"},
        {{"solve", folder / "none.json", "--item", "PROPS"}, 4, "none.json"},
        {{"solve", file, "--item", "PROPS", "--plot", folder / "p.gif"}, 2, "picture"},
        {{"export", file, "--item", "IMPOSSIBLE", "-o", folder / "s.xlsx"}, 1, "no solution"},
        {{"export", file, "--item", "PROPS", "-o", folder / "no/s.xlsx"}, 4, "no/s.xlsx"},
        {{"export", file, "--item", "PROPS", "-o", folder / "s.xlsx", "--date", "7.3.2026"},
         2,
         "YYYY-MM-DD"},
        {{"combine", file, "--item", "PROPS", "--name", "X"}, 2, "-o"},
        {{"combine", file, "--item", "PROPS", "--name", "ALL", "-o", folder / "c.json"}, 2, "ALL"},
        {{"combine", file, "--item", "PROPS", "--name", "", "-o", folder / "c.json"}, 2, "name"},
    };
    for (const auto& row : kRows) {
        std::vector<std::string> arguments{"ulf"};
        arguments.insert(arguments.end(), row.arguments.begin(), row.arguments.end());
        const T_RUN run = RunProgram(arguments);
        EXPECT_EQ(row.code, run.code) << row.says << ": " << run.err;
        EXPECT_EQ(1U, Lines(run.err).size()) << run.err;
        EXPECT_NE(std::string::npos, run.err.find(row.says)) << run.err;
    }
    EXPECT_TRUE(folder.Names().empty());
}

// The props push upward (factors 43/38 and 37/38), which the sign forbids.
TEST(Ulf, EquationsWhoseOnlyFactorsHaveTheWrongSignHaveNoSolution)
{
    const CTempFolder folder;
    const std::string file = folder / "c.json";
    json document = json::parse(ReadText(ExampleCase("tuned-beam")));
    json& item = document.at("ulf_items").at(0);
    ASSERT_EQ("PROPS", item.at("name"));
    item["sign"] = "negative";
    WriteText(file, document.dump());
    const json none = Solved(file, "PROPS", 1);
    EXPECT_EQ("not found", none.at("status"));
    EXPECT_EQ("[EXACT]", none.at("mode"));
    EXPECT_TRUE(none.at("factors").empty());
}

TEST(Ulf, BrokenItemsAreListedByCheckAndRefusedBySolve)
{
    const struct {
        const char* label;
        void (*spoil)(json& document);
    } kRows[] = {
        {"constraint on a missing node",
         [](json& d) { d.at("ulf_constraints").at(0).at("id") = 22; }},
        {"constraint that is not there",
         [](json& d) { d.at("ulf_items").at(0).at("constraints").at(1) = "D9"; }},
        {"no unknown", [](json& d) { d.at("ulf_items").at(0).at("unknown") = json::array(); }},
        {"no constraint",
         [](json& d) { d.at("ulf_items").at(0).at("constraints") = json::array(); }},
        {"bounds that cross",
         [](json& d) {
             json& c = d.at("ulf_constraints").at(0);
             c.erase("equal");
             c["upper"] = -1;
             c["lower"] = 1;
         }},
    };
    const CTempFolder folder;
    const std::string file = folder / "c.json";
    for (const auto& row : kRows) {
        json document = json::parse(ReadText(ExampleCase("tuned-beam")));
        row.spoil(document);
        WriteText(file, document.dump());
        const T_RUN solve = RunProgram({"ulf", "solve", file, "--item", "PROPS"});
        EXPECT_EQ(3, solve.code) << row.label << solve.out;
        EXPECT_EQ(1U, Lines(solve.err).size()) << row.label << ": " << solve.err;
        const int check = RunProgram({"ulf", "check", file}).code;
        EXPECT_TRUE(check == 1 || check == 3) << row.label << ": a finding, or not even read";
    }
    const T_RUN check = RunProgram({"ulf", "check", ExampleCase("tuned-beam")});
    EXPECT_EQ(0, check.code) << check.out;
    const T_RUN list = RunProgram({"ulf", "list", ExampleCase("tuned-beam")});
    EXPECT_NE(std::string::npos, list.out.find("4 items, 13 constraints")) << list.out;
}

} // namespace
