// Unknown load factor items of construction stages through the program.
#include "office.h"
#include "program.h"
#include "stagecase.h"

#include <functional>

namespace {

class StageUlf : public CProgramTest {
protected:
    StageUlf() { Write("c.json", kStageCase); }
    void Spoil(const std::function<void(json&)>& change) const
    {
        json document = json::parse(kStageCase);
        change(document);
        Write("c.json", document.dump());
    }
};

TEST_F(StageUlf, ListsAndChecksItemsOfStages)
{
    ExpectHolds(Done("ulf list c.json"),
                {"STAY: construction stages, 1 of 2 loads unknown (1 scale pretension)",
                 "Dead load: 0 of 1 unknown", "Erection load: 0 of 0", "Sum: 1 of 2 unknown",
                 "HOLD (S1/Last Step)", "5 items, 4 constraints"});
    EXPECT_EQ("5 items, 0 findings\n", Done("ulf check c.json"));
    Spoil([](json& d) { d.at("ulf_stage_items").at(0).at("unknown").at(0).at("case") = "G"; });
    const T_RUN check = Run("ulf check c.json --item STAY");
    EXPECT_EQ(1, check.code);
    ExpectHolds(check.out, {"rows[1].pretension", "row 1 (S1/First Step G)"});
    ExpectRefused("ulf solve c.json --item STAY", 3, "row 1 (S1/First Step G)");
}

TEST_F(StageUlf, SolvesFromACaseFileAndFromAModelFile)
{
    Done("import c.json m.qmdb");
    for (const std::string file : {"c.json", "m.qmdb"}) {
        const json r = Json("ulf solve " + file + " --item STAY");
        EXPECT_EQ("found", r.at("status"));
        EXPECT_EQ("[EXACT]", r.at("mode"));
        EXPECT_NEAR(4.0, r.at("factors").at("S1/First Step T"), 1e-12);
        EXPECT_EQ(1.0, r.at("factors").at("S1/First Step G"));
        EXPECT_EQ("S1/Last Step", r.at("constraints").at(0).at("place"));
        EXPECT_NEAR(0.0, r.at("constraints").at(0).at("value"), 1e-15);
    }
    // The square of T = 2.
    EXPECT_NEAR(4.0, Json("ulf solve c.json --item LEAST").at("objective"), 1e-8);
    ExpectHolds(Done("ulf solve c.json --item LEAST"), {"stage/step case"});
    // From all loads, as the item says: u = (4 - T) / 20 = 3 / 20 at T = 1, so 0.2 is 4/3 of it.
    EXPECT_NEAR(4.0 / 3, Json("ulf solve m.qmdb --item WILD").at("factors").at("S1/First Step T"),
                1e-12);
}

TEST_F(StageUlf, ExplainsWhatHoldsTheFactor)
{
    const json held = Json("ulf explain c.json --item LEAST").at("held");
    ASSERT_EQ(1U, held.size());
    EXPECT_EQ("MOST", held.at(0).at("name"));
    // T = 4 - 20 u, objective T^2: d/du = -40 T = -80 at T = 2.
    EXPECT_NEAR(-80.0, held.at(0).at("multiplier"), 1e-6);
    const T_RUN none = Run("ulf explain c.json --item SIGN");
    EXPECT_EQ(1, none.code);
    ExpectHolds(none.out, {"sign restriction", "S1/First Step T = "});
}

TEST_F(StageUlf, SheetNamesStageAndStep)
{
    Done("ulf export c.json --item STAY -o s.xlsx");
    if (!COffice::IsThere()) GTEST_SKIP() << "soffice or python3 is not installed";
    const OFFICE_CELLS cells = COffice().Recalculated(m_folder / "s.xlsx");
    ASSERT_LE(13U, cells.size());
    EXPECT_EQ("HOLD (S1/Last Step)", cells[7][2]);
    EXPECT_EQ("S1/First Step T", cells[11][0]);
    EXPECT_NEAR(4.0, std::stod(cells[11][1]), 1e-12);
    EXPECT_NEAR(-0.05, std::stod(cells[11][2]), 1e-15);
    EXPECT_NEAR(0.0, std::stod(cells[10][2]), 1e-14);
}

TEST_F(StageUlf, RefusesWhatDoesNotExistAtStages)
{
    Done("import c.json m.qmdb");
    const std::string before = Text("m.qmdb");
    ExpectRefused("ulf combine m.qmdb --item STAY --name X", 2,
                  "no combination of loads at stages");
    ExpectRefused("ulf combine m.qmdb --item STAY --name X", 2, "ulf iterate");
    ExpectRefused("ulf solve m.qmdb --item STAY --shape-plot p.svg", 2, "--shape-plot");
    const T_RUN sign = Run("ulf solve m.qmdb --item SIGN");
    EXPECT_EQ(1, sign.code);
    ExpectHolds(sign.err, {"(S1/First Step T)"});
    EXPECT_EQ(before, Text("m.qmdb"));
    EXPECT_EQ((std::vector<std::string>{"c.json", "m.qmdb"}), m_folder.Names());
}

TEST_F(StageUlf, RefusesANameOfBothKinds)
{
    Spoil([](json& d) {
        d["combinations"] = {{{"name", "C"}, {"items", {{{"case", "G"}, {"factor", 1}}}}}};
        d["ulf_items"] = {{{"name", "STAY"},
                           {"combination", "C"},
                           {"objective", "linear"},
                           {"unknown", {{{"case", "G"}}}},
                           {"constraints", {"U02"}}}};
    });
    ExpectRefused("ulf solve c.json --item STAY", 3, "another name");
    const T_RUN check = Run("ulf check c.json --item STAY");
    EXPECT_EQ(1, check.code);
    ExpectHolds(check.out, {"2 items, 2 findings"});
}

TEST_F(StageUlf, AConstraintThatIsNamedTwiceIsTold)
{
    Spoil([](json& d) { d.at("ulf_stage_items").at(0).at("constraints").push_back("HOLD"); });
    ExpectHolds(Run("ulf check c.json --item STAY").out, {"named twice"});
    ExpectRefused("ulf solve c.json --item STAY", 3, "named twice");
}

TEST_F(StageUlf, TheProblemOfTheSolverIsDumpedOnRequest)
{
    Done("ulf solve c.json --item STAY --dump");
    // By hand: -T / 20 = -4 / 20.
    ExpectHolds(Text("c_[EXACT].out"),
                {"NVAR  = 1", "NEQ   = 1", "RHS8(1) = -0.200000", "COEFVEC(1) = -0.050000"});
}

TEST_F(StageUlf, AForecastOfAModelThatIsNotLinearIsCalledOne)
{
    const std::string note = "linear forecast";
    EXPECT_EQ(std::string::npos, Done("ulf solve c.json --item STAY").find(note));
    Spoil([](json& d) {
        d["stage_control"] = {{"birth", "deformed"}, {"geometric_stiffness", true}};
    });
    ExpectHolds(Done("ulf solve c.json --item STAY"), {"forecast", note.c_str()});
    EXPECT_TRUE(Json("ulf solve c.json --item STAY").at("linear_forecast"));
    ExpectHolds(Done("ulf iterate c.json --item STAY"), {note.c_str()});
}

TEST_F(StageUlf, TellsWhyTheStagesCannotBeAnalysed)
{
    Spoil([](json& d) { d.at("stages").at(0).at("activate").at("supports") = {2}; });
    ExpectRefused("ulf solve c.json --item STAY", 3, "S1");
}

#ifdef QM_UI
TEST_F(StageUlf, PictureNamesStageAndStep)
{
    Done("ulf solve c.json --item STAY --plot b.svg");
    ExpectHolds(Text("b.svg"), {"HOLD (S1/Last Step)", "S1/First Step T = 4"});
}
#endif

} // namespace
