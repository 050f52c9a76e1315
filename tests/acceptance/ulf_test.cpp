// Unknown load factors through the program: exact factors, the spreadsheet in an office program,
// the combination and its way back, contradictions, refusals.
#include "office.h"
#include "program.h"
#include "stagecase.h"

#include <functional>
#include <set>
#include <sstream>

namespace {

using Ulf = CProgramTest;

TEST_F(Ulf, FiveSpanBeamHasItsExactPropForces)
{
    // Exact rational solution; in units of w L, which is one prop load.
    const double kFactors[] = {43.0 / 38.0, 37.0 / 38.0, 37.0 / 38.0, 43.0 / 38.0};
    for (const char* item : {"PROPS", "MOMENTS"}) {
        const json r = Json(std::string("ulf solve @tuned-beam --item ") + item);
        EXPECT_EQ("found", r.at("status"));
        EXPECT_EQ(0, r.at("code"));
        EXPECT_EQ("[EXACT]", r.at("mode"));
        for (int i = 0; i < 4; ++i)
            EXPECT_NEAR(kFactors[i], r.at("factors").at("P" + std::to_string(i + 2)), 1e-11);
        for (const json& c : r.at("constraints")) {
            EXPECT_TRUE(c.at("active")) << c;
            EXPECT_NEAR(0.0, c.at("residual"), 1e-9) << c;
        }
        EXPECT_NEAR(2.0 * (43.0 * 43.0 + 37.0 * 37.0) / (38.0 * 38.0), r.at("objective"), 1e-10);
    }
}

TEST_F(Ulf, ResultHasTheDocumentedKeysInTheirOrder)
{
    const auto r =
        nlohmann::ordered_json::parse(Done("ulf solve @tuned-beam --item SMALL --json -"));
    std::string keys;
    for (const auto& part : r.items())
        keys += part.key() + " ";
    for (const auto& part : r.at("constraints").at(0).items())
        keys += " " + part.key();
    EXPECT_EQ("status code message mode factors constraints objective "
              " name value unit upper lower residual active",
              keys);
    EXPECT_EQ("[OPTIMIZE]", r.at("mode"));
}

TEST_F(Ulf, CableStayedDeckIsLevelUnderDeadLoad)
{
    // Solved from another solver's recorded influence values with exact fractions.
    const std::pair<const char*, double> kFactors[] = {
        {"T101", 5774.555}, {"T102", 2765.100}, {"T103", 1518.974}, {"T104", 3603.577},
        {"T105", 4067.988}, {"T106", 1211.840}, {"T107", 4358.482}, {"T108", 4999.430}};
    const json factors = Json("ulf solve @cable-stayed-bridge --item LEVEL").at("factors");
    for (const auto& [name, factor] : kFactors)
        EXPECT_NEAR(factor, factors.at(name), 1e-3) << name;
    EXPECT_EQ(1.0, factors.at("DEAD"));
}

TEST_F(Ulf, AContradictionIsToldWithItsMembersAndACompromise)
{
    const json none = Json("ulf solve @tuned-beam --item IMPOSSIBLE", 1);
    EXPECT_EQ("not found", none.at("status"));
    EXPECT_EQ(6, none.at("code"));
    EXPECT_TRUE(none.at("factors").empty());
    EXPECT_TRUE(none.at("objective").is_null());

    const json e = Json("ulf explain @tuned-beam --item IMPOSSIBLE", 1);
    // Level supports leave no choice: the moment is 3/38 w L2 = 78.9, not at most 50.
    std::set<std::string> names;
    for (const json& member : e.at("conflict"))
        names.insert(member.at("name"));
    EXPECT_EQ((std::set<std::string>{"D2", "D3", "D4", "D5", "M3 small"}), names);
    EXPECT_EQ(4, e.at("rank"));
    EXPECT_FALSE(e.at("solved"));
    EXPECT_EQ(5U, e.at("compromise").at("factors").size());

    const json held = Json("ulf explain @tuned-beam --item SMALL").at("held");
    ASSERT_EQ(2U, held.size()) << "two props are at their bound";
    EXPECT_EQ("sag 2", held.at(0).at("name"));
    EXPECT_EQ("lower", held.at(0).at("limit"));
}

TEST_F(Ulf, TheSheetLivesInAnOfficeProgram)
{
    if (!COffice::IsThere()) GTEST_SKIP() << "soffice or python3 is not installed";
    const std::string sheet = m_folder / "level.xlsx";
    Done("ulf export @cable-stayed-bridge --item LEVEL -o level.xlsx --date 2026-3-7");
    const COffice office;
    const OFFICE_CELLS cells = office.Recalculated(sheet);
    ASSERT_LE(21U, cells.size());
    EXPECT_EQ("Date : 2026/3/7", cells[3][3]);
    EXPECT_EQ("T101", cells[13][0]);
    EXPECT_EQ("Quantity", cells[5][1]);
    EXPECT_EQ("m", cells[6][2]);
    EXPECT_EQ("unknown", cells[13][10]); // beside the frame of eight constraints
    const json solved = Json("ulf solve @cable-stayed-bridge --item LEVEL"),
               results = Json("analyse @cable-stayed-bridge --case T101");
    const double factor = std::stod(cells[13][1]);
    EXPECT_NEAR(solved.at("factors").at("T101"), factor, 1e-9);
    const double unit = results.at("displacements").at("T101").at("2").at(2);
    EXPECT_NEAR(unit, std::stod(cells[13][2]), 1e-14 * std::fabs(unit) + 1e-19);
    EXPECT_EQ("=SUMPRODUCT(B12:B21,C12:C21)", office.Formulas(sheet)[10][2]);

    // One more kN in stay 101 moves every place by its influence value.
    ASSERT_TRUE(COffice::PutNumber(sheet, "B14", factor + 1000.0));
    const OFFICE_CELLS changed = office.Recalculated(sheet);
    for (std::size_t j = 2; j < 10; ++j) { // levels of some 0.1 m cancel
        EXPECT_NEAR(0.0, std::stod(cells[10][j]), 1e-12) << j;
        EXPECT_NEAR(1000.0 * std::stod(cells[13][j]), std::stod(changed[10][j]), 1e-12) << j;
    }
}

TEST_F(Ulf, TheCombinationGivesTheConstraintValues)
{
    Done("ulf combine @cable-stayed-bridge --item BOUNDS --name TUNED -o tuned.json");
    const json solved = Json("ulf solve @cable-stayed-bridge --item BOUNDS");
    const json shape = Json("analyse tuned.json --case TUNED");
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
        EXPECT_LE(value, c.at("upper").get<double>() + 1e-9 * std::fabs(value)) << c;
        EXPECT_GE(value, c.at("lower").get<double>() - 1e-9 * std::fabs(value)) << c;
    }
    // The same into a model file, in place.
    Done("import @cable-stayed-bridge m.qmdb");
    Done("analyse m.qmdb --json r.json");
    Done("ulf combine m.qmdb --item BOUNDS --name TUNED");
    EXPECT_EQ(shape.at("truss"), Json("analyse m.qmdb --case TUNED").at("truss"));
    EXPECT_EQ(solved, Json("ulf solve m.qmdb --item BOUNDS")) << "the results are not older";
}

// Stay 107 is at its bound of 3348 kN; a unit load is 1 kN.
TEST_F(Ulf, StaysAreListedWithTheirUnitAndForces)
{
    const std::string out = Done("ulf solve @cable-stayed-bridge --item BOUNDS");
    ExpectHolds(out, {"start kN", "pretension kN", "force kN"});
    const json factors = Json("ulf solve @cable-stayed-bridge --item BOUNDS").at("factors");
    bool found = false;
    for (const std::string& line : Lines(out)) {
        std::istringstream words(line);
        std::string element, load;
        double start = 0.0, factor = 0.0, now = 0.0, force = 0.0;
        if (!(words >> element >> load >> start >> factor >> now >> force) || element != "107")
            continue;
        found = true;
        EXPECT_EQ(1.0, start);
        EXPECT_NEAR(factors.at("T107"), now, 1e-3);
        EXPECT_NEAR(3348.0, force, 1e-2);
    }
    EXPECT_TRUE(found);
}

#ifdef QM_UI
TEST_F(Ulf, PicturesShowEveryConstraintAndBothShapes)
{
    Done("ulf solve @cable-stayed-bridge --item BOUNDS --plot b.svg --shape-plot s.svg");
    ExpectHolds(Text("b.svg"), {"deck 2", "pylon top", "stay 108", "upper bound", "active",
                                "3348 kN", "Constraint", "T101 = "});
    ExpectHolds(Text("s.svg"), {"known load cases alone", "with the factors found", "Undeformed"});
}
#endif

// P moves node 2 by 1/20 a unit, to 0 and to 0.2 at once: the equations are met between.
TEST_F(Ulf, FactorsThatMissConstraintsAreWrittenOnlyWhenForced)
{
    json d = json::parse(kStageCase);
    d["load_cases"].push_back(
        {{"name", "P"}, {"nodal", {{{"node", 2}, {"load", {1, 0, 0, 0, 0, 0}}}}}});
    d["load_cases"].push_back(
        {{"name", "R"}, {"nodal", {{{"node", 2}, {"load", {2, 0, 0, 0, 0, 0}}}}}});
    d["combinations"] = {
        {{"name", "C"},
         {"items", {{{"case", "P"}, {"factor", 1}}, {{"case", "R"}, {"factor", 1}}}}}};
    d["ulf_items"] = {{{"name", "BOTH"},
                       {"combination", "C"},
                       {"objective", "linear"},
                       {"unknown", {{{"case", "P"}}, {{"case", "R"}}}},
                       {"constraints", {"U01", "U02"}}}};
    Write("c.json", d.dump());
    for (const std::string action : {"ulf export c.json --item BOTH -o s.xlsx",
                                     "ulf combine c.json --item BOTH --name N -o n.json"}) {
        ExpectRefused(action, 1, "U01, U02");
        EXPECT_EQ(std::vector<std::string>{"c.json"}, m_folder.Names());
    }
    ExpectHolds(Run("ulf export c.json --item BOTH -o s.xlsx --force").err, {"U01, U02"});
    Done("ulf combine c.json --item BOTH --name N -o n.json --force");
    EXPECT_EQ((std::vector<std::string>{"c.json", "n.json", "s.xlsx"}), m_folder.Names());
}

TEST_F(Ulf, TheSheetIsOpenedOnRequestOrItIsSaidThatItCanNot)
{
    std::filesystem::create_directory(m_folder / "bin");
    for (const int code : {0, 3}) { // of the desktop's program
        Write("bin/xdg-open",
              "#!/bin/sh\necho \"$1\" > opened\nexit " + std::to_string(code) + "\n");
        const T_RUN run = Run("ulf export @tuned-beam --item PROPS -o s.xlsx --overwrite --open",
                              "chmod +x bin/xdg-open; export PATH=\"$PWD/bin:$PATH\"; ");
        EXPECT_EQ(code == 0 ? 0 : 4, run.code) << run.err;
        EXPECT_EQ("s.xlsx\n", Text("opened"));
        EXPECT_EQ(code != 0, run.err.ends_with("Couldn't start Excel.\n"));
        EXPECT_TRUE(std::filesystem::exists(m_folder / "s.xlsx"));
    }
}

TEST_F(Ulf, RefusalsHaveTheirExitCodesAndLeaveNothing)
{
    const struct {
        const char* arguments;
        int code;
        const char* says;
    } kRows[] = {
        {"solve @tuned-beam --item none", 2, "none"},
        {"solve @tuned-beam", 2, "--item"},
        {"solve none.json --item PROPS", 4, "none.json"},
        {"solve @tuned-beam --item PROPS --plot p.gif", 2, "picture"},
        {"export @tuned-beam --item IMPOSSIBLE -o s.xlsx", 1, "no solution"},
        {"export @tuned-beam --item PROPS -o no/s.xlsx", 4, "no/s.xlsx"},
        {"export @tuned-beam --item PROPS -o s.xlsx --date 7.3.2026", 2, "YYYY-MM-DD"},
        {"combine @tuned-beam --item PROPS --name X", 2, "-o"},
        {"combine @tuned-beam --item PROPS --name ALL -o c.json", 2, "ALL"},
        {"combine @tuned-beam --item PROPS --name '' -o c.json", 2, "name"},
    };
    for (const auto& row : kRows)
        ExpectRefused(std::string("ulf ") + row.arguments, row.code, row.says);
    EXPECT_TRUE(m_folder.Names().empty());
}

TEST_F(Ulf, BrokenItemsAreListedByCheckAndRefusedBySolve)
{
    const struct {
        const char* label;
        std::function<void(json& item, json& constraint)> spoil;
    } kRows[] = {
        {"missing node", [](json&, json& c) { c["id"] = 22; }},
        {"missing constraint", [](json& i, json&) { i["constraints"][1] = "D9"; }},
        {"no unknown", [](json& i, json&) { i["unknown"] = json::array(); }},
    };
    for (const auto& row : kRows) {
        json document = json::parse(ReadText(ExampleCase("tuned-beam")));
        row.spoil(document.at("ulf_items").at(0), document.at("ulf_constraints").at(0));
        Write("c.json", document.dump());
        ExpectRefused("ulf solve c.json --item PROPS", 3, "");
        EXPECT_EQ(1, Run("ulf check c.json").code) << row.label << ": a finding";
    }
    Done("ulf check @tuned-beam");
    ExpectHolds(Done("ulf list @tuned-beam"), {"4 items, 13 constraints"});
}

} // namespace
