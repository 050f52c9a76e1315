// Given forces on sections, from a file and from results, through the program.
#include "program.h"

namespace {

class SectionCheckCommand : public CProgramTest {
protected:
    /// A cantilever of 3 m along X under 10 kN downwards and 100 kN of compression at its end.
    void WriteCantilever() const
    {
        Write("c.json", R"({"format": "qm-rps case 1",
            "units": {"force": "kN", "length": "m"}, "plane": "XZ",
            "nodes": [{"id": 1, "xyz": [0, 0, 0], "restraint": [1, 1, 1, 1, 1, 1]},
                      {"id": 2, "xyz": [3, 0, 0]}],
            "materials": [{"name": "S", "type": "steel", "E": 210e6, "nu": 0.3, "fy": 275000}],
            "sections": [{"name": "H", "shape": "I", "size": [0.2, 0.2, 0.009, 0.015]}],
            "elements": [{"id": 7, "nodes": [1, 2], "material": "S", "section": "H"}],
            "load_cases": [{"name": "P", "nodal": [{"node": 2, "load": [-100, 0, -10, 0, 0, 0]}]}],
            "combinations": [{"name": "ULS", "items": [{"case": "P", "factor": 1.5}]}]})");
    }
};

} // namespace

// By hand: M = -P (L - x), which pulls the upper side (+z); V = P; N = 100, times 1.5.
TEST_F(SectionCheckCommand, TakesTheForcesOfLoadCasesAndCombinations)
{
    WriteCantilever();
    const json r = Json("section check c.json --case P --case ULS --elements 7 --by-ratio");
    const json& sets = r.at("sections").at(0).at("sets");
    ASSERT_EQ(10u, sets.size()); // five places in two cases, no forces are left out
    EXPECT_EQ("ULS 7 I", sets[0].at("name"));
    const json& forces = sets[0].at("forces");
    EXPECT_NEAR(150.0, forces.at("N"), 1e-9);
    EXPECT_NEAR(-45.0, forces.at("My"), 1e-9);
    EXPECT_NEAR(15.0, std::abs(forces.at("Vz").get<double>()), 1e-9);
    EXPECT_EQ(0.0, forces.at("Mz"));
    for (const json& set : sets)
        if (set.at("name") == "P 7 3/4") {
            EXPECT_NEAR(-7.5, set["forces"]["My"], 1e-9);
        }
    // NR = 275e3 0.00753 = 2070.75 kN of the section calculator.
    EXPECT_NEAR(150.0 / 2070.75, sets[0].at("ways").at(0).at("ratio"), 1e-6);
    ExpectRefused("section check c.json --elements 7 --my 1", 2, "--case");
    ExpectRefused("section check c.json --case P --my 1", 2, "--case");
    ExpectRefused("section check c.json --case NO", 2, "NO");
    ExpectRefused("section check c.json --case P --elements 9", 3, "9");
}

TEST_F(SectionCheckCommand, TakesSetsOfAFile)
{
    WriteCantilever();
    Write("f.csv", "\xEF\xBB\xBFMy (kN m),name,N\r\n100,\"at, I\",400\r\n\r\n160,,400\r\n");
    const json r = Json("section check c.json --my 1 --forces f.csv");
    const json& sets = r.at("sections").at(0).at("sets");
    ASSERT_EQ(3u, sets.size());
    EXPECT_EQ("at, I", sets[1].at("name"));
    EXPECT_EQ("2", sets[2].at("name")); // its number in the file
    EXPECT_NEAR(400.0, sets[1]["forces"]["N"], 1e-9);
    EXPECT_NEAR(160.0, sets[2]["forces"]["My"], 1e-9);
    ExpectHolds(Done("section check c.json --forces f.csv"), {"at, I", "EXCEEDED"});
    const struct {
        const char *text, *says;
    } kBad[] = {
        {"name,Q\na,1\n", "line 1: no column is called \"Q\""},
        {"N (N),My\n1,1\n", "N (N)"},
        {"N,N\n1,1\n", "twice"},
        {"N;My\n1;1,5\n", "line 2: My: \"1,5\" is no finite number"},
        {"N,My\n1\n", "line 2: 1 values, the head has 2"},
        {"N,My\n", "no set of forces"},
    };
    for (const auto& bad : kBad) {
        Write("f.csv", bad.text);
        ExpectRefused("section check c.json --forces f.csv", 3, bad.says);
    }
}
